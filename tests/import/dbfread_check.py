#!/usr/bin/env python3
"""Checks the demo company with an independent dBASE reader.

Generates the demo company into a temporary folder, opens every file with dbfread (which reads
by the field descriptors) and compares each named field with what our fixed layouts read
(dbf-layout-dump). usage: dbfread_check.py MAKE_DEMO_COMPANY DBF_LAYOUT_DUMP
"""
import json
import subprocess
import sys
import tempfile
from pathlib import Path

import dbfread


def their_value_matches(kind, theirs, ours):
    if kind == "I":
        return theirs == ours
    if kind == "C":
        return (theirs or "").strip(" \0") == ours
    if kind == "N":
        return (theirs is None and ours == "") or (theirs is not None and float(ours) == theirs)
    if kind == "D":
        return (theirs is None and ours == "") or (
            theirs is not None and theirs.strftime("%Y%m%d") == ours)
    raise ValueError(f"unknown field type {kind}")


def check_file(path, ours, problems):
    table = dbfread.DBF(str(path), encoding="cp1255", char_decode_errors="strict", load=True)
    if table.encoding != "cp1255" or dbfread.DBF(str(path)).encoding != "cp1255":
        problems.append(f"{path.name}: the header does not declare code page 1255")
    theirs_live, theirs_deleted = list(table.records), list(table.deleted)
    ours_live = [r["values"] for r in ours["records"] if not r["deleted"]]
    ours_deleted = [r["values"] for r in ours["records"] if r["deleted"]]
    if len(theirs_live) + len(theirs_deleted) != ours["recordCount"]:
        problems.append(f"{path.name}: dbfread reads {len(theirs_live) + len(theirs_deleted)} "
                        f"records, the header says {ours['recordCount']}")
    names = set(table.field_names)
    for name in ours["types"]:
        if name not in names:
            problems.append(f"{path.name}: no field {name} in the descriptors")
    for name in names - set(ours["types"]):
        if not name.startswith("FILL"):
            problems.append(f"{path.name}: descriptor {name} is not in our layout")
    for label, theirs_list, ours_list in (("record", theirs_live, ours_live),
                                          ("deleted record", theirs_deleted, ours_deleted)):
        if len(theirs_list) != len(ours_list):
            problems.append(f"{path.name}: {len(theirs_list)} {label}s by dbfread, "
                            f"{len(ours_list)} by our layout")
        for index, (theirs, values) in enumerate(zip(theirs_list, ours_list)):
            for name, kind in ours["types"].items():
                if name in theirs and not their_value_matches(kind, theirs[name], values[name]):
                    problems.append(f"{path.name} {label} {index} {name}: dbfread "
                                    f"{theirs[name]!r}, our layout {values[name]!r}")
            for name, value in theirs.items():
                if name.startswith("FILL") and value != "":
                    problems.append(f"{path.name} {label} {index}: filler {name} holds {value!r}")


def main():
    make_demo, dump = sys.argv[1], sys.argv[2]
    with tempfile.TemporaryDirectory() as tmp:
        company = Path(tmp) / "company"
        subprocess.run([make_demo, str(company), "--items", "500", "--seed", "3"], check=True)
        ours = json.loads(subprocess.run([dump, str(company)], check=True,
                                         capture_output=True).stdout)
        files = sorted(company.glob("*.dbf"))
        problems = []
        if len(files) != 14:
            problems.append(f"expected 14 files, found {[f.name for f in files]}")
        for path in files:
            try:
                check_file(path, ours[path.name], problems)
            except Exception as e:  # a file dbfread cannot open is the finding itself
                problems.append(f"{path.name}: dbfread fails: {e!r}")
    for problem in problems[:50]:
        print(problem)
    if problems:
        print(f"dbfread check: {len(problems)} problems in {len(files)} files")
    else:
        print(f"dbfread check: all {len(files)} files read the same by name and by layout")
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main())
