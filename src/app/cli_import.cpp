// etiquon-cli import-items: the item import run of the reading-items tab, without windows.
#include <unistd.h>

#include <QDir>
#include <QFileInfo>
#include <QTextStream>
#include <algorithm>
#include <cstdio>
#include <optional>

#include "app/cli_command.h"
#include "db/file_names.h"
#include "import/connection.h"
#include "import/item_import.h"
#include "import/progress_bar.h"
#include "shell/card_controller.h"
#include "shell/component.h"
#include "shell/memory_surface.h"
#include "shell/settings_groups.h"

namespace etq::cli {

namespace {

const char kUsage[] =
    "usage: etiquon-cli import-items --company DIR --db DIR [--clean] [--price-field N] "
    "[--from KEY] [--to KEY] [--price-lists] [--special-prices] [--foreign-names] "
    "[--copies N] [--setting-id N]";

int usage() {
    printError(kUsage);
    return 2;
}

// "--name VALUE" taken out of args; nothing when it is absent (an empty VALUE is a value).
std::optional<QString> takeValue(QStringList& args, const QString& name) {
    const bool present = std::any_of(args.begin(), args.end(), [&](const QString& a) {
        return a == name || a.startsWith(name + u'=');
    });
    if (!present) return std::nullopt;
    return takeOption(args, name);
}

// What the command line says about this run; absent values keep the stored settings.
struct RunOptions {
    QString company;
    QString folder;
    bool clean = false;
    std::optional<QString> priceField;
    std::optional<QString> fromKey;
    std::optional<QString> toKey;
    bool priceLists = false;
    bool specialPrices = false;
    bool foreignNames = false;
    std::optional<QString> copies;
};

// Points the connection parameters at the company folder: its parent is the server folder,
// its own name the company.
void useCompanyFolder(const QString& company) {
    const QFileInfo info(QDir(company).absolutePath());
    connParams().server = info.path();
    connParams().database = info.fileName();
}

// Chooses the price list `number` in cmbPriceField. A number the company's price lists lack
// gets an entry of its own, so that the run tells what it makes of it.
void choosePriceField(const Surface& surface, qint16 number) {
    const ControlRef combo = surface.control(QStringLiteral("cmbPriceField"));
    for (int i = 0; i < combo.listCount(); ++i) {
        if (combo.itemData(i) == number) {
            combo.setListIndex(i);
            return;
        }
    }
    combo.addItem(QString::number(number), number);
    combo.setListIndex(combo.listCount() - 1);
}

void applyOptions(const Surface& surface, const RunOptions& options, qint16 priceField) {
    auto check = [&](const char* box) { surface.control(QString::fromLatin1(box)).setValue(1); };
    if (options.clean) check("ChkClean");
    if (options.priceLists) check("chkReadPriceList");
    if (options.specialPrices) check("ChkImportAlterPrices");
    if (options.foreignNames) surface.control(QStringLiteral("CmbItemNameType")).setListIndex(1);
    if (options.priceField) choosePriceField(surface, priceField);
    if (options.fromKey)
        surface.control(QStringLiteral("txtFromItemKey")).setText(*options.fromKey);
    if (options.toKey) surface.control(QStringLiteral("txtToItemKey")).setText(*options.toKey);
    if (options.copies) surface.control(QStringLiteral("txtCopies")).setText(*options.copies);
    surface.control(QStringLiteral("txtDBPath")).setText(QDir(options.folder).absolutePath());
}

// Draws the surface's progress bar and step message on a terminal, over and over one line.
class TerminalProgress {
  public:
    explicit TerminalProgress(const Surface& surface) : surface_(surface) {
        if (!isatty(fileno(stderr))) return;
        active_ = true;
        ProgressBar::setObserver([this](int fill, int frame) { draw(fill, frame); });
    }
    ~TerminalProgress() {
        if (!active_) return;
        ProgressBar::setObserver({});
        std::fputs("\r\033[K", stderr);
        std::fflush(stderr);
    }

  private:
    void draw(int fill, int frame) {
        constexpr int kCells = 30;
        const int done = frame > 0 ? fill * kCells / frame : 0;
        const QString step = surface_.control(QStringLiteral("Message1")).caption();
        const QString line = QStringLiteral("\r\033[K[%1%2] %3% %4")
                                 .arg(QString(done, u'#'), QString(kCells - done, u'.'))
                                 .arg(frame > 0 ? fill * 100 / frame : 0, 3)
                                 .arg(step);
        if (line == shown_) return;  // the bar moves every few records: draw only changes
        shown_ = line;
        std::fputs(line.toLocal8Bit().constData(), stderr);
        std::fflush(stderr);
    }

    const Surface& surface_;
    bool active_ = false;
    QString shown_;
};

}  // namespace

int runImportItems(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    RunOptions options;
    options.company = takeOption(args, "--company");
    options.folder = takeOption(args, "--db");
    options.clean = takeFlag(args, "--clean");
    options.priceField = takeValue(args, "--price-field");
    options.fromKey = takeValue(args, "--from");
    options.toKey = takeValue(args, "--to");
    options.priceLists = takeFlag(args, "--price-lists");
    options.specialPrices = takeFlag(args, "--special-prices");
    options.foreignNames = takeFlag(args, "--foreign-names");
    options.copies = takeValue(args, "--copies");
    if (options.company.isEmpty() || options.folder.isEmpty() || !args.isEmpty()) return usage();

    bool numeric = false;
    const qint16 priceField = options.priceField ? options.priceField->toShort(&numeric) : 0;
    if (options.priceField && !numeric) {
        printError(
            QString("--price-field takes a price list number, not '%1'").arg(*options.priceField));
        return 2;
    }
    if (!QFileInfo(options.company).isDir()) {
        printError(QString("there is no company folder %1").arg(options.company));
        return 1;
    }
    const QString docDb = db::inFolder(options.folder, db::kDocDatabaseFile);
    if (!QFileInfo::exists(docDb)) {
        printError(QString("%1 holds no document database %2; etiquon-cli init-db --db %1 "
                           "installs the delivered one")
                       .arg(options.folder, db::kDocDatabaseFile));
        return 1;
    }

    // The control as the window starts it, then pointed at this company: its lists are filled
    // from there and the stored choices of the reading-items tab are applied to them again.
    MemorySurface surface;
    CardController controller(surface);
    connectParts(controller, surface);
    controller.hooks().installedPrinters = [] { return QStringList(); };
    controller.InitProperties(common.settingId);
    useCompanyFolder(options.company);
    controller.FillCmbPrice();
    controller.FillCmbItmQGrp();
    controller.FillCmbItmBelong();
    GetSetParams(surface, 2, LoadSettings);
    applyOptions(surface, options, priceField);

    bool finished = false;
    {
        TerminalProgress progress(surface);
        finished = ImportItems(surface);
    }
    const QString step = surface.control(QStringLiteral("Message1")).caption();
    if (!finished) {
        printError(QString("the item import stopped at \"%1\"").arg(step));
        return 1;
    }
    QTextStream(stdout) << step << Qt::endl;
    return 0;
}

}  // namespace etq::cli
