"""retarget for Windows: names, paths and streams as that system has them.

    windows_test.py WINE RETARGET"""

import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"
RETARGET, sys.argv[1:] = sys.argv[1:], []


class Windows(unittest.TestCase):
    def setUp(self):
        # On the drive C:, which the share \\localhost\c$ is.
        made = self.retarget("eval", "1+1", cwd=DEMO)
        self.assertEqual(made.stdout, b"2\n", made.stderr)
        drive = pathlib.Path(__file__).resolve().parents[2] / "build/windows/wine/drive_c"
        self.folder = pathlib.Path(tempfile.mkdtemp(dir=drive))
        self.addCleanup(shutil.rmtree, self.folder)
        self.share = "\\\\localhost\\c$\\" + self.folder.name + "\\"
        for name in ("character.fbx", "performer.qrs"):
            shutil.copy(DEMO / name, self.folder)

    def retarget(self, *arguments, cwd=None, **options):
        return subprocess.run([*RETARGET, *arguments], cwd=cwd or self.folder, capture_output=True, check=False, **options)

    def create(self, output, **options):
        return self.retarget("create", "--fbx", "character.fbx", "--source", "performer.qrs", "--auto", "-o", output,
                             **options)

    def test_paths(self):
        long = "\\".join(["x" * 60] * 6)
        rows = (("plain", "k.qrr"), ("not ASCII", "Zoë 日本\\ünï.qrr"), ("long", long + "\\k.qrr"),
                ("network", self.share + "net.qrr"),
                ("long and not ASCII on the network", self.share + long + "\\日本.qrr"))
        for name, path in rows:
            with self.subTest(name):
                end = path.removeprefix(self.share)
                there = self.folder / end.replace("\\", "/")
                there.parent.mkdir(parents=True, exist_ok=True)
                for again in range(2):
                    done = self.create(path)
                    self.assertEqual(done.returncode, 0, done.stderr)
                    self.assertIn(b"<KinematicModel", there.read_bytes())
                targets = self.retarget("-q", "targets", path)
                self.assertEqual((targets.returncode, targets.stderr), (0, b""))
                self.assertGreater(targets.stdout.count(b"\n"), 10)
                self.assertNotIn(b"\r", targets.stdout + there.read_bytes())
                self.assertEqual([file.name for file in there.parent.glob("*.qrr*")], [there.name])
                there.write_text("a letter", encoding="utf8")
                refused = self.create(path)
                self.assertEqual(refused.returncode, 4, refused.stderr)
                self.assertIn(end.rpartition("\\")[2], refused.stderr.decode())
                self.assertEqual(there.read_text(encoding="utf8"), "a letter")
                there.unlink()

    def test_a_slash_begins_a_path(self):
        done = self.retarget("targets", "/none.qrr")
        self.assertEqual(done.returncode, 3, done.stderr)

    def test_streams_carry_bytes(self):
        self.create("k.qrr")
        subject = (self.folder / "k.qrr").read_bytes()
        self.assertEqual(self.create("-").stdout, subject)
        before = set(self.folder.parent.glob("users/*/Temp/retarget-*"))
        done = self.retarget("edit", "-", "-o", "-", "--log-file", "日.log", "-vv", input=subject)
        self.assertEqual(done.stdout, subject, done.stderr)
        log = (self.folder / "日.log").read_bytes()
        self.retarget("targets", "none.qrr", "--log-file", "日.log")
        self.assertTrue((self.folder / "日.log").read_bytes().startswith(log + b"warning "))
        self.assertEqual(set(self.folder.parent.glob("users/*/Temp/retarget-*")), before)


unittest.main()
