// The item, alternate key and account editor windows on a real item database.
#include <QApplication>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPrinter>
#include <QPushButton>
#include <QStyledItemDelegate>
#include <QTableView>
#include <QToolButton>

#include "db/db_fixture.h"
#include "dialogs/acc_def_window.h"
#include "dialogs/alter_items_window.h"
#include "dialogs/bound_grid_model.h"
#include "dialogs/edit_items_window.h"
#include "platform/captions.h"
#include "platform/context.h"
#include "platform/file_chooser.h"
#include "platform/settings_store.h"
#include "print/label_software.h"
#include "support/log_capture.h"
#include "support/process_run.h"
#include "support/recording_messages.h"
#include "support/sql_source_file.h"
#include "support/test_env.h"

namespace etq::dialogs::test {
namespace {

using etq::test::RecordingMessages;

// The file dialog answered with one file; remembers the filter it was shown.
class OneFileChooser : public FileChooser {
  public:
    QString chooseFile(const QString& filter, int filterIndex) override {
        shownFilter = filter;
        shownIndex = filterIndex;
        return file;
    }
    QString file;
    QString shownFilter;
    int shownIndex = 0;
};

class EditorWindowsTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        DbFolderTest::SetUp();
        etq::test::resetSettings();
        context.setMessages(&messages);
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Unit, BarCode, Price) VALUES ('100', 'סבון 12', 'יח', '7290100', 5), ('200', 'מברשת', 'יח', '7290200', 12), ('300', 'ספוג 112', 'קג', '7290300', 3)");
        items.execute(
            "INSERT INTO tAlterKeys (AccountKey, ItemKey, AlterNum, AlterBar) VALUES ('C1', '100', 'A-100', Null), ('C1', '200', 'A-200', Null), ('C2', '100', 'B-100', Null), ('C2', '300', 'B-300', Null)");
    }
    static void click(QWidget& window, const QString& name) {
        auto* button = window.findChild<QPushButton*>(name);
        ASSERT_TRUE(button) << name.toStdString();
        button->click();
    }
    static void type(QWidget& window, const QString& name, const QString& text) {
        window.findChild<QLineEdit*>(name)->setText(text);
    }
    static void choose(QWidget& window, const QString& name, int index) {
        window.findChild<QComboBox*>(name)->setCurrentIndex(index);
    }
    static QStringList column(EditorWindow& window, int column) {
        QStringList out;
        for (int row = 0; row < window.grid().rowCount(); ++row)
            out << window.grid().index(row, column - 1).data().toString();
        return out;
    }
    QStringList stored(const QString& sql) {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        return rows(items, sql);
    }
    void storeSetting(const QString& section, const QString& key, const QString& value) {
        SettingsStore store(context.applicationName);
        store.write(section, key, value);
    }

    Context context;
    RecordingMessages messages{MsgAnswer::No};
};

TEST_F(EditorWindowsTest, ItemEditorSearchesSortsAndWritesThrough) {
    storeSetting("EditItems", "ItmSearchBy", "1");
    storeSetting("EditItems", "ItmSortOrder", "1");
    EditItemsWindow window(context, dir.path());
    EXPECT_EQ(window.windowTitle(), "עריכת פריטים");
    EXPECT_EQ(window.grid().recordSource(), "qEditItems");
    EXPECT_EQ(column(window, 1), QStringList({"100", "200", "300"}));
    EXPECT_EQ(window.grid().headerData(4, Qt::Horizontal, Qt::DisplayRole).toString(),
              GetCaption(22, 0));
    // The stored group chose the name column and the descending order.
    EXPECT_EQ(window.findChild<QComboBox*>("cmbItmSearchBy")->currentIndex(), 1);
    EXPECT_EQ(window.findChild<QComboBox*>("cmbItmSortBy")->currentIndex(), 0);

    type(window, "txtItmSearchValue", "12");
    click(window, "cmdShowItems");
    EXPECT_EQ(column(window, 1), QStringList({"300", "100"}));
    type(window, "txtItmSearchValue", "");
    choose(window, "cmbItmSortBy", 2);
    choose(window, "cmbItmSortOrder", 0);
    click(window, "cmdShowItems");
    EXPECT_EQ(column(window, 4), QStringList({"7290100", "7290200", "7290300"}));

    QAbstractItemModel& model = window.grid();
    EXPECT_TRUE(model.setData(model.index(1, 1), "מברשת שיניים", Qt::EditRole));
    EXPECT_TRUE(model.setData(model.index(1, 4), 13.5, Qt::EditRole));
    EXPECT_EQ(stored("SELECT ItemName, Price FROM tItems WHERE ItemKey = '200'"),
              QStringList{"מברשת שיניים|13.5"});
}

TEST_F(EditorWindowsTest, AlterKeyWindowFiltersAddsDeletesAndSetsBarcodes) {
    AlterItemsWindow window(context, dir.path());
    EXPECT_EQ(window.windowTitle(), "פריטים חלופיים");
    EXPECT_EQ(column(window, 3), QStringList({"A-100", "A-200", "B-100", "B-300"}));
    // The group's defaults: account in the first filter row, item in the second.
    EXPECT_EQ(window.findChild<QComboBox*>("cmbAltSearchBy(0)")->currentIndex(), 0);
    EXPECT_EQ(window.findChild<QComboBox*>("cmbAltSearchBy(1)")->currentIndex(), 1);

    type(window, "txtAltSearchValue(0)", "C2");
    click(window, "CmdShowAlterKeys");
    EXPECT_EQ(column(window, 3), QStringList({"B-100", "B-300"}));
    type(window, "txtAltSearchValue(1)", "100");
    click(window, "CmdShowAlterKeys");
    EXPECT_EQ(column(window, 3), QStringList{"B-100"});
    type(window, "txtAltSearchValue(0)", "");
    type(window, "txtAltSearchValue(1)", "");
    choose(window, "cmbAltSortBy", 2);
    choose(window, "cmbAltSortOrder", 1);
    click(window, "CmdShowAlterKeys");
    EXPECT_EQ(column(window, 3), QStringList({"B-300", "B-100", "A-200", "A-100"}));

    // The alternate barcode goes into the two selected rows only; an empty one changes nothing.
    QTableView* view = window.view();
    const auto rows = QItemSelectionModel::Rows;
    view->selectionModel()->select(window.grid().index(0, 0),
                                   QItemSelectionModel::ClearAndSelect | rows);
    view->selectionModel()->select(window.grid().index(2, 0), QItemSelectionModel::Select | rows);
    click(window, "cmdSetAltBar");
    type(window, "txtAltBarCode", "7299999");
    click(window, "cmdSetAltBar");
    EXPECT_EQ(stored("SELECT AlterNum, AlterBar FROM tAlterKeys ORDER BY AlterNum"),
              QStringList({"A-100|Null", "A-200|7299999", "B-100|Null", "B-300|7299999"}));

    // Delete asks; No keeps the row, Yes deletes the current one.
    view->setCurrentIndex(window.grid().index(1, 0));
    click(window, "DelAccountDef");
    ASSERT_EQ(messages.shown.size(), 1);
    EXPECT_EQ(messages.shown[0].text, GetCaption(41, 0));
    EXPECT_EQ(messages.shown[0].title, GetCaption(30, 0));
    EXPECT_EQ(messages.shown[0].buttons, MsgButtons::YesNo);
    EXPECT_EQ(messages.shown[0].icon, MsgIcon::Question);
    EXPECT_EQ(stored("SELECT Count(*) FROM tAlterKeys"), QStringList{"4"});
    RecordingMessages yes(MsgAnswer::Yes);
    context.setMessages(&yes);
    click(window, "DelAccountDef");
    EXPECT_EQ(column(window, 3), QStringList({"B-300", "A-200", "A-100"}));
    EXPECT_EQ(stored("SELECT Count(*) FROM tAlterKeys WHERE AlterNum = 'B-100'"), QStringList{"0"});

    // A new row hides the others until the next show; a second one fails without a word.
    click(window, "cmdAddAccount");
    EXPECT_EQ(column(window, 1), QStringList{"?"});
    etq::test::LogCapture log;
    click(window, "cmdAddAccount");
    EXPECT_EQ(window.grid().rowCount(), 0);
    EXPECT_TRUE(log.contains("frmAlterItems"));
    EXPECT_EQ(yes.shown.size(), 1);
    click(window, "CmdShowAlterKeys");
    EXPECT_EQ(window.grid().rowCount(), 4);
}

TEST_F(EditorWindowsTest, AlterKeyGridPrintsToPdf) {
    AlterItemsWindow window(context, dir.path());
    const QString pdf = dir.filePath("alternate.pdf");
    QPrinter printer(QPrinter::HighResolution);
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(pdf);
    window.printTo(printer);
    const auto info = etq::test::runProcess("pdfinfo", {pdf});
    ASSERT_EQ(info.exitCode, 0) << info.err.toStdString();
    EXPECT_TRUE(info.out.contains(QRegularExpression("Title: +Alternate items\n")));
    const auto text = etq::test::runProcess("pdftotext", {pdf, "-"});
    for (const char* value : {"A-100", "A-200", "B-100", "B-300", "C1", "C2"})
        EXPECT_TRUE(text.out.contains(value)) << value;
}

TEST_F(EditorWindowsTest, AccountWindowOffersPriceListsAndLabelFiles) {
    const QString source = dir.filePath("host.db");
    etq::test::writeSqlSourceFile(source);
    context.connection = etq::test::sqlSourceParams(source);
    OneFileChooser chooser;
    AccDefWindow window(context, dir.path(), kBarTender, chooser);
    window.show();
    EXPECT_EQ(window.windowTitle(), "הגדרות לקוח/ספק");
    EXPECT_EQ(window.grid().recordSource(),
              "Select AccountKey,PriceList,LabelName From tAccountDef");
    EXPECT_EQ(window.grid().headerData(2, Qt::Horizontal, Qt::DisplayRole).toString(),
              GetCaption(26, 0));
    EXPECT_EQ(window.view()->columnWidth(2), 200);

    click(window, "cmdAddAccount");
    ASSERT_EQ(window.grid().rowCount(), 1);
    EXPECT_EQ(column(window, 1), QStringList{"00000000"});

    // Column 2: an empty entry, then the named lists; the cell keeps the number, shows the name.
    QTableView* view = window.view();
    const QModelIndex priceList = window.grid().index(0, 1);
    view->edit(priceList);
    auto* combo = view->findChild<QComboBox*>("PriceListCombo");
    ASSERT_TRUE(combo);
    EXPECT_EQ(combo->count(), 3);
    EXPECT_EQ(combo->itemText(0), "");
    EXPECT_EQ(combo->itemText(2), "סיטונאי");
    combo->setCurrentIndex(2);
    auto* delegate = static_cast<QStyledItemDelegate*>(view->itemDelegateForColumn(1));
    Q_EMIT delegate->commitData(combo);
    Q_EMIT delegate->closeEditor(combo);
    EXPECT_EQ(delegate->displayText(priceList.data(Qt::EditRole), QLocale()), "סיטונאי");

    // Column 3: "..." chooses a file of the kind's filter; a cancelled choice changes nothing.
    const QModelIndex label = window.grid().index(0, 2);
    view->edit(label);
    auto* ellipsis = view->findChild<QToolButton*>("LabelNameEllipsis");
    ASSERT_TRUE(ellipsis);
    ellipsis->click();
    EXPECT_EQ(chooser.shownFilter, toQtFilter(labelFileFilter(kBarTender)));
    EXPECT_EQ(chooser.shownIndex, 2);
    chooser.file = "/labels/shelf.btw";
    ellipsis->click();
    EXPECT_EQ(stored("SELECT AccountKey, PriceList, LabelName FROM tAccountDef"),
              QStringList{"00000000|4|/labels/shelf.btw"});

    RecordingMessages yes(MsgAnswer::Yes);
    context.setMessages(&yes);
    click(window, "DelAccountDef");
    EXPECT_EQ(stored("SELECT Count(*) FROM tAccountDef"), QStringList{"0"});
}

TEST_F(EditorWindowsTest, AccountWindowWithoutTheSourceLogsAndKeepsPlainCells) {
    ConnParams wrongDriver;
    wrongDriver.driver = "No Such Driver";
    ConnParams unreachable;  // FreeTDS, and nothing listens on port 1
    unreachable.server = "127.0.0.1,1";
    for (const auto& [params, said] :
         {std::pair{wrongDriver, "No Such Driver"}, {unreachable, "08001"}}) {
        context.connection = params;
        etq::test::LogCapture log;
        OneFileChooser chooser;
        AccDefWindow window(context, dir.path(), kNiceLabel, chooser);
        EXPECT_TRUE(window.editor().priceLists().isEmpty());
        EXPECT_TRUE(log.contains("price lists from the SQL Server source")) << said;
        EXPECT_TRUE(log.contains(said)) << said;
    }
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(EditorWindowsTest, EnglishWindowsTakeTheirEnglishTexts) {
    context.language = 1;
    EditItemsWindow items(context, dir.path());
    EXPECT_EQ(items.windowTitle(), "Edit items");
    EXPECT_EQ(items.layoutDirection(), Qt::LeftToRight);
    EXPECT_EQ(items.findChild<QComboBox*>("cmbItmSearchBy")->itemText(2), "Bar-code");
    EXPECT_EQ(items.findChild<QComboBox*>("cmbItmSortBy")->currentIndex(), 0);
    EXPECT_EQ(items.findChild<QPushButton*>("cmdClose")->text(), "Close");
    EXPECT_EQ(items.grid().headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(), "Item Code");

    AlterItemsWindow alter(context, dir.path());
    EXPECT_EQ(alter.windowTitle(), "Alternate items");
    EXPECT_EQ(alter.findChild<QComboBox*>("cmbAltSearchBy(1)")->currentText(), "Item code");
    EXPECT_EQ(alter.findChild<QComboBox*>("cmbAltSortOrder")->itemText(1), "Down");

    OneFileChooser chooser;
    AccDefWindow accounts(context, dir.path(), kCodeSoft, chooser);
    EXPECT_EQ(accounts.windowTitle(), "Customer/Supplier definitions");
    EXPECT_EQ(accounts.grid().headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(),
              "Price List");
}

}  // namespace
}  // namespace etq::dialogs::test
