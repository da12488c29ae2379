#!/usr/bin/env python3
"""Writes the meshes that the preview draws with: ManipulatorRing.fbx, a ring of radius 1 about Z, and
tetra_stripe.fbx, a bone of length 1 along Z whose stripe looks along Y. One unit of the files is a millimetre.

    make_geometry.py [-o FOLDER]

The same call always gives the same bytes.
"""

import argparse
import math
import pathlib
import sys

HERE = pathlib.Path(__file__).resolve().parent
# The demo's files are written by the same writer.
sys.path.insert(0, str(HERE.parents[2] / "demo"))

import fbx_file  # noqa: E402
from fbx_scene import (document, global_settings, material, material_layer, mesh_geometry, model,  # noqa: E402
                       normal_layer, prop)

VERSION = 7400
SCENE_ID, MODEL_ID, GEOMETRY_ID, MATERIAL_ID = 1000, 1001, 1002, 1003
# Centimetres of a unit.
UNIT_SCALE = 0.1
DECIMALS = 9

# At its usual size on the screen the ring's tube is two pixels thick.
RING_STEPS, RING_SIDES, RING_TUBE = 96, 6, 0.02

# Where the bone is thickest, and its corners there, as seen against Z: the upper edge is as wide as the stripe.
BONE_SHOULDER = 0.12
BONE_CORNERS = ((-0.03, 0.09), (-0.1, -0.07), (0.1, -0.07), (0.03, 0.09))


def subtract(a, b):
    return [x - y for x, y in zip(a, b)]


def cross(a, b):
    return [a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]]


def normalised(v):
    length = math.sqrt(sum(x * x for x in v))
    return [x / length for x in v]


def ring():
    """Points, a normal for each, and polygons."""
    points, normals, polygons = [], [], []
    for step in range(RING_STEPS):
        along = 2.0 * math.pi * step / RING_STEPS
        for side in range(RING_SIDES):
            around = 2.0 * math.pi * side / RING_SIDES
            normal = [math.cos(around) * math.cos(along), math.cos(around) * math.sin(along), math.sin(around)]
            centre = [math.cos(along), math.sin(along), 0.0]
            points.append([c + RING_TUBE * n for c, n in zip(centre, normal)])
            normals.append(normal)
            a, b = step * RING_SIDES, (step + 1) % RING_STEPS * RING_SIDES
            after = (side + 1) % RING_SIDES
            polygons.append([a + side, b + side, b + after, a + after])
    return points, normals, polygons


def bone():
    """Points, a normal for each, and polygons. Faces are flat: each has points of its own."""
    points, normals, polygons = [], [], []
    corners = [[x, y, BONE_SHOULDER] for x, y in BONE_CORNERS]
    for a, b in zip(corners, corners[1:] + corners[:1]):
        for face in ([[0.0, 0.0, 0.0], b, a], [a, b, [0.0, 0.0, 1.0]]):
            polygons.append([len(points) + corner for corner in range(3)])
            points += face
            normals += [normalised(cross(subtract(face[1], face[0]), subtract(face[2], face[0])))] * 3
    return points, normals, polygons


def rounded(vectors):
    return [[round(value, DECIMALS) + 0.0 for value in vector] for vector in vectors]


def elements(name, points, normals, polygons):
    layers = [normal_layer(rounded(normals)), material_layer([0] * len(polygons))]
    objects = [model(MODEL_ID, name, "Mesh", prop("DefaultAttributeIndex", "int", 0)),
               mesh_geometry(GEOMETRY_ID, name, rounded(points), polygons, layers),
               material(MATERIAL_ID, "plain", (0.8, 0.8, 0.8))]
    connections = [(MODEL_ID, 0), (GEOMETRY_ID, MODEL_ID), (MATERIAL_ID, MODEL_ID)]
    # Z up, as in the preview.
    settings = global_settings(up_axis=2, front_axis=1, coord_axis=0, unit_scale=UNIT_SCALE)
    return document(VERSION, SCENE_ID, settings, objects, connections)


def main():
    parser = argparse.ArgumentParser(description="Write the meshes that the preview draws with.")
    parser.add_argument("-o", "--output", default=HERE, type=pathlib.Path, help="folder")
    options = parser.parse_args()
    for name, mesh in (("ManipulatorRing", ring()), ("tetra_stripe", bone())):
        path = options.output / f"{name}.fbx"
        path.write_bytes(fbx_file.binary(elements(name, *mesh), VERSION))


if __name__ == "__main__":
    main()
