// Grids bound to the local databases: the document type grid of tab 6, and the upgrade button
// on a real item database.
#include <gtest/gtest.h>

#include <QFile>
#include <QLabel>
#include <QPushButton>
#include <QTabWidget>
#include <QTableView>
#include <QTemporaryDir>

#include "card/main_card.h"
#include "card_test_support.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "dialogs/bound_grid_model.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "support/qt_print.h"

namespace etq {
namespace {

class DataGridTest : public ::testing::Test {
  protected:
    void SetUp() override {
        test::resetSettings();
        docDb = db::inFolder(dir.path(), db::kDocDatabaseFile);
        ASSERT_TRUE(QFile::copy(ETIQUON_DELIVERED_KDB, docDb));
        QFile::setPermissions(docDb, QFile::ReadOwner | QFile::WriteOwner);
    }
    QStringList scanFlags() {
        QStringList flags;
        jet::Database doc = jet::Database::open(docDb);
        for (jet::Recordset rs =
                 doc.openRecordset("SELECT Include FROM tDocTypes ORDER BY DocType");
             !rs.eof(); rs.moveNext())
            flags << (rs.value(0).toBool() ? "1" : "0");
        return flags;
    }
    QTemporaryDir dir;
    QString docDb;
    test::RecordingMessages sink;
    Context context;
};

TEST_F(DataGridTest, TicksInABoundGridReachTheTable) {
    BoundGridModel model;
    model.setDatabaseName(docDb);
    model.setRecordSource("qSelectDocTypes");
    model.refresh();
    ASSERT_EQ(model.rowCount(), 7);
    ASSERT_EQ(model.columnCount(), 3);
    EXPECT_EQ(model.data(model.index(0, 0), Qt::DisplayRole).toString(), "תעודת משלוח");
    EXPECT_EQ(model.data(model.index(0, 1), Qt::CheckStateRole), Qt::Checked);
    EXPECT_TRUE(model.flags(model.index(2, 1)) & Qt::ItemIsUserCheckable);
    EXPECT_TRUE(model.setData(model.index(2, 1), Qt::Checked, Qt::CheckStateRole));
    EXPECT_TRUE(model.setData(model.index(0, 2), Qt::Checked, Qt::CheckStateRole));
    EXPECT_EQ(scanFlags(), QStringList({"1", "1", "1", "0", "0", "0", "0"}));

    // A text the field cannot hold is refused and the reason kept for the window.
    EXPECT_FALSE(model.setData(model.index(0, 0), QString(51, u'x'), Qt::EditRole));
    EXPECT_FALSE(model.lastError().isEmpty());
    // A new record source shows its own rows.
    model.setRecordSource("SELECT DocDesc FROM tDocTypes WHERE Include");
    model.refresh();
    EXPECT_EQ(model.rowCount(), 3);
    model.setRecordSource("tNothing");
    EXPECT_THROW(model.refresh(), jet::JetError);
    EXPECT_EQ(model.rowCount(), 0);
}

TEST_F(DataGridTest, TabSixShowsTheDocumentTypesAndItsButtonsTickThemAll) {
    context.setMessages(&sink);
    MainCard card(context);
    card.control("txtDBPath").setText(dir.path());
    card.mainTab()->setCurrentIndex(6);
    auto* view = card.findChild<QTableView*>("VSDocTypes");
    ASSERT_TRUE(view && view->model());
    const QAbstractItemModel* model = view->model();
    ASSERT_EQ(model->rowCount(), 7);
    EXPECT_EQ(model->headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(), GetCaption(7, 0));
    EXPECT_EQ(model->headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(), GetCaption(27, 0));
    EXPECT_EQ(model->headerData(2, Qt::Horizontal, Qt::DisplayRole).toString(), GetCaption(28, 0));
    card.findChild<QPushButton*>("cmdAllDocTypes")->click();
    EXPECT_EQ(scanFlags(), QStringList(7, "1"));
    card.findChild<QPushButton*>("cmdNoDocTypes")->click();
    EXPECT_EQ(scanFlags(), QStringList(7, "0"));
}

TEST_F(DataGridTest, TheUpgradeButtonAddsTheAccountTablesOnce) {
    const QString itemDb = db::inFolder(dir.path(), db::kItemDatabaseFile);
    db::CreateItemDatabase(itemDb);  // a file of the older release
    context.setMessages(&sink);
    MainCard card(context);
    card.control("txtDBPath").setText(dir.path());
    card.findChild<QPushButton*>("cmdUpgrade")->click();
    EXPECT_EQ(card.control("Message1").caption(), "Upgrade successfull");
    EXPECT_TRUE(jet::Database::open(itemDb).hasTable("tPriceList"));
    card.findChild<QPushButton*>("cmdUpgrade")->click();
    EXPECT_EQ(card.control("Message1").caption(), "Upgrade failed");
    ASSERT_FALSE(sink.shown.empty());
    EXPECT_EQ(sink.shown.back().text, "Table 'tAccountDef' already exists.");
}

}  // namespace
}  // namespace etq
