#include "dialogs/doc_lines_query.h"

#include "print/label_query.h"

namespace etq {

namespace {

QString sqlValue(const QString& text) {
    bool whole = false;
    const qint32 number = text.trimmed().toInt(&whole);
    return whole ? QString::number(number) : quotedText(text);
}

}  // namespace

QString BuildDocLinesQuery(const QString& wizFileId, const QString& headNumber) {
    return QStringLiteral(
               "SELECT tTempDocLines.LineNum, tTempDocLines.ItemKey, tItems.ItemName, tTempDocLines.Quantity, tTempDocLines.Warehouse, tTempDocLines.Copies, tTempDocLines.Include FROM (tTempDocLines Inner Join tItems On tItems.ItemKey = tTempDocLines.ItemKey) Where WizFileID=") +
           sqlValue(wizFileId) + QStringLiteral(" And HeadNumber=") + sqlValue(headNumber) +
           QStringLiteral(" ORDER BY tTempDocLines.HeadNumber, tTempDocLines.LineNum");
}

}  // namespace etq
