#include "import/scan_ranges.h"

#include <QLoggingCategory>

#include "jet/database.h"
#include "jet/error.h"
#include "jet/recordset.h"

namespace etq {

namespace {

Q_LOGGING_CATEGORY(lcImport, "etiquon.import")

const QString kRangesQuery = QStringLiteral("qWizFileRanges");

// The query's columns: description, LastIndx, FromIndx.
int fieldOf(ScanRangeColumn column) {
    return int(column) - 1;
}

qint64 numberOrZero(const QVariant& value) {
    return value.isNull() ? 0 : value.toLongLong();
}

}  // namespace

qint64 firstRecordToScan(qint64 nextStart, qint64 recordCount) {
    const qint64 first = nextStart > 1 ? nextStart - 1 : 0;
    return first > recordCount ? 0 : first;
}

ScanPosition positionAfterScan(qint64 recordCount) {
    return {recordCount, recordCount + 1};
}

QList<ScanRangeRow> readScanRanges(const QString& docDbPath) {
    jet::Database db = jet::Database::open(docDbPath);
    QList<ScanRangeRow> rows;
    for (jet::Recordset rs = db.openRecordset(kRangesQuery); !rs.eof(); rs.moveNext())
        rows.append({rs.value(fieldOf(DescriptionColumn)).toString(),
                     numberOrZero(rs.value(fieldOf(LastRecordColumn))),
                     numberOrZero(rs.value(fieldOf(NextStartColumn)))});
    return rows;
}

void writeScanRange(const QString& docDbPath, int row, ScanRangeColumn column,
                    const QVariant& value) {
    jet::Database db = jet::Database::open(docDbPath);
    jet::Recordset rs = db.openRecordset(kRangesQuery);
    rs.setAbsolutePosition(row);
    rs.edit();
    rs.setValue(fieldOf(column), value);
    rs.update();
}

int resetScanRanges(const QString& docDbPath) {
    jet::Database db = jet::Database::open(docDbPath);
    int reset = 0;
    for (jet::Recordset rs = db.openRecordset(kRangesQuery); !rs.eof(); rs.moveNext()) {
        try {
            rs.edit();
            rs.setValue(fieldOf(NextStartColumn), 0);
            rs.update();
            ++reset;
        } catch (const jet::JetError& e) {
            if (rs.editMode() != jet::Recordset::NoEdit) rs.cancelUpdate();
            qCWarning(lcImport) << "The scan range of row" << rs.absolutePosition() + 1
                                << "was not reset:" << e.description();
        }
    }
    return reset;
}

}  // namespace etq
