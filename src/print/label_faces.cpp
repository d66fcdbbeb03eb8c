#include "print/label_faces.h"

#include <QFileInfo>
#include <stdexcept>

#include "db/file_names.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/failure.h"
#include "platform/label_fields.h"
#include "platform/log.h"

namespace etq {

namespace {

[[noreturn]] void failWith(const QString& message) {
    throw std::runtime_error(message.toStdString());
}

// The field slot a cell shows, or nullptr when FldID names none.
const LabelFieldSlot* slotOf(const LabelCell& cell) {
    if (cell.FldID < 0 || cell.FldID >= kLabelFieldCount) return nullptr;
    return &labelFieldSlots()[size_t(cell.FldID)];
}

bool isPriceSlot(const LabelFieldSlot& slot) {
    return fieldFormat(slot.formatTag) == FieldFormat::Price;
}

// Whole copies of a record; Null counts 0.
qint32 copiesOf(const QVariant& value) {
    if (value.isNull()) return 0;
    return vb::toLong(value).value_or(0);
}

int columnOf(const jet::Recordset& rs, const QString& name) {
    const int column = rs.fieldIndex(name);
    if (column < 0) failWith(QStringLiteral("The label query has no column %1").arg(name));
    return column;
}

}  // namespace

void prepareCells(std::array<bool, kLabelFieldCount>& fieldChecks, LabelDefinition& def) {
    for (int i = 0; i < kLabelCellCount; ++i) {
        LabelCell& cell = def.cells[size_t(i)];
        if (!cell.UseCell) continue;
        const LabelFieldSlot* slot = slotOf(cell);
        if (!slot)
            failWith(
                QStringLiteral("Cell %1 of the label shows field %2, and there is no such field")
                    .arg(i)
                    .arg(cell.FldID));
        cell.FieldName = slot->column.toString();
        cell.IsPrice = isPriceSlot(*slot);
        fieldChecks[size_t(cell.FldID)] = true;
    }
}

QString priceFormatOf(const QString& given) {
    const QString format = given.trimmed();
    return format.isEmpty() ? QStringLiteral("0.00") : format;
}

QString cellText(const LabelCell& cell, bool isPrice, const QVariant& value, const QVariant& sign,
                 const QString& priceFormat, qint16 maxTextLen) {
    QString text;
    if (!value.isNull())
        text =
            isPrice ? vb::format(value, priceFormat) + u' ' + vb::toText(sign) : vb::toText(value);
    if (!cell.Prefix.isEmpty()) text = cell.Prefix + u' ' + text;
    if (maxTextLen > 0 && text.size() > maxTextLen) text.truncate(maxTextLen);
    return text;
}

QString barcodeText(const QVariant& value, const LabelBarDef& bar) {
    if (value.isNull() || (value.typeId() == QMetaType::QString && value.toString().isEmpty()))
        return {};
    QString text = vb::toText(value);
    if (bar.LeftLen > 0) text = text.left(bar.LeftLen);
    if (!bar.LeftPrefix.isEmpty()) text = bar.LeftPrefix + text;
    return text;
}

LabelFace faceOf(const LabelDefinition& def, const QVariantHash& record,
                 const QString& priceFormat) {
    LabelFace face;
    face.recordNo = 1;
    const QString format = priceFormatOf(priceFormat);
    for (int i = 0; i < kLabelCellCount; ++i) {
        const LabelCell& cell = def.cells[size_t(i)];
        const LabelFieldSlot* slot = slotOf(cell);
        if (!cell.UseCell || !slot) continue;
        const QVariant value = record.value(slot->column.toString());
        if (cell.ViewType == kBarcodeCell)
            face.texts[size_t(i)] = barcodeText(value, def.bar);
        else if (cell.ViewType == kTextCell)
            face.texts[size_t(i)] =
                cellText(cell, isPriceSlot(*slot), value, record.value(QStringLiteral("CoinSign")),
                         format, def.page.MaxTextLen);
    }
    return face;
}

LabelRecords::LabelRecords(jet::Recordset& rs, const LabelDefinition& def,
                           const QString& priceFormat)
    : rs_(rs), def_(def), priceFormat_(priceFormatOf(priceFormat)) {
    copiesColumn_ = columnOf(rs, QStringLiteral("Copies"));
    for (int i = 0; i < kLabelCellCount; ++i) {
        const LabelCell& cell = def.cells[size_t(i)];
        if (!cell.UseCell || (cell.ViewType != kTextCell && cell.ViewType != kBarcodeCell))
            continue;
        columns_[size_t(i)] = columnOf(rs, cell.FieldName);
        if (cell.ViewType == kTextCell && cell.IsPrice)
            signColumn_ = columnOf(rs, QStringLiteral("CoinSign"));
    }
}

qint64 LabelRecords::totalCopies() {
    qint64 total = 0;
    if (rs_.bof() && rs_.eof()) return total;
    for (rs_.moveFirst(); !rs_.eof(); rs_.moveNext())
        total += std::max(0, copiesOf(rs_.value(copiesColumn_)));
    return total;
}

void LabelRecords::start() {
    recordNo_ = 1;
    if (!(rs_.bof() && rs_.eof())) rs_.moveFirst();
    enter();
}

const LabelFace* LabelRecords::next() {
    if (rs_.eof()) return nullptr;
    const LabelFace* face = &faces_[size_t(current_)];
    if (++copy_ >= copies_) {
        rs_.moveNext();
        ++recordNo_;
        enter();
    }
    return face;
}

// Makes the current record the next one that has copies to print, and works out its face in
// the slot the position before does not use.
void LabelRecords::enter() {
    copy_ = 0;
    for (; !rs_.eof(); rs_.moveNext(), ++recordNo_) {
        copies_ = copiesOf(rs_.value(copiesColumn_));
        if (copies_ > 0) break;
    }
    if (rs_.eof()) return;
    current_ ^= 1;
    fill(faces_[size_t(current_)]);
}

void LabelRecords::fill(LabelFace& face) const {
    face.recordNo = recordNo_;
    for (int i = 0; i < kLabelCellCount; ++i) {
        const LabelCell& cell = def_.cells[size_t(i)];
        QString& text = face.texts[size_t(i)];
        text.clear();
        if (!cell.UseCell) continue;
        if (cell.ViewType == kBarcodeCell) {
            text = barcodeText(rs_.value(columns_[size_t(i)]), def_.bar);
        } else if (cell.ViewType == kTextCell) {
            const QVariant sign = cell.IsPrice ? rs_.value(signColumn_) : QVariant();
            text = cellText(cell, cell.IsPrice, rs_.value(columns_[size_t(i)]), sign, priceFormat_,
                            def_.page.MaxTextLen);
        }
    }
}

QVariantHash sampleLabelRecord() {
    return {
        {QStringLiteral("ItemKey"), QStringLiteral("10000")},
        {QStringLiteral("ItemName"), QStringLiteral("חלב 3%")},
        {QStringLiteral("ItemSort"), QStringLiteral("מוצרי חלב")},
        {QStringLiteral("FName"), QStringLiteral("Milk 3%")},
        {QStringLiteral("BarCode"), QStringLiteral("7290000005904")},
        {QStringLiteral("Unit"), QStringLiteral("ליטר")},
        {QStringLiteral("Price"), 7.55},
        {QStringLiteral("Coin"), QStringLiteral("¦")},
        {QStringLiteral("CoinSign"), QStringLiteral("₪")},
        {QStringLiteral("Copies"), 1},
        {QStringLiteral("SpecialPrice"), 6.9},
        {QStringLiteral("ListPrice"), 7.55},
        {QStringLiteral("AlterKey"), QStringLiteral("10000")},
        {QStringLiteral("AlterBar"), QStringLiteral("7290000005904")},
        {QStringLiteral("CardCode"), QStringLiteral("20001")},
        {QStringLiteral("CardName"), QStringLiteral("מכולת השכונה")},
        {QStringLiteral("Reference1"), QStringLiteral("1045")},
        {QStringLiteral("Address"), QStringLiteral("הרצל 12")},
        {QStringLiteral("City"), QStringLiteral("תל אביב")},
        {QStringLiteral("Phone1"), QStringLiteral("03-5551234")},
        {QStringLiteral("Quantity"), 2},
        {QStringLiteral("CompName"), QStringLiteral("Corvan Information Systems")},
    };
}

QVariantHash labelPreviewRecord(const QString& databaseFolder, LabelQueryInput query) {
    const QString workDb = db::inFolder(databaseFolder, db::kWorkDatabaseFile);
    if (databaseFolder.isEmpty() || !QFileInfo::exists(workDb)) return sampleLabelRecord();
    query.queryType = ItemLabels;
    query.fieldChecks.fill(true);
    try {
        jet::Database db = jet::Database::open(workDb);
        jet::Recordset rs = db.openRecordset(BuildLabelQuery(query));
        if (rs.eof()) return sampleLabelRecord();
        QVariantHash record;
        for (int i = 0; i < rs.fieldCount(); ++i)
            record.insert(rs.fieldName(i), rs.value(i));
        return record;
    } catch (const std::exception& e) {
        qCInfo(log::print) << "preview shows the sample item:" << describe(e);
        return sampleLabelRecord();
    }
}

}  // namespace etq
