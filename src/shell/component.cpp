#include "shell/component.h"

#include "db/local_databases.h"
#include "import/host_lists.h"
#include "import/item_import.h"
#include "print/label_definition.h"
#include "print/print_buttons.h"
#include "shell/card_controller.h"

namespace etq {

void connectParts(CardController& controller, Surface& surface) {
    CardHooks& hooks = controller.hooks();
    hooks.upgradeItemDatabase = [](const QString& itemDatabase) {
        return db::AddAccountTables(itemDatabase);
    };
    hooks.fillCmbPrice = [](const Surface& s) { FillCmbPrice(s); };
    hooks.fillCmbItmQGrp = [](const Surface& s) { FillCmbItmQGrp(s); };
    hooks.fillCmbItmBelong = [](const Surface& s) { FillCmbItmBelong(s); };
    controller.setWork(QStringLiteral("CmdImportItems"), [&surface](int) { ImportItems(surface); });
    hooks.labelDefinition = [](quint8 action) { GetSetLabelDef(action); };
    controller.setWork(QStringLiteral("cmdPrintItmes"),
                       [&surface](int) { PrintItemLabels(surface); });
}

}  // namespace etq
