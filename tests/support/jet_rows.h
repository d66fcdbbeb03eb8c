#pragma once

#include <QStringList>

#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"

namespace etq::test {

// The rows of a table, query or SELECT as "a|b|c" texts, values written as the component
// writes them and Null as "Null": compact expectations for tests.
inline QStringList jetRows(jet::Database& db, const QString& source) {
    QStringList out;
    jet::Recordset rs = db.openRecordset(source);
    for (; !rs.eof(); rs.moveNext()) {
        QStringList cells;
        for (int i = 0; i < rs.fieldCount(); ++i) {
            const QVariant v = rs.value(i);
            cells << (v.isNull() ? QString("Null") : vb::toText(v));
        }
        out << cells.join(u'|');
    }
    return out;
}

}  // namespace etq::test
