#!/usr/bin/env python3
"""Writes cases/: small FBX files, each about one matter of the format, and what their skeletons evaluate to.

    make_cases.py [-o FOLDER]

The files are written with the demo's container; the expected values come from transforms.py, which knows no format.
A .json has the shape of the reference files of this folder: matrices row by row for column vectors, translations in
millimetres, `local` with the pre-rotation divided out, `parent` by name (the last bone so far of the parent's name; -1
for the attribute kind Root). The same call always gives the same bytes.
"""

import argparse
import array
import json
import pathlib
import sys

HERE = pathlib.Path(__file__).resolve().parent
sys.path.insert(0, str(HERE.parents[2] / "demo"))

import fbx_file
import fbx_scene
from fbx_file import Int64, ObjectName, integers
from fbx_scene import branch, node, prop
from transforms import Node

SCENE_ID = 10
BONE_KINDS = ("Root", "Limb", "LimbNode", "Effector")

# Property of the file, its kind there, and the value's name in Node.
PROPERTIES = [
    ("RotationOffset", "vector", "rotation_offset"), ("RotationPivot", "vector", "rotation_pivot"),
    ("ScalingOffset", "vector", "scaling_offset"), ("ScalingPivot", "vector", "scaling_pivot"),
    ("RotationOrder", "enum", "order"), ("PreRotation", "vector", "pre"), ("PostRotation", "vector", "post"),
    ("RotationActive", "bool", "active"), ("InheritType", "enum", "inherit"),
    ("Lcl Translation", "translation", "translation"), ("Lcl Rotation", "rotation", "rotation"),
    ("Lcl Scaling", "scaling", "scale"),
]


def as_tuple(value):
    return tuple(value) if isinstance(value, (tuple, list)) else (value,)


def defaults_of(template):
    """What a node has that does not say otherwise."""
    values = {entry.properties[0]: tuple(entry.properties[4:]) for entry in template}
    return {name: values[name] for name, _, _ in PROPERTIES}


def entries(item, defaults, extra=()):
    """The properties in which a node differs from the defaults."""
    result = []
    for name, kind, member in PROPERTIES:
        values = as_tuple(getattr(item, member))
        if tuple(map(float, values)) != tuple(map(float, defaults[name])):
            result.append(prop(name, kind, *values))
    return result + list(extra)


class Case:
    """A scene: nodes in the order of their connections, and how it is written."""

    def __init__(self, name, nodes, version=7400, ascii_form=False, template=None, extra=(), more=None, **settings):
        self.name = name
        self.nodes = nodes
        self.version = version
        self.ascii_form = ascii_form
        self.template = fbx_scene.NODE_TEMPLATE if template is None else template
        # Properties that every node has besides, and further objects and connections.
        self.extra = extra
        self.more = more
        self.settings = settings

    def identifier(self, item):
        return 100 + 2 * self.nodes.index(item)

    def elements(self):
        if self.version < 7000:
            return legacy_document(self)
        defaults = defaults_of(self.template)
        objects, links = [], []
        for item in self.nodes:
            key = self.identifier(item)
            objects.append(fbx_scene.model(key, item.name, item.kind, *entries(item, defaults, self.extra)))
            if item.kind in BONE_KINDS:
                objects.append(fbx_scene.skeleton_attribute(key + 1, item.name, item.kind))
            else:
                objects.append(fbx_scene.null_attribute(key + 1, item.name))
            links.append((key, self.identifier(item.parent) if item.parent else 0))
            links.append((key + 1, key))
        templates = {"Model": ("FbxNode", self.template)}
        elements = fbx_scene.document(self.version, SCENE_ID, fbx_scene.global_settings(**self.settings),
                                      objects + (self.more[0] if self.more else []), links, templates)
        if self.more:
            connections = next(element for element in elements if element.name == "Connections")
            connections.children += self.more[1]
        return elements

    def data(self):
        write = fbx_file.ascii_text if self.ascii_form else fbx_file.binary
        return write(self.elements(), self.version)


# ---- version 6.1: objects are known by their names, properties have no template

def legacy_property(entry):
    name, kind, _, flags, *values = entry.properties
    return node("Property", name, kind, "A+" if flags == "A" else flags, *values)


def legacy_document(case):
    settings = fbx_scene.global_settings(**case.settings)
    listed = next(element for element in settings.children if element.name == "Properties70").children
    # A node of 6.1 says everything that is not zero or one; the flags and the inherit type always.
    neutral = {name: (1, 1, 1) if kind == "scaling" else (0, 0, 0) if kind in ("vector", "translation", "rotation")
               else (-1,) for name, kind, _ in PROPERTIES}
    models, links = [], []
    for item in case.nodes:
        name = ObjectName(item.name, "Model")
        written = [legacy_property(entry) for entry in entries(item, neutral, case.extra)]
        models.append(branch("Model", name, item.kind, children=[
            node("Version", 232), branch("Properties60", children=written),
            node("Shading", True), node("Culling", "CullingOff"),
            node("TypeFlags", "Skeleton" if item.kind in BONE_KINDS else "Null")]))
        links.append(node("Connect", "OO", name, ObjectName(item.parent.name if item.parent else "Scene", "Model")))
    legacy_settings = branch("GlobalSettings", children=[
        node("Version", 1000), branch("Properties60", children=[legacy_property(entry) for entry in listed])])
    return [
        branch("FBXHeaderExtension", children=[node("FBXHeaderVersion", 1003), node("FBXVersion", case.version)]),
        node("Creator", fbx_scene.CREATOR),
        branch("Definitions", children=[
            node("Version", 100), node("Count", len(models) + 1),
            branch("ObjectType", "Model", children=[node("Count", len(models))]),
            branch("ObjectType", "GlobalSettings", children=[node("Count", 1)])]),
        branch("Objects", children=models + [legacy_settings]),
        branch("Relations", children=[branch("Model", ObjectName(item.name, "Model"), item.kind, children=[])
                                      for item in case.nodes]),
        branch("Connections", children=links),
        branch("Takes", children=[node("Current", "")]),
    ]


# ---- expected values

def pre_order(nodes, parent=None):
    for item in nodes:
        if item.parent is parent:
            yield item
            yield from pre_order(nodes, item)


def flat(matrix, unit):
    return [float("%.9g" % (matrix[row][column] * (unit if column == 3 and row < 3 else 1.0))) + 0.0
            for row in range(4) for column in range(4)]


def expected(case):
    unit = case.settings.get("unit_scale", 1.0) * 10.0
    names, bones = [], []
    for item in pre_order(case.nodes):
        if item.kind not in BONE_KINDS:
            continue
        parent = -1
        if item.kind != "Root" and item.parent and item.parent.name in names:
            parent = len(names) - 1 - names[::-1].index(item.parent.name)
        names.append(item.name)
        bones.append({
            "name": item.name, "parent": parent, "accumulatedScale": float("%.9g" % item.accumulated_scale()),
            "preRotation": flat(item.pre_rotation, 1.0), "local": flat(item.local_without_pre_rotation(), unit),
            "global": flat(item.world, unit)})
    return {"upAxis": case.settings.get("up_axis", 1), "unitScale": float("%.9g" % unit), "version": case.version,
            "ascii": case.ascii_form, "meshes": 0, "skins": 0, "clusters": 0, "bones": bones, "placedMeshes": []}


def json_text(values):
    head = {key: value for key, value in values.items() if key != "bones"}
    lines = [" %s: %s" % (json.dumps(key), json.dumps(value)) for key, value in head.items()]
    bones = ",\n".join("  " + json.dumps(bone, ensure_ascii=False) for bone in values["bones"])
    lines.insert(-1, ' "bones": [\n%s\n ]' % bones if bones else ' "bones": []')
    return "{\n" + ",\n".join(lines) + "\n}\n"


# ---- the cases

def rotation_orders(active):
    base = Node("base", translation=(0, 90, 0), active=active)
    nodes = [base]
    for order, name in enumerate(("XYZ", "XZY", "YZX", "YXZ", "ZXY", "ZYX")):
        nodes.append(Node("turn" + name, base, translation=(10 * order, 5, -3), rotation=(20, -35, 50),
                          pre=(15, 40, -70), post=(-25, 10, 30), active=active, order=order))
    return nodes


def pivots():
    base = Node("base", translation=(1, 80, 2), rotation=(0, 30, 0), rotation_offset=(0, 2, 0),
                rotation_pivot=(3, 0, -4), active=True)
    scaled = Node("scaled", base, translation=(10, 0, 0), rotation=(10, 20, 30), scale=(2, 0.5, 1.5), pre=(0, 0, 45),
                  post=(5, 0, 0), rotation_offset=(1, 2, 3), rotation_pivot=(4, -5, 6), scaling_offset=(-1, 0.5, 0),
                  scaling_pivot=(2, 2, -3))
    end = Node("end", scaled, translation=(0, 7, 0), rotation=(0, 0, -15), scaling_pivot=(1, 0, 0), scale=(3, 1, 1))
    return [base, scaled, end]


def inherit_types():
    base = Node("base", translation=(0, 50, 0), rotation=(10, 20, 30), scale=(2, 3, 0.5))
    nodes = [base]
    for inherit, name in enumerate(("RrSs", "RSrs", "Rrs")):
        bone = Node("first" + name, base, translation=(5, 6, 7), rotation=(40, -20, 15), scale=(1.5, 0.8, 1.2),
                    pre=(0, 25, 0), inherit=inherit)
        nodes.append(bone)
        # Below a sheared node rotation and scale cannot be told apart, so only the type that needs neither follows.
        for below, below_name in enumerate(("RrSs", "RSrs", "Rrs")):
            if inherit != 1 or below == 1:
                nodes.append(Node("second%sBelow%s" % (below_name, name), bone, translation=(-3, 4, 1),
                                  rotation=(5, 50, -30), scale=(0.9, 1.1, 2), inherit=below))
    return nodes


def limb(**common):
    base = Node("base", translation=(0, 1, 0.25), rotation=(0, 0, 20), **common)
    middle = Node("middle", base, translation=(0.5, 0, 0), rotation=(30, 0, 0), pre=(0, 15, 0), **common)
    return [base, middle, Node("end", middle, translation=(0.25, 0.125, 0), **common)]


def clashes():
    base = Node("base")
    outer = Node("joint", base, translation=(1, 0, 0))
    inner = Node("joint", outer, translation=(0, 2, 0))
    # By its node the child of the outer joint; by name that of the inner one, which was met last.
    late = Node("late", outer, translation=(0, 0, 3))
    other = Node("joint", base, translation=(-1, 0, 0))
    return [base, outer, inner, late, other, Node("leaf", inner, translation=(0, 1, 0)),
            Node("leaf", other, translation=(0, 1, 0))]


def names():
    base = Node("Troupe:H\u00fcfte")
    return [base, Node("Troupe:Cast:spine", base, translation=(0, 10, 0)),
            Node("no space", base, translation=(3, -10, 0)), Node("\u9aa8", base, translation=(-3, -10, 0)),
            Node("", base, translation=(0, 0, 1)), Node('the "old" one', base, translation=(0, 0, 2))]


def kinds():
    root = Node("master", kind="Root", translation=(0, 4, 0))
    limb_bone = Node("limb", root, kind="Limb", translation=(0, 10, 0), rotation=(0, 0, 90))
    node_bone = Node("limbNode", limb_bone, translation=(0, 10, 0))
    second_root = Node("secondRoot", node_bone, kind="Root", translation=(2, 0, 0))
    return [root, limb_bone, node_bone, Node("effector", node_bone, kind="Effector", translation=(0, 3, 0)),
            second_root, Node("belowSecondRoot", second_root, translation=(0, 5, 0))]


def plain_parents():
    group = Node("group", kind="Null", translation=(0, 5, 0), rotation=(0, 90, 0), scale=(2, 2, 2))
    inner = Node("offset", group, kind="Null", translation=(1, 0, 0))
    base = Node("base", inner, translation=(0, 1, 0))
    between = Node("between", base, kind="Null", translation=(0, 0, 4), rotation=(15, 0, 0))
    return [group, inner, base, between, Node("cut", between, translation=(1, 1, 1)),
            Node("direct", base, translation=(1, 0, 0)), Node("alone", kind="LimbNode", translation=(9, 9, 9))]


def negative_scale():
    base = Node("base", translation=(0, 8, 0), rotation=(0, 30, 0))
    mirror = Node("mirror", base, translation=(2, 0, 0), rotation=(0, 0, 25), scale=(-1, 1, 1))
    shrunk = Node("shrunk", mirror, translation=(2, 0, 0), rotation=(10, 0, 0), scale=(-0.5, -0.5, -0.5))
    return [base, mirror, shrunk, Node("end", shrunk, translation=(2, 0, 0), pre=(0, 40, 0))]


TEMPLATE_VALUES = {"RotationOrder": ("enum", 4), "PreRotation": ("vector", 0, 0, 30), "RotationActive": ("bool", 1),
                   "InheritType": ("enum", 1), "Lcl Translation": ("translation", 0, 6, 0),
                   "Lcl Scaling": ("scaling", 0.5, 0.5, 0.5)}


def other_template():
    return [prop(entry.properties[0], *TEMPLATE_VALUES[entry.properties[0]])
            if entry.properties[0] in TEMPLATE_VALUES else entry for entry in fbx_scene.NODE_TEMPLATE]


def templated():
    same = dict(order=4, pre=(0, 0, 30), translation=(0, 6, 0), scale=(0.5, 0.5, 0.5))
    base = Node("allFromTemplate", **same)
    turned = Node("ownRotation", base, **dict(same, rotation=(10, 20, 30)))
    other = Node("ownAll", turned, translation=(1, 2, 3), rotation=(10, 20, 30), scale=(3, 1, 2), order=1)
    return [base, turned, other]


def animation(bone_id):
    """One take that turns the bone by 90 degrees about X; the pose without it is what counts."""
    stack, layer, channel, curve = 900, 901, 902, 903
    times = [Int64(0), Int64(46186158000)]
    objects = [
        branch("AnimationStack", Int64(stack), ObjectName("Take 001", "AnimStack"), "", children=[
            fbx_scene.properties(prop("LocalStop", "time", times[1]))]),
        branch("AnimationLayer", Int64(layer), ObjectName("BaseLayer", "AnimLayer"), "", children=[]),
        branch("AnimationCurveNode", Int64(channel), ObjectName("R", "AnimCurveNode"), "", children=[
            fbx_scene.properties(prop("d|X", "number", 90), prop("d|Y", "number", 0), prop("d|Z", "number", 0))]),
        branch("AnimationCurve", Int64(curve), ObjectName("", "AnimCurve"), "", children=[
            node("Default", 90.0), node("KeyVer", 4008), node("KeyTime", array.array("q", times)),
            node("KeyValueFloat", array.array("f", [90.0, 90.0])), node("KeyAttrFlags", integers([8456])),
            node("KeyAttrRefCount", integers([2]))]),
    ]
    links = [node("C", "OO", Int64(stack), Int64(0)), node("C", "OO", Int64(layer), Int64(stack)),
             node("C", "OO", Int64(channel), Int64(layer)),
             node("C", "OP", Int64(channel), Int64(bone_id), "Lcl Rotation"),
             node("C", "OP", Int64(curve), Int64(channel), "d|X")]
    return objects, links


GEOMETRIC = (prop("GeometricTranslation", "vector", 1, 2, 3), prop("GeometricRotation", "vector", 10, 20, 30),
             prop("GeometricScaling", "vector", 2, 2, 2))


def cases():
    return [
        Case("rotation_orders", rotation_orders(True)),
        Case("rotation_inactive", rotation_orders(False)),
        Case("pivots_and_offsets", pivots(), ascii_form=True),
        Case("geometric_ignored", pivots(), extra=GEOMETRIC),
        Case("inherit_types", inherit_types(), version=7500, ascii_form=True),
        Case("metre_z_up", limb(), unit_scale=100.0, up_axis=2, front_axis=1, coord_sign=1),
        Case("inch_x_up", limb(), unit_scale=2.54, up_axis=0, front_axis=2, coord_axis=1, coord_sign=-1),
        Case("millimetre_y_up", limb(), unit_scale=0.1, version=7700, ascii_form=True),
        Case("name_clashes", clashes()),
        Case("names_binary", names()),
        Case("names_ascii", names(), ascii_form=True),
        Case("skeleton_kinds", kinds()),
        Case("plain_parents", plain_parents(), version=7500),
        Case("negative_scale", negative_scale()),
        Case("template_values", templated(), template=other_template()),
        Case("template_values_ascii", templated(), template=other_template(), version=7500, ascii_form=True),
        Case("animated", limb(), more=animation(100)),
        Case("no_skeleton", [Node("group", kind="Null", scale=(2, 2, 2))]),
        Case("legacy_ascii", limb() + kinds()[:4], version=6100, ascii_form=True, unit_scale=100.0, up_axis=2,
             front_axis=1),
        Case("legacy_binary", pivots() + plain_parents()[:2], version=6100),
        Case("legacy_rotation_orders", rotation_orders(True), version=6100, ascii_form=True),
    ]


def main():
    parser = argparse.ArgumentParser(description="Write small FBX files and what their skeletons evaluate to.")
    parser.add_argument("-o", "--output", default=HERE / "cases", type=pathlib.Path)
    folder = parser.parse_args().output
    folder.mkdir(exist_ok=True)
    for case in cases():
        (folder / (case.name + ".fbx")).write_bytes(case.data())
        (folder / (case.name + ".json")).write_text(json_text(expected(case)), encoding="utf-8")


if __name__ == "__main__":
    main()
