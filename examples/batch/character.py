#!/usr/bin/env python3
"""Builds and checks one character of the table and writes a record of it.

    character.py TABLE NAME --retarget PROGRAM --subject OUT.qrr --record OUT.json

A character that cannot be made is a record, too, with the messages: the exit status is 0, and a subject that an earlier
run made stays as it was. What says nothing about the character, as a full disk or a missing program, is a failure, to
be tried again.
"""
import argparse
import json
import os
import subprocess
import sys

import table

# Exit statuses of retarget that tell something about its input: findings, wrong usage, bad input.
OF_THE_CHARACTER = (1, 2, 3)


def run(retarget, arguments, text=None):
    """Status, standard output as JSON (None for none) and messages of one command."""
    try:
        done = subprocess.run([retarget, *arguments, "--json"], input=text, capture_output=True, text=True, check=False)
    except OSError as error:
        raise SystemExit(f"{retarget} cannot be run: {error.strerror}") from error
    messages = []
    for line in done.stderr.splitlines():
        try:
            messages.append(json.loads(line))
        except ValueError:
            messages.append({"level": "error", "text": line})
    if done.returncode not in (0, *OF_THE_CHARACTER):
        sys.stderr.write(done.stderr)
        raise SystemExit(f"{retarget} {arguments[0]} ended with status {done.returncode}")
    return done.returncode, json.loads(done.stdout) if done.stdout.strip() else None, messages


def make(retarget, row, subject):
    record = {"made": False, "inputs": {file: table.digest(file) for file in table.files_of(row)}}
    try:
        recipe = json.dumps(table.recipe_for(row))
    except (OSError, ValueError) as error:
        return record | {"messages": [{"level": "error", "text": f"{row['recipe']}: {error}"}]}
    status, report, record["messages"] = run(retarget, ["build", "-", "-o", subject], recipe)
    record["made"] = status == 0
    if not record["made"]:
        return record
    record |= {key: report[key] for key in ("segments", "joints", "targets")}
    record["unlike"] = [pair for key in ("proposed", "missing") for pair in report.get("preset", {}).get(key, [])]
    record["pose"] = [finding["message"] for finding in report.get("pose", []) if not finding["fine"]]
    _, record["findings"], messages = run(retarget, ["check", subject])
    _, targets, _ = run(retarget, ["targets", subject, "--source", row["performer"]])
    for key in ("distance", "angle"):
        record[key] = max((target[key] for target in targets if target.get(key) is not None), default=None)
    record["messages"] += messages
    return record


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("table")
    parser.add_argument("name")
    parser.add_argument("--retarget", required=True)
    parser.add_argument("--subject", required=True)
    parser.add_argument("--record", required=True)
    options = parser.parse_args()
    try:
        row = table.read_table(options.table)[options.name]
    except table.TableError as error:
        raise SystemExit(str(error)) from error
    except KeyError as error:
        raise SystemExit(f"{options.table}: there is no \"{options.name}\"") from error
    record = {"name": options.name} | make(options.retarget, row, options.subject)
    # Of files as they were: the page must not show it as made of these.
    record["kept"] = not record["made"] and os.path.exists(options.subject)
    with open(options.record + ".new", "w", encoding="utf8") as file:
        json.dump(record, file, indent=1)
    os.replace(options.record + ".new", options.record)


if __name__ == "__main__":
    main()
