#pragma once

#include <QList>
#include <QString>

#include "jet/types.h"

// The tables and saved queries of the component's databases, as data: the creation routines
// walk these lists.
namespace etq::db::schema {

struct SavedQuery {
    const char* name;
    const char* sql;  // exactly as the file keeps it
};

// The working database (etiqondb.tmp).
const jet::TableDef& tempDocHeaders();
const jet::TableDef& tempDocLines();
const jet::TableDef& transports();
// Its links, in creation order: (table, source file name).
struct Link {
    const char* table;
    const QString* sourceFile;
};
const QList<Link>& workLinks();  // without the log link, which only some runs make
extern const SavedQuery kWorkQueries[2];

// The item database (etqnitm.kdb).
const jet::TableDef& items();
const jet::TableDef& alterKeys();
const jet::TableDef& alterPrices();
const jet::TableDef& accountDef();
const jet::TableDef& priceList();
extern const SavedQuery kItemQueries[3];

// The temporary items database (etiqonti.tmp): staging tables of the item tables' shapes.
const jet::TableDef& tempItems();
const jet::TableDef& tempAlterKeys();
const jet::TableDef& tempAlterPrices();
const jet::TableDef& tempPriceList();
extern const char* const kTempItemLinks[4];  // linked from the item database, in order
extern const SavedQuery kTempItemQueries[3];

// The log database (etqnlog.kdb).
const jet::TableDef& stockLog();

}  // namespace etq::db::schema
