#include "import/host_reading.h"

#include <QDir>
#include <QFileInfo>
#include <limits>
#include <optional>

#include "db/file_names.h"
#include "jet/error.h"
#include "jet/vb.h"
#include "platform/log.h"

namespace etq::hostread {

namespace {

QString latin1(std::string_view text) {
    return QString::fromLatin1(text.data(), qsizetype(text.size()));
}

template <class Whole>
Whole wholeNumber(const DbfFile& file, qint64 record, const host::HostField& field,
                  std::optional<Whole> (*convert)(const QVariant&)) {
    const QString text = file.text(record, field);
    if (const std::optional<Whole> value = convert(text)) return *value;
    throw HostValueError(
        QStringLiteral(
            "%1, record %2: the field %3 holds \"%4\", which is not a whole number from %5 to %6")
            .arg(file.path())
            .arg(record + 1)
            .arg(latin1(field.name), text)
            .arg(std::numeric_limits<Whole>::min())
            .arg(std::numeric_limits<Whole>::max()));
}

}  // namespace

QString hostFilePath(const QString& companyFolder, const QString& fileName) {
    const QString asked = db::inFolder(companyFolder, fileName);
    if (QFileInfo::exists(asked)) return asked;
    const QStringList entries =
        QDir(companyFolder)
            .entryList(QDir::AllEntries | QDir::System | QDir::Hidden | QDir::NoDotAndDotDot,
                       QDir::Name);
    for (const QString& entry : entries)
        if (entry.compare(fileName, Qt::CaseInsensitive) == 0)
            return db::inFolder(companyFolder, entry);
    return asked;
}

QString hostFilePath(const QString& companyFolder, const host::HostLayout& layout) {
    return hostFilePath(companyFolder, latin1(layout.fileName));
}

DbfFile openHostFile(const QString& path, const host::HostLayout& layout) {
    DbfFile file(path);
    host::requireLayout(file, layout);
    return file;
}

qint16 wholeNumber16(const DbfFile& file, qint64 record, const host::HostField& field) {
    return wholeNumber<qint16>(file, record, field, &vb::toInteger);
}

qint32 wholeNumber32(const DbfFile& file, qint64 record, const host::HostField& field) {
    return wholeNumber<qint32>(file, record, field, &vb::toLong);
}

QString criterionLiteral(const QString& text, QChar quote) {
    QString literal = text;
    literal.replace(quote, QString(2, quote));
    return quote + literal + quote;
}

bool updateUnlessDuplicate(jet::Recordset& recordset) {
    try {
        recordset.update();
        return true;
    } catch (const jet::JetError& e) {
        if (e.number() != jet::err::kDuplicateKey) throw;
        recordset.cancelUpdate();
        return false;
    }
}

KeptWrites::~KeptWrites() {
    if (!open_) return;
    // The reader is on its way out with a failure its caller reports. Keep what it wrote;
    // should even that fail, nothing of the transaction stays, so no row is left half-written.
    try {
        db_.commitTrans();
    } catch (const std::exception& e) {
        qCWarning(log::import) << "keeping the rows read before the failure:" << describe(e);
        try {
            db_.rollback();
        } catch (const std::exception& again) {
            qCWarning(log::import) << "rolling back:" << describe(again);
        }
    }
}

void KeptWrites::commit() {
    open_ = false;
    db_.commitTrans();
}

}  // namespace etq::hostread
