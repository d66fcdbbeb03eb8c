// The tables tab's buttons open the editors modally on the control's database folder.
#include <QApplication>
#include <QTimer>

#include "card/card_controller.h"
#include "card/main_card.h"
#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/editor_window.h"
#include "platform/context.h"

namespace etq::test {
namespace {

class EditorCommandsTest : public db::test::DbFolderTest {};

TEST_F(EditorCommandsTest, ButtonsOpenTheirEditors) {
    jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
    items.execute("INSERT INTO tItems (ItemKey, ItemName) VALUES ('100', 'סבון'), ('200', 'ספוג')");
    items.execute(
        "INSERT INTO tAlterKeys (AccountKey, ItemKey, AlterNum) VALUES ('C1', '100', 'X')");
    Context context;
    context.connection.driver = "No Such Driver";  // the account window reads no price lists
    MainCard card(context);
    card.control("txtDBPath").setText(dir.path());
    const struct {
        const char* button;
        const char* window;
        int rows;
    } cases[] = {
        {"cmdEditItems", "frmEditItems", 2},
        {"cmdAlterKeys", "frmAlterItems", 1},
        {"cmdAccDef", "frmAccDef", 0},
    };
    for (const auto& c : cases) {
        QString opened;
        int rows = -1;
        QTimer::singleShot(0, [&] {
            auto* window = qobject_cast<EditorWindow*>(QApplication::activeModalWidget());
            if (!window) return;
            opened = window->objectName();
            rows = window->grid().rowCount();
            window->accept();
        });
        card.controller().click(c.button);
        EXPECT_EQ(opened, c.window) << c.button;
        EXPECT_EQ(rows, c.rows) << c.button;
    }
}

}  // namespace
}  // namespace etq::test
