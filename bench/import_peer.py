#!/usr/bin/env python3
"""A shop's own item import, written as a user would: python3-dbfread reads oitm.dbf, sqlite3
upserts the items and their ten price lists into the item database in one transaction.

usage: import_peer.py OITM_DBF ITEM_DATABASE
Prints the seconds the import took (the interpreter's start-up left out).
"""
import sqlite3
import sys
import time

import dbfread

LOCAL = "\u00a6"  # the host's code of the local currency


def text(value):
    value = (value or "").strip(" \0")
    return value or None


def main():
    oitm, item_db = sys.argv[1], sys.argv[2]
    start = time.perf_counter()
    items, prices = [], []
    for r in dbfread.DBF(oitm, encoding="cp1255"):
        key = text(r["ITEMCODE"])
        if key is None:
            continue
        key = key.replace('"', "'")
        group = r["ITMSGRPCOD"]  # a number field: None when blank
        items.append((key, text(r["ITEMNAME"]), text(r["FRGNNAME"]), group, text(r["UNIT"]),
                      text(r["CODEBARS"]), text(r["SUPPCATNUM"]), 1, r["PRICE1"] / 100,
                      text(r["CURRENCY1"]) or LOCAL, 1.0, 1.0))
        for n in range(1, 11):
            if r[f"PRICE{n}"]:
                prices.append((key, n, r[f"PRICE{n}"] / 100, text(r[f"CURRENCY{n}"]) or LOCAL))
    db = sqlite3.connect(item_db)
    with db:
        db.executemany(
            "INSERT INTO tItems (ItemKey, ItemName, Fname, ItemSort, Unit, BarCode, SuppCatNum, "
            "Copies, Price, Coin, SalPackUN, PurPackUN) VALUES (?,?,?,?,?,?,?,?,?,?,?,?) "
            "ON CONFLICT(ItemKey) DO UPDATE SET ItemName = coalesce(excluded.ItemName, ItemName), "
            "Fname = coalesce(excluded.Fname, Fname), ItemSort = coalesce(excluded.ItemSort, "
            "ItemSort), Unit = coalesce(excluded.Unit, Unit), BarCode = coalesce(excluded.BarCode, "
            "BarCode), SuppCatNum = coalesce(excluded.SuppCatNum, SuppCatNum), Copies = "
            "excluded.Copies, Price = excluded.Price, Coin = excluded.Coin, SalPackUN = 1, "
            "PurPackUN = 1", items)
        db.executemany(
            "INSERT INTO tPriceList (ItemKey, PriceList, Price, Currency) VALUES (?,?,?,?) "
            "ON CONFLICT(ItemKey, PriceList) DO UPDATE SET Price = excluded.Price, "
            "Currency = excluded.Currency", prices)
    db.close()
    print(f"{time.perf_counter() - start:.6f}")


if __name__ == "__main__":
    main()
