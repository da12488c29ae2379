"""The demo's performer and its mapping: the script gives the committed bytes, and what the file says fits together."""

import math
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest
import xml.etree.ElementTree as xml

import fbx_parser

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"

STATE_SIZE = {"JointFree": 6, "JointBall": 3, "JointHardySpicer": 2, "JointHinge": 1, "JointSlider": 1, "JointDummy": 0}


def reals(text):
    values = [float(token) for token in text.split()]
    assert all(math.isfinite(value) for value in values), text
    return values


def evaluate(expression, values):
    assert re.fullmatch(r"[-+*/(). \w]+", expression), expression
    return eval(expression, {"__builtins__": {}}, values)


def side_neutral(name):
    for side in ("Left", "left", "Right", "right"):
        name = name.replace(side, "")
    return name.strip("lLrR")


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

    def test_names_are_unique_and_references_resolve(self):
        segments = [segment.get("NAME") for segment in self.segments]
        names = segments + [joint.get("NAME") for joint in self.joints] + self.markers + list(self.values)
        self.assertEqual(len(names), len(set(names)))
        for name in names:
            self.assertRegex(name, r"^[A-Za-z_][\w.-]*$")
        for stick in self.model.iter("Stick"):
            self.assertLessEqual({stick.get("MARKER1"), stick.get("MARKER2")}, set(self.markers))
            self.assertNotEqual(stick.get("MARKER1"), stick.get("MARKER2"))
        targets = list(self.model.iter("TargetLocalPointToWorldPoint"))
        self.assertEqual(sorted(target.get("MARKER") for target in targets), sorted(self.markers))
        for target in targets:
            self.assertIn(target.get("SEGMENT"), segments)
            self.assertAlmostEqual(math.hypot(*reals(target.get("VIEW-NORMAL"))), 1.0, delta=1e-6)
            self.assertEqual(len([evaluate(text, self.values) for text in target.get("POSITION").split()]), 3)

    def test_joint_lists_have_the_size_of_the_state(self):
        for joint in self.joints:
            size = STATE_SIZE[joint.tag]
            template = joint.find("JointTemplate")
            for owner in (joint, template):
                for key in ("MEAN", "TPOSE-MEAN", "BIND-POSE", "RANGE-CENTRING-STATE"):
                    if owner.get(key):
                        self.assertEqual(len(reals(owner.get(key))), size, joint.get("NAME") + " " + key)
                for key in ("COVARIANCE", "RANGE-MATRIX"):
                    if owner.get(key):
                        self.assertEqual(len(reals(owner.get(key))), size * size, joint.get("NAME") + " " + key)
                self.assertEqual(owner.get("RANGE-MATRIX") is None, owner.get("RANGE-CENTRING-STATE") is None)
            self.assertEqual("MEAN" in joint.attrib, size > 0)

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

    def test_mapping_names_segments_of_both_and_sides_have_partners(self):
        _, records = fbx_parser.parse_binary((DEMO / "character.fbx").read_bytes())
        objects = next(record for record in records if record[0] == "Objects")
        bones = [record[1][1].split("\x00")[0] for record in objects[2]
                 if record[0] == "Model" and record[1][2] == "LimbNode"]
        segments = [segment.get("NAME") for segment in self.segments]

        def mirror(names, name):
            return next((other for other in names if other != name and side_neutral(other) == side_neutral(name)), None)

        count, symmetry, seen = 0, None, set()
        for line in (DEMO / "mapping.txt").read_text().splitlines():
            if line in ("--symmetry", "--no-symmetry"):
                symmetry = line == "--symmetry"
                continue
            option, pair = line.split(" ")
            self.assertIn(option, ("--position", "--rotation"))
            self.assertNotIn(line, seen)
            seen.add(line)
            source, target = pair.split(":")
            self.assertIn(source, segments)
            self.assertIn(target, bones)
            partners = (mirror(segments, source), mirror(bones, target))
            if symmetry:
                self.assertEqual(partners, ("R_" + source[2:], target.replace("Left", "Right")))
            else:
                self.assertEqual(partners, (None, None), line)
            count += 2 if symmetry else 1
        self.assertEqual(count, 34)


if __name__ == "__main__":
    unittest.main()
