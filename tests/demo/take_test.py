"""The demo's take: its script gives the committed bytes, and a foot that stands neither slides nor turns.

That it is read without a finding, and played through a subject, is tested with the command line."""

import math
import pathlib
import subprocess
import sys
import tempfile
import unittest

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"


def rotation(channel, degrees):
    c, s = math.cos(math.radians(degrees)), math.sin(math.radians(degrees))
    rows = {"X": [[1, 0, 0], [0, c, -s], [0, s, c]], "Y": [[c, 0, s], [0, 1, 0], [-s, 0, c]],
            "Z": [[c, -s, 0], [s, c, 0], [0, 0, 1]]}
    return rows[channel[0]]


def multiply(a, b):
    return [[sum(a[i][k] * b[k][j] for k in range(3)) for j in range(3)] for i in range(3)]


def apply(matrix, vector):
    return [sum(matrix[i][k] * vector[k] for k in range(3)) for i in range(3)]


class Take:
    """A reader of its own: name, parent, offset and channels of each joint, and the frames."""

    def __init__(self, text):
        hierarchy, motion = text.split("MOTION\n")
        self.joints, open_joints = [], []
        for line in hierarchy.split("\n"):
            words = line.split()
            if words[:1] in (["ROOT"], ["JOINT"], ["End"]):
                self.joints.append([words[-1], open_joints[-1] if open_joints else None, None, []])
            elif words == ["{"]:
                open_joints.append(len(self.joints) - 1)
            elif words == ["}"]:
                open_joints.pop()
            elif words[:1] == ["OFFSET"]:
                self.joints[-1][2] = [float(word) for word in words[1:]]
            elif words[:1] == ["CHANNELS"]:
                self.joints[-1][3] = words[2:]
        lines = motion.strip().split("\n")
        self.frames = [[float(word) for word in line.split()] for line in lines[2:]]
        assert lines[0] == "Frames: %d" % len(self.frames)

    def places(self, frame):
        """World place and rotation of each joint by name."""
        values, world, result = iter(frame), [], {}
        for name, parent, offset, channels in self.joints:
            local, place = [[1, 0, 0], [0, 1, 0], [0, 0, 1]], list(offset)
            for channel in channels:
                if channel.endswith("position"):
                    place["XYZ".index(channel[0])] = next(values)
                else:
                    local = multiply(local, rotation(channel, next(values)))
            if parent is not None:
                above, origin = world[parent]
                place = [a + b for a, b in zip(origin, apply(above, place))]
                local = multiply(above, local)
            world.append((local, place))
            result[name] = world[-1]
        return result


class TakeTest(unittest.TestCase):
    def test_script_gives_the_committed_bytes(self):
        with tempfile.TemporaryDirectory() as folder:
            output = pathlib.Path(folder, "written.bvh")
            subprocess.run([sys.executable, "-B", DEMO / "make_take.py", "-o", output], check=True)
            self.assertEqual(output.read_bytes(), (DEMO / "walk.bvh").read_bytes())

    def test_walks_turns_and_squats(self):
        take = Take((DEMO / "walk.bvh").read_text())
        poses = [take.places(frame) for frame in take.frames]
        for side in ("L_", "R_"):
            heights = [poses[0][side + name][1][1] for name in ("Humerus", "Radius", "Hand")]
            self.assertLess(max(heights) - min(heights), 0.01, "it begins in the T-pose")
        hips = [pose["Pelvis"][1] for pose in poses]
        self.assertGreater(max(hip[2] for hip in hips), 150.0, "forward")
        self.assertLess(min(hip[1] for hip in hips), 70.0, "a squat")
        forward = [pose["Pelvis"][0][2][2] for pose in poses]
        self.assertLess(min(forward), -0.99, "half a turn")
        for name in ("L_Foot", "R_Foot"):
            floor = poses[0][name][1][1]
            lifted = [pose[name][1][1] - floor for pose in poses]
            self.assertGreater(max(lifted), 8.0)
            self.assertGreater(min(lifted), -0.02)
            stands = [low < 0.01 and next_low < 0.01 for low, next_low in zip(lifted, lifted[1:])]
            self.assertGreater(sum(stands), 200)
            for before, after, standing in zip(poses, poses[1:], stands):
                if standing:
                    self.assertLess(math.dist(before[name][1], after[name][1]), 0.05)
                    self.assertLess(math.dist(before[name][0][0], after[name][0][0]), 1e-3)
        # Nothing jumps: centimetres from frame to frame.
        for before, after in zip(poses, poses[1:]):
            for name in before:
                self.assertLess(math.dist(before[name][1], after[name][1]), 14.0, name)


if __name__ == "__main__":
    unittest.main()
