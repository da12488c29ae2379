"""The preview's meshes: their script gives the committed bytes."""

import pathlib
import subprocess
import sys
import tempfile
import unittest

GEOMETRY = pathlib.Path(__file__).resolve().parents[2] / "src" / "scene" / "Geometry"


class Geometry(unittest.TestCase):
    def test_script_gives_the_committed_bytes(self):
        with tempfile.TemporaryDirectory() as folder:
            subprocess.run([sys.executable, "-B", GEOMETRY / "make_geometry.py", "-o", folder], check=True)
            written = {path.name: path.read_bytes() for path in pathlib.Path(folder).iterdir()}
        committed = {path.name: path.read_bytes() for path in GEOMETRY.glob("*.fbx")}
        self.assertEqual(sorted(written), ["ManipulatorRing.fbx", "tetra_stripe.fbx"])
        self.assertEqual(written, committed)


if __name__ == "__main__":
    unittest.main()
