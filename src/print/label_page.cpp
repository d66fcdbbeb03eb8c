#include "print/label_page.h"

#include <QFile>
#include <exception>
#include <stdexcept>
#include <thread>

#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/failure.h"
#include "platform/label_fields.h"
#include "platform/page_file.h"
#include "platform/print_folder.h"
#include "platform/progress.h"
#include "platform/user_paths.h"
#include "print/barcode_images.h"
#include "print/label_query.h"

namespace etq {

namespace {

constexpr quint8 kTextCell = 0;
constexpr quint8 kBarcodeCell = 1;

// The style values of the designer's lists, by list index; an index outside a list writes
// nothing after the property's name.
constexpr QStringView kFonts[] = {u"Arial (Hebrew)", u"David", u"Miriam"};
constexpr QStringView kWeights[] = {u"Normal", u"Bolder", u"Bold"};
constexpr QStringView kAlignments[] = {u"Right", u"Center", u"Left"};
constexpr QStringView kDirections[] = {u"ltr", u"rtl"};

template <size_t N>
QString listEntry(const QStringView (&list)[N], int index) {
    return index >= 0 && index < int(N) ? list[index].toString() : QString();
}

[[noreturn]] void failWith(const QString& message) {
    throw std::runtime_error(message.toStdString());
}

// The field slot a cell in use shows.
const LabelFieldSlot& slotOfCell(const LabelCell& cell, int cellIndex) {
    if (cell.FldID < 0 || cell.FldID >= kLabelFieldCount)
        failWith(QStringLiteral("Cell %1 of the label shows field %2, and there is no such field")
                     .arg(cellIndex)
                     .arg(cell.FldID));
    return labelFieldSlots()[size_t(cell.FldID)];
}

// Whole copies of a record; Null counts 0.
qint32 copiesOf(const QVariant& value) {
    if (value.isNull()) return 0;
    return vb::toLong(value).value_or(0);
}

QString styleLine(int i, const LabelCell& cell) {
    QString line = QStringLiteral("       .L") + QString::number(i);
    line += QStringLiteral(" {font-family:") + listEntry(kFonts, cell.Font);
    line += QStringLiteral("; font-weight:") + listEntry(kWeights, cell.FontWeight);
    line += QStringLiteral("; font-size:") + QString::number(cell.FontSize) + QStringLiteral("pt");
    line += QStringLiteral("; font-style:") +
            (cell.FontItalic ? QStringLiteral("Italic") : QStringLiteral("Normal"));
    if (cell.FontUL) line += QStringLiteral("; text-decoration: underline");
    line += QStringLiteral("; text-align:") + listEntry(kAlignments, cell.Align);
    line += QStringLiteral("; direction:") + listEntry(kDirections, cell.Direction);
    if (cell.Height > 0)
        line += QStringLiteral("; height: ") + QString::number(cell.Height) + QStringLiteral("pt");
    if (cell.Border) line += QStringLiteral("; border: thin solid black");
    line += QStringLiteral("; color:black;}");
    return line;
}

void writeHead(PageFile& page, const LabelDefinition& def) {
    page.writeLine(u"<HTML>");
    page.writeLine(u"<HEAD>");
    page.writeLine(u"<TITLE>מדבקות פריטים</TITLE>");
    page.writeLine(u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>");
    page.writeLine(u"<style>");
    for (int i = 0; i < kLabelCellCount; ++i)
        if (def.cells[size_t(i)].UseCell) page.writeLine(styleLine(i, def.cells[size_t(i)]));
    page.writeLine(u"       TR {vertical-align: middle; }");
    page.writeLine(u"       TD {vertical-align: middle; }");
    page.writeLine(
        u"       TABLE {border: none; direction: rtl; padding: 0; word-spacing: 0; letter-spacing: 0}");
    page.writeLine(
        QStringLiteral(
            "       .Lab {border: none; direction: rtl; padding: 1; word-spacing: 0; letter-spacing: 0; margin-top: ") +
        QString::number(def.page.LabTop) + QStringLiteral("; margin-bottom: ") +
        QString::number(def.page.LabBottom) + u'}');
    page.writeLine(u"</style>");
    page.writeLine(u"</HEAD>");
    page.write(u"<BODY");
    if (def.page.PageAutoPrint) page.writeLine(u" onload='window.print()'");
    page.writeLine(u" BGCOLOR='#FFFFFF'>");
}

// Gives every cell in use its query column and price flag, and ticks its field so that the query
// selects the column.
void prepareCells(LabelQueryInput& query, LabelDefinition& def) {
    for (int i = 0; i < kLabelCellCount; ++i) {
        LabelCell& cell = def.cells[size_t(i)];
        if (!cell.UseCell) continue;
        const LabelFieldSlot& slot = slotOfCell(cell, i);
        cell.FieldName = slot.column.toString();
        cell.IsPrice = fieldFormat(slot.formatTag) == FieldFormat::Price;
        query.fieldChecks[size_t(cell.FldID)] = true;
    }
}

QString priceFormatOf(const QString& given) {
    const QString format = given.trimmed();
    return format.isEmpty() ? QStringLiteral("0.00") : format;
}

// "00.0" of a share of the page: 6 rows give 16.7, 12 columns 08.3, 1 row 100.0.
QString percentOf(qint16 parts) {
    return vb::format(100.0 / parts, QStringLiteral("00.0")) + QStringLiteral("%'");
}

// Writes the labels: one position per copy of each record, row by row, sheet by sheet.
class LabelWriter {
  public:
    LabelWriter(const QString& priceFormat, const LabelDefinition& def, PageFile& page,
                Progress& progress)
        : progress_(progress), def_(def), page_(page), priceFormat_(priceFormatOf(priceFormat)) {
        imageAttributes_ = QStringLiteral(" ");
        if (def.bar.UserResoX > 0)
            imageAttributes_ += QStringLiteral(" width=") + QString::number(def.bar.UserResoX);
        if (def.bar.UserResoY > 0)
            imageAttributes_ += QStringLiteral(" height=") + QString::number(def.bar.UserResoY);
        cellOpening_ = QStringLiteral("    <td width='") + percentOf(def.page.PageCols) +
                       QStringLiteral(" height='") + percentOf(def.page.PageRows) +
                       QStringLiteral(" align='center'>");
    }

    void write(jet::Recordset& rs) {
        findColumns(rs);
        qint64 total = 0;
        for (; !rs.eof(); rs.moveNext())
            total += std::max(0, copiesOf(rs.value(copiesColumn_)));
        const qint64 perSheet = qint64(def_.page.PageRows) * def_.page.PageCols;
        const qint64 sheets = (total + perSheet - 1) / perSheet;

        progress_.clear();
        rs.moveFirst();
        recordNo_ = 1;
        enterRecord(rs);
        for (qint64 sheet = 1; sheet <= sheets; ++sheet) {
            writeSheet(rs);
            if (recordNo_ % 5 == 0) progress_.show(recordNo_, total);
        }
    }

  private:
    void findColumns(const jet::Recordset& rs) {
        copiesColumn_ = columnOf(rs, QStringLiteral("Copies"));
        for (int i = 0; i < kLabelCellCount; ++i) {
            const LabelCell& cell = def_.cells[size_t(i)];
            if (!cell.UseCell || cell.ViewType != kTextCell) continue;
            columns_[size_t(i)] = columnOf(rs, cell.FieldName);
            if (cell.IsPrice) signColumn_ = columnOf(rs, QStringLiteral("CoinSign"));
        }
    }

    static int columnOf(const jet::Recordset& rs, const QString& name) {
        const int column = rs.fieldIndex(name);
        if (column < 0) failWith(QStringLiteral("The label query has no column %1").arg(name));
        return column;
    }

    void writeSheet(jet::Recordset& rs) {
        page_.writeLine(u"<table height='100%' width='100%' border='0'>");
        for (int row = 0; row < def_.page.PageRows; ++row) {
            page_.writeLine(u"  <tr>");
            for (int column = 0; column < def_.page.PageCols; ++column)
                writeLabel(rs);
            page_.writeLine(u"  </tr>");
        }
        page_.writeLine(u"</table>");
    }

    void writeLabel(jet::Recordset& rs) {
        page_.writeLine(cellOpening_);
        page_.writeLine(u"     <table class=Lab border='0'>");
        if (!rs.eof()) {
            for (const QString& line : recordRows_)
                page_.writeLine(line);
            if (++copy_ >= copies_) {
                rs.moveNext();
                ++recordNo_;
                enterRecord(rs);
            }
        } else {
            page_.writeLine(u"    <tr><td nowrap>&nbsp;</td></tr>");
        }
        page_.writeLine(u"     </table>");
        page_.writeLine(u"    </td>");
    }

    // Makes the current record the next one that has copies to print; a record without
    // copies takes no position but keeps its record number, as its bitmaps do.
    void enterRecord(jet::Recordset& rs) {
        copy_ = 0;
        for (; !rs.eof(); rs.moveNext(), ++recordNo_) {
            copies_ = copiesOf(rs.value(copiesColumn_));
            if (copies_ > 0) break;
        }
        recordRows_.clear();
        if (rs.eof()) return;
        for (int i = 0; i < kLabelCellCount; ++i) {
            const LabelCell& cell = def_.cells[size_t(i)];
            if (!cell.UseCell) continue;
            if (cell.ViewType == kBarcodeCell) {
                recordRows_.append(QStringLiteral("    <tr align='center'><td class='L") +
                                   QString::number(i) + QStringLiteral("'><img src='") +
                                   BmpName(cell.FldID, recordNo_) + u'\'' + imageAttributes_ +
                                   QStringLiteral("></img></td></tr>"));
            } else if (cell.ViewType == kTextCell) {
                recordRows_.append(QStringLiteral("    <tr align='center'><td class='L") +
                                   QString::number(i) + QStringLiteral("'>") +
                                   htmlEscaped(cellText(rs, i)) + QStringLiteral("</td></tr>"));
            }
        }
    }

    QString cellText(const jet::Recordset& rs, int i) const {
        const LabelCell& cell = def_.cells[size_t(i)];
        const QVariant value = rs.value(columns_[size_t(i)]);
        QString text;
        if (!value.isNull()) {
            text = cell.IsPrice
                       ? vb::format(value, priceFormat_) + u' ' + vb::toText(rs.value(signColumn_))
                       : vb::toText(value);
        }
        if (!cell.Prefix.isEmpty()) text = cell.Prefix + u' ' + text;
        if (def_.page.MaxTextLen > 0 && text.size() > def_.page.MaxTextLen)
            text.truncate(def_.page.MaxTextLen);
        return text;
    }

    Progress& progress_;
    const LabelDefinition& def_;
    PageFile& page_;
    QString priceFormat_;
    QString imageAttributes_;
    QString cellOpening_;
    int copiesColumn_ = -1;
    int signColumn_ = -1;
    std::array<int, kLabelCellCount> columns_{};
    qint32 recordNo_ = 1;
    qint32 copy_ = 0;
    qint32 copies_ = 0;
    QStringList recordRows_;
};

}  // namespace

void requirePrintableGrid(const DirectLabelDef& page) {
    if (page.PageRows > 0 && page.PageCols > 0 && page.PageRows <= kMaxPageRows &&
        page.PageCols <= kMaxPageCols)
        return;
    throw BadSetting(
        QStringLiteral(
            "The label page has %1 rows and %2 columns; a sheet holds from 1 to %3 rows and from 1 to %4 columns of labels")
            .arg(page.PageRows)
            .arg(page.PageCols)
            .arg(kMaxPageRows)
            .arg(kMaxPageCols));
}

void writeLabelPage(const QString& fileName, const QString& dbName, LabelPageInput& input,
                    LabelDefinition& def, Progress& progress) {
    requirePrintableGrid(def.page);
    prepareCells(input.query, def);
    if (QFile::exists(fileName) && !QFile::remove(fileName))
        failWith(QStringLiteral("Cannot delete %1").arg(fileName));
    PageFile page;
    page.open(fileName);
    writeHead(page, def);

    jet::Database db = jet::Database::open(dbName);
    jet::Recordset rs = db.openRecordset(BuildLabelQuery(input.query));
    if (rs.bof() && rs.eof()) {
        page.close();
        return;
    }
    LabelWriter(input.priceFormat, def, page, progress).write(rs);
    page.writeLine(u"</BODY>");
    page.writeLine(u"</HTML>");
    page.close();
    progress.clear();
}

BuiltInPrint printBuiltInLabels(const QString& dbName, LabelPageInput& input, LabelDefinition& def,
                                Progress& progress) {
    requirePrintableGrid(def.page);
    // Built before the page ticks the cells' fields, as the page's own query is later.
    const QString sql = BuildLabelQuery(input.query);
    const PrintRunFolder run;
    const QString folder = run.path();

    // Every barcode cell's values are read first, so that a failing query ends the run before
    // the page is begun.
    std::vector<BarcodeBatch> batches;
    if (def.bar.BarType >= 0) {
        for (int i = 0; i < kLabelCellCount; ++i) {
            const LabelCell& cell = def.cells[size_t(i)];
            if (cell.ViewType != kBarcodeCell || !cell.UseCell || cell.FldID < 0) continue;
            batches.push_back(collectBarcodes(folder, slotOfCell(cell, i).column.toString(),
                                              cell.FldID, dbName, sql, def.bar));
        }
    }
    // The bitmaps are written beside the page while it is written; both are done before the
    // run ends.
    BarcodeRun barcodes;
    std::exception_ptr bitmapFailure;
    std::thread bitmaps([&] {
        try {
            barcodes =
                writeBarcodes(batches, int(std::max(1u, std::thread::hardware_concurrency())));
        } catch (...) {
            bitmapFailure = std::current_exception();
        }
    });
    BuiltInPrint print{joinPath(folder, kLabelPageFile), {}};
    try {
        writeLabelPage(print.pagePath, dbName, input, def, progress);
    } catch (...) {
        bitmaps.join();
        throw;
    }
    bitmaps.join();
    if (bitmapFailure) std::rethrow_exception(bitmapFailure);
    print.refusedBarcodes = barcodes.refused;
    return print;
}

}  // namespace etq
