#pragma once

// The print routes as the control runs them: the routines that read the label tab, the general
// settings and the printer list into the options of the print logic, and the control's own
// routines, which report as the window always has.

#include <QString>
#include <optional>

#include "print/label_pdf.h"
#include "print/print_items.h"

namespace etq {

class Context;
class ControlValues;
class Surface;

// The label software kind chosen with the option array OptOLE: 5 NiceLabel (option 0),
// 2 CodeSoft (1), 4 BarTender (2), 6 the built-in label page (3), 7 FastLabel (4), 0 when no
// option is selected.
qint16 GetLabelSoftwareKind(const ControlValues& values);
qint16 GetLabelSoftwareKind(const Surface& surface);

// The order the printer type asks for: descending for "Thermal" (OptPrinter(1)), ascending
// otherwise.
quint8 labelOrder(const ControlValues& values);

// The label query's settings as the label tab holds them: the account, the item range, the
// field slots whose box ChkFldSend is checked and the company name.
LabelQueryInput readLabelQueryInput(const ControlValues& values, quint8 queryType, quint8 order);

// The item print's options: the database folder, the route, the printer chosen in cmbPrinter
// and the label page's settings (item labels, in the printer type's order).
ItemPrintOptions readItemPrintOptions(const ControlValues& values);

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

// cmdPrintItmes: labels for the marked items on the chosen route. Returns the page's path, or
// empty text when nothing was printed (the reason was shown).
QString PrintItemLabels(Surface& surface, Context& context);

// The control's page writer: the label page `fileName` for the query of the label tab on the
// database dbName, with the context's label definition. Ticks the boxes of the cells' fields.
// Throws on any failure.
void CreateLabFile(Surface& surface, Context& context, const QString& fileName,
                   const QString& dbName, quint8 queryType, quint8 orderBy);

}  // namespace etq
