// Fuzz target: the dialect translator on any text. Text it cannot read must end in the
// engine's error; anything else (a crash, undefined behaviour, another exception) is a fault.
#include <QString>
#include <cstddef>
#include <cstdint>

#include "jet/error.h"
#include "jet/sql_translator.h"

namespace sql = etq::jet::sql;

namespace {

// Every way the engine calls the translator: statements as executed and as recordsets open
// them, criteria as FindFirst takes them, with literals and field names as parameters.
void translateEveryWay(const QString& text) {
    sql::Options executed;
    executed.ignoreRowErrors = true;
    executed.primaryKey = [](const QString&) { return QStringList{"ItemKey", "PriceList"}; };
    const QHash<QString, int> fields{{"itemkey", 0}, {"price", 1}};
    sql::Options recordset;
    recordset.addRowids = true;
    recordset.parameterizeLiterals = true;
    recordset.fieldParameters = &fields;
    recordset.primaryKey = executed.primaryKey;

    for (const sql::Options* options : {&executed, &recordset}) {
        try {
            sql::translate(text, *options);
        } catch (const etq::jet::JetError&) {
        }
        try {
            sql::translateCriterion(text, *options);
        } catch (const etq::jet::JetError&) {
        }
    }
    try {
        QList<QVariant> literals;
        sql::criterionShape(text, &literals);
    } catch (const etq::jet::JetError&) {
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    translateEveryWay(QString::fromUtf8(reinterpret_cast<const char*>(data), qsizetype(size)));
    return 0;
}
