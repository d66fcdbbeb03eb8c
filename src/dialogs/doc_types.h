#pragma once

#include <QList>
#include <QString>
#include <optional>

namespace etq {

// Which document types the document import scans, as the document type grid of the settings
// tab shows them: tDocTypes of the document database, each type with its scan and draft flags
// (Include, IncludeDraft). The functions take the path of the document database and open it
// for the call only; failures throw (the engine's JetError).

struct DocTypeRow {
    qint16 type = 0;
    QString description;
    bool scan = false;    // Include
    bool drafts = false;  // IncludeDraft
    bool operator==(const DocTypeRow&) const = default;
};

// The types in type order.
QList<DocTypeRow> readDocTypes(const QString& docDbPath);

// Sets the flags given of one type (nothing changes for a flag not given). Throws JetError
// 3021 when the document database has no such type.
void setDocTypeFlags(const QString& docDbPath, qint16 type, std::optional<bool> scan,
                     std::optional<bool> drafts);

}  // namespace etq
