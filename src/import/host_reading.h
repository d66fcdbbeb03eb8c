#pragma once

// What the host readers share: finding and opening a host file, walking its records, reading
// numbers out of its decimal fields, quoting keys into find criteria and keeping the writes of a
// run in one transaction.

#include <QString>
#include <exception>
#include <optional>

#include "import/dbf_file.h"
#include "import/host_layouts.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "platform/failure.h"
#include "platform/progress.h"

namespace etq {

namespace hostread {

// The host's code of the local currency: a blank currency code in a price entry means it.
inline const QString kLocalCurrency = QStringLiteral("\u00A6");  // "¦"
// The sign labels show for the local currency, whatever sign the host keeps for it.
inline const QString kLocalCurrencySign = QStringLiteral("\u20AA");  // "₪"

// The host file called `fileName` in the company folder, whatever the letter case of the name
// on disk: a company folder copied from Windows holds OITM.DBF or Oitm.dbf. A name spelt
// exactly as asked wins; otherwise the first entry, in name order, that differs only in case.
// When there is none, the path as asked (which does not exist).
QString hostFilePath(const QString& companyFolder, const QString& fileName);
// The host file of `layout` in the company folder, found the same way.
QString hostFilePath(const QString& companyFolder, const host::HostLayout& layout);

// Opens a host file for a reader of `layout`. Throws DbfError when the file is damaged or its
// records are too short for the layout.
DbfFile openHostFile(const QString& path, const host::HostLayout& layout);

// Calls read(record) for every record in file order. Records marked deleted are not read, but
// they count like the others: with a progress, it moves after every `every` records.
template <class Read>
void forEachRecord(const DbfFile& file, Read&& read, Progress* bar = nullptr, int every = 1) {
    const qint64 count = file.recordCount();
    for (qint64 record = 0; record < count; ++record) {
        if (!file.isDeleted(record)) read(record);
        const qint64 done = record + 1;
        if (bar && done % every == 0) bar->show(done, count);
    }
}

// The decimal text of `field` in `record` as a 16- or 32-bit whole number, the way the host's
// numbers convert (halves to even). Throws HostValueError when it is no number or too large.
qint16 wholeNumber16(const DbfFile& file, qint64 record, const host::HostField& field);
qint32 wholeNumber32(const DbfFile& file, qint64 record, const host::HostField& field);

// A text literal for a find criterion, enclosed in `quote` with every `quote` inside doubled,
// so that no key can end the literal early or add to the criterion.
QString criterionLiteral(const QString& text, QChar quote);

// Writes the pending row. A duplicate key is passed over as the readers always have: the row
// is dropped and false returned. Any other failure throws.
bool updateUnlessDuplicate(jet::Recordset& recordset);

// The writes of one reader, in one transaction. When the reader stops early the rows written
// before the failure are kept, as they always were; commit() ends the transaction normally.
class KeptWrites {
  public:
    explicit KeptWrites(jet::Database& db) : db_(db) { db_.beginTrans(); }
    ~KeptWrites();
    KeptWrites(const KeptWrites&) = delete;
    KeptWrites& operator=(const KeptWrites&) = delete;

    void commit();

  private:
    jet::Database& db_;
    bool open_ = true;
};

}  // namespace hostread
}  // namespace etq
