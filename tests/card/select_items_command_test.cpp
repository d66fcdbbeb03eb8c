// The control's item selection button opens the selection window on its database folder, the
// label tab's item range narrowing the list; the document buttons open theirs alike.
#include <QApplication>
#include <QTimer>

#include "card/card_controller.h"
#include "card/main_card.h"
#include "db/db_fixture.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/edit_ranges_window.h"
#include "dialogs/select_doc_item_window.h"
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

TEST_F(SelectItemsCommandTest, DocumentButtonsOpenTheirWindowsOnTheControlsFolder) {
    ASSERT_FALSE(createWork(false).isEmpty());
    jet::Database work = jet::Database::open(path(db::kWorkDatabaseFile));
    work.execute(
        "INSERT INTO tTempDocHeaders (WizFileID, [Number], RecIndex, DocType) VALUES (1, 5, 0, 1)");
    Context context;
    MainCard card(context);
    card.control("txtDBPath").setText(dir.path());
    int rows = -1;
    QString shown;
    QTimer::singleShot(0, [&] {
        QWidget* window = QApplication::activeModalWidget();
        shown = window ? window->objectName() : QString();
        if (auto* lines = qobject_cast<SelectDocItemWindow*>(window))
            rows = lines->documents().rowCount();
        if (window) qobject_cast<QDialog*>(window)->accept();
    });
    card.controller().click("Image7");
    EXPECT_EQ(shown, "frmSelectDocItem");
    EXPECT_EQ(rows, 1);
    QTimer::singleShot(0, [&] {
        auto* window = qobject_cast<EditRangesWindow*>(QApplication::activeModalWidget());
        rows = window ? window->grid().rowCount() : -1;
        if (window) window->accept();
    });
    card.controller().click("cmdRanges");
    EXPECT_EQ(rows, 7);
}

}  // namespace
}  // namespace etq::test
