#pragma once

#include <QHash>
#include <QString>
#include <QStringList>
#include <functional>

#include "platform/file_chooser.h"

namespace etq {

class Context;
class Surface;

class ControlValues;

// The language of the run from the key Params/Language of its settings store: "1" English,
// anything else Hebrew.
void loadLanguage(Context& context);

// Start-up's last step: the built-in label definition is loaded from the store when the
// built-in label page is the chosen route.
void loadStartUpLabelDefinition(const ControlValues& values, Context& context);

// The printers cmbPrinter lists among those installed.
QStringList listedPrinters(const QStringList& installed);

// The work other parts of the component do for the control. Each hook is optional: an empty
// one does nothing (or, for the upgrade, fails).
struct CardHooks {
    // Fill cmbPriceField, cmbItmQGrp and cmbItmBelong with the host's lists.
    std::function<void(const Surface&, Context&)> fillCmbPrice;
    std::function<void(const Surface&, Context&)> fillCmbItmQGrp;
    std::function<void(const Surface&, Context&)> fillCmbItmBelong;
    // Moves the built-in label definition: 1 writes it to the store, 2 reads it (when the run
    // has not yet).
    std::function<void(quint8 action)> labelDefinition;
    // Upgrades the item database at the path; the path on success, empty text on failure.
    std::function<QString(const QString& itemDatabase)> upgradeItemDatabase;
    // The document type grid of tab 6: shown from the document database at the path, and
    // every type's scan box set (true) or cleared (false).
    std::function<void(const QString& documentDatabase)> showDocTypes;
    std::function<void(bool scan)> markAllDocTypes;
    // The installed printers; CUPS unless replaced.
    std::function<QStringList()> installedPrinters;
    // Starts a program with its arguments without waiting for it; false when it cannot start.
    std::function<bool(const QString& program, const QStringList& arguments)> startProgram;
    // The document import run (ImportDocs) with the controls' values.
    std::function<void()> importDocs;
};

// What the control does: start-up, the handling of every clickable element and of text and
// tab changes, on any surface, in the run's context. The window forwards its events here; tests
// call it directly.
class CardController {
  public:
    // Listens to the surface's changes from now on.
    CardController(Surface& surface, Context& context);

    Context& context() { return context_; }

    CardHooks& hooks() { return hooks_; }
    // The file dialog (not owned); until one is set, every dialog is cancelled.
    void setFileChooser(FileChooser* chooser);

    // Start-up: the application name from the hosting page's SettingID (into the context), the
    // printer list, the connection parameters, the host lists, the settings groups 1 to 6, the
    // first tab and the built-in label definition, in that order. A failing step is passed over.
    void InitProperties(const QString& settingId = {});

    void FillCmbPrice();
    void FillCmbItmQGrp();
    void FillCmbItmBelong();

    // A click on a command button, picture or clickable label of the surface.
    void click(const QString& element, int index = -1);
    // Whether the element does something when clicked (the window marks those labels).
    static bool isClickable(const QString& element);
    // A change of a control's text or of the tab of MainTab.
    void changed(const QString& name, int index);

    // The work of an element that another part of the component provides, run when the
    // element is clicked. Elements that open a dialog copy txtDBPath to databaseFolder() first.
    using Work = std::function<void(int index)>;
    void setWork(const QString& element, Work work);

    // The database folder the dialogs read, taken from txtDBPath just before one opens.
    const QString& databaseFolder() const { return databaseFolder_; }

  private:
    friend struct CommandTable;

    void copyText(const QString& from, const QString& to);
    void forward(const QString& element);
    void runWork(const QString& element, int index);
    void onTabChanged();
    void fillPrinterList();

    void lblToKey(int);
    void lblToDate(int);
    void lblToRef(int);
    void importDocs(int);
    void image6(int);
    void importDocsAnew();
    void image3(int);
    void image5(int);
    void image7(int);
    void image8(int);
    void markAllDocTypes(int);
    void markNoDocTypes(int);
    void imgEdit(int index);
    void upgrade(int);
    void saveGeneral(int);
    void saveImportItems(int);
    void saveLabelVars(int);
    void saveLabelByItems(int);
    void saveLabelByDocs(int);
    void saveByDocsDef(int);
    void chooseFile(int index);
    void chooseRoute(int index);

    Surface& surface_;
    Context& context_;
    CardHooks hooks_;
    CancelFileChooser cancelChooser_;
    FileChooser* chooser_ = &cancelChooser_;
    QHash<QString, Work> work_;
    QString databaseFolder_;
};

}  // namespace etq
