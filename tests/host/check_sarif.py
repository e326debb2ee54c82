#!/usr/bin/python3
"""Checks a SARIF 2.1.0 log: check_sarif.py FILE

The classes of sarif_om are made from the JSON schema of SARIF: they know the
properties of each object and which ones are required. Types, enumerations and
references between objects are checked by the table and the rules below.
"""
import json
import sys

import attr
import sarif_om as om

OBJECT, LIST, TEXT, WHOLE, TRUTH = "object", "list", "text", "whole", "truth"
LEVELS = ("none", "note", "warning", "error")

# Class and, by property, the kind of the value with the class of objects.
TYPES = {
    om.SarifLog: {"$schema": TEXT, "version": ("2.1.0",), "runs": (LIST, om.Run)},
    om.Run: {"tool": (OBJECT, om.Tool), "results": (LIST, om.Result),
             "invocations": (LIST, om.Invocation),
             "columnKind": ("utf16CodeUnits", "unicodeCodePoints")},
    om.Tool: {"driver": (OBJECT, om.ToolComponent)},
    om.ToolComponent: {"name": TEXT, "version": TEXT,
                       "rules": (LIST, om.ReportingDescriptor)},
    om.ReportingDescriptor: {
        "id": TEXT, "help": (OBJECT, om.MultiformatMessageString),
        "shortDescription": (OBJECT, om.MultiformatMessageString),
        "fullDescription": (OBJECT, om.MultiformatMessageString),
        "defaultConfiguration": (OBJECT, om.ReportingConfiguration)},
    om.MultiformatMessageString: {"text": TEXT},
    om.ReportingConfiguration: {"level": LEVELS},
    om.Invocation: {"exitCode": WHOLE, "executionSuccessful": TRUTH},
    om.Result: {"ruleId": TEXT, "ruleIndex": WHOLE, "level": LEVELS,
                "message": (OBJECT, om.Message), "occurrenceCount": WHOLE,
                "locations": (LIST, om.Location)},
    om.Message: {"text": TEXT},
    om.Location: {"physicalLocation": (OBJECT, om.PhysicalLocation),
                  "logicalLocations": (LIST, om.LogicalLocation)},
    om.PhysicalLocation: {"artifactLocation": (OBJECT, om.ArtifactLocation),
                          "region": (OBJECT, om.Region)},
    om.ArtifactLocation: {"uri": TEXT},
    om.Region: {"startLine": WHOLE, "startColumn": WHOLE},
    om.LogicalLocation: {"name": TEXT, "fullyQualifiedName": TEXT},
}
PLAIN = {TEXT: str, WHOLE: int, TRUTH: bool}


def check(value, kind, place):
    if isinstance(kind, str):
        assert type(value) is PLAIN[kind], f"{place}: {value!r} is no {kind}"
    elif kind[0] == LIST:
        assert type(value) is list, f"{place}: no list"
        for index, entry in enumerate(value):
            check(entry, (OBJECT, kind[1]), f"{place}/{index}")
    elif kind[0] == OBJECT:
        check_object(value, kind[1], place)
    else:
        assert value in kind, f"{place}: {value!r} is none of {kind}"


def check_object(value, kind, place):
    assert type(value) is dict, f"{place}: no object"
    known = {f.metadata["schema_property_name"]: f for f in attr.fields(kind)}
    for name, entry in value.items():
        assert name in known, f"{place}: no property {name!r} in the schema"
        check(entry, TYPES[kind][name], f"{place}/{name}")
    for name, field in known.items():
        required = field.default is attr.NOTHING
        assert not required or name in value, f"{place}: no {name}"


def check_references(run):
    rules = run["tool"]["driver"]["rules"]
    assert len({rule["id"] for rule in rules}) == len(rules)
    for result in run["results"]:
        assert rules[result["ruleIndex"]]["id"] == result["ruleId"]
        assert result["occurrenceCount"] >= 1
        for location in result["locations"]:
            physical = location.get("physicalLocation", {})
            for number in physical.get("region", {}).values():
                assert number >= 1
            uri = physical.get("artifactLocation", {}).get("uri", "")
            assert uri.isascii() and " " not in uri, uri


with open(sys.argv[1], encoding="utf-8") as file:
    log = json.load(file)
check_object(log, om.SarifLog, "")
for each in log["runs"]:
    check_references(each)
