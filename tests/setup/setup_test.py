"""What stands in the way of an installation is told in words, and a command that is asked for help does nothing else."""

import json
import os
import pathlib
import subprocess
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]
# By name, what stands for the system's programs: no package is there, and whoever asks is not root.
SYSTEM = {"dpkg-query": "exit 1", "id": "echo 1000", "awk": 'exec /usr/bin/awk "$@"', "env": 'exec /usr/bin/env "$@"',
          "sudo": 'exec "$@"', "apt-get": "echo apt-get $*"}
INSTALL = "apt-get install --no-install-recommends clang-format cppcheck python3\n"


def run(*command, path=None):
    environment = dict(os.environ, **({"PATH": path} if path else {}))
    return subprocess.run(["/bin/bash", *command], cwd=ROOT, env=environment, text=True, capture_output=True, timeout=60)


class Setup(unittest.TestCase):
    def install(self, **changes):
        """Installs what checks need, with some of the programs changed or, as None, missing."""
        with tempfile.TemporaryDirectory() as folder:
            for name, lines in (SYSTEM | changes).items():
                if lines is not None:
                    program = pathlib.Path(folder, name)
                    program.write_text(f"#!/bin/bash\n{lines}\n")
                    program.chmod(0o755)
            return run("-c", "set -euo pipefail; source setup/ensure.sh; ensure_packages check; echo on", path=folder)

    def test_installs(self):
        for name, changes in {"with sudo": {}, "as root": {"id": "echo 0", "sudo": None}}.items():
            with self.subTest(name):
                result = self.install(**changes)
                self.assertEqual((result.returncode, result.stderr), (0, ""))
                self.assertIn("apt-get install -y -q --no-install-recommends clang-format cppcheck python3\non\n",
                              result.stdout)

    def test_nothing_is_missing(self):
        result = self.install(**{"dpkg-query": "echo -n installed", "apt-get": None})
        self.assertEqual((result.returncode, result.stdout, result.stderr), (0, "on\n", ""))

    def test_says_what_stands_in_the_way(self):
        rows = {
            "no apt-get": ({"apt-get": None}, "there is no apt-get here to install them.\nInstall what they"),
            "no sudo": ({"sudo": None}, f"there is no sudo here. As root, run\n  {INSTALL}and then this again.\n"),
            "no network": ({"apt-get": '[ "$1" = install ]'}, "Is the network there?\n"),
            "no such package": ({"apt-get": '[ "$1" = update ]'}, "The packages could not be installed, see above.\n"),
        }
        for name, (changes, text) in rows.items():
            with self.subTest(name):
                result = self.install(**changes)
                self.assertEqual(result.returncode, 1)
                self.assertIn(text, result.stderr)
                self.assertIn("== Installing 3 Debian packages: clang-format cppcheck python3\n", result.stdout)
                self.assertNotIn("on\n", result.stdout)

    def test_presets_state_what_they_need(self):
        """A build folder keeps what it was configured with: `./run` leaves one without tests."""
        presets = json.loads((ROOT / "CMakePresets.json").read_text(encoding="utf8"))["configurePresets"]
        presets = {preset["name"]: preset for preset in presets}

        def stated(name):
            base = presets[name].get("inherits")
            return (stated(base) if base else {}) | presets[name].get("cacheVariables", {})

        for name, preset in presets.items():
            if not preset.get("hidden"):
                with self.subTest(name):
                    self.assertEqual(stated(name).get("RETARGET_TESTS"), "OFF" if name in ("bench", "fuzzing", "package") else "ON")
                    self.assertEqual(stated(name).get("CMAKE_UNITY_BUILD"), "ON" if name == "package" else "OFF")

    def test_answers_help(self):
        for command in ("run", "test", "check"):
            for argument, status in (("--help", 0), ("nonsense", 2)):
                with self.subTest(command, argument=argument):
                    result = run(command, argument)
                    self.assertEqual((result.returncode, result.stderr), (status, ""))
                    self.assertTrue(result.stdout.startswith(f"usage: ./{command} "), result.stdout)


if __name__ == "__main__":
    unittest.main()
