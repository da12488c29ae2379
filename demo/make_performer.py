#!/usr/bin/env python3
"""Writes demo/performer.qrs: a performer of 25 segments with a set of 53 markers.

    make_performer.py [-o FILE]

Millimetres and radians; Z is up, the performer faces -Y and the left side is at +X. In the T-pose all joints are zero.
The same call always gives the same bytes.
"""

import argparse
import pathlib
import xml.etree.ElementTree as xml

CENTRE_COLOUR, LEFT_COLOUR, RIGHT_COLOUR = "112 112 112", "40 140 255", "255 112 24"

# Name, quantity, prior or expression, measured value. Lengths of the body come from two measurements; a measured value
# beats its expression.
PARAMETERS = [
    ("BodyHeight", "length", 1825.0, None),
    ("HipWidth", "length", 184.0, None),
    ("ArmSpan", "length", "1.015*BodyHeight", 1858.0),
    ("ShoulderWidth", "length", "0.5*(HipWidth + 0.19*BodyHeight)", None),
    ("UpperArmLength", "length", "0.4*(ArmSpan - ShoulderWidth)/2.12", None),
    ("ForeArmLength", "length", "0.88*UpperArmLength", None),
    ("ThighLength", "length", "0.245*BodyHeight", 441.5),
    ("ShinLength", "length", "0.246*BodyHeight", None),
    ("FootLength", "length", "0.0805*BodyHeight", None),
    ("TrunkScale", "scalar", "BodyHeight/1825", None),
]

# Number of values that make up the state of a joint.
STATE_SIZE = {"Free": 6, "Ball": 3, "HardySpicer": 2, "Hinge": 1, "Dummy": 0}
VARIANCE = 10.0
POSITION_VARIANCE = 1e8


class Segment:
    """offset is the place in the parent's frame, as expressions; orientation an angle-axis. bind is the joint's state
    in the pose in which the performer is related to a character. centre and spread bound a limited joint."""

    def __init__(self, name, parent, joint, offset, bind=None, orientation="0 0 0", axes=None, centre=None, spread=None,
                 mass=None, mass_centre=None, gyration=None, style="tetra-stripe", labels=None):
        self.name = name
        self.parent = parent
        self.joint = joint
        self.offset = offset
        self.bind = bind or [0.0] * STATE_SIZE[joint]
        self.orientation = orientation
        self.axes = axes
        self.centre = centre
        self.spread = spread
        self.mass = mass
        self.mass_centre = mass_centre
        self.gyration = gyration
        self.style = style
        self.labels = labels
        self.context = None
        self.children = []


PELVIS_HEIGHT = 1000.0

CENTRE = [
    Segment("Pelvis", None, "Free", "0 0 0", bind=[0, 0, 0, 0, 0, PELVIS_HEIGHT], mass=0.142,
            mass_centre="0 0 20*TrunkScale", gyration="82*TrunkScale 78*TrunkScale 86*TrunkScale", style="box"),
    Segment("Lumbar", "Pelvis", "Ball", "0 14*TrunkScale 92*TrunkScale", bind=[0.02, 0, 0], style="spine",
            centre=[0.15, 0, 0], spread=[0.25, 0.1, 0.08], mass=0.139, mass_centre="0 0 60*TrunkScale",
            gyration="70*TrunkScale 64*TrunkScale 74*TrunkScale"),
    Segment("ThoraxLow", "Lumbar", "Ball", "0 -4*TrunkScale 128*TrunkScale", bind=[0.01, 0, 0], style="spine"),
    Segment("ThoraxHigh", "ThoraxLow", "Ball", "0 -2*TrunkScale 136*TrunkScale", orientation="0.12 0 0", style="spine",
            mass=0.216, mass_centre="0 -12*TrunkScale 70*TrunkScale",
            gyration="110*TrunkScale 92*TrunkScale 98*TrunkScale"),
    Segment("Cervical", "ThoraxHigh", "Ball", "0 8*TrunkScale 158*TrunkScale", bind=[0.03, 0, 0],
            orientation="-0.18 0 0", style="spine"),
    Segment("Cranium", "Cervical", "Ball", "0 -16*TrunkScale 104*TrunkScale", bind=[-0.03, 0, 0],
            orientation="0.06 0 0", mass=0.081, mass_centre="0 -10*TrunkScale 62*TrunkScale",
            gyration="78*TrunkScale 80*TrunkScale 70*TrunkScale", style="head"),
    Segment("CraniumTop", "Cranium", "Dummy", "0 0 0.0925*BodyHeight"),
]

# The left side: names get "L_" or "R_" in front, and x turns round for the right.
SIDE = [
    Segment("Clavicle", "ThoraxHigh", "HardySpicer", "22*TrunkScale -34*TrunkScale 112*TrunkScale", bind=[0.0, 0.04],
            axes=[(0, 0, 1), (0, 1, 0)]),
    Segment("Humerus", "Clavicle", "Ball", "0.5*ShoulderWidth 26*TrunkScale 8*TrunkScale", bind=[0.05, 0.61, 0],
            centre=[0, 0.5, -0.3], spread=[0.4, 0.9, 0.7], mass=0.028, mass_centre="0.436*UpperArmLength 0 0",
            gyration="0.1*UpperArmLength 0.322*UpperArmLength 0.322*UpperArmLength"),
    Segment("Radius", "Humerus", "Hinge", "UpperArmLength 0 0", bind=[0.24], axes=[(0, 0, -1)], centre=[1.2],
            spread=[0.5], mass=0.016, mass_centre="0.43*ForeArmLength 0 0",
            gyration="0.1*ForeArmLength 0.303*ForeArmLength 0.303*ForeArmLength", labels="Flexion"),
    Segment("Hand", "Radius", "HardySpicer", "ForeArmLength 0 0", bind=[0.05, 0.0], axes=[(0, 1, 0), (0, 0, 1)],
            mass=0.006, mass_centre="0.3*ForeArmLength 0 0", style="carton"),
    Segment("Thumb", "Hand", "Hinge", "0.12*ForeArmLength -0.11*ForeArmLength -8*TrunkScale", axes=[(0.48, 0.36, 0.8)],
            labels="Opposition"),
    Segment("Femur", "Pelvis", "Ball", "0.5*HipWidth -6*TrunkScale -0.0189*BodyHeight", bind=[0, -0.06, 0],
            centre=[-0.6, 0, 0], spread=[0.7, 0.3, 0.3], mass=0.1, mass_centre="0 0 -0.433*ThighLength",
            gyration="0.323*ThighLength 0.323*ThighLength 0.12*ThighLength"),
    Segment("Tibia", "Femur", "Hinge", "0 0 -1*ThighLength", bind=[0.06], axes=[(1, 0, 0)], centre=[1.1], spread=[0.55],
            mass=0.0465, mass_centre="0 0 -0.433*ShinLength",
            gyration="0.302*ShinLength 0.302*ShinLength 0.1*ShinLength", labels="Flexion"),
    Segment("Foot", "Tibia", "HardySpicer", "0 4*TrunkScale -1*ShinLength", bind=[-0.05, 0.05],
            axes=[(1, 0, 0), (0, 1, 0)], mass=0.0145, mass_centre="0 -0.4*FootLength -0.0205*BodyHeight",
            style="carton"),
    Segment("Toes", "Foot", "Hinge", "6*TrunkScale -1*FootLength -0.0325*BodyHeight", axes=[(1, 0, 0)],
            labels="Extension", style="carton"),
]

# Markers on central segments: name, segment, position, outward normal, status.
CENTRE_MARKERS = [
    ("PelvisFrontL", "Pelvis", "0.66*HipWidth -88*TrunkScale 44*TrunkScale", (0, -1, 0), "required"),
    ("PelvisFrontR", "Pelvis", "-0.66*HipWidth -88*TrunkScale 44*TrunkScale", (0, -1, 0), "required"),
    ("PelvisBackL", "Pelvis", "0.27*HipWidth 96*TrunkScale 58*TrunkScale", (0, 1, 0), "required"),
    ("PelvisBackR", "Pelvis", "-0.27*HipWidth 96*TrunkScale 58*TrunkScale", (0, 1, 0), "required"),
    ("LumbarBack", "Lumbar", "0 84*TrunkScale 70*TrunkScale", (0, 1, 0), "optional"),
    ("ThoraxBack", "ThoraxLow", "0 102*TrunkScale 64*TrunkScale", (0, 1, 0), "required"),
    ("SternumTop", "ThoraxHigh", "0 -92*TrunkScale 104*TrunkScale", (0, -1, 0), "required"),
    ("SternumLow", "ThoraxHigh", "0 -124*TrunkScale -20*TrunkScale", (0, -1, 0), "required"),
    ("NeckBack", "ThoraxHigh", "0 74*TrunkScale 142*TrunkScale", (0, 1, 0), "required"),
    ("ShoulderBladeR", "ThoraxHigh", "-86*TrunkScale 104*TrunkScale 40*TrunkScale", (0, 1, 0), "optional"),
    ("HeadFrontL", "Cranium", "70*TrunkScale -82*TrunkScale 94*TrunkScale", (0.6, -0.8, 0), "required"),
    ("HeadFrontR", "Cranium", "-70*TrunkScale -82*TrunkScale 94*TrunkScale", (-0.6, -0.8, 0), "required"),
    ("HeadBackL", "Cranium", "66*TrunkScale 84*TrunkScale 98*TrunkScale", (0.6, 0.8, 0), "required"),
    ("HeadBackR", "Cranium", "-66*TrunkScale 84*TrunkScale 98*TrunkScale", (-0.6, 0.8, 0), "required"),
    ("HeadTop", "Cranium", "0 4*TrunkScale 176*TrunkScale", (0, 0, 1), "optional"),
]

# Markers of the left side, named with "L" or "R" at their end.
SIDE_MARKERS = [
    ("ShoulderTop", "Clavicle", "0.46*ShoulderWidth 10*TrunkScale 58*TrunkScale", (0, 0, 1), "required"),
    ("UpperArmOut", "Humerus", "0.48*UpperArmLength 46*TrunkScale 10*TrunkScale", (0, 1, 0), "optional"),
    ("ElbowOut", "Humerus", "0.97*UpperArmLength 48*TrunkScale 2*TrunkScale", (0, 1, 0), "required"),
    ("ElbowIn", "Humerus", "0.98*UpperArmLength -46*TrunkScale -4*TrunkScale", (0, -1, 0), "constraint"),
    ("ForeArmOut", "Radius", "0.5*ForeArmLength 34*TrunkScale 6*TrunkScale", (0, 1, 0), "optional"),
    ("WristOut", "Radius", "0.97*ForeArmLength 38*TrunkScale 0", (0, 1, 0), "required"),
    ("WristIn", "Radius", "0.97*ForeArmLength -40*TrunkScale 2*TrunkScale", (0, -1, 0), "required"),
    ("HandOut", "Hand", "0.34*ForeArmLength 26*TrunkScale 18*TrunkScale", (0, 0, 1), "required"),
    ("HandIn", "Hand", "0.36*ForeArmLength -30*TrunkScale 18*TrunkScale", (0, 0, 1), "required"),
    ("ThumbTip", "Thumb", "0.2*ForeArmLength -14*TrunkScale 8*TrunkScale", (0, -1, 0), "missing"),
    ("ThighFront", "Femur", "12*TrunkScale -92*TrunkScale -0.5*ThighLength", (0, -1, 0), "required"),
    ("KneeOut", "Femur", "58*TrunkScale 4*TrunkScale -0.98*ThighLength", (1, 0, 0), "required"),
    ("KneeIn", "Femur", "-56*TrunkScale 6*TrunkScale -0.98*ThighLength", (-1, 0, 0), "constraint"),
    ("ShinFront", "Tibia", "10*TrunkScale -54*TrunkScale -0.45*ShinLength", (0, -1, 0), "required"),
    ("AnkleOut", "Tibia", "44*TrunkScale 8*TrunkScale -0.985*ShinLength", (1, 0, 0), "required"),
    ("AnkleIn", "Tibia", "-42*TrunkScale 2*TrunkScale -0.97*ShinLength", (-1, 0, 0), "constraint"),
    ("Heel", "Foot", "0 58*TrunkScale -0.025*BodyHeight", (0, 1, 0), "required"),
    ("BallOut", "Foot", "48*TrunkScale -0.9*FootLength -0.0245*BodyHeight", (1, 0, 0), "required"),
    ("ToeTip", "Toes", "-2*TrunkScale -62*TrunkScale 8*TrunkScale", (0, -1, 0), "required"),
]

CENTRE_STICKS = [
    ("PelvisFrontL", "PelvisFrontR"), ("PelvisFrontL", "PelvisBackL"), ("PelvisFrontR", "PelvisBackR"),
    ("PelvisBackL", "PelvisBackR"), ("LumbarBack", "ThoraxBack"), ("ThoraxBack", "NeckBack"),
    ("SternumLow", "SternumTop"), ("HeadFrontL", "HeadFrontR"), ("HeadFrontL", "HeadBackL"),
    ("HeadFrontR", "HeadBackR"), ("HeadBackL", "HeadBackR"),
]
SIDE_STICKS = [
    ("ShoulderTop", "UpperArmOut"), ("UpperArmOut", "ElbowOut"), ("ElbowOut", "ForeArmOut"), ("ForeArmOut", "WristOut"),
    ("WristOut", "WristIn"), ("WristOut", "HandOut"), ("HandOut", "HandIn"), ("ThighFront", "KneeOut"),
    ("KneeOut", "ShinFront"), ("ShinFront", "AnkleOut"), ("AnkleOut", "Heel"), ("AnkleOut", "BallOut"),
    ("BallOut", "ToeTip"),
]


# ---- numbers and expressions

def number(value):
    text = "%.6f" % value
    text = text.rstrip("0").rstrip(".")
    return "0" if text == "-0" else text


def numbers(values):
    return " ".join(number(value) for value in values)


def diagonal(values):
    return numbers(value if row == column else 0.0 for row, value in enumerate(values) for column in range(len(values)))


def evaluate(expression, values):
    return float(eval(expression, {"__builtins__": {}}, values))


def parameter_values():
    values = {}
    for name, _, prior, measured in PARAMETERS:
        if measured is not None:
            values[name] = measured
        else:
            values[name] = evaluate(prior, values) if isinstance(prior, str) else prior
    return values


def evaluated(expressions, values):
    return numbers(evaluate(expression, values) for expression in expressions.split())


def negated(expression):
    if expression == "0":
        return expression
    if expression[0] == "-":
        return expression[1:]
    return "-" + expression if expression[0].isdigit() else "-1*" + expression


def mirrored_expressions(expressions):
    first, rest = expressions.split(" ", 1)
    return negated(first) + " " + rest


# ---- the right side from the left one

def mirrored_rotation(vector):
    """A rotation mirrored in the plane X = 0 keeps its X component and turns the others round."""
    return [vector[0], -vector[1], -vector[2]]


def side_segment(segment, side):
    right = side == "R_"
    siblings = {other.name for other in SIDE}
    result = Segment(**{key: value for key, value in vars(segment).items() if key not in ("context", "children")})
    result.name = side + segment.name
    result.parent = side + segment.parent if segment.parent in siblings else segment.parent
    result.context = "Right" if right else "Left"
    if right:
        # The axes are mirrored as rotations are, so that hinges and pairs keep the values of their states.
        result.offset = mirrored_expressions(segment.offset)
        result.axes = segment.axes and [mirrored_rotation(axis) for axis in segment.axes]
        result.mass_centre = segment.mass_centre and mirrored_expressions(segment.mass_centre)
        if segment.joint == "Ball":
            result.bind = mirrored_rotation(segment.bind)
            result.centre = segment.centre and mirrored_rotation(segment.centre)
    return result


def side_marker(marker, side):
    name, segment, position, normal, status = marker
    if side == "R_":
        position, normal = mirrored_expressions(position), (-normal[0],) + normal[1:]
    return (name + side[0], side + segment, position, normal, status)


def skeleton():
    """All segments with their children; the first is the root."""
    segments = CENTRE + [side_segment(segment, side) for side in ("L_", "R_") for segment in SIDE]
    by_name = {segment.name: segment for segment in segments}
    for segment in segments:
        if segment.parent:
            by_name[segment.parent].children.append(segment)
    return segments


# ---- the document

def colour_of(segment):
    return {"Left": LEFT_COLOUR, "Right": RIGHT_COLOUR}.get(segment.context, CENTRE_COLOUR)


def add_parameters(model):
    section = xml.SubElement(model, "Parameters")
    for name, quantity, prior, measured in PARAMETERS:
        derived = isinstance(prior, str)
        attributes = {"NAME": name}
        if measured is not None:
            attributes["VALUE"] = number(measured)
        attributes.update({"EXPRESSION": prior} if derived else {"PRIOR": number(prior)})
        attributes.update({"HIDDEN": str(derived and measured is None).lower(), "ADVANCED": str(derived).lower(),
                           "READONLY": "false", "REQUIRED": str(not derived).lower(), "QUANTITY": quantity})
        xml.SubElement(section, "StaticParameter", attributes)


def add_joint(element, segment, values):
    size = STATE_SIZE[segment.joint]
    pose = {"PRE-ORIENTATION": evaluated(segment.orientation, values),
            "PRE-POSITION": evaluated(segment.offset, values),
            "INVERSE-POST-ORIENTATION": "0 0 0", "INVERSE-POST-POSITION": "0 0 0"}
    template_pose = dict(pose, **{"PRE-ORIENTATION": segment.orientation, "PRE-POSITION": segment.offset})
    attributes = {"NAME": segment.name + "Joint", **pose}
    template = {}
    if size:
        free = segment.joint == "Free"
        t_pose = [0, 0, 0, 0, 0, PELVIS_HEIGHT] if free else [0] * size
        variances = [VARIANCE] * min(size, 3) + [POSITION_VARIANCE] * (size - 3)
        statistics = {"MEAN": numbers(t_pose), "COVARIANCE": diagonal(variances)}
        limits = {}
        if segment.centre:
            limits = {"RANGE-CENTRING-STATE": numbers(segment.centre), "RANGE-MATRIX": diagonal(segment.spread)}
        attributes.update(statistics, T="0 0 0 * * *" if free else numbers(t_pose))
        if segment.labels:
            attributes["LABELS"] = segment.labels
        attributes.update(limits)
        template.update(statistics, **{"TPOSE-MEAN": numbers(t_pose), "BIND-POSE": numbers(segment.bind)})
        template_pose.update(limits)
    if segment.joint in ("Free", "Ball"):
        attributes["EULER-ORDER"] = "XYZ"
    elif segment.joint == "HardySpicer":
        attributes["AXIS-PAIR"] = numbers(value for axis in segment.axes for value in axis)
    elif segment.joint == "Hinge":
        attributes["AXIS"] = numbers(segment.axes[0])
    joint = xml.SubElement(element, "Joint" + segment.joint, attributes)
    xml.SubElement(joint, "JointTemplate", {**template, **template_pose})


def add_segment(parent, segment, values):
    attributes = {"NAME": segment.name}
    if segment.mass is not None:
        attributes["MASS"] = number(segment.mass)
    if segment.mass_centre:
        attributes["MASS-CENTRE"] = segment.mass_centre
    if segment.gyration:
        attributes["INERTIA"] = segment.gyration
    attributes["RGB"] = colour_of(segment)
    if segment.context:
        attributes["CONTEXT"] = segment.context
    attributes.update({"HIDDEN": "false", "DRAW-STYLE": segment.style, "DRAW-SHADING": "shaded-smooth"})
    element = xml.SubElement(parent, "Segment", attributes)
    add_joint(element, segment, values)
    for child in segment.children:
        add_segment(element, child, values)


def add_markers(model, markers, sticks, colours):
    section = xml.SubElement(model, "MarkerSet", {"NAME": "BodyMarkers"})
    listed = xml.SubElement(section, "Markers")
    for name, segment, _, _, status in markers:
        xml.SubElement(listed, "Marker", {"NAME": name, "RADIUS": "7", "RGB": colours[segment], "STATUS": status,
                                          "VIEW-ANGLE": "1.4"})
    listed = xml.SubElement(section, "Sticks")
    segment_of = {name: segment for name, segment, _, _, _ in markers}
    for first, second in sticks:
        xml.SubElement(listed, "Stick", {"MARKER1": first, "MARKER2": second, "RGB1": colours[segment_of[first]],
                                         "RGB2": colours[segment_of[second]]})


def add_targets(model, markers, colours):
    listed = xml.SubElement(xml.SubElement(model, "TargetSet"), "Targets")
    for name, segment, position, normal, status in markers:
        kind = "TargetLocalPointToWorldPoint"
        target = xml.SubElement(listed, kind, {
            "FILL-GAPS": "true", "HIDDEN": "false", "NAME": name, "MARKER": name, "POSITION": position,
            "CALIBRATION-WEIGHT": "0.5" if status == "optional" else "1", "RGB": colours[segment], "SEGMENT": segment,
            "WEIGHT": "1", "VIEW-NORMAL": numbers(normal)})
        # Skin moves more over the limbs than over the head.
        spread = 9 if segment == "Cranium" else 64
        xml.SubElement(target, kind + "Template", {"COVARIANCE": diagonal([spread] * 3)})


def performer():
    values = parameter_values()
    segments = skeleton()
    colours = {segment.name: colour_of(segment) for segment in segments}
    markers = CENTRE_MARKERS + [side_marker(marker, side) for side in ("L_", "R_") for marker in SIDE_MARKERS]
    sticks = CENTRE_STICKS + [(first + side, second + side) for side in "LR" for first, second in SIDE_STICKS]
    model = xml.Element("KinematicModel", {"MODEL": "DemoPerformer", "VERSION": "3.5", "MODEL-VERSION": "1"})
    add_parameters(model)
    add_segment(xml.SubElement(model, "Skeleton", {"RGB": CENTRE_COLOUR}), segments[0], values)
    add_markers(model, markers, sticks, colours)
    add_targets(model, markers, colours)
    return model


def main():
    parser = argparse.ArgumentParser(description="Write the demo's performer as a skeleton file.")
    parser.add_argument("-o", "--output", default=pathlib.Path(__file__).with_name("performer.qrs"), type=pathlib.Path)
    options = parser.parse_args()
    model = performer()
    xml.indent(model, " ")
    text = '<?xml version="1.0" encoding="UTF-8" standalone="no"?>\n' + xml.tostring(model, encoding="unicode") + "\n"
    options.output.write_bytes(text.encode("utf-8"))


if __name__ == "__main__":
    main()
