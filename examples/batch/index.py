#!/usr/bin/env python3
"""Writes a page of all characters of a table from their records, which stand beside the page in records/.

    index.py OUT.html TABLE
"""
import html
import json
import os
import sys

import table

STYLE = """body { font: 14px sans-serif; margin: 2em; } table { border-collapse: collapse; }
td, th { border: 1px solid #bbb; padding: 4px 8px; text-align: left; vertical-align: top; } img { height: 120px; }
.failed { background: #f7d4d0; } .look { background: #fbeec4; } .number { text-align: right; }"""
WORDS = {"failed": "not made", "look": "to be looked at", "fine": "fine"}


def state(record):
    """One of WORDS: whether a person must look."""
    if not record["made"]:
        return "failed"
    bad = [message for message in record["messages"] if message.get("level") in ("error", "warning")]
    return "look" if bad or record["findings"] or record["unlike"] or record["pose"] else "fine"


def said(record):
    """What a person should read of a character, a sentence each."""
    yield from (message["text"] for message in record["messages"] if message.get("text"))
    if record["kept"]:
        yield f"The subject is that of an earlier run: {record['name']}.qrr is as it was."
    yield from record.get("pose", [])
    for pair in record.get("unlike", []):
        yield (f"the pair {pair['source']}:{pair['target']} became {pair['foundSource']}:{pair['foundTarget']}"
               if "foundTarget" in pair else f"the pair {pair['source']}:{pair['target']} is missing: {pair['reason']}")
    for finding in record.get("findings", []):
        yield f"{finding['kind']} \"{finding['name']}\": {finding['message']} {finding.get('remedy') or ''}"


def number(value, factor, unit):
    return "" if value is None else f"{value * factor:.3f} {unit}"


def row(record, folder):
    name = record["name"]
    picture = f"pictures/{name}.png"
    shown = os.path.exists(os.path.join(folder, picture)) and os.path.getsize(os.path.join(folder, picture)) > 0
    link = html.escape(name)
    if record["made"] or record["kept"]:
        link = f'<a href="subjects/{link}.qrr">{link}</a>'
    cells = [link, WORDS[state(record)], *(str(record.get(key, "")) for key in ("segments", "joints", "targets")),
             number(record.get("distance"), 1, "mm"), number(record.get("angle"), 57.29577951308232, "degrees"),
             "<br>".join(html.escape(text) for text in said(record)),
             f'<img loading="lazy" alt="" src="{html.escape(picture)}">' if shown else ""]
    classes = ["", "", *["number"] * 5, "", ""]
    return f'<tr class="{state(record)}">' + "".join(
        f'<td class="{of}">{cell}</td>' for of, cell in zip(classes, cells)) + "</tr>"


def page(records, folder):
    states = [state(record) for record in records]
    order = sorted(records, key=lambda record: (list(WORDS).index(state(record)), record["name"]))
    counts = ", ".join(f"{states.count(key)} {word}" for key, word in WORDS.items())
    heads = "".join(f"<th>{head}</th>" for head in (
        "Character", "State", "Segments", "Joints", "Targets", "Largest distance", "Largest angle", "Messages, findings",
        "Picture"))
    rows = "\n".join(row(record, folder) for record in order)
    return (f"<!DOCTYPE html>\n<html lang=\"en\"><head><meta charset=\"utf-8\"><title>Retarget subjects</title>\n"
            f"<style>{STYLE}</style></head><body>\n<h1>Retarget subjects</h1>\n<p>{len(records)} characters: {counts}."
            f"</p>\n<table><tr>{heads}</tr>\n{rows}\n</table>\n</body></html>\n")


def main():
    output, names = sys.argv[1], table.read_table(sys.argv[2])
    folder = os.path.dirname(output) or "."
    records = []
    for name in names:
        with open(os.path.join(folder, "records", f"{name}.json"), encoding="utf8") as file:
            records.append(json.load(file))
    with open(output + ".new", "w", encoding="utf8") as file:
        file.write(page(records, folder))
    os.replace(output + ".new", output)


if __name__ == "__main__":
    main()
