#pragma once

#include <QString>

namespace etq {

class BoundGridModel;

// What the item selection window does with its grid, without the window: the items of the
// item database listed through a bound grid (ItemKey, PrintLabel, Copies, ItemName), every tick
// and every copies value written straight to tItems. The window's buttons and the command line
// both call it.
class ItemSelection {
  public:
    // Grid columns as the window counts them (column 0 is the fixed column).
    static constexpr int kKeyColumn = 1;
    static constexpr int kMarkColumn = 2;
    static constexpr int kCopiesColumn = 3;
    static constexpr int kNameColumn = 4;

    // `rangeFilter` narrows the items listed (ItemKeyRangeCondition of the label tab's range).
    ItemSelection(BoundGridModel& grid, QString rangeFilter);

    // Lists the items of the item database in the database folder. Throws jet::JetError when
    // it cannot be opened.
    void open(const QString& databaseFolder, qint16 sortBy, qint16 sortOrder);
    // Lists the marked items only, or all, with the sort given; throws like open().
    void show(bool markedOnly, qint16 sortBy, qint16 sortOrder);

    int rowCount() const;
    // Ticks (true) or clears the print flag of every row listed.
    void markAll(bool mark);
    // Puts the whole number in `copies` into every ticked row. An empty or non-numeric text
    // changes nothing.
    void setCopies(const QString& copies);
    // The first row from the top whose key begins with `key` (case ignored), ticked; -1 when
    // none or `key` is empty.
    int findByKey(const QString& key);
    // The first row after `currentRow` whose name begins with `name` (case ignored), searching
    // again from the top when none follows; -1 when none or `name` is empty. Not ticked.
    int findByName(const QString& name, int currentRow) const;

    // The engine's word on the last write it refused; the loops go on past such a row.
    const QString& lastError() const { return lastError_; }

  private:
    static int modelColumn(int gridColumn) { return gridColumn - 1; }
    QString text(int row, int gridColumn) const;
    void write(int row, int gridColumn, const QVariant& value);
    int findFrom(int gridColumn, const QString& start, int fromRow) const;

    BoundGridModel& grid_;
    QString rangeFilter_;
    QString lastError_;
};

}  // namespace etq
