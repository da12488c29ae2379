"""What the nodes of an FBX scene evaluate to, computed apart from any reader: the expected values of its tests.

Local transform, for column vectors: T Roff Rp Rpre R Rpost^-1 Rp^-1 Soff Sp S Sp^-1. Without RotationActive the order
of rotation is XYZ and Rpre and Rpost are the identity. Global transform: the translation is the local one seen from
the parent; rotation and scale follow the inherit type, with capitals for the parent's global parts: 0 R r S s,
1 R S r s, 2 R r (S without the parent's own scale) s.
"""

import math

ORDERS = ("xyz", "xzy", "yzx", "yxz", "zxy", "zyx")


def identity():
    return [[1.0 if row == column else 0.0 for column in range(4)] for row in range(4)]


def product(*factors):
    result = identity()
    for factor in factors:
        result = [[sum(result[i][k] * factor[k][j] for k in range(4)) for j in range(4)] for i in range(4)]
    return result


def shift(v, sign=1.0):
    result = identity()
    for i in range(3):
        result[i][3] = sign * v[i]
    return result


def stretch(v):
    result = identity()
    for i in range(3):
        result[i][i] = float(v[i])
    return result


def turn(degrees, order="xyz"):
    x, y, z = (math.radians(angle) for angle in degrees)
    about = {
        "x": [[1, 0, 0, 0], [0, math.cos(x), -math.sin(x), 0], [0, math.sin(x), math.cos(x), 0], [0, 0, 0, 1]],
        "y": [[math.cos(y), 0, math.sin(y), 0], [0, 1, 0, 0], [-math.sin(y), 0, math.cos(y), 0], [0, 0, 0, 1]],
        "z": [[math.cos(z), -math.sin(z), 0, 0], [math.sin(z), math.cos(z), 0, 0], [0, 0, 1, 0], [0, 0, 0, 1]],
    }
    return product(*(about[axis] for axis in reversed(order)))


def turned_back(rotation):
    """The inverse of a rotation."""
    return [[rotation[j][i] for j in range(4)] for i in range(4)]


def linear_part(matrix):
    result = identity()
    for i in range(3):
        result[i][:3] = matrix[i][:3]
    return result


class Node:
    """A node with the values that are in force, whether they stand in the file or come from a template."""

    def __init__(self, name, parent=None, kind="LimbNode", translation=(0, 0, 0), rotation=(0, 0, 0), scale=(1, 1, 1),
                 pre=(0, 0, 0), post=(0, 0, 0), active=True, order=0, inherit=1, rotation_offset=(0, 0, 0),
                 rotation_pivot=(0, 0, 0), scaling_offset=(0, 0, 0), scaling_pivot=(0, 0, 0)):
        self.name = name
        self.parent = parent
        self.kind = kind
        self.translation = translation
        self.rotation = rotation
        self.scale = scale
        self.pre = pre
        self.post = post
        self.active = active
        self.order = order
        self.inherit = inherit
        self.rotation_offset = rotation_offset
        self.rotation_pivot = rotation_pivot
        self.scaling_offset = scaling_offset
        self.scaling_pivot = scaling_pivot
        self._evaluate()

    def _evaluate(self):
        pre = self.pre_rotation = turn(self.pre) if self.active else identity()
        post = turn(self.post) if self.active else identity()
        rotation = product(pre, turn(self.rotation, ORDERS[self.order if self.active else 0]), turned_back(post))
        own = product(
            shift(self.translation), shift(self.rotation_offset), shift(self.rotation_pivot), rotation,
            shift(self.rotation_pivot, -1.0), shift(self.scaling_offset), shift(self.scaling_pivot),
            stretch(self.scale), shift(self.scaling_pivot, -1.0))
        self.local = own
        parent = self.parent
        if parent is None:
            self.world, self.world_rotation, self.world_scale = own, rotation, self.scale
            return
        above = parent.world_scale
        if self.inherit == 2:
            above = [total / last for total, last in zip(above, parent.scale)]
        # Only types 0 and 2 need rotation and scale apart; they are not asked for below a sheared node.
        self.world_rotation = product(parent.world_rotation, rotation)
        self.world_scale = [a * b for a, b in zip(above, self.scale)]
        if self.inherit == 1:
            linear = product(linear_part(parent.world), rotation, stretch(self.scale))
        else:
            linear = product(self.world_rotation, stretch(self.world_scale))
        place = [sum(parent.world[i][k] * own[k][3] for k in range(3)) + parent.world[i][3] for i in range(3)]
        self.world = product(shift(place), linear)

    def local_without_pre_rotation(self):
        return product(self.local, turned_back(self.pre_rotation))

    def accumulated_scale(self):
        return self.scale[0] * (self.parent.accumulated_scale() if self.parent else 1.0)
