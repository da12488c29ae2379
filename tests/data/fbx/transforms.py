"""What the nodes of an FBX scene evaluate to, computed apart from any reader: the expected values of its tests.

Local transform, for column vectors: T Roff Rp Rpre R Rpost^-1 Rp^-1 Soff Sp S Sp^-1. Without RotationActive the order
of rotation is XYZ and Rpre and Rpost are the identity. Global transform: the translation is the local one seen from
the parent; rotation and scale follow the inherit type, with capitals for the parent's global parts: 0 R r S s,
1 R S r s, 2 R r (S without the parent's own scale) s.
"""

import pathlib
import sys

sys.path.insert(0, str(pathlib.Path(__file__).resolve().parents[3] / "demo"))

from matrix import ROTATION_ORDERS, axis_rotation, identity, multiply, rigid_inverse, scaling, translation


def turn(degrees, order="xyz"):
    return multiply(*(axis_rotation(axis, degrees["xyz".index(axis)]) for axis in reversed(order)))


def linear_part(matrix):
    return [row[:3] + [0.0] for row in matrix[:3]] + identity()[3:]


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
        rotation = multiply(pre, turn(self.rotation, ROTATION_ORDERS[self.order if self.active else 0]), rigid_inverse(post))
        rotation_pivot, scaling_pivot = translation(self.rotation_pivot), translation(self.scaling_pivot)
        own = multiply(
            translation(self.translation), translation(self.rotation_offset), rotation_pivot, rotation,
            rigid_inverse(rotation_pivot), translation(self.scaling_offset), scaling_pivot,
            scaling(self.scale), rigid_inverse(scaling_pivot))
        self.local = own
        parent = self.parent
        if parent is None:
            self.world, self.world_rotation, self.world_scale = own, rotation, self.scale
            return
        above = parent.world_scale
        if self.inherit == 2:
            above = [total / last for total, last in zip(above, parent.scale)]
        # Only types 0 and 2 need rotation and scale apart; they are not asked for below a sheared node.
        self.world_rotation = multiply(parent.world_rotation, rotation)
        self.world_scale = [a * b for a, b in zip(above, self.scale)]
        if self.inherit == 1:
            linear = multiply(linear_part(parent.world), rotation, scaling(self.scale))
        else:
            linear = multiply(self.world_rotation, scaling(self.world_scale))
        place = [sum(parent.world[i][k] * own[k][3] for k in range(3)) + parent.world[i][3] for i in range(3)]
        self.world = multiply(translation(place), linear)

    def local_without_pre_rotation(self):
        return multiply(self.local, rigid_inverse(self.pre_rotation))

    def accumulated_scale(self):
        return self.scale[0] * (self.parent.accumulated_scale() if self.parent else 1.0)
