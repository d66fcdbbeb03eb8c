#pragma once

#include <QList>
#include <QString>
#include <QVariant>
#include <utility>

#include "dialogs/editor_queries.h"
#include "platform/list_entry.h"

namespace etq {

class BoundGridModel;
struct ConnParams;

// What the item, alternate key and account editors do with their grids, without the windows:
// each grid is bound to a record source of the item database, and every change goes straight
// into its table. The windows and the command line both use these. Columns are counted as the
// windows count them, from 1 (column 0 being the fixed column). The engine's refusals come out
// as jet::JetError; the caller decides whether the user hears of them.
class EditorGrid {
  public:
    explicit EditorGrid(BoundGridModel& grid) : grid_(grid) {}

    // The item database of the folder becomes the grid's database.
    void setDatabaseFolder(const QString& folder);
    // Binds the grid to the record source and shows its rows.
    void show(const QString& recordSource);

    BoundGridModel& grid() { return grid_; }
    int rowCount() const;
    QVariant value(int row, int column) const;
    void write(int row, int column, const QVariant& value);

    // Adds a record with the values given by column and saves it; the grid shows it after its
    // other rows.
    void addRecord(const QList<std::pair<int, QVariant>>& values);
    // Deletes the row's record from its table and from the grid.
    void deleteRow(int row);

  private:
    BoundGridModel& grid_;
};

// frmEditItems: ItemKey, ItemName, Unit, BarCode, Price of tItems.
class ItemEditor : public EditorGrid {
  public:
    static constexpr int kHeaderCaptions[] = {14, 15, 20, 21, 22};
    using EditorGrid::EditorGrid;
    using EditorGrid::show;
    void show(const ItemsFilter& filter) { show(BuildEditItemsQuery(filter)); }
};

// frmAlterItems: AccountKey, ItemKey, AlterNum, AlterBar of tAlterKeys.
class AlterKeyEditor : public EditorGrid {
  public:
    static constexpr int kHeaderCaptions[] = {10, 14, 23, 24};
    static constexpr int kAlterBarColumn = 4;
    using EditorGrid::EditorGrid;
    using EditorGrid::show;
    void show(const AlterKeysFilter& filter) { show(BuildAlterKeysQuery(filter)); }

    // Hides every row and adds one whose account, item and alternate key are "?", to be
    // overtyped. A second such row breaks the table's key and fails.
    void addRow();
    // Puts the barcode into the AlterBar cell of each of the rows; an empty barcode changes
    // nothing. A refused write throws after the rows before it were written.
    void setAltBar(const QList<int>& rows, const QString& barcode);
};

// frmAccDef: AccountKey, PriceList, LabelName of tAccountDef, with the host's price lists as the
// drop-down of the price list column.
class AccountDefEditor : public EditorGrid {
  public:
    static constexpr int kHeaderCaptions[] = {10, 25, 26};
    static constexpr int kColumnWidths[] = {2000, 2000, 3000};  // twips, as the grid is laid out
    static constexpr int kPriceListColumn = 2;
    static constexpr int kLabelColumn = 3;
    using EditorGrid::EditorGrid;
    using EditorGrid::show;
    void show() { show(BuildAccountDefQuery()); }

    // Adds the account "00000000" with the default label file, to be overtyped.
    void addRow();

    // Reads the host's price lists from the SQL Server source into the price list column's
    // drop-down: one entry per list with a name, showing the name and storing the number. A
    // source without lists, or one that fails, leaves the drop-down as it was; the failure is
    // logged.
    void FillPriceListColumn(const ConnParams& params);
    const EntryList& priceLists() const { return priceLists_; }

  private:
    EntryList priceLists_;
};

}  // namespace etq
