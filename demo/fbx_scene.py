"""The parts of an FBX 7.x document that are the same for every scene of ours, as element trees."""

from fbx_file import CREATION_TIME, FILE_ID, Element, Int64, ObjectName, doubles, integers

CREATOR = "Retarget Setup demo"


def node(name, *properties):
    """An element without a list of children."""
    return Element(name, *properties)


def branch(name, *properties, children):
    return Element(name, *properties, children=children)


# One property of an object: its type names and flags, then its values.
PROPERTY_TYPES = {
    "int": ("int", "Integer", ""),
    "enum": ("enum", "", ""),
    "bool": ("bool", "", ""),
    "double": ("double", "Number", ""),
    "number": ("Number", "", "A"),
    "vector": ("Vector3D", "Vector", ""),
    "color": ("ColorRGB", "Color", ""),
    "shaded": ("Color", "", "A"),
    "translation": ("Lcl Translation", "", "A"),
    "rotation": ("Lcl Rotation", "", "A"),
    "scaling": ("Lcl Scaling", "", "A"),
    "visibility": ("Visibility", "", "A"),
    "text": ("KString", "", ""),
    "time": ("KTime", "Time", ""),
}


def prop(name, kind, *values):
    if kind in ("int", "enum", "bool"):
        values = [int(value) for value in values]
    elif kind == "time":
        values = [Int64(value) for value in values]
    elif kind != "text":
        values = [float(value) for value in values]
    return node("P", name, *PROPERTY_TYPES[kind], *values)


def properties(*entries):
    return branch("Properties70", children=list(entries))


def header(version):
    year, month, day = 1970, 1, 1
    stamp = [node("Version", 1000), node("Year", year), node("Month", month), node("Day", day),
             node("Hour", 10), node("Minute", 0), node("Second", 0), node("Millisecond", 0)]
    extension = branch("FBXHeaderExtension", children=[
        node("FBXHeaderVersion", 1003),
        node("FBXVersion", version),
        branch("CreationTimeStamp", children=stamp),
        node("Creator", CREATOR),
    ])
    return [extension, node("FileId", FILE_ID), node("CreationTime", CREATION_TIME), node("Creator", CREATOR)]


def global_settings(up_axis=1, front_axis=2, coord_axis=0, coord_sign=1, unit_scale=1.0):
    """unit_scale is the length of one file unit in centimetres; axes are 0 for X, 1 for Y, 2 for Z."""
    return branch("GlobalSettings", children=[
        node("Version", 1000),
        properties(
            prop("UpAxis", "int", up_axis), prop("UpAxisSign", "int", 1),
            prop("FrontAxis", "int", front_axis), prop("FrontAxisSign", "int", 1),
            prop("CoordAxis", "int", coord_axis), prop("CoordAxisSign", "int", coord_sign),
            prop("OriginalUpAxis", "int", up_axis), prop("OriginalUpAxisSign", "int", 1),
            prop("UnitScaleFactor", "double", unit_scale), prop("OriginalUnitScaleFactor", "double", unit_scale),
            prop("AmbientColor", "color", 0, 0, 0),
            node("P", "DefaultCamera", "KString", "", "", "Producer Perspective"),
            prop("TimeMode", "enum", 11),
            prop("TimeSpanStart", "time", 0), prop("TimeSpanStop", "time", 46186158000),
            prop("CustomFrameRate", "double", -1),
        ),
    ])


def documents(scene_id):
    return [
        branch("Documents", children=[
            node("Count", 1),
            branch("Document", Int64(scene_id), "", "Scene", children=[
                properties(node("P", "SourceObject", "object", "", ""),
                           node("P", "ActiveAnimStackName", "KString", "", "", "")),
                node("RootNode", Int64(0)),
            ]),
        ]),
        branch("References", children=[]),
    ]


NODE_TEMPLATE = [
    prop("QuaternionInterpolate", "enum", 0),
    prop("RotationOffset", "vector", 0, 0, 0), prop("RotationPivot", "vector", 0, 0, 0),
    prop("ScalingOffset", "vector", 0, 0, 0), prop("ScalingPivot", "vector", 0, 0, 0),
    prop("TranslationActive", "bool", 0),
    prop("RotationOrder", "enum", 0), prop("RotationSpaceForLimitOnly", "bool", 0),
    prop("PreRotation", "vector", 0, 0, 0), prop("PostRotation", "vector", 0, 0, 0),
    prop("RotationActive", "bool", 0),
    prop("InheritType", "enum", 0), prop("ScalingActive", "bool", 0),
    prop("GeometricTranslation", "vector", 0, 0, 0), prop("GeometricRotation", "vector", 0, 0, 0),
    prop("GeometricScaling", "vector", 1, 1, 1),
    node("P", "LookAtProperty", "object", "", ""), node("P", "UpVectorProperty", "object", "", ""),
    prop("Show", "bool", 1), prop("NegativePercentShapeSupport", "bool", 1),
    prop("DefaultAttributeIndex", "int", -1), prop("Freeze", "bool", 0), prop("LODBox", "bool", 0),
    prop("Lcl Translation", "translation", 0, 0, 0), prop("Lcl Rotation", "rotation", 0, 0, 0),
    prop("Lcl Scaling", "scaling", 1, 1, 1), prop("Visibility", "visibility", 1),
]

SKELETON_TEMPLATE = [
    prop("Color", "color", 0.8, 0.8, 0.8), prop("Size", "double", 100), prop("LimbLength", "double", 1),
]

MESH_TEMPLATE = [
    prop("Color", "color", 0.8, 0.8, 0.8),
    prop("BBoxMin", "vector", 0, 0, 0), prop("BBoxMax", "vector", 0, 0, 0),
    prop("Primary Visibility", "bool", 1), prop("Casts Shadows", "bool", 1), prop("Receive Shadows", "bool", 1),
]

LAMBERT_TEMPLATE = [
    node("P", "ShadingModel", "KString", "", "", "Lambert"), prop("MultiLayer", "bool", 0),
    prop("EmissiveColor", "shaded", 0, 0, 0), prop("EmissiveFactor", "number", 1),
    prop("AmbientColor", "shaded", 0.2, 0.2, 0.2), prop("AmbientFactor", "number", 1),
    prop("DiffuseColor", "shaded", 0.8, 0.8, 0.8), prop("DiffuseFactor", "number", 1),
    prop("TransparentColor", "shaded", 0, 0, 0), prop("TransparencyFactor", "number", 0),
]

# Object type: the class that its property template describes, and the template.
TEMPLATES = {
    "Model": ("FbxNode", NODE_TEMPLATE),
    "NodeAttribute": ("FbxSkeleton", SKELETON_TEMPLATE),
    "Geometry": ("FbxMesh", MESH_TEMPLATE),
    "Material": ("FbxSurfaceLambert", LAMBERT_TEMPLATE),
}


def definitions(objects, templates=None):
    """Counts the objects by type, with the property templates that they rely on."""
    templates = TEMPLATES if templates is None else templates
    counts = {}
    for element in objects:
        counts[element.name] = counts.get(element.name, 0) + 1
    types = [branch("ObjectType", "GlobalSettings", children=[node("Count", 1)])]
    for name, count in counts.items():
        children = [node("Count", count)]
        if name in templates:
            class_name, entries = templates[name]
            children.append(branch("PropertyTemplate", class_name, children=[properties(*entries)]))
        types.append(branch("ObjectType", name, children=children))
    return branch("Definitions", children=[node("Version", 100), node("Count", 1 + len(objects))] + types)


def model(object_id, name, kind, *entries):
    """A node of the scene; kind is its class of attribute ("LimbNode", "Mesh", "Null", ...)."""
    return branch("Model", Int64(object_id), ObjectName(name, "Model"), kind, children=[
        node("Version", 232), properties(*entries), node("Shading", True), node("Culling", "CullingOff"),
    ])


def skeleton_attribute(object_id, name, kind, *entries):
    return branch("NodeAttribute", Int64(object_id), ObjectName(name, "NodeAttribute"), kind, children=[
        properties(*entries), node("TypeFlags", "Skeleton"),
    ])


def null_attribute(object_id, name):
    return branch("NodeAttribute", Int64(object_id), ObjectName(name, "NodeAttribute"), "Null", children=[
        node("TypeFlags", "Null"),
    ])


def layer_element(kind, index, *children):
    """One kind of data of a mesh's corners or polygons."""
    return branch(kind, index, children=[node("Version", 101), *children])


def normal_layer(normals):
    """One normal for each point."""
    return layer_element("LayerElementNormal", 0, node("Name", ""), node("MappingInformationType", "ByVertice"),
                         node("ReferenceInformationType", "Direct"),
                         node("Normals", doubles([value for normal in normals for value in normal])))


def material_layer(materials):
    """For each polygon the place of its material among the model's."""
    return layer_element("LayerElementMaterial", 0, node("Name", ""), node("MappingInformationType", "ByPolygon"),
                         node("ReferenceInformationType", "IndexToDirect"), node("Materials", integers(materials)))


def mesh_geometry(object_id, name, points, polygons, layers, *entries):
    """A mesh: points, polygons as lists of places in points, and the layer elements of its one layer."""
    # A polygon's last index is stored as its complement.
    indices = [index for polygon in polygons for index in polygon[:-1] + [~polygon[-1]]]
    return branch("Geometry", Int64(object_id), ObjectName(name, "Geometry"), "Mesh", children=[
        properties(*entries),
        node("Vertices", doubles([value for point in points for value in point])),
        node("PolygonVertexIndex", integers(indices)),
        node("GeometryVersion", 124),
        *layers,
        branch("Layer", 0, children=[node("Version", 100)] + [
            branch("LayerElement", children=[node("Type", layer.name), node("TypedIndex", 0)]) for layer in layers]),
    ])


def material(material_id, name, color):
    return branch("Material", Int64(material_id), ObjectName(name, "Material"), "", children=[
        node("Version", 102), node("ShadingModel", "lambert"), node("MultiLayer", 0),
        branch("Properties70", children=[prop("DiffuseColor", "shaded", *color)]),
    ])


def document(version, scene_id, settings, objects, connections, templates=None):
    """The whole file; connections are pairs (child id, parent id), 0 being the root of the scene."""
    links = [node("C", "OO", Int64(child), Int64(parent)) for child, parent in connections]
    return header(version) + [settings] + documents(scene_id) + [
        definitions(objects, templates),
        branch("Objects", children=objects),
        branch("Connections", children=links),
        branch("Takes", children=[node("Current", "")]),
    ]
