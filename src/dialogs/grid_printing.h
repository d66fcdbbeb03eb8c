#pragma once

#include <Qt>

class QAbstractItemModel;
class QPrinter;

namespace etq {

// Prints a grid's rows under its column headers as one table, page after page, to the printer
// (a printer of the system or a PDF file, as the printer is set up). Values are printed as the
// grid shows them; the table reads in `direction`.
void PrintGrid(const QAbstractItemModel& model, QPrinter& printer, Qt::LayoutDirection direction);

}  // namespace etq
