"""The demo's character: its script gives the committed bytes, its forms hold one scene, its skin fits its bones."""

import math
import pathlib
import subprocess
import sys
import tempfile
import unittest

import fbx_parser
from fbx_parser import child, children

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"


def generate(*options):
    with tempfile.TemporaryDirectory() as folder:
        output = pathlib.Path(folder, "written.fbx")
        subprocess.run([sys.executable, "-B", DEMO / "make_character.py", "-o", output, *options], check=True)
        return output.read_bytes()


# Rotations as quaternions (w, x, y, z), so that the check goes another way than the matrices of the script.

def product(a, b):
    return (a[0] * b[0] - a[1] * b[1] - a[2] * b[2] - a[3] * b[3],
            a[0] * b[1] + a[1] * b[0] + a[2] * b[3] - a[3] * b[2],
            a[0] * b[2] - a[1] * b[3] + a[2] * b[0] + a[3] * b[1],
            a[0] * b[3] + a[1] * b[2] - a[2] * b[1] + a[3] * b[0])


def rotated(q, v):
    return product(product(q, (0.0, *v)), (q[0], -q[1], -q[2], -q[3]))[1:]


def euler_quaternion(degrees, order):
    result = (1.0, 0.0, 0.0, 0.0)
    for axis in order:
        half = math.radians(degrees[axis]) / 2.0
        turn = [math.cos(half), 0.0, 0.0, 0.0]
        turn[1 + axis] = math.sin(half)
        result = product(turn, result)
    return result


ORDERS = ((0, 1, 2), (0, 2, 1), (1, 2, 0), (1, 0, 2), (2, 0, 1), (2, 1, 0))


class Scene:
    def __init__(self, records):
        top = {record[0]: record for record in records}
        self.objects = {}
        for record in top["Objects"][2]:
            assert record[1][0] not in self.objects, "an id twice"
            self.objects[record[1][0]] = record
        self.links = [tuple(link[1][1:]) for link in top["Connections"][2]]
        self.definitions = top["Definitions"]

    def of_kind(self, name, kind):
        return [key for key, record in self.objects.items() if record[0] == name and record[1][2] == kind]

    def parents(self, key, name):
        return [to for source, to in self.links if source == key and to and self.objects[to][0] == name]

    def sources(self, key, name):
        return [source for source, to in self.links if to == key and self.objects[source][0] == name]

    def value(self, key, name, default):
        for entry in child(self.objects[key], "Properties70")[2]:
            if entry[1][0] == name:
                return entry[1][4:] if len(entry[1]) > 5 else entry[1][4]
        return default

    def world(self, key):
        """Rotation and translation of a node without pivots and scale."""
        zero = (0.0, 0.0, 0.0)
        turn = product(euler_quaternion(self.value(key, "PreRotation", zero), ORDERS[0]),
                       euler_quaternion(self.value(key, "Lcl Rotation", zero),
                                        ORDERS[self.value(key, "RotationOrder", 0)]))
        offset = self.value(key, "Lcl Translation", zero)
        for parent in self.parents(key, "Model"):
            parent_turn, parent_offset = self.world(parent)
            offset = [a + b for a, b in zip(parent_offset, rotated(parent_turn, offset))]
            turn = product(parent_turn, turn)
        return turn, offset


def apply_stored(numbers, point):
    """A matrix as the file stores it: columns one after the other."""
    return [sum(numbers[4 * k + row] * value for k, value in enumerate((*point, 1.0))) for row in range(3)]


PROBES = ((0, 0, 0), (10, 0, 0), (0, 10, 0), (0, 0, 10))


class CharacterTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.bytes = (DEMO / "character.fbx").read_bytes()
        cls.version, cls.records = fbx_parser.parse_binary(cls.bytes)
        cls.scene = Scene(cls.records)
        cls.bones = cls.scene.of_kind("Model", "LimbNode")

    def test_script_gives_the_committed_bytes(self):
        self.assertEqual(generate(), self.bytes)
        self.assertEqual(self.version, 7400)

    def test_forms_hold_one_scene(self):
        version, wide = fbx_parser.parse_binary(generate("--binary-7500"))
        self.assertEqual(version, 7500)
        text = fbx_parser.parse_ascii(generate("--ascii"))
        # The header tells the version, and ASCII has no FileId.
        content = [record for record in self.records if record[0] not in ("FBXHeaderExtension", "FileId")]
        self.assertEqual([record for record in wide if record[0] not in ("FBXHeaderExtension", "FileId")], content)
        self.assertEqual([record for record in text if record[0] != "FBXHeaderExtension"], content)

    def test_objects_are_counted_and_connected(self):
        counts = {entry[1][0]: child(entry, "Count")[1][0] for entry in children(self.scene.definitions, "ObjectType")}
        self.assertEqual(counts.pop("GlobalSettings"), 1)
        kinds = [record[0] for record in self.scene.objects.values()]
        self.assertEqual(counts, {kind: kinds.count(kind) for kind in set(kinds)})
        for source, to in self.scene.links:
            self.assertIn(source, self.scene.objects)
            self.assertTrue(to == 0 or to in self.scene.objects)
        for key, record in self.scene.objects.items():
            if record[0] != "Pose":
                self.assertTrue(any(source == key for source, _ in self.scene.links), record[1])

    def test_bones(self):
        names = [self.scene.objects[bone][1][1].split("\x00")[0] for bone in self.bones]
        self.assertEqual(len(names), 39)
        self.assertEqual(len(set(names)), 39)
        for bone in self.bones:
            self.assertEqual(self.scene.value(bone, "RotationActive", 0), 1)
            self.assertEqual(len(self.scene.sources(bone, "NodeAttribute")), 1)
        posed = [bone for bone in self.bones if self.scene.value(bone, "PreRotation", None)
                 and self.scene.value(bone, "Lcl Rotation", None)]
        self.assertGreater(len(posed), 10)

    def test_sides_mirror_each_other(self):
        place = {self.scene.objects[bone][1][1].split("\x00")[0]: self.scene.world(bone)[1] for bone in self.bones}
        lefts = [name for name in place if name.endswith("Left")]
        self.assertEqual(len(lefts), 14)
        for name in lefts:
            left, right = place[name], place[name[:-4] + "Right"]
            for a, b in zip((-left[0], left[1], left[2]), right):
                self.assertAlmostEqual(a, b, delta=1e-4, msg=name)

    def assertSameTransform(self, stored, world, name):
        turn, offset = world
        for probe in PROBES:
            expected = [a + b for a, b in zip(rotated(turn, probe), offset)]
            for a, b in zip(apply_stored(stored, probe), expected):
                self.assertAlmostEqual(a, b, delta=1e-6, msg=name)

    def test_clusters_hold_the_bones_transforms(self):
        clusters = self.scene.of_kind("Deformer", "Cluster")
        self.assertEqual(len(clusters), len(self.bones))
        for cluster in clusters:
            bone, = self.scene.sources(cluster, "Model")
            record = self.scene.objects[cluster]
            link = child(record, "TransformLink")[1][0]
            self.assertSameTransform(link, self.scene.world(bone), record[1][1])
            for probe in PROBES:
                back = apply_stored(child(record, "Transform")[1][0], apply_stored(link, probe))
                self.assertLess(math.dist(back, probe), 1e-6)

    def test_bind_pose_holds_the_nodes_transforms(self):
        pose = self.scene.objects[self.scene.of_kind("Pose", "BindPose")[0]]
        nodes = children(pose, "PoseNode")
        self.assertEqual(child(pose, "NbPoseNodes")[1][0], len(nodes))
        self.assertLessEqual(set(self.bones), {child(entry, "Node")[1][0] for entry in nodes})
        for entry in nodes:
            key = child(entry, "Node")[1][0]
            self.assertSameTransform(child(entry, "Matrix")[1][0], self.scene.world(key), str(key))

    def test_skin_weights(self):
        geometry = self.scene.objects[self.scene.of_kind("Geometry", "Mesh")[0]]
        count = len(child(geometry, "Vertices")[1][0]) // 3
        sums, influences = [0.0] * count, [0] * count
        for cluster in self.scene.of_kind("Deformer", "Cluster"):
            indices = child(self.scene.objects[cluster], "Indexes")[1][0]
            weights = child(self.scene.objects[cluster], "Weights")[1][0]
            self.assertEqual(len(indices), len(weights))
            for index, weight in zip(indices, weights):
                self.assertGreater(weight, 0.0)
                sums[index] += weight
                influences[index] += 1
        self.assertLess(max(abs(total - 1.0) for total in sums), 1e-12)
        self.assertLessEqual(max(influences), 4)

    def test_mesh(self):
        geometry = self.scene.objects[self.scene.of_kind("Geometry", "Mesh")[0]]
        flat = child(geometry, "Vertices")[1][0]
        points = [flat[first:first + 3] for first in range(0, len(flat), 3)]
        indices = child(geometry, "PolygonVertexIndex")[1][0]
        normals = child(child(geometry, "LayerElementNormal"), "Normals")[1][0]
        self.assertEqual(len(normals), len(flat))
        uvs = child(geometry, "LayerElementUV")
        self.assertEqual(len(child(uvs, "UVIndex")[1][0]), len(indices))
        self.assertLess(max(child(uvs, "UVIndex")[1][0]), len(child(uvs, "UV")[1][0]) // 2)
        polygons, corners = [], []
        for index in indices:
            corners.append(index if index >= 0 else ~index)
            if index < 0:
                polygons.append(corners)
                corners = []
        self.assertEqual(corners, [])
        self.assertEqual({index for polygon in polygons for index in polygon}, set(range(len(points))))
        materials = child(child(geometry, "LayerElementMaterial"), "Materials")[1][0]
        self.assertEqual(len(materials), len(polygons))
        self.assertEqual(set(materials), {0, 1})
        # A closed body whose faces look outwards has a positive volume, and each edge is used once in each direction.
        volume, edges = 0.0, set()
        for polygon in polygons:
            a = points[polygon[0]]
            for second, third in zip(polygon[1:], polygon[2:]):
                b, c = points[second], points[third]
                volume += (a[0] * (b[1] * c[2] - b[2] * c[1]) + a[1] * (b[2] * c[0] - b[0] * c[2])
                           + a[2] * (b[0] * c[1] - b[1] * c[0])) / 6.0
            for edge in zip(polygon, polygon[1:] + polygon[:1]):
                self.assertNotIn(edge, edges)
                edges.add(edge)
        self.assertEqual({(b, a) for a, b in edges}, edges)
        self.assertGreater(volume, 30000.0)


if __name__ == "__main__":
    unittest.main()
