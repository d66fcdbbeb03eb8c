#include "card/editor_commands.h"

#include "card/card_controller.h"
#include "card/print_adapters.h"
#include "dialogs/acc_def_window.h"
#include "dialogs/alter_items_window.h"
#include "dialogs/edit_items_window.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/qt_file_chooser.h"

namespace etq {

void connectEditors(CardController& controller, const Surface& surface, QWidget* parent) {
    controller.setWork(QStringLiteral("cmdEditItems"), [&controller, parent](int) {
        EditItemsWindow window(controller.context(), controller.databaseFolder(), parent);
        window.exec();
    });
    controller.setWork(QStringLiteral("cmdAlterKeys"), [&controller, parent](int) {
        AlterItemsWindow window(controller.context(), controller.databaseFolder(), parent);
        window.exec();
    });
    controller.setWork(QStringLiteral("cmdAccDef"), [&controller, &surface, parent](int) {
        qint16 kind = 0;
        try {
            kind = GetLabelSoftwareKind(surface);
        } catch (const std::exception& e) {
            qCInfo(log::card) << "cmdAccDef passed over:" << describe(e);
        }
        QtFileChooser chooser(parent);
        AccDefWindow window(controller.context(), controller.databaseFolder(), kind, chooser,
                            parent);
        window.exec();
    });
}

}  // namespace etq
