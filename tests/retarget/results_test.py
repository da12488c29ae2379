"""What each verb prints with --json is what docs/results.schema.json promises, and nothing that it does not tell.

    results_test.py RETARGET, which may be several words"""

import json
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

import jsonschema

ROOT = pathlib.Path(__file__).resolve().parents[2]
RETARGET, sys.argv[1:] = sys.argv[1:], []
SCHEMA = json.loads((ROOT / "docs/results.schema.json").read_text(encoding="utf8"))
KENNEY = str(ROOT / "tests/data/fbx/kenney_medium_b7400.fbx")

# In their order: later ones read what earlier ones wrote.
RUNS = """
create --fbx character.fbx --source performer.qrs --preset other.json --prune-joints --align --update-targets -o k.qrr
edit k.qrr --scale 1.1 -o e.qrr
build recipe.json --dry-run -o b.qrr
rebind k.qrr --fbx KENNEY
rebind k.qrr --source performer.qrs -o r.qrr
preset save k.qrr -o p.json
map --fbx KENNEY --source performer.qrs
targets k.qrr
targets k.qrr --source performer.qrs
check k.qrr
check bad.qrr
create --fbx character.fbx --source performer.qrs --auto -o all.qrr
advise all.qrr --fbx character.fbx
advise all.qrr --source performer.qrs
diff k.qrr e.qrr
diff --describe k.qrr
bones character.fbx
segments k.qrr
report k.qrr --no-pictures -o k.html
solve k.qrr --take walk.bvh --source performer.qrs --frames 0:9
fbx KENNEY --meshes --skin
take walk.bvh
take walk.bvh -o w.bvh
performer walk.bvh -o w.qrs
dump k.qrr --evaluated
dump performer.qrs
fk performer.qrs
convert performer.qrs old.qrs --format-version 3.4
schema -o s.xsd
eval 1+1
eval 1/0
"""
# Needs a display.
NOT_RUN = {"render"}


def resolved(schema):
    while "$ref" in schema:
        schema = SCHEMA["$defs"][schema["$ref"].rpartition("/")[2]]
    return schema


def untold(value, schema, path=""):
    """Paths of the fields that no schema tells of."""
    schema = resolved(schema)
    choices = [untold(value, choice, path) for choice in schema.get("anyOf", [])]
    if choices:
        return min(choices, key=len)
    if isinstance(value, list):
        return [found for item in value for found in untold(item, schema.get("items", {}), path + "[]")]
    if not isinstance(value, dict) or "properties" not in schema:
        return []
    known = schema["properties"]
    return [f"{path}.{key}" for key in value if key not in known] + [
        found for key in value if key in known for found in untold(value[key], known[key], f"{path}.{key}")]


def validator(name):
    return jsonschema.Draft202012Validator({"$ref": f"#/$defs/{name}", "$defs": SCHEMA["$defs"]})


class Results(unittest.TestCase):
    def test_every_verb(self):
        jsonschema.Draft202012Validator.check_schema(SCHEMA)
        verbs = set()
        with tempfile.TemporaryDirectory() as folder:
            for name in ("character.fbx", "performer.qrs", "mapping.json", "recipe.json", "walk.bvh"):
                shutil.copy(ROOT / "demo" / name, folder)
            mapping = (ROOT / "demo/mapping.json").read_text(encoding="utf8")
            pathlib.Path(folder, "other.json").write_text(
                mapping.replace("haunch", "houch").replace("Cranium", "No").replace("skull", "none"), encoding="utf8")
            for line in RUNS.strip().split("\n"):
                arguments = line.replace("KENNEY", KENNEY).split()
                if "bad.qrr" in arguments:
                    text = pathlib.Path(folder, "k.qrr").read_text(encoding="utf8")
                    pathlib.Path(folder, "bad.qrr").write_text(text.replace('WEIGHT="1"', 'WEIGHT="-1"', 1), encoding="utf8")
                done = subprocess.run([*RETARGET, *arguments, "--json"], cwd=folder, capture_output=True, text=True,
                                      check=False)
                verbs.add(arguments[0])
                with self.subTest(line):
                    self.assertIn(done.returncode, (0, 1), done.stderr)
                    result = json.loads(done.stdout)
                    validator(arguments[0]).validate(result)
                    self.assertEqual(untold(result, SCHEMA["$defs"][arguments[0]]), [])
                    for message in done.stderr.splitlines():
                        validator("message").validate(json.loads(message))
        shown = subprocess.run([*RETARGET, "--help"], capture_output=True, text=True, check=True).stdout
        listed = set(re.findall(r"^  ([a-z]+)  ", shown.partition("Commands:")[2].partition("Messages:")[0], re.M))
        self.assertEqual(verbs | NOT_RUN, listed)
        self.assertLessEqual(listed, set(SCHEMA["$defs"]))


unittest.main()
