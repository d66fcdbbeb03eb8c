#include "dialogs/doc_types.h"

#include "jet/database.h"
#include "jet/error.h"
#include "jet/recordset.h"
#include "jet/vb.h"

namespace etq {

namespace {

bool flag(const QVariant& value) {
    return !value.isNull() && value.toBool();
}

}  // namespace

QList<DocTypeRow> readDocTypes(const QString& docDbPath) {
    jet::Database db = jet::Database::open(docDbPath);
    QList<DocTypeRow> rows;
    for (jet::Recordset rs = db.openRecordset(QStringLiteral(
             "SELECT DocType, DocDesc, Include, IncludeDraft FROM tDocTypes ORDER BY DocType"));
         !rs.eof(); rs.moveNext())
        rows.append({vb::toInteger(rs.value(0)).value_or(0), vb::toText(rs.value(1)),
                     flag(rs.value(2)), flag(rs.value(3))});
    return rows;
}

void setDocTypeFlags(const QString& docDbPath, qint16 type, std::optional<bool> scan,
                     std::optional<bool> drafts) {
    jet::Database db = jet::Database::open(docDbPath);
    jet::Recordset rs = db.openRecordset(
        QStringLiteral("SELECT Include, IncludeDraft FROM tDocTypes WHERE DocType = %1").arg(type));
    if (rs.eof())
        jet::fail(jet::err::kNoCurrentRecord,
                  QStringLiteral("The document database has no document type %1.").arg(type));
    rs.edit();
    if (scan) rs.setValue(0, *scan);
    if (drafts) rs.setValue(1, *drafts);
    rs.update();
}

}  // namespace etq
