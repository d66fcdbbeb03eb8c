#pragma once

#include <gtest/gtest.h>

#include "support/jet_rows.h"
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

    static QStringList rows(Database& db, const QString& sql) {
        return etq::test::jetRows(db, sql);
    }

    QTemporaryDir dir_;
};

}  // namespace etq::jet::test
