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
#include "print/label_faces.h"
#include "print/label_query.h"

namespace etq {

namespace {

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

// "00.0" of a share of the page: 6 rows give 16.7, 12 columns 08.3, 1 row 100.0.
QString percentOf(qint16 parts) {
    return vb::format(100.0 / parts, QStringLiteral("00.0")) + QStringLiteral("%'");
}

// Writes the labels: one position per copy of each record, row by row, sheet by sheet.
class LabelWriter {
  public:
    LabelWriter(const QString& priceFormat, const LabelDefinition& def, PageFile& page,
                Progress& progress, jet::Recordset& rs)
        : progress_(progress), def_(def), page_(page), records_(rs, def, priceFormat) {
        imageAttributes_ = QStringLiteral(" ");
        if (def.bar.UserResoX > 0)
            imageAttributes_ += QStringLiteral(" width=") + QString::number(def.bar.UserResoX);
        if (def.bar.UserResoY > 0)
            imageAttributes_ += QStringLiteral(" height=") + QString::number(def.bar.UserResoY);
        cellOpening_ = QStringLiteral("    <td width='") + percentOf(def.page.PageCols) +
                       QStringLiteral(" height='") + percentOf(def.page.PageRows) +
                       QStringLiteral(" align='center'>");
    }

    void write() {
        const qint64 total = records_.totalCopies();
        const qint64 perSheet = qint64(def_.page.PageRows) * def_.page.PageCols;
        const qint64 sheets = (total + perSheet - 1) / perSheet;

        progress_.clear();
        records_.start();
        for (qint64 sheet = 1; sheet <= sheets; ++sheet) {
            writeSheet();
            if (records_.recordNo() % 5 == 0) progress_.show(records_.recordNo(), total);
        }
    }

  private:
    void writeSheet() {
        page_.writeLine(u"<table height='100%' width='100%' border='0'>");
        for (int row = 0; row < def_.page.PageRows; ++row) {
            page_.writeLine(u"  <tr>");
            for (int column = 0; column < def_.page.PageCols; ++column)
                writeLabel(records_.next());
            page_.writeLine(u"  </tr>");
        }
        page_.writeLine(u"</table>");
    }

    void writeLabel(const LabelFace* face) {
        page_.writeLine(cellOpening_);
        page_.writeLine(u"     <table class=Lab border='0'>");
        if (face) {
            for (const QString& line : rowsOf(*face))
                page_.writeLine(line);
        } else {
            page_.writeLine(u"    <tr><td nowrap>&nbsp;</td></tr>");
        }
        page_.writeLine(u"     </table>");
        page_.writeLine(u"    </td>");
    }

    // A record's rows, made once for all its copies.
    const QStringList& rowsOf(const LabelFace& face) {
        if (face.recordNo == rowsRecord_) return rows_;
        rowsRecord_ = face.recordNo;
        rows_.clear();
        for (int i = 0; i < kLabelCellCount; ++i) {
            const LabelCell& cell = def_.cells[size_t(i)];
            if (!cell.UseCell) continue;
            if (cell.ViewType == kBarcodeCell) {
                rows_.append(QStringLiteral("    <tr align='center'><td class='L") +
                             QString::number(i) + QStringLiteral("'><img src='") +
                             BmpName(cell.FldID, face.recordNo) + u'\'' + imageAttributes_ +
                             QStringLiteral("></img></td></tr>"));
            } else if (cell.ViewType == kTextCell) {
                rows_.append(QStringLiteral("    <tr align='center'><td class='L") +
                             QString::number(i) + QStringLiteral("'>") +
                             htmlEscaped(face.texts[size_t(i)]) + QStringLiteral("</td></tr>"));
            }
        }
        return rows_;
    }

    Progress& progress_;
    const LabelDefinition& def_;
    PageFile& page_;
    LabelRecords records_;
    QString imageAttributes_;
    QString cellOpening_;
    qint32 rowsRecord_ = 0;
    QStringList rows_;
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
    prepareCells(input.query.fieldChecks, def);
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
    LabelWriter(input.priceFormat, def, page, progress, rs).write();
    page.writeLine(u"</BODY>");
    page.writeLine(u"</HTML>");
    page.close();
    progress.clear();
}

BuiltInPrint printBuiltInLabels(const QString& dbName, LabelPageInput& input, LabelDefinition& def,
                                Progress& progress) {
    requirePrintableGrid(def.page);
    // The cells' fields are ticked first, so that the barcodes' query has every column the
    // cells show, as the page's own query has.
    prepareCells(input.query.fieldChecks, def);
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
            batches.push_back(
                collectBarcodes(folder, cell.FieldName, cell.FldID, dbName, sql, def.bar));
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
