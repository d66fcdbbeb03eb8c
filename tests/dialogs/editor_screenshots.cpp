// editor-screenshots DBDIR OUTDIR: pictures of the item, alternate key and account editors on the
// database folder, with the settings of the run's store (the SQL Server source for the price
// lists): OUTDIR/frmEditItems.png, frmAlterItems.png and frmAccDef.png. tools/screenshots.sh runs
// it under a virtual display.
#include <QApplication>
#include <QDir>
#include <QTextStream>

#include "dialogs/acc_def_window.h"
#include "dialogs/alter_items_window.h"
#include "dialogs/edit_items_window.h"
#include "import/connection.h"
#include "platform/context.h"
#include "platform/file_chooser.h"
#include "print/label_software.h"

namespace {

bool save(QWidget& window, const QString& folder) {
    window.show();
    QApplication::processEvents();
    const QString file = QDir(folder).filePath(window.objectName() + QStringLiteral(".png"));
    if (window.grab().save(file)) return true;
    QTextStream(stderr) << "editor-screenshots: cannot write " << file << Qt::endl;
    return false;
}

}  // namespace

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QFont font = QApplication::font();
    font.setFamilies({QStringLiteral("Nachlieli CLM"), QStringLiteral("DejaVu Sans")});
    QApplication::setFont(font);
    const QStringList args = app.arguments();
    if (args.size() != 3 || !QDir().mkpath(args[2])) {
        QTextStream(stderr) << "usage: editor-screenshots DBDIR OUTDIR" << Qt::endl;
        return 2;
    }
    etq::Context context;
    etq::GetConnParams(context);
    etq::CancelFileChooser chooser;
    etq::EditItemsWindow items(context, args[1]);
    etq::AlterItemsWindow alternates(context, args[1]);
    etq::AccDefWindow accounts(context, args[1], etq::kNiceLabel, chooser);
    return save(items, args[2]) && save(alternates, args[2]) && save(accounts, args[2]) ? 0 : 1;
}
