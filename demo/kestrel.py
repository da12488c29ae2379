"""Kestrel, the demo's character, as a rigger would describe it: its joints, how they are posed, how thick it is.

Centimetres and degrees; Y is up, the character faces +Z and its left side is at +X.
"""


class Bone:
    """start and end are world positions in the T-pose. The joint's X axis runs from start to end, its Y axis is the
    part of `up` at right angles to that. rotation is the pose in which the character is handed over, on top of
    the joint's orientation. radius is that of the body around the bone, along the joint's Y and Z."""

    def __init__(self, name, parent, start, end, up, radius, rotation=(0, 0, 0), order=0, accent=False, aligned=False):
        self.name = name
        self.parent = parent
        self.start = start
        self.end = end
        self.up = up
        self.radius = radius
        self.rotation = rotation
        self.order = order
        self.accent = accent
        # An aligned joint keeps the world's axes and has no orientation of its own, as the root of most rigs.
        self.aligned = aligned
        self.mirrored = False


UP, FRONT = (0, 1, 0), (0, 0, 1)

CENTRE = [
    Bone("haunch", None, (0, 82, 0), (0, 92, -1), FRONT, (11, 14), aligned=True),
    Bone("loin", "haunch", (0, 92, -1), (0, 104, -1.5), FRONT, (8.5, 11)),
    Bone("ribs", "loin", (0, 104, -1.5), (0, 116, -1), FRONT, (9.5, 12.5), rotation=(0, 0, -3)),
    Bone("breast", "ribs", (0, 116, -1), (0, 128, -1), FRONT, (9, 13), rotation=(0, 0, 3)),
    Bone("nape", "breast", (0, 128, -1), (0, 136, 1), FRONT, (4.5, 5)),
    Bone("skull", "nape", (0, 136, 1), (0, 152, 1.5), FRONT, (9.5, 8), rotation=(2, 0, -4), order=4),
    Bone("crest", "skull", (0, 152, -2), (0, 160, -9), FRONT, (2.5, 1), accent=True),
    Bone("cape1", "breast", (0, 124, -11), (0, 104, -15), FRONT, (1.2, 17), accent=True),
    Bone("cape2", "cape1", (0, 104, -15), (0, 82, -19), FRONT, (1.2, 19), rotation=(0, 0, -4), accent=True),
    Bone("cape3", "cape2", (0, 82, -19), (0, 60, -22), FRONT, (1.2, 21), rotation=(0, 0, -6), accent=True),
    Bone("cape4", "cape3", (0, 60, -22), (0, 38, -24), FRONT, (1.2, 23), rotation=(0, 0, -3), accent=True),
]

# The left side; names get "Left" or "Right" at their end. A parent that is listed here is the one of the same side.
SIDE = [
    Bone("collar", "breast", (3, 124, 1), (15, 125, -1), UP, (4, 4.5)),
    Bone("upperArm", "collar", (15, 125, -1), (41, 125, -1), UP, (5, 5), rotation=(4, 6, -38), order=2),
    Bone("foreArm", "upperArm", (41, 125, -1), (65, 125, 0), UP, (4, 4), rotation=(0, -18, 0)),
    Bone("palm", "foreArm", (65, 125, 0), (74, 125, 0), UP, (2, 4), rotation=(5, 0, -4), accent=True),
    Bone("thumb1", "palm", (68, 124, 4), (71, 123, 7), UP, (1.3, 1.3), rotation=(0, 8, 0), accent=True),
    Bone("thumb2", "thumb1", (71, 123, 7), (74, 122, 9), UP, (1.2, 1.2), rotation=(0, 10, 0), accent=True),
    Bone("point1", "palm", (74, 125, 3), (78.5, 125, 3.5), UP, (1.1, 1.1), rotation=(0, 0, -12), accent=True),
    Bone("point2", "point1", (78.5, 125, 3.5), (83, 125, 4), UP, (1, 1), rotation=(0, 0, -15), accent=True),
    Bone("grip1", "palm", (74, 124.5, -1.5), (79, 124.5, -1.5), UP, (1.3, 2.6), rotation=(0, 0, -16), accent=True),
    Bone("grip2", "grip1", (79, 124.5, -1.5), (83.5, 124.5, -1.5), UP, (1.1, 2.4), rotation=(0, 0, -20), accent=True),
    Bone("thigh", "haunch", (9, 78, 0), (10, 43, 1), FRONT, (8, 7.5), rotation=(0, 5, 3)),
    Bone("shin", "thigh", (10, 43, 1), (10.5, 9, -3), FRONT, (5.5, 5), rotation=(0, 0, -6)),
    Bone("hock", "shin", (10.5, 9, -3), (11, 3, 8), UP, (4, 4), rotation=(0, -2, 3), accent=True),
    Bone("claw", "hock", (11, 3, 8), (11.2, 2.5, 17), UP, (2, 3.8), accent=True),
]


def _side_bone(bone, suffix, siblings):
    mirrored = suffix == "Right"
    sign = -1 if mirrored else 1
    parent = bone.parent + suffix if bone.parent in siblings else bone.parent
    result = Bone(bone.name + suffix, parent, (sign * bone.start[0],) + bone.start[1:],
                  (sign * bone.end[0],) + bone.end[1:], bone.up, bone.radius, bone.rotation, bone.order, bone.accent)
    result.mirrored = mirrored
    return result


def bones():
    """All bones, parents before children."""
    siblings = {bone.name for bone in SIDE}
    return CENTRE + [_side_bone(bone, suffix, siblings) for suffix in ("Left", "Right") for bone in SIDE]
