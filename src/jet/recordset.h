#pragma once

#include <QString>
#include <QVariant>
#include <memory>

#include "jet/types.h"

namespace etq::jet {

class Database;

// The rows of a table, a saved query or a SELECT, walked and edited one at a time, as the
// engine's dynasets are: BOF/EOF, MoveFirst/MoveLast/MoveNext, FindFirst with NoMatch, and
// AddNew/Edit/Update/Delete that write straight to the base tables (also through a join).
//
// A table recordset reads rows on demand and finds by criterion through the table's indexes;
// a query recordset reads its rows when it opens. Values come as the field types give them:
// Yes/No as bool, dates as QDateTime, whole numbers as int, Null as a null QVariant.
class Recordset {
  public:
    Recordset();
    ~Recordset();
    Recordset(Recordset&&) noexcept;
    Recordset& operator=(Recordset&&) noexcept;

    bool isOpen() const;
    void close();
    // Reads the rows again and moves to the first.
    void requery();

    // Position ------------------------------------------------------------------------------
    bool bof() const;
    bool eof() const;
    int recordCount() const;
    int absolutePosition() const;  // 0-based; -1 before the first or after the last
    void setAbsolutePosition(int position);
    void moveFirst();  // 3021 when there are no rows
    void moveLast();   // 3021 when there are no rows
    void moveNext();
    void movePrevious();

    // Finds the first (next) row that meets a criterion in the engine's dialect
    // (ItemKey="123", CURRENCY='$'). Without a match NoMatch is set and the position stays.
    void findFirst(const QString& criterion);
    void findNext(const QString& criterion);
    bool noMatch() const;

    // Fields --------------------------------------------------------------------------------
    int fieldCount() const;
    QString fieldName(int index) const;
    int fieldIndex(const QString& name) const;  // -1 when the recordset has no such field
    // The field's definition in its base table, or nullptr for a computed column.
    const FieldDef* fieldDef(int index) const;
    bool isUpdatable(int index) const;

    QVariant value(int index) const;
    QVariant value(const QString& name) const;  // 3265 for an unknown name
    void setValue(int index, const QVariant& value);
    void setValue(const QString& name, const QVariant& value);

    // Editing -------------------------------------------------------------------------------
    enum EditMode { NoEdit, Editing, Adding };
    void addNew();
    void edit();
    void update();  // writes the pending row; on failure the edit stays pending
    void cancelUpdate();
    void deleteRecord();
    EditMode editMode() const;

    struct Impl;  // the engine's inside (recordset_impl.h)

  private:
    friend class Database;
    explicit Recordset(std::unique_ptr<Impl> impl);
    Impl& impl() const;
    std::unique_ptr<Impl> d_;
};

}  // namespace etq::jet
