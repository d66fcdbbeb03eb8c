#!/usr/bin/env python3
"""Checks the item import against an independent dBASE reader.

Writes the demo company, imports it with etiquon-cli (price list 2 as the items' price, all price
lists and the special prices), then reads oitm.dbf, ospp.dbf and ocrn.dbf with dbfread, which goes
by the files' field descriptors, and compares every imported value with the local databases.
usage: import_dbfread_check.py MAKE_DEMO_COMPANY ETIQUON_CLI
"""
import os
import sqlite3
import subprocess
import sys
import tempfile
from pathlib import Path

import dbfread

LOCAL = "\u00a6"  # the host's code of the local currency
SHEKEL = "\u20aa"


def text(value):
    """A host text as the readers keep it: trimmed, and no value at all when blank."""
    value = (value or "").strip(" \0")
    return value or None


def host(path):
    table = dbfread.DBF(str(path), encoding="cp1255", char_decode_errors="strict")
    return list(table.records), list(table.deleted)


def rows(path, sql):
    with sqlite3.connect(path) as db:
        return db.execute(sql).fetchall()


def expected_items(items):
    wanted, prices = {}, set()
    for r in items:
        key = text(r["ITEMCODE"])
        if key is None:
            continue
        key = key.replace('"', "'")
        group = r["ITMSGRPCOD"]
        wanted[key] = (key, text(r["ITEMNAME"]), text(r["FRGNNAME"]),
                       None if group is None else int(group), text(r["UNIT"]),
                       text(r["CODEBARS"]), text(r["SUPPCATNUM"]), 1, r["PRICE2"] / 100,
                       text(r["CURRENCY2"]) or LOCAL, 1.0, 1.0)
        for n in range(1, 11):
            if r[f"PRICE{n}"] != 0:
                prices.add((key, n, r[f"PRICE{n}"] / 100, text(r[f"CURRENCY{n}"]) or LOCAL))
    return wanted, prices


def expected_special_prices(records):
    wanted = {}
    for r in records:
        item, account = text(r["ITEMCODE"]), text(r["CARDCODE"])
        if item is None or account is None:
            continue
        key = (account, item.replace('"', "'"))
        wanted.setdefault(key, key + (r["PRICE"] / 100, text(r["CURRENCY"])))
    return set(wanted.values())


def expected_currencies(records, delivered):
    wanted = {row[0]: list(row) for row in delivered}
    for r in records:
        code = text(r["CURRCODE"])
        row = wanted.setdefault(code, [code, None, None, None])
        host_sign = text(r["HOSTSIGN"])
        row[1] = text(r["CURRNAME"]) or row[1]
        row[2] = text(r["SIGN"]) or row[2]
        row[3] = (SHEKEL if code == LOCAL else host_sign) if host_sign else row[3]
    return {tuple(row) for row in wanted.values()}


def compare(problems, what, ours, theirs):
    ours, theirs = set(ours), set(theirs)
    for row in sorted(theirs - ours, key=repr)[:10]:
        problems.append(f"{what}: dbfread reads {row!r}, the import did not write it")
    for row in sorted(ours - theirs, key=repr)[:10]:
        problems.append(f"{what}: the import wrote {row!r}, which dbfread does not read")


def main():
    make_demo, cli = sys.argv[1], sys.argv[2]
    with tempfile.TemporaryDirectory() as tmp:
        company, folder = Path(tmp) / "company", Path(tmp) / "db"
        env = dict(os.environ, XDG_CONFIG_HOME=str(Path(tmp) / "config"))
        subprocess.run([make_demo, str(company), "--items", "700", "--seed", "11"], check=True,
                       stdout=subprocess.DEVNULL)
        subprocess.run([cli, "init-db", "--db", str(folder)], check=True, env=env,
                       stdout=subprocess.DEVNULL)
        delivered = rows(folder / "etiquon.kdb",
                         "SELECT Currency, [Desc], Sign, WizSign FROM tCurrencies")
        subprocess.run([cli, "import-items", "--company", str(company), "--db", str(folder),
                        "--price-field", "2", "--price-lists", "--special-prices"],
                       check=True, env=env, stdout=subprocess.DEVNULL)

        items, deleted_items = host(company / "oitm.dbf")
        wanted_items, wanted_prices = expected_items(items)
        item_db = folder / "etqnitm.kdb"
        ours = rows(item_db, "SELECT ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, "
                             "SuppCatNum, Copies, Price, Coin, SalPackUN, PurPackUN FROM tItems")
        problems = []
        compare(problems, "tItems", ours, wanted_items.values())
        gone = {text(r["ITEMCODE"]) for r in deleted_items} - set(wanted_items)
        if not gone:
            problems.append("the demo company has no deleted item to leave out")
        compare(problems, "tPriceList",
                rows(item_db, "SELECT ItemKey, PriceList, Price, Currency FROM tPriceList"),
                wanted_prices)
        compare(problems, "tAlterPrices",
                rows(item_db, "SELECT AccountKey, ItemKey, Price, Coin FROM tAlterPrices"),
                expected_special_prices(host(company / "ospp.dbf")[0]))
        compare(problems, "tCurrencies",
                rows(folder / "etiquon.kdb",
                     "SELECT Currency, [Desc], Sign, WizSign FROM tCurrencies"),
                expected_currencies(host(company / "ocrn.dbf")[0], delivered))
    for problem in problems:
        print(problem)
    if problems:
        return 1
    print(f"{len(wanted_items)} items, {len(wanted_prices)} price list rows, special prices "
          f"and currencies read alike by dbfread and the import")
    return 0


if __name__ == "__main__":
    sys.exit(main())
