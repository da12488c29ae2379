#!/usr/bin/env python3
"""Writes demo/character.fbx: Kestrel, a skinned character with a skeleton of 39 bones.

    make_character.py [-o FILE] [--ascii | --binary-7500]

The same call always gives the same bytes.
"""

import argparse
import math
import pathlib

import fbx_file
from fbx_file import Int64, ObjectName, doubles, integers
from fbx_scene import (branch, document, global_settings, layer_element, material, material_layer, mesh_geometry,
                       model, node, normal_layer, null_attribute, prop, skeleton_attribute)
from kestrel import bones
from matrix import (axis_rotation, column_major, euler, euler_angles, identity, multiply, rigid_inverse,
                    transform_point, translation)

# Decimals kept in the file. All that follows from an angle or an offset is computed from the rounded number.
ANGLE_DECIMALS = 6
LENGTH_DECIMALS = 6
MATRIX_DECIMALS = 9

# The body is one closed tube per bone: rings of vertices from end to end, and a vertex at each pole.
SIDES = 10
# Place of each ring along the bone, and its share of the radius.
RINGS = ((-0.04, 0.55), (0.06, 0.85), (0.28, 1.0), (0.72, 0.98), (0.94, 0.8), (1.04, 0.5))
POLES = (-0.1, 1.1)

SCENE_ID, GROUP_ID, GROUP_ATTRIBUTE_ID, BODY_ID, GEOMETRY_ID, SKIN_ID, POSE_ID = (
    1000, 1001, 1002, 1003, 1004, 1005, 1006)
MATERIAL_IDS = (1010, 1011)
BONE_IDS, ATTRIBUTE_IDS, CLUSTER_IDS = 2000, 3000, 4000


def subtract(a, b):
    return [x - y for x, y in zip(a, b)]


def normalised(v):
    length = math.sqrt(sum(x * x for x in v))
    return [x / length for x in v]


def cross(a, b):
    return [a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]]


def rounded(values, decimals):
    return [round(value, decimals) + 0.0 for value in values]


def stored_matrix(matrix):
    return doubles(rounded(column_major(matrix), MATRIX_DECIMALS))


def rest_frame(bone):
    """The joint in the T-pose, in world space. The right side's joints are the left side's mirrored, with all axes
    turned round, so that the same angles move both sides alike."""
    result = translation(bone.start)
    if bone.aligned:
        return result
    sign = -1.0 if bone.mirrored else 1.0
    x = [sign * value for value in normalised(subtract(bone.end, bone.start))]
    up = [sign * value for value in bone.up]
    along = sum(a * b for a, b in zip(x, up))
    y = normalised([u - along * a for u, a in zip(up, x)])
    z = cross(x, y)
    for row in range(3):
        result[row][0], result[row][1], result[row][2] = x[row], y[row], z[row]
    return result


class Joint:
    """A bone with its numbers as they stand in the file, and the world transform that they give."""

    def __init__(self, bone, index, parent):
        self.bone = bone
        self.index = index
        self.parent = parent
        self.rest = rest_frame(bone)
        local = multiply(rigid_inverse(parent.rest), self.rest) if parent else self.rest
        self.translation = rounded([local[row][3] for row in range(3)], LENGTH_DECIMALS)
        self.pre_rotation = rounded(euler_angles(local), ANGLE_DECIMALS)
        self.local = multiply(translation(self.translation), euler(self.pre_rotation),
                              euler(bone.rotation, bone.order))
        self.world = multiply(parent.world, self.local) if parent else self.local


def pose_skeleton():
    joints = {}
    for index, bone in enumerate(bones()):
        joints[bone.name] = Joint(bone, index, joints.get(bone.parent))
    return list(joints.values())


class Mesh:
    """Vertices in world space, with what belongs to each: normal, texture coordinate and weights by joint index."""

    def __init__(self):
        self.points = []
        self.normals = []
        self.weights = []
        self.polygons = []
        self.uv_polygons = []
        self.uvs = []
        self.materials = []


def tube_weights(joint, child, place):
    """Which joints move a ring: near its start the bone shares with its parent, near its end with its child."""
    if place < 0.0 and joint.parent:
        return [(joint, 0.5), (joint.parent, 0.5)]
    if place < 0.2 and joint.parent:
        return [(joint, 0.75), (joint.parent, 0.25)]
    if place > 1.0 and child:
        return [(joint, 0.5), (child, 0.5)]
    if place > 0.8 and child:
        return [(joint, 0.75), (child, 0.25)]
    return [(joint, 1.0)]


def tube_frame(joint):
    """The transform from the tube's space to the world: X along the bone, whatever way the joint's X points."""
    if not joint.bone.aligned:
        return joint.world
    # An aligned joint's bone runs along its Y axis, more or less.
    turn = multiply(axis_rotation("z", 90.0), axis_rotation("x", 90.0))
    return multiply(joint.world, turn)


def add_tube(mesh, joint, child):
    bone = joint.bone
    frame = tube_frame(joint)
    length = math.dist(bone.start, bone.end) * (-1.0 if bone.mirrored else 1.0)
    base = len(mesh.points)
    uv_base = len(mesh.uvs)
    material = 1 if bone.accent else 0

    def add_point(place, y, z, normal):
        origin = transform_point(frame, (0, 0, 0))
        mesh.points.append(rounded(transform_point(frame, (place * length, y, z)), LENGTH_DECIMALS))
        mesh.normals.append(rounded(normalised(subtract(transform_point(frame, normal), origin)), LENGTH_DECIMALS))
        mesh.weights.append(tube_weights(joint, child, place))

    def add_uv(u, place):
        low, high = POLES
        mesh.uvs.append(rounded((u, (place - low) / (high - low)), LENGTH_DECIMALS))

    def add_polygon(corners, uv_corners):
        # Mirrored tubes run the other way; turn their faces so that they look outwards.
        if bone.mirrored:
            corners, uv_corners = corners[::-1], uv_corners[::-1]
        mesh.polygons.append([base + corner for corner in corners])
        mesh.uv_polygons.append([uv_base + corner for corner in uv_corners])
        mesh.materials.append(material)

    forward = math.copysign(1.0, length)
    for place, share in RINGS:
        lean = 1.4 * (place - 0.5) ** 3 * forward
        for side in range(SIDES):
            angle = 2.0 * math.pi * side / SIDES
            y, z = math.cos(angle), math.sin(angle)
            # The gradient of the ellipse, leaning towards the nearer end.
            slope = [lean / max(bone.radius), y / bone.radius[0], z / bone.radius[1]]
            add_point(place, y * bone.radius[0] * share, z * bone.radius[1] * share, slope)
        # One more texture coordinate than vertices closes the seam.
        for side in range(SIDES + 1):
            add_uv(side / SIDES, place)
    for place, direction in zip(POLES, (-forward, forward)):
        add_point(place, 0.0, 0.0, (direction, 0.0, 0.0))
        add_uv(0.5, place)

    first_pole = len(RINGS) * SIDES
    first_uv_pole = len(RINGS) * (SIDES + 1)
    last, last_uv = (len(RINGS) - 1) * SIDES, (len(RINGS) - 1) * (SIDES + 1)
    for side in range(SIDES):
        after = (side + 1) % SIDES
        add_polygon([first_pole, after, side], [first_uv_pole, side + 1, side])
        for ring in range(len(RINGS) - 1):
            a, b = ring * SIDES, (ring + 1) * SIDES
            ua, ub = ring * (SIDES + 1), (ring + 1) * (SIDES + 1)
            add_polygon([a + side, a + after, b + after, b + side],
                        [ua + side, ua + side + 1, ub + side + 1, ub + side])
        add_polygon([first_pole + 1, last + side, last + after],
                    [first_uv_pole + 1, last_uv + side, last_uv + side + 1])


def build_mesh(joints):
    mesh = Mesh()
    for joint in joints:
        # The child that goes on where this bone ends bends the tube's end.
        child = next((other for other in joints
                      if other.parent is joint and math.dist(other.bone.start, joint.bone.end) < 1e-6), None)
        add_tube(mesh, joint, child)
    return mesh


def geometry(mesh):
    uvs = layer_element("LayerElementUV", 0, node("Name", "tubes"), node("MappingInformationType", "ByPolygonVertex"),
                        node("ReferenceInformationType", "IndexToDirect"),
                        node("UV", doubles([value for uv in mesh.uvs for value in uv])),
                        node("UVIndex", integers([index for polygon in mesh.uv_polygons for index in polygon])))
    layers = [normal_layer(mesh.normals), uvs, material_layer(mesh.materials)]
    return mesh_geometry(GEOMETRY_ID, "kestrelBody", mesh.points, mesh.polygons, layers,
                         prop("Color", "color", 0.6, 0.5, 0.4))


def skin(joints, mesh):
    """The skin and one cluster per joint; the body's own transform is the identity."""
    objects = [branch("Deformer", Int64(SKIN_ID), ObjectName("kestrelSkin", "Deformer"), "Skin", children=[
        node("Version", 101), node("Link_DeformAcuracy", 50.0), node("SkinningType", "Linear")])]
    for joint in joints:
        shares = [(vertex, share) for vertex, weights in enumerate(mesh.weights)
                  for owner, share in weights if owner is joint]
        name = ObjectName(joint.bone.name + "Cluster", "SubDeformer")
        objects.append(branch("Deformer", Int64(CLUSTER_IDS + joint.index), name, "Cluster", children=[
            node("Version", 100), node("UserData", "", ""),
            node("Indexes", integers([vertex for vertex, _ in shares])),
            node("Weights", doubles([share for _, share in shares])),
            node("Transform", stored_matrix(rigid_inverse(joint.world))),
            node("TransformLink", stored_matrix(joint.world)),
        ]))
    return objects


def bind_pose(joints):
    poses = [(GROUP_ID, identity()), (BODY_ID, identity())]
    poses += [(BONE_IDS + joint.index, joint.world) for joint in joints]
    return branch("Pose", Int64(POSE_ID), ObjectName("kestrelBindPose", "Pose"), "BindPose", children=[
        node("Type", "BindPose"), node("Version", 100), node("NbPoseNodes", len(poses)),
    ] + [branch("PoseNode", children=[node("Node", Int64(owner)), node("Matrix", stored_matrix(matrix))])
         for owner, matrix in poses])


def bone_objects(joint):
    name = joint.bone.name
    entries = [prop("RotationActive", "bool", 1), prop("InheritType", "enum", 1),
               prop("DefaultAttributeIndex", "int", 0)]
    if joint.bone.order:
        entries.append(prop("RotationOrder", "enum", joint.bone.order))
    if any(joint.pre_rotation):
        entries.append(prop("PreRotation", "vector", *joint.pre_rotation))
    entries.append(prop("Lcl Translation", "translation", *joint.translation))
    if any(joint.bone.rotation):
        entries.append(prop("Lcl Rotation", "rotation", *joint.bone.rotation))
    return [model(BONE_IDS + joint.index, name, "LimbNode", *entries),
            skeleton_attribute(ATTRIBUTE_IDS + joint.index, name, "LimbNode",
                               prop("Size", "double", round(max(joint.bone.radius), 3)))]


def scene():
    joints = pose_skeleton()
    mesh = build_mesh(joints)
    objects = [
        model(GROUP_ID, "Kestrel", "Null", prop("DefaultAttributeIndex", "int", 0)),
        null_attribute(GROUP_ATTRIBUTE_ID, "Kestrel"),
        model(BODY_ID, "kestrelBody", "Mesh", prop("DefaultAttributeIndex", "int", 0)),
        geometry(mesh),
        material(MATERIAL_IDS[0], "kestrelSuit", (0.36, 0.24, 0.16)),
        material(MATERIAL_IDS[1], "kestrelPlume", (0.75, 0.55, 0.2)),
    ]
    for joint in joints:
        objects += bone_objects(joint)
    objects += skin(joints, mesh)
    objects.append(bind_pose(joints))

    connections = [(GROUP_ID, 0), (GROUP_ATTRIBUTE_ID, GROUP_ID), (BODY_ID, GROUP_ID), (GEOMETRY_ID, BODY_ID)]
    connections += [(material_id, BODY_ID) for material_id in MATERIAL_IDS]
    connections.append((SKIN_ID, GEOMETRY_ID))
    for joint in joints:
        parent = BONE_IDS + joint.parent.index if joint.parent else GROUP_ID
        connections.append((BONE_IDS + joint.index, parent))
        connections.append((ATTRIBUTE_IDS + joint.index, BONE_IDS + joint.index))
        connections.append((CLUSTER_IDS + joint.index, SKIN_ID))
        connections.append((BONE_IDS + joint.index, CLUSTER_IDS + joint.index))
    return objects, connections


def main():
    parser = argparse.ArgumentParser(description="Write the demo's character as an FBX file.")
    parser.add_argument("-o", "--output", default=pathlib.Path(__file__).with_name("character.fbx"), type=pathlib.Path)
    form = parser.add_mutually_exclusive_group()
    form.add_argument("--ascii", action="store_true", help="ASCII, version 7.4")
    form.add_argument("--binary-7500", action="store_true", help="binary, version 7.5 with 64-bit record offsets")
    options = parser.parse_args()

    version = 7500 if options.binary_7500 else 7400
    elements = document(version, SCENE_ID, global_settings(), *scene())
    write = fbx_file.ascii_text if options.ascii else fbx_file.binary
    options.output.write_bytes(write(elements, version))


if __name__ == "__main__":
    main()
