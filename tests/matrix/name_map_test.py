"""Name maps fit their schema, by an independent validator, and tell the truth.

    name_map_test.py PROGRAM WORK

Each sample gives a map in both forms. Every declaration that a map names stands
in the line of the file, and every name of the code has an entry.
"""

import csv
import json
import pathlib
import re
import subprocess
import sys

import jsonschema

ROOT = pathlib.Path(__file__).resolve().parents[2]
PROGRAM, WORK = sys.argv[1].split(), pathlib.Path(sys.argv[2])
SCHEMA = json.loads((ROOT / "host/name_map.schema.json").read_text("utf-8"))
LINE = {**SCHEMA, "required": [], "properties": {}, "$ref": "#/$defs/line"}
DECLARED = re.compile(r"^(?:\s|HX_\w+\(\S+\) )*(?:extern |static |const |volatile )*"
                      r"\w+ (\w+)(?:\(void\))?(?: = .*[;,]|;)$", re.M)


def validator(schema):
    jsonschema.Draft202012Validator.check_schema(schema)
    return jsonschema.Draft202012Validator(schema)


def expect(holds, what):
    if not holds:
        sys.exit(f"name_map_test: {what}")


def files_of(sample, *options):
    out = WORK / f"{sample.stem}{len(options)}"
    subprocess.run([*PROGRAM, "generate", str(sample), "--out", str(out),
                    "--quiet", *options], check=True, stderr=subprocess.DEVNULL)
    return out


def check_declarations(names, out):
    """Entries point at declarations; declarations have entries."""
    lines = {file.name: file.read_text("utf-8").splitlines()
             for file in out.glob("*.[ch]")}
    entries = set()
    for name in names:
        if name["file"] is None:
            continue
        text = lines[name["file"]][name["line"] - 1]
        found = DECLARED.search(text)
        expect(found and found[1] == name["actual"],
               f"{name['id']}: not declared in {text!r}")
        expect(name["type"] is None or f"{name['type']} {name['actual']}" in text,
               f"{name['id']}: no {name['type']} in {text!r}")
        entries.add(name["actual"])
    declared = {found[1] for file, content in lines.items()
                if not file.endswith("_types.h")
                for found in DECLARED.finditer("\n".join(content))}
    expect(declared == entries, f"without an entry: {declared ^ entries}")
    expect(len(entries) > 9, "too few declarations to tell")


def check_reasons(names):
    for name in names:
        changed = name["defined"] and name["wanted"] != name["actual"]
        expect(not changed or name["reasons"], f"{name['id']}: no reason")


def check_sample(sample):
    out = files_of(sample)
    whole = json.loads((out / "name_map.json").read_text("utf-8"))
    validator(SCHEMA).validate(whole)
    check_declarations(whole["names"], out)
    check_reasons(whole["names"])
    with open(out / "name_map.csv", encoding="utf-8", newline="") as file:
        rows = list(csv.DictReader(file))
    for name, row in zip(whole["names"], rows, strict=True):
        for field in ("id", "kind", "type", "scope", "source", "file", "line",
                      "template", "formal", "wanted", "actual"):
            value = "" if name[field] is None else str(name[field])
            expect(row[field] == value, f"{name['id']}: {field} in CSV")
        expect(row["reasons"] == "; ".join(r["text"] for r in name["reasons"]),
               f"{name['id']}: reasons in CSV")
    text = (files_of(sample, "--lines") / "name_map.jsonl").read_text("utf-8")
    records = [json.loads(line) for line in text.splitlines()]
    for record in records:
        validator(LINE).validate(record)
    parts = {"head": {}, "end": {}}
    for record in (records[0], records[-1]):
        parts[record.pop("record")] = record
    names = [{k: v for k, v in r.items() if k != "record"} for r in records[1:-1]]
    expect({**parts["head"], **parts["end"], "names": names} == whole,
           "the forms differ")
    return whole


def check_schema_notices(whole):
    """The schema is no schema of everything."""
    for field, value in (("kind", "thing"), ("line", 0), ("line", None),
                         ("file", "model.txt"), ("actual", "a b"),
                         ("reasons", [{"kind": "taken", "text": "x"}]),
                         ("reasons", [{"kind": "takenByName", "text": "x"}])):
        broken = json.loads(json.dumps(whole))
        entry = next(n for n in broken["names"] if n["file"] is not None)
        entry[field] = value
        expect(not validator(SCHEMA).is_valid(broken), f"{field} {value} fits")
    expect(not validator(SCHEMA).is_valid({**whole, "nameMap": 2}), "version 2 fits")


demo = check_sample(ROOT / "host/models/cruise_control.json")
check_sample(ROOT / "tests/host/code_options.json")
check_schema_notices(demo)
