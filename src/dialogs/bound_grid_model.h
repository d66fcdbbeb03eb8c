#pragma once

#include <QAbstractTableModel>
#include <QHash>
#include <QString>
#include <memory>

#include "jet/database.h"
#include "jet/recordset.h"

namespace etq {

// A data control and the grid bound to it: a table, saved query or SELECT of a database file,
// shown row by row, with every edit and every tick written straight through to the base table
// (also through a joined query). Yes/No columns show as check boxes.
//
// Grids of the component count their columns from 1, column 0 being the fixed column; here the
// fixed column is the row header, so grid column n is model column n - 1.
class BoundGridModel : public QAbstractTableModel {
  public:
    explicit BoundGridModel(QObject* parent = nullptr);
    ~BoundGridModel() override;

    // The data control's database and record source; refresh() reads them.
    void setDatabaseName(const QString& path) { databaseName_ = path; }
    void setRecordSource(const QString& source) { recordSource_ = source; }
    const QString& databaseName() const { return databaseName_; }
    const QString& recordSource() const { return recordSource_; }

    // Opens the database and the record source again and shows their rows. Throws JetError
    // when either cannot be opened; the grid is then empty.
    void refresh();
    void close();

    // The recordset behind the grid (open after a successful refresh).
    jet::Recordset& recordset() { return recordset_; }
    bool isOpen() const { return recordset_.isOpen(); }

    // Writes one cell through to its base table. Throws JetError when the engine refuses.
    void writeCell(int row, int column, const QVariant& value);
    QVariant cell(int row, int column) const;
    // Re-reads the rows after rows were added or deleted through the recordset.
    void reload();
    // Shows the recordset's rows as they stand after rows were added or deleted through it,
    // without reading them again (a row added to a source that selects none stays shown).
    void showRows();

    // Column look, as the dialogs set it.
    void setHeader(int column, const QString& text);
    void setAlignment(int column, Qt::Alignment alignment);
    // The alignment the component's grids give a code: 7 right-centred, 1 left-centred,
    // 4 centred; right and left as the eye sees them, also in a right-to-left grid.
    static Qt::Alignment alignmentOfCode(int code);

    // The last write the engine refused, for the window to show.
    const QString& lastError() const { return lastError_; }

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role) override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

  private:
    bool isCheckColumn(int column) const;

    QString databaseName_;
    QString recordSource_;
    jet::Database database_;
    jet::Recordset recordset_;
    QHash<int, QString> headers_;
    QHash<int, Qt::Alignment> alignments_;
    QString lastError_;
};

}  // namespace etq
