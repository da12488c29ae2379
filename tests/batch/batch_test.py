"""What the batch of examples/batch does for each character, and its page. The engine that calls it is not needed.

    batch_test.py RETARGET"""

import json
import pathlib
import subprocess
import sys
import tempfile
import unittest

BATCH = pathlib.Path(__file__).resolve().parents[2] / "examples/batch"
sys.path.insert(0, str(BATCH))
import index  # noqa: E402
import table  # noqa: E402

RETARGET = sys.argv.pop()
HEAD = "name\tfbx\tperformer\trecipe\n"


class Batch(unittest.TestCase):
    def setUp(self):
        self.scratch = tempfile.TemporaryDirectory()
        self.addCleanup(self.scratch.cleanup)
        self.folder = pathlib.Path(self.scratch.name)

    def make(self, name, retarget=RETARGET):
        subject, record = self.folder / f"{name}.qrr", self.folder / f"{name}.json"
        done = subprocess.run([sys.executable, "-B", BATCH / "character.py", self.folder / "characters.tsv", name,
                               "--retarget", retarget, "--subject", subject, "--record", record],
                              capture_output=True, text=True, check=False)
        return done, subject, json.loads(record.read_text(encoding="utf8")) if record.exists() else None

    def test_characters(self):
        subprocess.run([sys.executable, "-B", BATCH / "make_example.py", self.folder, "4"], check=True)
        _, subject, fine = self.make("character0000")
        self.assertTrue(fine["made"] and subject.exists(), fine)
        self.assertEqual((fine["targets"], fine["findings"], fine["unlike"], fine["messages"]), (34, [], [], []))
        self.assertTrue(fine["distance"] < 0.001 and len(fine["inputs"]) == 4, fine)
        # A set-up of yesterday stays, but is not taken for that of the file that is damaged now.
        of_yesterday = subject.read_bytes()
        subject.with_name("character0003.qrr").write_bytes(of_yesterday)
        done, subject, damaged = self.make("character0003")
        self.assertEqual((done.returncode, damaged["made"], damaged["kept"]), (0, False, True))
        self.assertEqual(subject.read_bytes(), of_yesterday)
        self.assertIn("File is corrupted", damaged["messages"][0]["text"])
        # What is not the character's fault is tried again.
        (self.folder / "character0000.json").unlink()
        done, _, record = self.make("character0000", "/bin/false-program")
        self.assertTrue(done.returncode != 0 and record is None, done.stderr)

        damaged["messages"][0]["text"] = '<b>"&'
        page = index.page([fine, damaged], str(self.folder))
        self.assertIn("2 characters: 1 not made, 0 to be looked at, 1 fine.", page)
        self.assertLess(page.index("character0003"), page.index("character0000"))
        self.assertIn("The subject is that of an earlier run: character0003.qrr is as it was.", page)
        self.assertTrue("&lt;b&gt;&quot;&amp;" in page and "<b>" not in page, page)

    def test_wrong_tables(self):
        path = self.folder / "wrong.tsv"
        for text, reason in (("name\tfbx\n", "does not name the columns performer, recipe"),
                             (HEAD, "there is no character"),
                             (HEAD + "../a\tx\ty\tz\n", 'wrong.tsv:2: "../a" is no name'),
                             (HEAD + "a\tx\ty\tz\n" * 2, 'wrong.tsv:3: "a" stands there twice'),
                             (HEAD + "a\tx\ty\n", 'wrong.tsv:2: "a" has no recipe'),
                             (HEAD + "a\tx\ty\tz\tw\n", 'wrong.tsv:2: "a" has more columns')):
            path.write_text(text, encoding="utf8")
            with self.subTest(reason), self.assertRaises(table.TableError) as raised:
                table.read_table(str(path))
            self.assertIn(reason, str(raised.exception))


unittest.main()
