"""The demo's performer: its script gives the committed bytes, and its numbers are what its expressions say.

That "retarget check" finds nothing, and that the mapping names segments of both, is tested with these."""

import math
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest
import xml.etree.ElementTree as xml

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"


def reals(text):
    values = [float(token) for token in text.split()]
    assert all(math.isfinite(value) for value in values), text
    return values


def evaluate(expression, values):
    assert re.fullmatch(r"[-+*/(). \w]+", expression), expression
    return eval(expression, {"__builtins__": {}}, values)


class PerformerTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.bytes = (DEMO / "performer.qrs").read_bytes()
        cls.model = xml.fromstring(cls.bytes)
        cls.segments = list(cls.model.find("Skeleton").iter("Segment"))
        cls.joints = [next(child for child in segment if child.tag != "Segment") for segment in cls.segments]
        cls.markers = [marker.get("NAME") for marker in cls.model.iter("Marker")]
        cls.values = {}
        for parameter in cls.model.iter("StaticParameter"):
            number = parameter.get("VALUE") or parameter.get("PRIOR")
            expression = parameter.get("EXPRESSION")
            cls.values[parameter.get("NAME")] = float(number) if number else evaluate(expression, cls.values)

    def test_script_gives_the_committed_bytes(self):
        with tempfile.TemporaryDirectory() as folder:
            output = pathlib.Path(folder, "written.qrs")
            subprocess.run([sys.executable, "-B", DEMO / "make_performer.py", "-o", output], check=True)
            self.assertEqual(output.read_bytes(), self.bytes)

    def test_size_and_joint_types(self):
        self.assertEqual(len(self.segments), 25)
        kinds = [joint.tag for joint in self.joints]
        self.assertEqual(kinds[0], "JointFree")
        self.assertEqual({kind: kinds.count(kind) for kind in set(kinds)},
                         {"JointFree": 1, "JointBall": 9, "JointHardySpicer": 6, "JointHinge": 8, "JointDummy": 1})

    def test_each_marker_has_one_target(self):
        targets = [target.get("MARKER") for target in self.model.iter("TargetLocalPointToWorldPoint")]
        self.assertEqual(sorted(targets), sorted(self.markers))

    def test_axes(self):
        for joint in self.joints:
            if joint.tag == "JointHinge":
                self.assertGreater(math.hypot(*reals(joint.get("AXIS"))), 0.9)
            if joint.tag == "JointHardySpicer":
                pair = reals(joint.get("AXIS-PAIR"))
                self.assertAlmostEqual(sum(a * b for a, b in zip(pair[:3], pair[3:])), 0.0, delta=1e-6)

    def test_places_are_what_their_expressions_give(self):
        for joint in self.joints:
            for key in ("PRE-POSITION", "PRE-ORIENTATION"):
                expressions = joint.find("JointTemplate").get(key).split()
                self.assertEqual(len(expressions), 3)
                for number, expression in zip(reals(joint.get(key)), expressions):
                    self.assertAlmostEqual(number, evaluate(expression, self.values), delta=1e-6, msg=joint.get("NAME"))


if __name__ == "__main__":
    unittest.main()
