#include "shell/component.h"

#include "db/local_databases.h"
#include "print/label_definition.h"
#include "print/print_buttons.h"
#include "shell/card_controller.h"

namespace etq {

void connectParts(CardController& controller, Surface& surface) {
    CardHooks& hooks = controller.hooks();
    hooks.upgradeItemDatabase = [](const QString& itemDatabase) {
        return db::AddAccountTables(itemDatabase);
    };
    hooks.labelDefinition = [](quint8 action) { GetSetLabelDef(action); };
    controller.setWork(QStringLiteral("cmdPrintItmes"),
                       [&surface](int) { PrintItemLabels(surface); });
}

}  // namespace etq
