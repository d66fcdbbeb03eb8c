#include "card/card_controller.h"

#include <QFileInfo>
#include <QProcess>
#include <span>

#include "card/boundary.h"
#include "card/print_adapters.h"
#include "import/connection.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/messages.h"
#include "platform/printers.h"
#include "platform/settings_keys.h"
#include "platform/settings_store.h"
#include "platform/user_paths.h"
#include "print/label_definition.h"
#include "print/label_software.h"
#include "surface/control_values.h"
#include "surface/settings_groups.h"
#include "surface/surface.h"

namespace etq {

namespace {

// Runs one step of a handler that passes over failures and goes on with its next step.
template <typename Step>
void passOver(Step&& step) {
    try {
        step();
    } catch (const std::exception& e) {
        qCInfo(log::card) << "passed over:" << describe(e);
    }
}

// The elements that open a modal dialog; the dialog reads the database folder taken just
// before it opens.
constexpr QStringView kDialogElements[] = {
    u"cmdSelectItems", u"cmdSelectDocItems", u"cmdRanges",    u"cmdDLog",    u"cmdAlterKeys",
    u"cmdAccDef",      u"cmdEditItems",      u"cmdLabDesign", u"CmdConnect",
};

bool opensDialog(const QString& element) {
    for (QStringView e : kDialogElements)
        if (e == element) return true;
    return false;
}

}  // namespace

// The elements the control handles itself. Every other element goes to its work, when
// another part of the component has provided it.
struct CommandTable {
    struct Entry {
        QStringView element;
        void (CardController::*handler)(int index);
    };
    static std::span<const Entry> entries() {
        static constexpr Entry kEntries[] = {
            {u"LblToKey", &CardController::lblToKey},
            {u"LblToDate", &CardController::lblToDate},
            {u"LblToRef", &CardController::lblToRef},
            {u"Image3", &CardController::image3},
            {u"Image5", &CardController::image5},
            {u"cmdImportDocs", &CardController::importDocs},
            {u"Image6", &CardController::image6},
            {u"Image7", &CardController::image7},
            {u"Image8", &CardController::image8},
            {u"cmdAllDocTypes", &CardController::markAllDocTypes},
            {u"cmdNoDocTypes", &CardController::markNoDocTypes},
            {u"ImgEdit", &CardController::imgEdit},
            {u"cmdUpgrade", &CardController::upgrade},
            {u"cmdSaveDef1", &CardController::saveGeneral},
            {u"cmdSaveDef2", &CardController::saveImportItems},
            {u"CmdSaveFields", &CardController::saveLabelVars},
            {u"cmdSaveDef4", &CardController::saveLabelByItems},
            {u"cmdSaveDef5", &CardController::saveLabelByDocs},
            {u"cmdSaveDef6", &CardController::saveByDocsDef},
            {u"CmdDir", &CardController::chooseFile},
            {u"OptOLE", &CardController::chooseRoute},
        };
        return kEntries;
    }
};

namespace {
// Elements whose work another part provides.
constexpr QStringView kWorkElements[] = {
    u"cmdSelectItems", u"cmdPrintItmes", u"cmdSelectDocItems", u"cmdPrintDocButt",
    u"cmdRanges",      u"cmdDLog",       u"CmdImportItems",    u"cmdAlterKeys",
    u"cmdAccDef",      u"cmdEditItems",  u"cmdLabDesign",      u"CmdConnect",
};
}  // namespace

void loadLanguage(Context& context) {
    const QString language =
        readSetting(context.applicationName, QStringLiteral("Params"), QStringLiteral("Language"),
                    settingDefault(u"Params", u"Language"));
    context.language = language.trimmed() == u"1" ? 1 : 0;
}

void loadStartUpLabelDefinition(const ControlValues& values, Context& context) {
    if (GetLabelSoftwareKind(values) == kBuiltInPage)
        GetSetLabelDef(LoadLabelDef, context.applicationName, context.labelDefinition());
}

CardController::CardController(Surface& surface, Context& context)
    : surface_(surface), context_(context) {
    hooks_.installedPrinters = [] { return installedPrinters(); };
    hooks_.startProgram = [](const QString& program, const QStringList& arguments) {
        return QProcess::startDetached(program, arguments);
    };
    surface_.setChangeListener([this](const QString& name, int index) { changed(name, index); });
}

void CardController::setFileChooser(FileChooser* chooser) {
    chooser_ = chooser ? chooser : &cancelChooser_;
}

void CardController::InitProperties(const QString& settingId) {
    context_.applicationName = applicationNameFor(settingId);
    passOver([this] { loadLanguage(context_); });
    passOver([this] { fillPrinterList(); });
    passOver([this] { GetConnParams(context_); });
    // The host lists come first: the settings select their entries by position.
    if (context_.connection.database != settingDefault(u"Params", u"ConnDataBase")) {
        passOver([this] { FillCmbPrice(); });
        passOver([this] { FillCmbItmQGrp(); });
        passOver([this] { FillCmbItmBelong(); });
    }
    for (quint8 group = 1; group <= 6; ++group)
        passOver([&] { GetSetParams(surface_, context_.applicationName, group, LoadSettings); });
    passOver([this] {
        const bool fastWay = surface_.control(QStringLiteral("chkUseFastWay")).value().toInt() == 1;
        surface_.control(QStringLiteral("MainTab")).setCurrentTab(fastWay ? 1 : 0);
    });
    passOver([this] {
        if (surface_.control(QStringLiteral("OptOLE"), 3).value().toBool() &&
            hooks_.labelDefinition)
            hooks_.labelDefinition(LoadSettings);
    });
}

void CardController::FillCmbPrice() {
    if (hooks_.fillCmbPrice) hooks_.fillCmbPrice(surface_, context_);
}

void CardController::FillCmbItmQGrp() {
    if (hooks_.fillCmbItmQGrp) hooks_.fillCmbItmQGrp(surface_, context_);
}

void CardController::FillCmbItmBelong() {
    if (hooks_.fillCmbItmBelong) hooks_.fillCmbItmBelong(surface_, context_);
}

QStringList listedPrinters(const QStringList& installed) {
    // Windows' own rendering pseudo-printer is no printer, should CUPS ever list it.
    QStringList listed = installed;
    listed.removeAll(QStringLiteral("Rendering Subsystem"));
    return listed;
}

void CardController::fillPrinterList() {
    const ControlRef combo = surface_.control(QStringLiteral("cmbPrinter"));
    combo.clearList();
    for (const QString& printer : listedPrinters(hooks_.installedPrinters()))
        combo.addItem(printer);
}

void CardController::click(const QString& element, int index) {
    try {
        for (const CommandTable::Entry& c : CommandTable::entries()) {
            if (c.element == element) {
                (this->*c.handler)(index);
                return;
            }
        }
        runWork(element, index);
    } catch (const std::exception& e) {
        reportFailure(context_, e, context_.caption(1));
    }
}

bool CardController::isClickable(const QString& element) {
    for (const CommandTable::Entry& c : CommandTable::entries())
        if (c.element == element) return true;
    for (QStringView e : kWorkElements)
        if (e == element) return true;
    return false;
}

void CardController::setWork(const QString& element, Work work) {
    work_.insert(element, std::move(work));
}

void CardController::runWork(const QString& element, int index) {
    if (opensDialog(element))
        databaseFolder_ = surface_.control(QStringLiteral("txtDBPath")).text();
    const auto work = work_.constFind(element);
    if (work != work_.constEnd() && *work) (*work)(index);
}

void CardController::changed(const QString& name, int index) {
    if (name == u"txtFromDocNum") {
        copyText(QStringLiteral("txtFromDocNum"), QStringLiteral("txtToDocNum"));
    } else if (name == u"MainTab") {
        onTabChanged();
    }
}

void CardController::copyText(const QString& from, const QString& to) {
    surface_.control(to).setText(surface_.control(from).text());
}

void CardController::forward(const QString& element) {
    surface_.control(element).setFocus();
    click(element);
}

void CardController::onTabChanged() {
    passOver([this] { surface_.control(QStringLiteral("ProgressFill")).setWidth(0); });
    passOver([this] { surface_.control(QStringLiteral("Message1")).setCaption({}); });
    const int tab = surface_.control(QStringLiteral("MainTab")).currentTab();
    if (tab == 1) {
        passOver([this] {
            const bool log =
                surface_.control(QStringLiteral("chkUseDeliverLog")).value().toInt() == 1;
            surface_.control(QStringLiteral("cmdDLog")).setVisible(log);
        });
    } else if (tab == 6) {
        passOver([this] {
            if (!hooks_.showDocTypes) return;
            const QString folder = surface_.control(QStringLiteral("txtDBPath")).text();
            hooks_.showDocTypes(joinPath(folder, QStringLiteral("etiquon.kdb")));
        });
    }
}

void CardController::lblToKey(int) {
    copyText(QStringLiteral("txtFromItem"), QStringLiteral("txtToItem"));
}

void CardController::lblToDate(int) {
    copyText(QStringLiteral("txtFromDate"), QStringLiteral("txtToDate"));
}

void CardController::lblToRef(int) {
    copyText(QStringLiteral("txtFromDocNum"), QStringLiteral("txtToDocNum"));
}

// The document import button starts with an empty progress bar and message line.
void CardController::importDocs(int) {
    surface_.control(QStringLiteral("ProgressFill")).setWidth(0);
    surface_.control(QStringLiteral("Message1")).setCaption({});
    importDocsAnew();
}

// Its picture leaves the bar as it was.
void CardController::image6(int) {
    surface_.control(QStringLiteral("cmdImportDocs")).setFocus();
    importDocsAnew();
}

// A document import asked for by hand is never the fast way, which the print button's own
// import is.
void CardController::importDocsAnew() {
    surface_.control(QStringLiteral("chkUseFastWay")).setValue(0);
    if (hooks_.importDocs) hooks_.importDocs();
}

void CardController::image3(int) {
    forward(QStringLiteral("cmdSelectItems"));
}

void CardController::image5(int) {
    forward(QStringLiteral("cmdPrintItmes"));
}

void CardController::image7(int) {
    forward(QStringLiteral("cmdSelectDocItems"));
}

void CardController::image8(int) {
    forward(QStringLiteral("cmdPrintDocButt"));
}

void CardController::markAllDocTypes(int) {
    passOver([this] {
        if (hooks_.markAllDocTypes) hooks_.markAllDocTypes(true);
    });
}

void CardController::markNoDocTypes(int) {
    passOver([this] {
        if (hooks_.markAllDocTypes) hooks_.markAllDocTypes(false);
    });
}

// Opens the label software on the head label (index 0) or the line label (index 1).
void CardController::imgEdit(int index) {
    passOver([&] {
        const QString label = surface_
                                  .control(index == 0 ? QStringLiteral("txtLabelNameHead")
                                                      : QStringLiteral("txtLabelName"))
                                  .text();
        const QString program = surface_.control(QStringLiteral("txtLabelSoftware")).text();
        if (!QFileInfo(program).isFile()) {
            showCritical(context_.messages(), context_.caption(39), context_.caption(30));
            return;
        }
        QStringList arguments;
        if (QFileInfo(label).isFile()) {
            arguments.append(label);
        } else if (askYesNo(context_.messages(), context_.caption(40), context_.caption(30)) !=
                   MsgAnswer::Yes) {
            return;
        }
        hooks_.startProgram(program, arguments);
    });
}

void CardController::upgrade(int) {
    passOver([this] {
        const QString folder = surface_.control(QStringLiteral("txtDBPath")).text();
        QString path = joinPath(folder, QStringLiteral("etqnitm.kdb"));
        // A folder without an item database has nothing to upgrade, which counts as success.
        if (QFileInfo::exists(path))
            path = hooks_.upgradeItemDatabase ? hooks_.upgradeItemDatabase(path) : QString();
        const ControlRef frame = surface_.control(QStringLiteral("ProgressFrame"));
        surface_.control(QStringLiteral("ProgressFill")).setWidth(frame.width());
        surface_.control(QStringLiteral("Message1"))
            .setCaption(path.isEmpty() ? QStringLiteral("Upgrade failed")
                                       : QStringLiteral("Upgrade successfull"));
    });
}

void CardController::saveGeneral(int) {
    GetSetParams(surface_, context_.applicationName, 1, SaveSettings);
    if (surface_.control(QStringLiteral("OptOLE"), 3).value().toBool() && hooks_.labelDefinition)
        hooks_.labelDefinition(SaveSettings);
}

void CardController::saveImportItems(int) {
    GetSetParams(surface_, context_.applicationName, 2, SaveSettings);
}

void CardController::saveLabelVars(int) {
    GetSetParams(surface_, context_.applicationName, 3, SaveSettings);
}

void CardController::saveLabelByItems(int) {
    GetSetParams(surface_, context_.applicationName, 4, SaveSettings);
}

void CardController::saveLabelByDocs(int) {
    GetSetParams(surface_, context_.applicationName, 5, SaveSettings);
}

void CardController::saveByDocsDef(int) {
    GetSetParams(surface_, context_.applicationName, 6, SaveSettings);
}

// The built-in label chosen after start-up: its definition is loaded now (unless this run has
// it already), so that the designer, a save and a print all work on the stored one.
void CardController::chooseRoute(int index) {
    passOver([&] {
        if (index == 3 && surface_.control(QStringLiteral("OptOLE"), 3).value().toBool() &&
            hooks_.labelDefinition)
            hooks_.labelDefinition(LoadSettings);
    });
}

// CmdDir(0) chooses the head label file, CmdDir(1) the line label file, CmdDir(2) the label
// software's program; a cancelled dialog leaves the box as it was.
void CardController::chooseFile(int index) {
    const qint16 kind = GetLabelSoftwareKind(surface_);
    const QString file =
        index == 2 ? SelectLabelSoftware(kind, *chooser_) : SelectLabelFile(kind, *chooser_);
    if (file.isEmpty()) return;
    const QString box = index == 0   ? QStringLiteral("txtLabelNameHead")
                        : index == 1 ? QStringLiteral("txtLabelName")
                                     : QStringLiteral("txtLabelSoftware");
    surface_.control(box).setText(file);
}

}  // namespace etq
