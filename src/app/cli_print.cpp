// etiquon-cli mark-items, print-items and print-docs: the item selection window and the two
// print buttons without windows.
#include <QFileInfo>
#include <QTextStream>
#include <optional>

#include "app/cli_command.h"
#include "card/card_controller.h"
#include "card/document_adapters.h"
#include "card/print_adapters.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/item_selection.h"
#include "jet/error.h"
#include "platform/automation.h"
#include "platform/browser.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/glabels_automation.h"
#include "platform/log.h"
#include "platform/messages.h"
#include "platform/printers.h"
#include "platform/progress.h"
#include "print/label_definition.h"
#include "print/label_pdf.h"
#include "print/label_query.h"
#include "print/label_software.h"
#include "print/print_engine.h"
#include "surface/control_values.h"

namespace etq::cli {

namespace {

// Writes messages on stderr like the plain sink, and remembers whether one was a failure.
class CountingSink : public MessageSink {
  public:
    MsgAnswer show(const Message& message) override {
        if (message.icon == MsgIcon::Critical) ++failures;
        return stderrSink_.show(message);
    }
    int failures = 0;

  private:
    StderrMessageSink stderrSink_;
};

// The installed printers, as the window lists them in cmbPrinter; none when CUPS cannot be
// asked, which the window passes over too.
EntryList printerEntries() {
    EntryList entries;
    try {
        for (const QString& printer : listedPrinters(installedPrinters()))
            entries.append({printer, 0});
    } catch (const Failure& e) {
        qCInfo(log::card) << "no printer list:" << e.description();
    }
    return entries;
}

// The item print through label software: the engine on the stored settings. Prints the path of
// every PDF gLabels made, then the output file when one was asked for.
int printWithLabelSoftwareRoute(const StoredValues& stored, const ItemPrintOptions& item,
                                const PrintDestination& destination, Context& context) {
    QStringList made;
    context.automation().add(
        std::make_shared<GLabelsProvider>([&made](const QString& pdf) { made << pdf; }));
    NoProgress progress;
    SystemPacing pacing;
    const int status = runReporting([&] {
        const quint8 queryType = item.page.query.queryType;
        // Document lines may have a head label per document, on a design of its own.
        const bool headLabels = queryType == DocumentLineLabels &&
                                stored.isChecked(QStringLiteral("chkPrintHeadLabel"));
        LabelSoftwareOptions options =
            readLabelSoftwareOptions(stored, stored.text(QStringLiteral("txtLabelName")), queryType,
                                     item.kind, prepareItemPrint(item), headLabels);
        if (destination.printer) options.printer = destination.printer;
        if (destination.output) options.outputFile = *destination.output;
        printWithLabelSoftware(options, context, progress, pacing);
    });
    if (status != 0) return status;
    QTextStream out(stdout);
    for (const QString& pdf : made)
        out << pdf << '\n';
    if (destination.output) out << *destination.output << '\n';
    return 0;
}

// The built-in labels' PDF: where the command line sends it, or else the direct print of the
// settings; nothing for the browser page. The printer chosen in the settings gives the paper
// also when the PDF is only written.
std::optional<PdfDestination> pdfDestinationOf(const PrintDestination& given,
                                               const ControlValues& stored, bool outlines) {
    std::optional<PdfDestination> destination = readPdfDestination(stored);
    if (given.given()) {
        destination = PdfDestination{};
        destination->file = given.output;
        destination->send = given.printer.has_value();
        destination->printer =
            given.printer.value_or(stored.listIndex(QStringLiteral("cmbPrinter")) >= 0
                                       ? stored.text(QStringLiteral("cmbPrinter"))
                                       : QString());
    }
    if (destination) destination->outlines = outlines;
    return destination;
}

int markUsage() {
    printError(
        "usage: etiquon-cli mark-items --db DIR (--all | --none | KEY...) [--copies N] [--setting-id N]");
    return 2;
}

}  // namespace

PrintDestination takePrintDestination(QStringList& args) {
    // Given as "--name VALUE" or "--name=VALUE"; an empty value is kept, for the usage to refuse.
    auto take = [&args](const QString& name) -> std::optional<QString> {
        for (const QString& arg : args)
            if (arg == name || arg.startsWith(name + u'=')) return takeOption(args, name);
        return std::nullopt;
    };
    PrintDestination destination;
    destination.output = take(QStringLiteral("--output"));
    destination.printer = take(QStringLiteral("--printer"));
    // A label program writes from its own working folder: the file is named absolutely.
    if (destination.output && !destination.output->isEmpty())
        destination.output = QFileInfo(*destination.output).absoluteFilePath();
    return destination;
}

int runMarkItems(const QStringList& arguments) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    const QString folder = takeOption(args, "--db");
    const QString copies = takeOption(args, "--copies");
    const bool all = takeFlag(args, "--all");
    const bool none = takeFlag(args, "--none");
    if (folder.isEmpty() || (all && none) || ((all || none) && !args.isEmpty()) ||
        (!all && !none && args.isEmpty() && copies.isEmpty()))
        return markUsage();
    for (const QString& key : args)
        if (key.startsWith("--")) return markUsage();
    if (!copies.isEmpty() && (copies.toInt() <= 0 || copies.toInt() > 255)) {
        printError(QString("--copies takes a whole number from 1 to 255, not '%1'").arg(copies));
        return 2;
    }

    Context context;
    startContext(context, common.settingId);
    const StoredValues stored(context.applicationName);
    const QString filter = ItemKeyRangeCondition(stored.text(QStringLiteral("txtFromItem")),
                                                 stored.text(QStringLiteral("txtToItem")));
    BoundGridModel grid;
    ItemSelection selection(grid, filter);
    QTextStream out(stdout);
    try {
        selection.open(folder, 0, 0);
    } catch (const jet::JetError& e) {
        printError(e.description());
        return 1;
    }
    if (all || none) selection.markAll(all);
    int missing = 0;
    for (const QString& key : args) {
        const int row = selection.findByKey(key);
        if (row < 0) {
            printError(QString("no item whose key begins with '%1'").arg(key));
            ++missing;
            continue;
        }
        out << "marked " << grid.cell(row, ItemSelection::kKeyColumn - 1).toString() << ' '
            << grid.cell(row, ItemSelection::kNameColumn - 1).toString() << '\n';
    }
    if (!copies.isEmpty()) selection.setCopies(copies);
    if (!selection.lastError().isEmpty()) {
        printError(selection.lastError());
        return 1;
    }

    int marked = 0;
    for (int row = 0; row < selection.rowCount(); ++row)
        if (grid.cell(row, ItemSelection::kMarkColumn - 1).toBool()) ++marked;
    out << marked << " of " << selection.rowCount() << " items marked for printing" << Qt::endl;
    return missing ? 1 : 0;
}

namespace {

// A print button's run: item labels, or document-line labels, which the fast way reads first.
int runPrint(const QStringList& arguments, quint8 queryType) {
    QStringList args = arguments;
    const CommonOptions common = takeCommonOptions(args);
    const PrintDestination destination = takePrintDestination(args);
    const QString folder = takeOption(args, "--db");
    const bool open = takeFlag(args, "--open");
    const bool outlines = takeFlag(args, "--outlines");
    if (folder.isEmpty() || !args.isEmpty() || destination.output == QString() ||
        destination.printer == QString()) {
        printError(
            QString(
                "usage: etiquon-cli %1 --db DIR [--open] [--output FILE] [--printer NAME] [--outlines] [--setting-id N]")
                .arg(queryType == ItemLabels ? "print-items" : "print-docs"));
        return 2;
    }
    CountingSink sink;
    HeadlessPageViewer viewer(open);
    Context context;
    context.setMessages(&sink);
    context.setPages(&viewer);
    startContext(context, common.settingId);
    StoredValues stored(context.applicationName);
    stored.setList(QStringLiteral("cmbPrinter"), printerEntries());
    stored.choose(QStringLiteral("txtDBPath"), folder);
    loadStartUpLabelDefinition(stored, context);

    NoProgress progress;
    // The fast way reads the documents first, as the button does.
    if (queryType == DocumentLineLabels && printsTheFastWay(stored) && runReporting([&] {
            if (runDocImport(stored, context, progress).stopped)
                throw Failure(QStringLiteral("the document import stopped; nothing was printed"));
        }))
        return 1;
    ItemPrintOptions options;
    if (runReporting([&] { options = readItemPrintOptions(stored, queryType); })) return 1;
    if (options.kind != kBuiltInPage)
        return printWithLabelSoftwareRoute(stored, options, destination, context);

    if (const std::optional<PdfDestination> pdf = pdfDestinationOf(destination, stored, outlines)) {
        options.printer.reset();  // the job names its printer; the user's default stays
        PdfLabels labels;
        const int status = runReporting([&] {
            const QString workDb = prepareItemPrint(options);
            labels = printLabelsPdf(workDb, options.page, loadedLabelDefinition(context), *pdf,
                                    progress);
        });
        if (status != 0) return status;
        if (!labels.refusedBarcodes.isEmpty())
            printError(QStringLiteral("%1 labels have no barcode:\n%2")
                           .arg(labels.refusedBarcodes.size())
                           .arg(labels.refusedBarcodes.join(u'\n')));
        QTextStream(stdout) << labels.labels << " labels on " << labels.pages
                            << (labels.pages == 1 ? " page" : " pages")
                            << (pdf->send && labels.labels > 0 ? " sent to the printer" : "")
                            << "\n"
                            << labels.path << Qt::endl;
        return sink.failures ? 1 : 0;
    }

    BuiltInPrint print;
    const int status = runReporting([&] { print = printLabels(options, context, progress); });
    if (status != 0) return status;
    if (runReporting([&] { context.pages().showPage(print.pagePath); })) return 1;
    if (!print.refusedBarcodes.isEmpty())
        printError(QStringLiteral("%1 labels have no barcode:\n%2")
                       .arg(print.refusedBarcodes.size())
                       .arg(print.refusedBarcodes.join(u'\n')));
    return sink.failures ? 1 : 0;
}

}  // namespace

int runPrintItems(const QStringList& arguments) {
    return runPrint(arguments, ItemLabels);
}

int runPrintDocs(const QStringList& arguments) {
    return runPrint(arguments, DocumentLineLabels);
}

}  // namespace etq::cli
