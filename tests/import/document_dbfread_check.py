#!/usr/bin/env python3
"""Checks the document import against an independent dBASE reader.

Writes the demo company, imports every document type of it (drafts included) with the
component's run, then lets the benchmark's peer (document_peer.py: dbfread reading by field
name, sqlite3 writing) fill an empty working database from the same files, and compares the two
row by row.
usage: document_dbfread_check.py MAKE_DEMO_COMPANY DOCUMENT_IMPORT_RUN DOCUMENT_PEER
"""
import importlib.util
import sqlite3
import subprocess
import sys
import tempfile
from pathlib import Path

TABLES = ("tTempDocHeaders", "tTempDocLines")


def load_peer(path):
    spec = importlib.util.spec_from_file_location("document_peer", path)
    module = importlib.util.module_from_spec(spec)
    spec.loader.exec_module(module)
    return module


def rows(db, sql):
    with sqlite3.connect(db) as con:
        return con.execute(sql).fetchall()


def main():
    make_demo, run, peer = sys.argv[1], sys.argv[2], load_peer(sys.argv[3])
    problems = []
    with tempfile.TemporaryDirectory() as tmp:
        company, folder = Path(tmp) / "company", Path(tmp) / "db"
        subprocess.run([make_demo, str(company), "--items", "500", "--seed", "5"], check=True,
                       stdout=subprocess.DEVNULL)
        subprocess.run([run, str(company), str(folder)], check=True, stdout=subprocess.DEVNULL)
        ours, theirs = folder / "etiqondb.tmp", folder / "peer.tmp"
        for wiz, name in rows(folder / "etiquon.kdb", "SELECT WizFileID, Filename FROM tWizFiles"):
            peer.scan(str(company / f"{name}.dbf"), str(theirs), wiz, drafts=True)
        with sqlite3.connect(ours) as con:
            con.execute(f"ATTACH '{theirs}' AS peer")
            for table in TABLES:
                for a, b, says in (("peer", "main", "dbfread reads"),
                                   ("main", "peer", "the import wrote")):
                    for row in con.execute(f"SELECT * FROM {a}.{table} EXCEPT "
                                           f"SELECT * FROM {b}.{table} LIMIT 10"):
                        problems.append(f"{table}: {says} {row!r}, the other not")
        headers = rows(ours, "SELECT count(*), sum(IsDraft <> 0) FROM tTempDocHeaders")[0]
        lines = rows(ours, "SELECT count(*) FROM tTempDocLines")[0][0]
        facts = {
            "a line of -3.6 with 4 copies":
                "SELECT count(*) FROM tTempDocLines WHERE Quantity = -3.6 AND Copies = 4",
            "a line of 2500 with 999 copies":
                "SELECT count(*) FROM tTempDocLines WHERE Quantity = 2500 AND Copies = 999",
            "a line of the item the item file lacks":
                "SELECT count(*) FROM tTempDocLines WHERE ItemKey = '99999'",
            "a document of three pages":
                "SELECT count(*) FROM tTempDocLines WHERE LineNum = 23",
            "an address of two lines":
                "SELECT count(*) FROM tTempDocHeaders WHERE Address LIKE '%' || char(13, 10) || '%'",
        }
        for fact, sql in facts.items():
            if rows(ours, sql)[0][0] == 0:
                problems.append(f"the import holds no {fact}")
    for problem in problems:
        print(problem)
    if problems:
        return 1
    print(f"{headers[0]} documents ({headers[1]} drafts) and {lines} lines read alike by dbfread "
          f"and the import")
    return 0


if __name__ == "__main__":
    sys.exit(main())
