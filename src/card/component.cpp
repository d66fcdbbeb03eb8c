#include "card/component.h"

#include <QFileInfo>

#include "card/boundary.h"
#include "card/card_controller.h"
#include "card/document_adapters.h"
#include "card/import_adapters.h"
#include "card/print_adapters.h"
#include "db/local_databases.h"
#include "platform/context.h"
#include "platform/folder_lock.h"
#include "print/label_definition.h"

namespace etq {

void connectParts(CardController& controller, Surface& surface) {
    Context& context = controller.context();
    CardHooks& hooks = controller.hooks();
    hooks.upgradeItemDatabase = [&context](const QString& itemDatabase) {
        QString upgraded;
        reportFailures(context, context.caption(1), [&] {
            const FolderLock lock(QFileInfo(itemDatabase).path());
            upgraded = db::AddAccountTables(itemDatabase);
        });
        return upgraded;
    };
    hooks.fillCmbPrice = [](const Surface& s, Context& c) { FillCmbPrice(s, c); };
    hooks.fillCmbItmQGrp = [](const Surface& s, Context& c) { FillCmbItmQGrp(s, c); };
    hooks.fillCmbItmBelong = [](const Surface& s, Context& c) { FillCmbItmBelong(s, c); };
    // A load keeps what the designer changed since an earlier one; a save writes the user's
    // definition, never the empty one of a run that has not loaded it.
    hooks.labelDefinition = [&context](quint8 action) {
        LabelDefinition& definition = loadedLabelDefinition(context);
        if (action == SaveLabelDef) GetSetLabelDef(action, context.applicationName, definition);
    };
    controller.setWork(QStringLiteral("CmdImportItems"),
                       [&surface, &context](int) { CmdImportItems(surface, context); });
    controller.setWork(QStringLiteral("cmdPrintItmes"),
                       [&surface, &context](int) { PrintItemLabels(surface, context); });
    hooks.importDocs = [&surface, &context] { ImportDocs(surface, context); };
    controller.setWork(QStringLiteral("cmdPrintDocButt"),
                       [&surface, &context](int) { PrintDocLabels(surface, context); });
}

}  // namespace etq
