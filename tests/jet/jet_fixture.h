#pragma once

#include <gtest/gtest.h>

#include "support/qt_print.h"

#include <QTemporaryDir>

#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"

namespace etq::jet::test {

// Expects `statement` to throw the engine error numbered `expected`.
#define EXPECT_JET_ERROR(expected, statement)                                   \
    do {                                                                        \
        try {                                                                   \
            statement;                                                          \
            ADD_FAILURE() << "no error, expected " << (expected);               \
        } catch (const ::etq::jet::JetError& e) {                               \
            EXPECT_EQ(e.number(), (expected)) << e.description().toStdString(); \
        }                                                                       \
    } while (0)

inline FieldDef text(const char* name, int size) {
    return {name, FieldType::Text, size};
}
inline FieldDef field(const char* name, FieldType type) {
    return {name, type, 0};
}

// A folder of fresh database files for one test.
class JetTest : public ::testing::Test {
  protected:
    QString file(const QString& name) const { return dir_.filePath(name); }
    Database create(const QString& name) { return Database::create(file(name)); }

    // Rows of a query as text, "a|b|c" per row, for compact expectations.
    static QStringList rows(Database& db, const QString& sql) {
        QStringList out;
        Recordset rs = db.openRecordset(sql);
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

    QTemporaryDir dir_;
};

}  // namespace etq::jet::test
