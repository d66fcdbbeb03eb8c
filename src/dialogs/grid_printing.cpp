#include "dialogs/grid_printing.h"

#include <QAbstractItemModel>
#include <QPrinter>
#include <QTextDocument>
#include <QTextOption>

namespace etq {

void PrintGrid(const QAbstractItemModel& model, QPrinter& printer, Qt::LayoutDirection direction) {
    QString html =
        QStringLiteral("<table border=1 cellspacing=0 cellpadding=4 width='100%' dir='%1'><tr>")
            .arg(direction == Qt::RightToLeft ? QStringLiteral("rtl") : QStringLiteral("ltr"));
    for (int column = 0; column < model.columnCount(); ++column)
        html += QStringLiteral("<th>%1</th>")
                    .arg(model.headerData(column, Qt::Horizontal).toString().toHtmlEscaped());
    html += QStringLiteral("</tr>");
    for (int row = 0; row < model.rowCount(); ++row) {
        html += QStringLiteral("<tr>");
        for (int column = 0; column < model.columnCount(); ++column)
            html += QStringLiteral("<td>%1</td>")
                        .arg(model.data(model.index(row, column)).toString().toHtmlEscaped());
        html += QStringLiteral("</tr>");
    }
    html += QStringLiteral("</table>");

    QTextDocument document;
    document.setHtml(html);
    QTextOption option = document.defaultTextOption();
    option.setTextDirection(direction);
    document.setDefaultTextOption(option);
    document.print(&printer);
}

}  // namespace etq
