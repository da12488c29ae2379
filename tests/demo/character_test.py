"""The demo's character: its script gives the committed bytes, its forms hold one scene, its body is closed.

That the reader has nothing to say against it, and that its skin lies where its mesh lies, is tested with the reader."""

import collections
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

    def sources(self, key, name):
        return [source for source, to in self.links if to == key and self.objects[source][0] == name]


class CharacterTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.bytes = (DEMO / "character.fbx").read_bytes()
        cls.version, cls.records = fbx_parser.parse_binary(cls.bytes)
        cls.scene = Scene(cls.records)

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

    def test_clusters_and_bind_pose_hold_the_same_mirrored_places(self):
        pose = self.scene.objects[self.scene.of_kind("Pose", "BindPose")[0]]
        entries = children(pose, "PoseNode")
        self.assertEqual(child(pose, "NbPoseNodes")[1][0], len(entries))
        posed = {child(entry, "Node")[1][0]: child(entry, "Matrix")[1][0] for entry in entries}
        place = {}
        for cluster in self.scene.of_kind("Deformer", "Cluster"):
            bone, = self.scene.sources(cluster, "Model")
            link = child(self.scene.objects[cluster], "TransformLink")[1][0]
            self.assertEqual(link, posed[bone])
            place[self.scene.objects[bone][1][1].split("\x00")[0]] = link[12:15]
        self.assertEqual(len(place), 39)
        lefts = [name for name in place if name.endswith("Left")]
        self.assertEqual(len(lefts), 14)
        for name in lefts:
            left, right = place[name], place[name[:-4] + "Right"]
            for a, b in zip((-left[0], left[1], left[2]), right):
                self.assertAlmostEqual(a, b, delta=1e-4, msg=name)

    def test_weights_sum_to_one(self):
        sums = collections.Counter()
        for cluster in map(self.scene.objects.get, self.scene.of_kind("Deformer", "Cluster")):
            for index, weight in zip(child(cluster, "Indexes")[1][0], child(cluster, "Weights")[1][0]):
                sums[index] += weight
        self.assertLess(max(abs(total - 1.0) for total in sums.values()), 1e-12)

    def test_mesh(self):
        geometry = self.scene.objects[self.scene.of_kind("Geometry", "Mesh")[0]]
        flat = child(geometry, "Vertices")[1][0]
        points = [flat[first:first + 3] for first in range(0, len(flat), 3)]
        indices = child(geometry, "PolygonVertexIndex")[1][0]
        polygons, corners = [], []
        for index in indices:
            corners.append(index if index >= 0 else ~index)
            if index < 0:
                polygons.append(corners)
                corners = []
        self.assertEqual(len(child(child(geometry, "LayerElementNormal"), "Normals")[1][0]), len(flat))
        materials = child(child(geometry, "LayerElementMaterial"), "Materials")[1][0]
        self.assertEqual((len(materials), set(materials)), (len(polygons), {0, 1}))
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
