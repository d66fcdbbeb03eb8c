#include "print/print_buttons.h"

#include <QFileInfo>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "platform/messages.h"
#include "platform/printers.h"
#include "print/label_page.h"
#include "print/label_query.h"
#include "shell/captions.h"
#include "shell/label_software.h"
#include "shell/surface.h"

namespace etq {

namespace {

constexpr qint16 kBuiltInPage = 6;

// The printer chosen in cmbPrinter becomes the user's default printer, which the browser
// prints to. False after the refusal was shown.
bool applyChosenPrinter(const Surface& surface) {
    const ControlRef printers = surface.control(QStringLiteral("cmbPrinter"));
    if (printers.listIndex() < 0) return true;
    QString error;
    if (setDefaultPrinter(printers.text(), &error)) return true;
    showCritical(error, GetCaption(1));
    return false;
}

}  // namespace

QString PrintItemLabels(Surface& surface) {
    const qint16 kind = GetLabelSoftwareKind(surface);
    const QString folder = surface.control(QStringLiteral("txtDBPath")).text();
    const QString workDb = db::inFolder(folder, db::kWorkDatabaseFile);
    if (!QFileInfo::exists(workDb)) {
        const QString made =
            db::CreateDocDatabase(db::inFolder(folder, db::kDocDatabaseFile),
                                  db::inFolder(folder, db::kItemDatabaseFile), workDb, {});
        if (made.isEmpty()) return {};  // reported by the creation
    }
    if (kind != kBuiltInPage) {
        showCritical(QStringLiteral("No label software can be driven on this system (kind %1): "
                                    "choose \"Direct\" to print on the built-in label page")
                         .arg(kind),
                     GetCaption(1));
        return {};
    }
    if (!applyChosenPrinter(surface)) return {};
    return PrintBuiltInLabels(surface, workDb, ItemLabels);
}

}  // namespace etq
