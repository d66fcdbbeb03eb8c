#include "card/print_adapters.h"

#include "card/boundary.h"
#include "platform/browser.h"
#include "platform/context.h"
#include "platform/label_fields.h"
#include "platform/messages.h"
#include "surface/control_values.h"
#include "surface/surface.h"
#include "surface/surface_progress.h"

namespace etq {

namespace {

// The built-in page has always titled its messages in Hebrew, whatever the language.
const QString kPageFailureTitle = QStringLiteral("תקלה");

void tellRefusedBarcodes(Context& context, const QStringList& refused) {
    constexpr int kShown = 10;
    QString text = QStringLiteral("%1 labels have no barcode:").arg(refused.size());
    for (int i = 0; i < refused.size() && i < kShown; ++i)
        text += u'\n' + refused[i];
    if (refused.size() > kShown)
        text += QStringLiteral("\n... and %1 more").arg(refused.size() - kShown);
    context.messages().show({text, kPageFailureTitle, MsgIcon::Exclamation, MsgButtons::Ok});
}

LabelPageInput readLabelPageInput(const ControlValues& values, quint8 queryType) {
    return {readLabelQueryInput(values, queryType, labelOrder(values)),
            values.text(QStringLiteral("txtPriceFormat"))};
}

// The direct print: the labels' PDF drawn here and sent to the printer.
QString printDirect(Surface& surface, Context& context, const QString& dbName,
                    LabelPageInput& input, const PdfDestination& destination) {
    SurfaceProgress progress(surface);
    PdfLabels pdf;
    const bool printed = reportFailures(context, kPageFailureTitle, [&] {
        pdf = printLabelsPdf(dbName, input, loadedLabelDefinition(context), destination, progress);
    });
    showFieldChecks(surface, input.query);
    if (!printed) return {};
    if (!pdf.refusedBarcodes.isEmpty()) tellRefusedBarcodes(context, pdf.refusedBarcodes);
    return pdf.path;
}

}  // namespace

qint16 GetLabelSoftwareKind(const ControlValues& values) {
    constexpr qint16 kKindOfOption[] = {kNiceLabel,   kCodeSoft,  kBarTender,
                                        kBuiltInPage, kFastLabel, kGLabels};
    for (int option = 0; option < int(std::size(kKindOfOption)); ++option)
        if (values.value(QStringLiteral("OptOLE"), option) == 1) return kKindOfOption[option];
    return kNoLabelSoftware;
}

qint16 GetLabelSoftwareKind(const Surface& surface) {
    return GetLabelSoftwareKind(SurfaceValues(surface));
}

quint8 labelOrder(const ControlValues& values) {
    return values.value(QStringLiteral("OptPrinter"), 1) == 1 ? Descending : Ascending;
}

LabelQueryInput readLabelQueryInput(const ControlValues& values, quint8 queryType, quint8 order) {
    LabelQueryInput in;
    in.queryType = queryType;
    in.order = order;
    in.useAccountKey = values.isChecked(QStringLiteral("ChkUseAccountKey"));
    in.accountKey = values.text(QStringLiteral("txtAccountKey"));
    in.fromItem = values.text(QStringLiteral("txtFromItem"));
    in.toItem = values.text(QStringLiteral("txtToItem"));
    for (const LabelFieldSlot& slot : labelFieldSlots())
        in.fieldChecks[size_t(slot.slot)] =
            values.isChecked(QStringLiteral("ChkFldSend"), slot.slot);
    in.companyName = values.text(QStringLiteral("txtCompanyName"));
    return in;
}

ItemPrintOptions readItemPrintOptions(const ControlValues& values, quint8 queryType) {
    ItemPrintOptions options;
    options.databaseFolder = values.text(QStringLiteral("txtDBPath"));
    options.kind = GetLabelSoftwareKind(values);
    if (values.listIndex(QStringLiteral("cmbPrinter")) >= 0)
        options.printer = values.text(QStringLiteral("cmbPrinter"));
    options.page = readLabelPageInput(values, queryType);
    return options;
}

std::optional<PdfDestination> readPdfDestination(const ControlValues& values) {
    if (values.listIndex(QStringLiteral("cmbPrintMode")) != kDirectPrint) return std::nullopt;
    PdfDestination destination;
    destination.send = true;
    if (values.listIndex(QStringLiteral("cmbPrinter")) >= 0)
        destination.printer = values.text(QStringLiteral("cmbPrinter"));
    return destination;
}

void showFieldChecks(const Surface& surface, const LabelQueryInput& query) {
    for (const LabelFieldSlot& slot : labelFieldSlots()) {
        const ControlRef box = surface.control(QStringLiteral("ChkFldSend"), slot.slot);
        if (query.fieldChecks[size_t(slot.slot)] && box.value().toInt() != 1) box.setValue(1);
    }
}

QString PrintBuiltInLabels(Surface& surface, Context& context, const QString& dbName,
                           quint8 queryType) {
    const SurfaceValues values(surface);
    LabelPageInput input = readLabelPageInput(values, queryType);
    if (const std::optional<PdfDestination> destination = readPdfDestination(values))
        return printDirect(surface, context, dbName, input, *destination);
    SurfaceProgress progress(surface);
    BuiltInPrint print;
    const bool printed = reportFailures(context, kPageFailureTitle, [&] {
        print = printBuiltInLabels(dbName, input, loadedLabelDefinition(context), progress);
    });
    showFieldChecks(surface, input.query);
    if (!printed) return {};
    reportFailures(context, kPageFailureTitle, [&] { context.pages().showPage(print.pagePath); });
    if (!print.refusedBarcodes.isEmpty()) tellRefusedBarcodes(context, print.refusedBarcodes);
    return print.pagePath;
}

LabelSoftwareOptions readLabelSoftwareOptions(const ControlValues& values, const QString& labelFile,
                                              quint8 queryType, qint16 kind, const QString& workDb,
                                              bool headLabels) {
    LabelSoftwareOptions options;
    options.workDatabase = workDb;
    options.kind = kind;
    options.labelFile = labelFile;
    options.headLabels = headLabels;
    if (headLabels) options.headLabelFile = values.text(QStringLiteral("txtLabelNameHead"));
    options.query = readLabelQueryInput(values, queryType, labelOrder(values));
    options.printDelay = values.text(QStringLiteral("txtPrintDelay"));
    options.a4 = values.isChecked(QStringLiteral("OptPrinter"), 0);
    options.priceFormat = values.text(QStringLiteral("txtPriceFormat"));
    if (values.listIndex(QStringLiteral("cmbPrinter")) >= 0)
        options.printer = values.text(QStringLiteral("cmbPrinter"));
    return options;
}

bool PrintWithLabelSoftware(Surface& surface, Context& context, const QString& labelFile,
                            quint8 queryType, qint16 kind, const QString& workDb, bool headLabels) {
    SurfaceProgress progress(surface);
    SystemPacing pacing;
    return reportFailures(context, context.caption(1), [&] {
        printWithLabelSoftware(readLabelSoftwareOptions(SurfaceValues(surface), labelFile,
                                                        queryType, kind, workDb, headLabels),
                               context, progress, pacing);
    });
}

QString PrintItemLabels(Surface& surface, Context& context) {
    return PrintLabels(surface, context, ItemLabels);
}

QString PrintLabels(Surface& surface, Context& context, quint8 queryType) {
    const SurfaceValues values(surface);
    ItemPrintOptions options;
    QString workDb;
    if (!reportFailures(context, context.caption(1), [&] {
            options = readItemPrintOptions(values, queryType);
            // A direct print names its printer in the job; the user's default stays.
            if (readPdfDestination(values)) options.printer.reset();
            workDb = prepareItemPrint(options);
        }))
        return {};
    if (options.kind != kBuiltInPage) {
        // Document lines may have a head label per document, on a design of its own.
        const bool headLabels = queryType == DocumentLineLabels &&
                                values.isChecked(QStringLiteral("chkPrintHeadLabel"));
        PrintWithLabelSoftware(surface, context, values.text(QStringLiteral("txtLabelName")),
                               queryType, options.kind, workDb, headLabels);
        return {};
    }
    return PrintBuiltInLabels(surface, context, workDb, queryType);
}

void CreateLabFile(Surface& surface, Context& context, const QString& fileName,
                   const QString& dbName, quint8 queryType, quint8 orderBy) {
    SurfaceProgress progress(surface);
    const SurfaceValues values(surface);
    LabelPageInput input{readLabelQueryInput(values, queryType, orderBy),
                         values.text(QStringLiteral("txtPriceFormat"))};
    // The boxes of the cells' fields are ticked also when the page fails after ticking them.
    try {
        writeLabelPage(fileName, dbName, input, loadedLabelDefinition(context), progress);
    } catch (...) {
        showFieldChecks(surface, input.query);
        throw;
    }
    showFieldChecks(surface, input.query);
}

}  // namespace etq
