// etiquon-cli import-items and import-docs: the item import run of the reading-items tab and the
// document import of the tab of labels by documents, without windows.
#include <unistd.h>

#include <QDir>
#include <QFileInfo>
#include <QTextStream>
#include <algorithm>
#include <cstdio>
#include <optional>

#include "app/cli_command.h"
#include "card/document_adapters.h"
#include "card/import_adapters.h"
#include "db/file_names.h"
#include "import/item_import.h"
#include "platform/context.h"
#include "platform/progress.h"
#include "surface/control_values.h"

namespace etq::cli {

namespace {

const char kUsage[] =
    "usage: etiquon-cli import-items --company DIR --db DIR [--clean] [--price-field N] [--from KEY] [--to KEY] [--price-lists] [--special-prices] [--foreign-names] [--copies N] [--setting-id N]";

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
void useCompanyFolder(Context& context, const QString& company) {
    const QFileInfo info(QDir(company).absolutePath());
    context.connection.server = info.path();
    context.connection.database = info.fileName();
}

// The price list `number` chosen among the company's. A number the company lacks gets an entry
// of its own, so that the run tells what it makes of it.
void choosePriceField(StoredValues& stored, qint16 number) {
    const QString combo = QStringLiteral("cmbPriceField");
    EntryList lists = stored.list(combo);
    qsizetype position = 0;
    while (position < lists.size() && lists[position].data != number)
        ++position;
    if (position == lists.size()) {
        lists.append({QString::number(number), number});
        stored.setList(combo, lists);
    }
    stored.choose(combo, QString::number(position));
}

// The command line's options on top of the stored settings, as if they had been saved there.
void chooseOptions(StoredValues& stored, const RunOptions& options, qint16 priceField) {
    auto check = [&](const char* box) { stored.choose(QString::fromLatin1(box), "1"); };
    if (options.clean) check("ChkClean");
    if (options.priceLists) check("chkReadPriceList");
    if (options.specialPrices) check("ChkImportAlterPrices");
    if (options.foreignNames) stored.choose(QStringLiteral("CmbItemNameType"), "1");
    if (options.priceField) choosePriceField(stored, priceField);
    if (options.fromKey) stored.choose(QStringLiteral("txtFromItemKey"), *options.fromKey);
    if (options.toKey) stored.choose(QStringLiteral("txtToItemKey"), *options.toKey);
    if (options.copies) stored.choose(QStringLiteral("txtCopies"), *options.copies);
    stored.choose(QStringLiteral("txtDBPath"), QDir(options.folder).absolutePath());
}

// Draws the run's step and progress on a terminal, over and over one line.
class TerminalProgress : public Progress {
  public:
    TerminalProgress() : active_(isatty(fileno(stderr))) {}
    ~TerminalProgress() override {
        if (!active_) return;
        std::fputs("\r\033[K", stderr);
        std::fflush(stderr);
    }

    void step(const QString& text) override {
        step_ = text;
        draw();
    }
    void show(qint64 done, qint64 total) override {
        if (total < 1 || done < 0 || done > total) return;
        percent_ = int(done * 100 / total);
        draw();
    }
    void clear() override {
        percent_ = 0;
        draw();
    }
    void fill() override {
        percent_ = 100;
        draw();
    }
    const QString& lastStep() const { return step_; }

  private:
    void draw() {
        if (!active_) return;
        constexpr int kCells = 30;
        const int done = percent_ * kCells / 100;
        const QString line = QStringLiteral("\r\033[K[%1%2] %3% %4")
                                 .arg(QString(done, u'#'), QString(kCells - done, u'.'))
                                 .arg(percent_, 3)
                                 .arg(step_);
        if (line == shown_) return;  // the bar moves every few records: draw only changes
        shown_ = line;
        std::fputs(line.toLocal8Bit().constData(), stderr);
        std::fflush(stderr);
    }

    bool active_;
    int percent_ = 0;
    QString step_;
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
        printError(
            QString(
                "%1 holds no document database %2; etiquon-cli init-db --db %1 installs the delivered one")
                .arg(options.folder, db::kDocDatabaseFile));
        return 1;
    }

    // The settings the window would load, pointed at this company: its lists are read from
    // there and the stored choices of the reading-items tab select among them.
    Context context;
    startContext(context, common.settingId);
    useCompanyFolder(context, options.company);
    StoredValues stored(context.applicationName);
    FillHostLists(stored, context);

    chooseOptions(stored, options, priceField);

    TerminalProgress progress;
    const int status = runReporting(
        [&] { importItems(readItemImportOptions(stored, context), context, progress); });
    if (status != 0) {
        printError(QString("the item import stopped at \"%1\"").arg(progress.lastStep()));
        return status;
    }
    QTextStream(stdout) << progress.lastStep() << Qt::endl;
    return 0;
}

namespace {

const char kDocsUsage[] =
    "usage: etiquon-cli import-docs --company DIR --db DIR [--from-date DD/MM/YYYY] [--to-date DD/MM/YYYY] [--from-num N] [--to-num N] [--read-items] [--fast] [--setting-id N]";

// A document number given on the command line: a whole number of 32 bits.
bool isDocumentNumber(const std::optional<QString>& text) {
    bool ok = true;
    if (text) text->trimmed().toInt(&ok);
    return ok;
}

QString describeRead(const DocTypeRead& read) {
    const StockDocScan& scan = read.scan;
    QString line = QStringLiteral("document type %1: ").arg(read.docType);
    if (read.failure) return line + QStringLiteral("not read");
    if (scan.recordCount == 0) return line + QStringLiteral("no records");
    if (scan.firstRecord >= scan.recordCount)
        return line + QStringLiteral("no records after record %1").arg(scan.recordCount);
    line += QStringLiteral("records %1 to %2: %3 documents, %4 lines")
                .arg(scan.firstRecord + 1)
                .arg(scan.recordCount)
                .arg(scan.headers)
                .arg(scan.lines);
    if (read.itemsImported) line += QStringLiteral(", their items imported");
    return line;
}

}  // namespace

int runImportDocs(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    const QString company = takeOption(args, "--company");
    const QString folder = takeOption(args, "--db");
    const std::optional<QString> fromDate = takeValue(args, "--from-date");
    const std::optional<QString> toDate = takeValue(args, "--to-date");
    const std::optional<QString> fromNumber = takeValue(args, "--from-num");
    const std::optional<QString> toNumber = takeValue(args, "--to-num");
    const bool readItems = takeFlag(args, "--read-items");
    const bool fast = takeFlag(args, "--fast");
    if (company.isEmpty() || folder.isEmpty() || !args.isEmpty()) {
        printError(kDocsUsage);
        return 2;
    }
    for (const auto& number : {fromNumber, toNumber}) {
        if (isDocumentNumber(number)) continue;
        printError(
            QString("--from-num and --to-num take a document number, not '%1'").arg(*number));
        return 2;
    }
    if (!QFileInfo(company).isDir()) {
        printError(QString("there is no company folder %1").arg(company));
        return 1;
    }

    Context context;
    startContext(context, common.settingId);
    useCompanyFolder(context, company);
    StoredValues stored(context.applicationName);
    stored.choose(QStringLiteral("txtDBPath"), QDir(folder).absolutePath());
    if (fromDate) stored.choose(QStringLiteral("txtFromDate"), *fromDate);
    if (toDate) stored.choose(QStringLiteral("txtToDate"), *toDate);
    if (fromNumber) stored.choose(QStringLiteral("txtFromDocNum"), fromNumber->trimmed());
    if (toNumber) stored.choose(QStringLiteral("txtToDocNum"), toNumber->trimmed());
    if (readItems) stored.choose(QStringLiteral("chkReadDocItems"), "1");
    // The import button never reads the fast way; the flag asks for it.
    stored.choose(QStringLiteral("chkUseFastWay"), fast ? "1" : "0");
    if (fast) stored.choose(QStringLiteral("chkOnlyLine0"), "1");
    if (stored.isChecked(QStringLiteral("chkReadDocItems"))) FillHostLists(stored, context);

    TerminalProgress progress;
    DocImportResult result;
    const int status = runReporting([&] { result = runDocImport(stored, context, progress); });
    if (status != 0) return status;
    QTextStream out(stdout);
    bool failed = result.stopped;
    for (const DocTypeRead& read : result.types) {
        out << describeRead(read) << '\n';
        failed = failed || read.failure ||
                 (stored.isChecked(QStringLiteral("chkReadDocItems")) &&
                  read.scan.recordCount > 0 && !read.itemsImported);
    }
    if (result.stopped) {
        printError("the document import stopped");
        return 1;
    }
    out << progress.lastStep() << Qt::endl;
    return failed ? 1 : 0;
}

}  // namespace etq::cli
