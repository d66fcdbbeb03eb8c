#pragma once

// The print routes as the control runs them: the routines that read the label tab, the general
// settings and the printer list into the options of the print logic, and the control's own
// routines, which report as the window always has.

#include <QString>
#include <optional>

#include "print/label_pdf.h"
#include "print/print_engine.h"
#include "print/print_items.h"

namespace etq {

class Context;
class ControlValues;
class Surface;

// The label software kind chosen with the option array OptOLE: 5 NiceLabel (option 0),
// 2 CodeSoft (1), 4 BarTender (2), 6 the built-in label page (3), 7 FastLabel (4), 8 gLabels
// (5), 0 when no option is selected.
qint16 GetLabelSoftwareKind(const ControlValues& values);
qint16 GetLabelSoftwareKind(const Surface& surface);

// The order the printer type asks for: descending for "Thermal" (OptPrinter(1)), ascending
// otherwise.
quint8 labelOrder(const ControlValues& values);

// The label query's settings as the label tab holds them: the account, the item range, the
// field slots whose box ChkFldSend is checked and the company name.
LabelQueryInput readLabelQueryInput(const ControlValues& values, quint8 queryType, quint8 order);

// A print button's options: the database folder, the route, the printer chosen in cmbPrinter
// and the label page's settings (item labels unless told, in the printer type's order).
ItemPrintOptions readItemPrintOptions(const ControlValues& values, quint8 queryType = ItemLabels);

// The list beside the printer list (cmbPrintMode): 0 the page in the browser, 1 direct print.
inline constexpr int kDirectPrint = 1;

// With direct print chosen, the PDF goes to the printer chosen in cmbPrinter (the default
// printer when none is); nothing for the browser page.
std::optional<PdfDestination> readPdfDestination(const ControlValues& values);

// Ticks the boxes of the fields the query was given (the label page ticks those its cells show).
void showFieldChecks(const Surface& surface, const LabelQueryInput& query);

// The built-in print run on the database dbName with the label tab's settings and the context's
// label definition (loaded first when the run has not yet): the page is shown through the
// context's page viewer, or, with direct print chosen, the labels' PDF is sent to the printer. A
// failure is shown with the title "תקלה" and ends the run; a record whose barcode cannot be made is
// told after the page. Returns the page's path (the PDF's for a direct print), or empty text when
// nothing was printed.
QString PrintBuiltInLabels(Surface& surface, Context& context, const QString& dbName,
                           quint8 queryType);

// The print engine's options as the label tab and the general settings hold them: the print
// delay txtPrintDelay, the printer type (OptPrinter: "Thermal" sorts descending, "A4" makes
// NiceLabel print in sessions), the head label's design txtLabelNameHead when head labels are
// on, the price format txtPriceFormat, the label query's settings and the printer chosen in
// cmbPrinter. The caller gives the default design (txtLabelName), the query type, the kind and
// the working database.
LabelSoftwareOptions readLabelSoftwareOptions(const ControlValues& values, const QString& labelFile,
                                              quint8 queryType, qint16 kind, const QString& workDb,
                                              bool headLabels);

// The print engine on the label tab's settings, its progress on the surface: labels of the
// query type (item labels, or the chosen document lines with head labels when headLabels is
// set) through the kind's label software, from the default design labelFile, on the working
// database workDb. A failure is shown with caption 1 as title and the engine's message. True
// when the run reached its end. The document print calls it with DocumentLineLabels,
// txtLabelName, and head labels when chkPrintHeadLabel is checked.
bool PrintWithLabelSoftware(Surface& surface, Context& context, const QString& labelFile,
                            quint8 queryType, qint16 kind, const QString& workDb, bool headLabels);

// cmdPrintItmes: labels for the marked items on the chosen route, the built-in page or the print
// engine with txtLabelName. Returns the page's path, or empty text when no page was made (label
// software prints without one; a failure was shown).
QString PrintItemLabels(Surface& surface, Context& context);

// A print button's route for the labels of `queryType`: the steps before the labels, then the
// built-in print. Returns as PrintItemLabels.
QString PrintLabels(Surface& surface, Context& context, quint8 queryType);

// The control's page writer: the label page `fileName` for the query of the label tab on the
// database dbName, with the context's label definition. Ticks the boxes of the cells' fields.
// Throws on any failure.
void CreateLabFile(Surface& surface, Context& context, const QString& fileName,
                   const QString& dbName, quint8 queryType, quint8 orderBy);

}  // namespace etq
