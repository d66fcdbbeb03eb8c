#include "shell/component.h"

#include "db/local_databases.h"
#include "shell/card_controller.h"

namespace etq {

void connectParts(CardController& controller, Surface& surface) {
    Q_UNUSED(surface);
    CardHooks& hooks = controller.hooks();
    hooks.upgradeItemDatabase = [](const QString& itemDatabase) {
        return db::AddAccountTables(itemDatabase);
    };
}

}  // namespace etq
