#pragma once

#include <QDir>
#include <QStandardPaths>

#include "db/db_fixture.h"
#include "platform/browser.h"
#include "platform/context.h"
#include "platform/settings_store.h"
#include "print/label_definition.h"
#include "support/recording_messages.h"
#include "surface/memory_surface.h"

namespace etq::print::test {

// One item row of tItems.
struct Item {
    QString key;
    QString name;
    QVariant barcode;  // Null when the item has none
    double price = 10;
    int copies = 1;
    bool marked = true;
    QString coin = QStringLiteral("¦");
};

// Keeps the pages shown instead of opening a browser.
class RecordingViewer : public PageViewer {
  public:
    void showPage(const QString& path) override { shown.append(path); }
    QStringList shown;
};

// A database folder as a first run leaves it, with its working database, the headless surface
// with the label tab pointed at it, and a fresh settings store and label definition.
class PrintTest : public db::test::DbFolderTest {
  protected:
    void SetUp() override {
        QDir(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + "/Etiquon")
            .removeRecursively();
        context.setMessages(&messages);
        context.setPages(&viewer);
        DbFolderTest::SetUp();
        createWork(false);
        surface.control("txtDBPath").setText(dir.path());
        surface.control("txtCompanyName").setText("Corvan Information Systems");
        surface.control("OptOLE", 3).setValue(true);
        surface.control("OptPrinter", 0).setValue(true);  // ascending
        GetSetLabelDef(LoadLabelDef, context.applicationName, def);
    }

    void addItems(const QList<Item>& items) {
        jet::Database items_db = jet::Database::open(path(db::kItemDatabaseFile));
        jet::Recordset rs = items_db.openRecordset("tItems");
        for (const Item& item : items) {
            rs.addNew();
            rs.setValue("ItemKey", item.key);
            rs.setValue("ItemName", item.name);
            rs.setValue("BarCode", item.barcode);
            rs.setValue("Coin", item.coin);
            rs.setValue("Price", item.price);
            rs.setValue("Copies", item.copies);
            rs.setValue("PrintLabel", item.marked);
            rs.update();
        }
    }

    // Items "K01".."Knn" named "פריט n", one copy each, all marked.
    void addNumberedItems(int count, int copies = 1) {
        QList<Item> items;
        for (int i = 1; i <= count; ++i)
            items.append({QStringLiteral("K%1").arg(i, 2, 10, QLatin1Char('0')),
                          QStringLiteral("פריט %1").arg(i),
                          {},
                          10.0 + i,
                          copies});
        addItems(items);
    }

    QString workDb() const { return path(db::kWorkDatabaseFile); }

    MemorySurface surface;
    etq::test::RecordingMessages messages;
    RecordingViewer viewer;
    Context context;
    LabelDefinition& def = context.labelDefinition();  // the run's definition
};

}  // namespace etq::print::test
