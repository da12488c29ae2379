#!/usr/bin/env python3
"""Writes demo/walk.bvh: the demo's performer walks with swinging arms, turns round, walks on, and squats.

    make_take.py [-o FILE]

Joints have the names and lengths of the performer's segments; where all angles are zero it stands in its bind pose. The
first frame is the T-pose. Centimetres, Y up, facing +Z. The same call always gives the same bytes.
"""

import argparse
import math
import pathlib

import make_performer
from matrix import axis_rotation, identity, multiply, rigid_inverse, transform_point

# All that follows is in the performer's axes, Z up and facing -Y, and in millimetres, seconds and degrees.
RATE = 30.0
STEP_TIME, SWING_TIME = 0.56, 0.46
STEP_LENGTH, STEP_WIDTH, STEP_HEIGHT = 480.0, 92.0, 90.0
# How far each step turns, and its part of a whole one.
STEPS = [(0, 0.5), (0, 1), (0, 1), (0, 1), (20, 0.9), (40, 0.6), (40, 0.5), (40, 0.5), (40, 0.6), (0, 0.9), (0, 1),
         (0, 1), (0, 0.5)]
POSE_TIME, LOWER_TIME, REST_TIME, SQUAT_TIME = 0.7, 0.8, 0.5, 2.6
WALK_START = POSE_TIME + LOWER_TIME + REST_TIME
WALK_END = WALK_START + STEP_TIME * len(STEPS)
SQUAT_START = WALK_END + REST_TIME
END = SQUAT_START + SQUAT_TIME + REST_TIME
WALK_DROP, SQUAT_DROP = 56.0, 330.0
# Pelvis and trunk follow the feet as through a window of that width.
SMOOTH_TIME = 0.16

# The pelvis has a place, too.
ROOT_CHANNELS = "Xposition Yposition Zposition Zrotation Xrotation Yrotation"
FIXED = ("CraniumTop", "Thumb", "Toes")
DECIMALS = 3


def smooth(time, start, duration):
    """From 0 to 1, with a slope of 0 at both ends."""
    part = min(max((time - start) / duration, 0.0), 1.0)
    return part * part * (3.0 - 2.0 * part)


def add(a, b, factor=1.0):
    return [x + factor * y for x, y in zip(a, b)]


def normalised(v):
    length = math.sqrt(sum(x * x for x in v))
    return [x / length for x in v]


def cross(a, b):
    return [a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]]


def frame_of(x, y, z, place=(0.0, 0.0, 0.0)):
    return [[x[row], y[row], z[row], place[row]] for row in range(3)] + [[0.0, 0.0, 0.0, 1.0]]


def place_of(matrix):
    return [matrix[row][3] for row in range(3)]


def turned(matrix):
    """The rotation alone."""
    return [row[:3] + [0.0] for row in matrix[:3]] + [[0.0, 0.0, 0.0, 1.0]]


def about(axis, angle):
    """By radians about an axis of any direction."""
    c, s = math.cos(angle), math.sin(angle)
    x, y, z = normalised(axis)
    return frame_of((c + (1 - c) * x * x, (1 - c) * x * y + s * z, (1 - c) * x * z - s * y),
                    ((1 - c) * x * y - s * z, c + (1 - c) * y * y, (1 - c) * y * z + s * x),
                    ((1 - c) * x * z + s * y, (1 - c) * y * z - s * x, c + (1 - c) * z * z))


def vector_rotation(vector):
    angle = math.sqrt(sum(x * x for x in vector))
    return about(vector, angle) if angle > 0.0 else identity()


def bind_motion(segment):
    """What its joint turns by in the bind pose."""
    if segment.axes:
        turns = [about(axis, angle) for axis, angle in zip(segment.axes, segment.bind)]
        return multiply(*turns) if len(turns) > 1 else turns[0]
    return vector_rotation(segment.bind[:3])


class Bone:
    """A segment of the performer in its T-pose, with axes that stand unturned there; bound is how it is turned in the
    bind pose."""

    def __init__(self, segment, parent, values):
        self.name = segment.name
        self.kind = segment.name[2:] if segment.name[1] == "_" else segment.name
        self.side = {"L_": 1.0, "R_": -1.0}.get(segment.name[:2], 0.0)
        self.parent = parent
        self.children = []
        offset = [make_performer.evaluate(text, values) for text in segment.offset.split()]
        oriented = parent.oriented if parent else identity()
        self.offset = transform_point(oriented, offset)
        orientation = vector_rotation([float(token) for token in segment.orientation.split()])
        self.oriented = multiply(oriented, orientation)
        above = multiply(parent.bound, oriented) if parent else identity()
        self.bound = multiply(above, orientation, bind_motion(segment), rigid_inverse(self.oriented))
        if parent:
            parent.children.append(self)


def skeleton():
    values = make_performer.parameter_values()
    bones = {}
    open_segments = [(make_performer.skeleton()[0], None)]
    while open_segments:
        segment, parent = open_segments.pop()
        bone = Bone(segment, parent, values)
        bones[bone.name] = bone
        open_segments += [(child, bone) for child in reversed(segment.children)]
    return bones


class Foot:
    """Where a foot stands, and the steps that it takes: start, place and heading before and after."""

    def __init__(self, place):
        self.place, self.heading, self.steps = place, 0.0, []

    def step(self, start, place, heading):
        self.steps.append((start, self.place, self.heading, place, heading))
        self.place, self.heading = place, heading

    def at(self, time):
        """Place on the floor, height and heading."""
        place, heading, lift = self.steps[0][1], self.steps[0][2], 0.0
        for start, before, heading_before, after, heading_after in self.steps:
            if time < start:
                break
            part = smooth(time, start, SWING_TIME)
            place = add(before, add(after, before, -1.0), part)
            heading = heading_before + part * (heading_after - heading_before)
            lift = STEP_HEIGHT * math.sin(math.pi * part)
        return place, lift, heading


def plan_feet():
    feet = {1.0: Foot([STEP_WIDTH, 0.0]), -1.0: Foot([-STEP_WIDTH, 0.0])}
    middle, heading, side = [0.0, 0.0], 0.0, 1.0
    for index, (turn, length) in enumerate(STEPS):
        heading += turn
        c, s = math.cos(math.radians(heading)), math.sin(math.radians(heading))
        # Forward is -Y, left +X. The last step brings the feet together.
        advance = STEP_LENGTH * length if index + 1 < len(STEPS) else 0.0
        middle = add(middle, [s * advance, -c * advance])
        feet[side].step(WALK_START + index * STEP_TIME, add(middle, [c * side * STEP_WIDTH, s * side * STEP_WIDTH]),
                        heading)
        side = -side
    return feet


def middle_of(feet, time):
    """Place and heading between the feet, as if seen through a window."""
    total, x, y, heading = 0.0, 0.0, 0.0, 0.0
    for k in range(-12, 13):
        weight = math.exp(-0.5 * (k / 5.0) ** 2)
        for foot in feet.values():
            place, _, turn = foot.at(time + k * SMOOTH_TIME / 5.0)
            total += weight
            x, y, heading = x + weight * place[0], y + weight * place[1], heading + weight * turn
    return [x / total, y / total], heading / total


class Body:
    """World frames of all joints, by name, and how each is turned on its parent."""

    def __init__(self, bones):
        self.bones = bones
        self.world = {}

    def turn(self, name, *rotations):
        bone = self.bones[name]
        parent = self.world[bone.parent.name]
        self.world[name] = multiply(parent, make_translation(bone.offset), *rotations)

    def set_rotation(self, name, rotation):
        bone = self.bones[name]
        place = transform_point(self.world[bone.parent.name], bone.offset)
        self.world[name] = frame_of(*([row[k] for row in rotation[:3]] for k in range(3)), place)

    def since_bind(self, name):
        return turned(multiply(self.world[name], rigid_inverse(self.bones[name].bound)))

    def local_rotation(self, name):
        bone = self.bones[name]
        parent = self.since_bind(bone.parent.name) if bone.parent else identity()
        return multiply(rigid_inverse(parent), self.since_bind(name))


def make_translation(offset):
    result = identity()
    for row in range(3):
        result[row][3] = offset[row]
    return result


def pose_leg(body, prefix, ankle, foot_turn, forward):
    """Thigh and shin in one plane with the way that the knee points, so that the foot stands where it should."""
    thigh, shin, foot = prefix + "Femur", prefix + "Tibia", prefix + "Foot"
    bones = body.bones
    hip = transform_point(body.world[bones[thigh].parent.name], bones[thigh].offset)
    thigh_length = -bones[shin].offset[2]
    to_ankle = bones[foot].offset
    shin_length = math.hypot(to_ankle[1], to_ankle[2])
    way = add(ankle, hip, -1.0)
    distance = math.sqrt(sum(x * x for x in way))
    # Straight in the T-pose.
    assert distance < thigh_length + shin_length + 1e-3, "the leg does not reach its foot"
    distance = min(distance, thigh_length + shin_length - 1e-6)
    along = normalised(way)
    ahead = normalised(add(forward, along, -sum(a * b for a, b in zip(forward, along))))
    cosine = (thigh_length ** 2 + distance ** 2 - shin_length ** 2) / (2.0 * thigh_length * distance)
    sine = math.sqrt(1.0 - cosine * cosine)
    x = cross(ahead, along)
    down = [cosine * a + sine * b for a, b in zip(along, ahead)]
    z = [-value for value in down]
    body.set_rotation(thigh, frame_of(x, cross(z, x), z))
    knee = add(hip, down, thigh_length)
    z = [-value for value in normalised(add(ankle, knee, -1.0))]
    lean = math.degrees(math.atan(to_ankle[1] / to_ankle[2]))
    body.set_rotation(shin, multiply(frame_of(x, cross(z, x), z), axis_rotation("x", lean)))
    body.set_rotation(foot, foot_turn)


def pose(bones, feet, time):
    body = Body(bones)
    middle, heading = middle_of(feet, time)
    lowered = smooth(time, POSE_TIME, LOWER_TIME)
    squat = smooth(time, SQUAT_START, 0.45 * SQUAT_TIME) - smooth(time, SQUAT_START + 0.55 * SQUAT_TIME,
                                                                   0.45 * SQUAT_TIME)
    walk = smooth(time, WALK_START - 0.2, 0.6) - smooth(time, WALK_END - 0.4, 0.6)
    # Half a turn of the phase for each step; the left leg is ahead at 0.
    phase = math.pi * ((time - WALK_START) / STEP_TIME - 0.8)
    swing = walk * math.cos(phase)

    facing = axis_rotation("z", heading)
    drop = WALK_DROP * smooth(time, POSE_TIME, LOWER_TIME) + SQUAT_DROP * squat - 10.0 * walk * math.cos(2.0 * phase)
    back = transform_point(facing, (0.0, 130.0 * squat, 0.0))
    place = [middle[0] + back[0], middle[1] + back[1], make_performer.PELVIS_HEIGHT - drop]
    body.world["Pelvis"] = multiply(make_translation(place), facing, axis_rotation("z", -5.0 * swing),
                                    axis_rotation("x", 18.0 * squat), axis_rotation("y", 2.5 * walk * math.sin(phase)))
    body.turn("Lumbar", axis_rotation("x", 1.5 * lowered + 14.0 * squat), axis_rotation("z", 3.0 * swing))
    body.turn("ThoraxLow", axis_rotation("x", 1.0 * lowered + 10.0 * squat), axis_rotation("z", 3.0 * swing))
    body.turn("ThoraxHigh", axis_rotation("z", 3.0 * swing))
    body.turn("Cervical", axis_rotation("x", 1.5 * lowered - 12.0 * squat))
    body.turn("Cranium", axis_rotation("x", -1.0 * lowered - 16.0 * squat), axis_rotation("z", -3.0 * swing))
    for prefix, side in (("L_", 1.0), ("R_", -1.0)):
        body.turn(prefix + "Clavicle", axis_rotation("y", side * 3.0 * lowered))
        # The arm goes with the leg of the other side.
        body.turn(prefix + "Humerus", axis_rotation("x", 26.0 * side * swing - 62.0 * squat),
                  axis_rotation("y", side * (72.0 * lowered - 8.0 * squat)))
        flexion = 14.0 * lowered + walk * (10.0 - 8.0 * side * math.cos(phase)) + 18.0 * squat
        body.turn(prefix + "Radius", axis_rotation("z", -side * flexion))
        body.turn(prefix + "Hand", axis_rotation("y", side * 4.0 * lowered))

        foot_place, lift, foot_heading = feet[side].at(time)
        foot_turn = axis_rotation("z", foot_heading)
        chain = [bones[prefix + name].offset for name in ("Femur", "Tibia", "Foot")]
        behind, height = (sum(offset[axis] for offset in chain) for axis in (1, 2))
        ankle = add(foot_place + [make_performer.PELVIS_HEIGHT + height + lift],
                    transform_point(foot_turn, (0.0, behind, 0.0)))
        forward = transform_point(axis_rotation("z", 0.5 * (foot_heading + heading)),
                                  (side * 0.12 * lowered, -1.0, 0.0))
        pose_leg(body, prefix, ankle, multiply(foot_turn, axis_rotation("x", 0.18 * lift)), forward)
    return body


def in_file(matrix):
    """The same rotation in the file's axes, where (x, y, z) is (x, z, -y)."""
    order = ((0, 1.0), (2, 1.0), (1, -1.0))
    return [[a_sign * b_sign * matrix[a][b] for b, b_sign in order] for a, a_sign in order]


def angles_zxy(matrix):
    """Degrees about Z, X and Y, for their product in that order."""
    x = math.asin(max(-1.0, min(1.0, matrix[2][1])))
    return [math.degrees(angle) for angle in (math.atan2(-matrix[0][1], matrix[1][1]), x,
                                              math.atan2(-matrix[2][0], matrix[2][2]))]


def centimetres(place):
    return [0.1 * place[0], 0.1 * place[2], -0.1 * place[1]]


def text(values):
    # A zero has no sign.
    return " ".join("%.*f" % (DECIMALS, round(value, DECIMALS) + 0.0) for value in values)


def channels_of(bone):
    if bone.parent is None:
        return ROOT_CHANNELS.split()
    if bone.kind in FIXED:
        return []
    return ["Zrotation", "Xrotation", "Yrotation"]


def write_hierarchy(lines, bone, depth):
    indent = "\t" * depth
    lines.append("%s%s %s" % (indent, "JOINT" if bone.parent else "ROOT", bone.name))
    lines.append(indent + "{")
    offset = transform_point(bone.parent.bound, bone.offset) if bone.parent else (0.0, 0.0, 0.0)
    lines.append("%s\tOFFSET %s" % (indent, text(centimetres(offset))))
    channels = channels_of(bone)
    lines.append("%s\tCHANNELS %s" % (indent, " ".join([str(len(channels))] + channels)))
    for child in bone.children:
        write_hierarchy(lines, child, depth + 1)
    if not bone.children:
        end = {"CraniumTop": (0.0, 0.0, 10.0), "Thumb": (bone.side * 30.0, -30.0, 0.0)}.get(bone.kind, (0, -70.0, 0))
        end = text(centimetres(transform_point(bone.bound, end)))
        lines.append("%s\tEnd Site\n%s\t{\n%s\t\tOFFSET %s\n%s\t}" % (indent, indent, indent, end, indent))
    lines.append(indent + "}")


def frame_values(body, bone):
    values = []
    channels = channels_of(bone)
    if bone.parent is None:
        values += centimetres(place_of(body.world[bone.name]))
    if channels:
        values += angles_zxy(in_file(body.local_rotation(bone.name)))
    for child in bone.children:
        values += frame_values(body, child)
    return values


def take():
    bones = skeleton()
    root = bones["Pelvis"]
    feet = plan_feet()
    lines = ["HIERARCHY"]
    write_hierarchy(lines, root, 0)
    frames = int(END * RATE) + 1
    lines += ["MOTION", "Frames: %d" % frames, "Frame Time: %.7f" % (1.0 / RATE)]
    before = None
    for index in range(frames):
        body = pose(bones, feet, index / RATE)
        for name in bones:
            if name not in body.world:
                body.turn(name)
        values = frame_values(body, root)
        # The heading goes on where a half turn is reached.
        if before:
            values[3:6] = [value + 360.0 * round((last - value) / 360.0)
                           for value, last in zip(values[3:6], before[3:6])]
        before = values
        lines.append(text(values))
    return "\n".join(lines) + "\n"


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("-o", "--output", type=pathlib.Path, default=pathlib.Path(__file__).with_name("walk.bvh"))
    arguments = parser.parse_args()
    arguments.output.write_bytes(take().encode("ascii"))


if __name__ == "__main__":
    main()
