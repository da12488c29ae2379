"""The table of characters, and which files make each of them."""
import csv
import functools
import hashlib
import json
import os
import re

COLUMNS = ("name", "fbx", "performer", "recipe")
# Of a recipe's edits those whose value is the path of a file.
FILE_EDITS = ("preset", "edits")


class TableError(Exception):
    """What is wrong with the table, for who wrote it."""


def read_table(path):
    """The rows by their names; paths in them are relative to the table's folder."""
    folder = os.path.dirname(path)
    rows = {}
    try:
        with open(path, encoding="utf8", newline="") as file:
            reader = csv.DictReader(file, delimiter="\t", quoting=csv.QUOTE_NONE)
            missing = [column for column in COLUMNS if column not in (reader.fieldnames or ())]
            if missing:
                raise TableError(f"{path}: the first line does not name the columns {', '.join(missing)}")
            for row in reader:
                name = row["name"] or ""
                if not re.fullmatch(r"\w[\w.-]*", name, re.ASCII):
                    raise TableError(f"{path}:{reader.line_num}: \"{name}\" is no name of letters, digits, _, . and -")
                if name in rows:
                    raise TableError(f"{path}:{reader.line_num}: \"{name}\" stands there twice")
                empty = [column for column in COLUMNS if not row[column]]
                if empty or None in row:
                    raise TableError(f"{path}:{reader.line_num}: \"{name}\" has "
                                     + (f"no {', '.join(empty)}" if empty else "more columns than the first line"))
                rows[name] = {column: os.path.normpath(os.path.join(folder, row[column])) for column in COLUMNS[1:]}
    except (OSError, UnicodeDecodeError, csv.Error) as error:
        raise TableError(f"{path}: {error}") from error
    if not rows:
        raise TableError(f"{path}: there is no character in it")
    return rows


def recipe_for(row):
    """The row's recipe with its own character and performer in it, and paths that hold from here."""
    folder = os.path.dirname(row["recipe"])
    with open(row["recipe"], encoding="utf8") as file:
        recipe = json.load(file)
    if not isinstance(recipe, dict):
        raise ValueError("the recipe is no JSON object")
    recipe.pop("output", None)
    recipe["fbx"], recipe["source"] = row["fbx"], row["performer"]
    for edit in recipe.get("edits", []):
        for key in FILE_EDITS:
            if isinstance(edit, dict) and isinstance(edit.get(key), str):
                edit[key] = os.path.normpath(os.path.join(folder, edit[key]))
    return recipe


def files_of(row):
    """All files that the character is made of, whether they are there or not."""
    files = [row["fbx"], row["performer"], row["recipe"]]
    try:
        edits = recipe_for(row).get("edits", [])
    except (OSError, ValueError):
        edits = []
    return files + [edit[key] for edit in edits if isinstance(edit, dict) for key in FILE_EDITS
                    if isinstance(edit.get(key), str)]


@functools.lru_cache(maxsize=None)
def digest(path):
    """SHA-256 of a file, "missing" for one that cannot be read."""
    try:
        with open(path, "rb") as file:
            state = hashlib.sha256()
            while block := file.read(1 << 20):
                state.update(block)
            return state.hexdigest()
    except OSError:
        return "missing"
