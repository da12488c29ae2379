"""The small FBX files of tests/data: their script gives the committed bytes, and its binary files are well-formed."""

import pathlib
import subprocess
import sys
import tempfile
import unittest

import fbx_parser

FBX = pathlib.Path(__file__).resolve().parents[1] / "data" / "fbx"


class CasesTest(unittest.TestCase):
    def test_script_gives_the_committed_bytes(self):
        with tempfile.TemporaryDirectory() as folder:
            subprocess.run([sys.executable, "-B", FBX / "make_cases.py", "-o", folder], check=True)
            written = {path.name: path.read_bytes() for path in pathlib.Path(folder).iterdir()}
        committed = {path.name: path.read_bytes() for path in (FBX / "cases").iterdir() if path.suffix != ".md"}
        self.assertEqual(sorted(written), sorted(committed))
        for name, data in committed.items():
            self.assertEqual(written[name], data, name)

    def test_binary_files_are_well_formed(self):
        parsed = 0
        for path in (FBX / "cases").glob("*.fbx"):
            data = path.read_bytes()
            if data[:1] != b";":
                with self.subTest(path.name):
                    fbx_parser.parse_binary(data)
                parsed += 1
        self.assertGreater(parsed, 10)


if __name__ == "__main__":
    unittest.main()
