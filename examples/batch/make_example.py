#!/usr/bin/env python3
"""Writes a folder with variations of the demo's character, and their table, to try the batch with.

    make_example.py FOLDER COUNT

Every character has other limbs: one that cannot be read and one without a skeleton are among them.
"""
import copy
import pathlib
import random
import shutil
import sys

DEMO = pathlib.Path(__file__).resolve().parents[2] / "demo"
sys.path.insert(0, str(DEMO))
import fbx_file  # noqa: E402
import kestrel  # noqa: E402
import make_character  # noqa: E402
from fbx_scene import document, global_settings  # noqa: E402


def varied(bones, numbers):
    """The same bones with other lengths: each part of the body is stretched by a factor of its own."""
    tall, wide, deep = (numbers.uniform(0.8, 1.25) for _ in range(3))
    result = [copy.copy(bone) for bone in bones]
    for bone in result:
        bone.start, bone.end = ((x * wide, y * tall, z * deep) for x, y, z in (bone.start, bone.end))
    return result


def main():
    folder, count = pathlib.Path(sys.argv[1]), int(sys.argv[2])
    folder.mkdir(parents=True, exist_ok=True)
    for name in ("performer.qrs", "mapping.json", "recipe.json"):
        shutil.copy(DEMO / name, folder)
    rows = ["name\tfbx\tperformer\trecipe"]
    original = kestrel.bones
    for index in range(count):
        numbers = random.Random(index)
        make_character.bones = lambda: varied(original(), numbers)
        name = f"character{index:04}"
        content = fbx_file.binary(document(7400, make_character.SCENE_ID, global_settings(), *make_character.scene()), 7400)
        if index == 3:
            content = content[:1000]
        elif index == 5:
            content = b"; FBX 7.4.0 project file\n"
        (folder / f"{name}.fbx").write_bytes(content)
        rows.append(f"{name}\t{name}.fbx\tperformer.qrs\trecipe.json")
    (folder / "characters.tsv").write_text("\n".join(rows) + "\n", encoding="utf8")


if __name__ == "__main__":
    main()
