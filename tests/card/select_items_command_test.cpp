// The control's item selection button opens the selection window on its database folder, the
// label tab's item range narrowing the list.
#include <QApplication>
#include <QTimer>

#include "card/card_controller.h"
#include "card/main_card.h"
#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/select_item_window.h"
#include "platform/context.h"

namespace etq::test {
namespace {

class SelectItemsCommandTest : public db::test::DbFolderTest {};

TEST_F(SelectItemsCommandTest, ControlOpensItWithTheLabelTabsRange) {
    jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
    items.execute(
        "INSERT INTO tItems (ItemKey, ItemName, Coin, Price, Copies, PrintLabel) VALUES ('100', 'סבון', '¦', 1, 1, False), ('200', 'מברשת', '¦', 1, 1, False), ('300', 'ספוג', '¦', 1, 1, False)");
    Context context;
    MainCard card(context);
    card.control("txtDBPath").setText(dir.path());
    card.control("txtFromItem").setText("200");
    int listed = -1;
    QTimer::singleShot(0, [&] {
        auto* window = qobject_cast<SelectItemWindow*>(QApplication::activeModalWidget());
        if (!window) return;
        listed = window->grid().rowCount();
        window->accept();
    });
    card.controller().click("cmdSelectItems");
    EXPECT_EQ(listed, 2);
}

}  // namespace
}  // namespace etq::test
