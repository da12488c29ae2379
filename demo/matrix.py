"""4x4 matrices for column vectors, as lists of rows, and rotations as FBX writes them (Euler angles in degrees)."""

import math

# The axes of FBX's rotation orders by their number; the first one is applied to a vector first.
ROTATION_ORDERS = ("xyz", "xzy", "yzx", "yxz", "zxy", "zyx")


def identity():
    return [[float(row == column) for column in range(4)] for row in range(4)]


def multiply(*matrices):
    result = matrices[0]
    for right in matrices[1:]:
        result = [[sum(left_row[k] * right[k][column] for k in range(4)) for column in range(4)] for left_row in result]
    return result


def transform_point(matrix, point):
    return [sum(matrix[row][k] * point[k] for k in range(3)) + matrix[row][3] for row in range(3)]


def translation(offset):
    result = identity()
    for row in range(3):
        result[row][3] = float(offset[row])
    return result


def scaling(factors):
    result = identity()
    for row in range(3):
        result[row][row] = float(factors[row])
    return result


def axis_rotation(axis, degrees):
    """Rotation about "x", "y" or "z"."""
    first = ("xyz".index(axis) + 1) % 3
    second = (first + 1) % 3
    c, s = math.cos(math.radians(degrees)), math.sin(math.radians(degrees))
    result = identity()
    result[first][first] = result[second][second] = c
    result[first][second], result[second][first] = -s, s
    return result


def euler(degrees, order=0):
    """degrees holds the angles about X, Y and Z whatever the order of their application."""
    result = identity()
    for axis in ROTATION_ORDERS[order]:
        result = multiply(axis_rotation(axis, degrees["xyz".index(axis)]), result)
    return result


def euler_angles(matrix):
    """The angles of order XYZ (X first) of a rotation, in degrees."""
    y = math.asin(max(-1.0, min(1.0, -matrix[2][0])))
    if abs(matrix[2][0]) < 1.0 - 1e-12:
        x = math.atan2(matrix[2][1], matrix[2][2])
        z = math.atan2(matrix[1][0], matrix[0][0])
    else:
        x, z = math.atan2(-matrix[1][2], matrix[1][1]), 0.0
    return [math.degrees(angle) for angle in (x, y, z)]


def rigid_inverse(matrix):
    """The inverse of a rotation with a translation."""
    rotation = [[matrix[column][row] for column in range(3)] for row in range(3)]
    result = identity()
    for row in range(3):
        result[row][:3] = rotation[row]
        result[row][3] = -sum(rotation[row][k] * matrix[k][3] for k in range(3))
    return result


def column_major(matrix):
    """The sixteen numbers as FBX stores a matrix."""
    return [matrix[row][column] for column in range(4) for row in range(4)]
