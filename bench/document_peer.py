#!/usr/bin/env python3
"""The document scan as a user would script it: dbfread reads the host's document file by its
field descriptors, sqlite3 writes headers and lines into a working database, one transaction.

The rows are the ones Etiquon's document reader writes, so the two databases can be compared:
document_bench compares them after timing both, and the tests use scan() to check the reader
against an independent dBASE reader.

usage: document_peer.py DBF WORKING_DB WIZ_FILE_ID [--drafts] [--fast]
Prints the seconds the scan took (after the imports), then the header and line counts.
"""
import datetime
import sqlite3
import sys
import time

import dbfread

EPOCH = datetime.date(1899, 12, 30)  # the engine keeps dates as days since this day
TRANSFERS = 12  # transfers between warehouses name no customer contact


def text(value):
    """A host text as the reader keeps it: trimmed, and no value at all when blank."""
    value = (value or "").strip(" \0")
    return value or None


def serial(day):
    return None if day is None else float((day - EPOCH).days)


def whole(value):
    try:
        return int(value.strip())
    except (ValueError, AttributeError):
        return 0


def copies(quantity):
    rounded = round(quantity)  # halves to even, as the reader rounds
    return 999 if abs(rounded) > 999 else abs(rounded)


def header_row(wiz, index, r, fast):
    contact = text(r["CNTCTNAME"]) if wiz != TRANSFERS else None
    name = text(r["CARDNAME"])
    if name:
        name = name.replace("'", "").replace('"', "").replace(",", "") or None
    address = text(r["ADDRESS"])
    return (wiz, int(r["DOCNUM"]), index, wiz, whole(r["REFNUM"]), serial(r["DOCDATE"]),
            serial(r["DUEDATE"]), text((r["CARDCODE"] or "").replace('"', "'")), name,
            address and address.replace("\r", "\r\n"), text(r["NUMATCARD"]), contact,
            text(r["COMMENTS"]), 1, 1, -1 if fast else 0, 0 if r["DRAFT"] == "N" else -1)


def line_rows(wiz, index, r):
    page = int(r["PAGE"] or 0)
    for slot in range(1, 11):
        key = text((r[f"ITEMCODE{slot}"] or "").replace('"', "'"))
        if key is None:
            continue
        quantity = r[f"QTY{slot}"] or 0.0
        warehouse = r[f"WHS{slot}"]
        yield (wiz, int(r["DOCNUM"]), page * 10 + slot, index, key, text(r[f"ITEMNAME{slot}"]),
               quantity, None if warehouse is None else int(warehouse), copies(quantity), -1,
               text(r[f"SERIAL{slot}"]), text(r[f"VENDNUM{slot}"]))


def scan(dbf, db, wiz, drafts=False, fast=False):
    """Reads every live record of the file into the working database; returns the counts."""
    table = dbfread.DBF(dbf, encoding="cp1255", char_decode_errors="strict")
    con = sqlite3.connect(db, isolation_level=None)
    cur = con.cursor()
    cur.execute("BEGIN")
    headers = lines = 0
    # dbfread leaves deleted records out; their index still counts in the file.
    index = -1
    for deleted, r in iterate(table):
        index += 1
        if deleted or r["STATUS"] == "I" or (not drafts and r["DRAFT"] != "N"):
            continue
        if r["DOCDATE"] is None:
            continue
        cur.execute("INSERT OR IGNORE INTO tTempDocHeaders (WizFileID, Number, RecIndex, DocType, "
                    "Reference1, DocDate, DocDueDate, AccountKey, CardName, Address, NumAtCard, "
                    "CntctName, Comments, Copies, TotalCrates, Include, IsDraft) VALUES "
                    "(?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)",
                    header_row(wiz, index, r, fast))
        headers += cur.rowcount
        for row in line_rows(wiz, index, r):
            cur.execute("INSERT OR IGNORE INTO tTempDocLines (WizFileID, HeadNumber, LineNum, "
                        "Number, ItemKey, ItemName, Quantity, Warehouse, Copies, Include, "
                        "SerialNum, VendorNum) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)", row)
            lines += cur.rowcount
    cur.execute("COMMIT")
    con.close()
    return headers, lines


def iterate(table):
    """Every record in file order, each with whether it is marked deleted."""
    live = iter(table.records)
    gone = iter(table.deleted)
    with open(table.filename, "rb") as f:
        f.seek(table.header.headerlen)
        for _ in range(table.header.numrecords):
            mark = f.read(1)
            f.seek(table.header.recordlen - 1, 1)
            yield (True, next(gone)) if mark == b"*" else (False, next(live))


def main():
    args = [a for a in sys.argv[1:] if not a.startswith("--")]
    if len(args) != 3:
        print(__doc__, file=sys.stderr)
        return 2
    start = time.perf_counter()
    headers, lines = scan(args[0], args[1], int(args[2]), "--drafts" in sys.argv,
                          "--fast" in sys.argv)
    print(f"{time.perf_counter() - start:.3f}")
    print(headers, lines)
    return 0


if __name__ == "__main__":
    sys.exit(main())
