#include "jet/recordset.h"

#include <algorithm>
#include <set>

#include "jet/recordset_impl.h"
#include "jet/sql_translator.h"

namespace etq::jet {

using detail::Connection;
using detail::Stmt;
using sql::quoteName;

namespace {

[[noreturn]] void noCurrentRecord() {
    fail(err::kNoCurrentRecord, "No current record.");
}

QString columnList(const QList<Recordset::Impl::Column>& columns) {
    QStringList names;
    for (const auto& c : columns)
        names << quoteName(c.name);
    return names.join(", ");
}

}  // namespace

// ---------------------------------------------------------------------------------------------
// Opening

std::unique_ptr<Recordset::Impl> Recordset::Impl::forTable(std::shared_ptr<Connection> conn,
                                                           const TableDef& table) {
    auto d = std::make_unique<Impl>();
    d->conn = std::move(conn);
    d->tableMode = true;
    d->bases.append({table.name, table.name});
    for (const FieldDef& f : table.fields)
        d->columns.append({f.name, f, 0, f.name});
    d->selectRowSql = QString("SELECT %1 FROM %2 WHERE rowid = ?1")
                          .arg(columnList(d->columns), quoteName(table.name));
    d->load();
    return d;
}

std::unique_ptr<Recordset::Impl> Recordset::Impl::forQuery(std::shared_ptr<Connection> conn,
                                                           const QString& jetSql) {
    auto d = std::make_unique<Impl>();
    d->conn = std::move(conn);
    d->sourceSql = jetSql;
    sql::Options options;
    options.addRowids = true;
    const sql::Translation t = sql::translate(jetSql, options);
    if (t.kind != sql::Translation::Select)
        fail(err::kInvalidArgument, "Only a select statement opens as a recordset.");
    d->translatedSql = t.sql;
    d->rowidTables = t.rowidTables;
    for (const sql::SourceTable& s : t.rowidTables)
        d->bases.append({s.name, s.name});
    d->load();
    return d;
}

void Recordset::Impl::load() {
    pos = -1;
    currentDeleted = false;
    cachedKey = -1;
    mode = NoEdit;
    if (tableMode) {
        keys.clear();
        Stmt s = conn->prepare(
            QString("SELECT rowid FROM %1 ORDER BY rowid").arg(quoteName(bases[0].table)), false);
        while (s.step())
            keys.push_back(sqlite3_column_int64(s.get(), 0));
    } else {
        rows.clear();
        Stmt s = conn->prepare(translatedSql, false);
        const int total = s.columnCount();
        const int visible = total - int(rowidTables.size());
        if (columns.isEmpty()) {
            for (int i = 0; i < visible; ++i) {
                Column c;
                c.name = QString::fromUtf8(sqlite3_column_name(s.get(), i));
                const char* table = sqlite3_column_table_name(s.get(), i);
                const char* origin = sqlite3_column_origin_name(s.get(), i);
                if (table && origin) {
                    const QString tableName = QString::fromUtf8(table);
                    int match = -1, matches = 0;
                    for (int b = 0; b < bases.size(); ++b) {
                        if (bases[b].table.compare(tableName, Qt::CaseInsensitive) == 0) {
                            match = b;
                            ++matches;
                        }
                    }
                    c.baseColumn = QString::fromUtf8(origin);
                    if (const TableDef* def = conn->findTableDef(tableName))
                        if (const FieldDef* f = def->field(c.baseColumn)) c.def = *f;
                    // A table joined twice leaves its columns read-only: which row is meant?
                    if (matches == 1 && c.def) c.base = match;
                }
                columns.append(c);
            }
        }
        while (s.step()) {
            Row row;
            row.values.reserve(visible);
            for (int i = 0; i < visible; ++i)
                row.values.append(s.column(i));
            for (int i = visible; i < total; ++i)
                row.rowids.append(sqlite3_column_type(s.get(), i) == SQLITE_NULL
                                      ? -1
                                      : sqlite3_column_int64(s.get(), i));
            rows.push_back(std::move(row));
        }
    }
    if (columnByName.isEmpty()) {
        for (int i = 0; i < columns.size(); ++i) {
            const QString key = columns[i].name.toLower();
            if (!columnByName.contains(key)) columnByName.insert(key, i);
            if (!columnByExactName.contains(columns[i].name))
                columnByExactName.insert(columns[i].name, i);
        }
    }
    buffer = QVector<QVariant>(columns.size());
    changed.assign(size_t(columns.size()), false);
    if (count() > 0) pos = 0;
}

// ---------------------------------------------------------------------------------------------
// Rows

void Recordset::Impl::requireRow() const {
    if (currentDeleted) fail(err::kRecordDeleted, "Record is deleted.");
    if (!onRow()) noCurrentRecord();
}

const QVector<QVariant>& Recordset::Impl::currentStored() const {
    requireRow();
    if (!tableMode) return rows[size_t(pos)].values;
    const qint64 key = keys[size_t(pos)];
    if (cachedKey != key) {
        Stmt s = conn->prepare(selectRowSql);
        s.bind(1, key);
        if (!s.step()) fail(err::kRecordDeleted, "Record is deleted.");
        cachedRow.resize(columns.size());
        for (int i = 0; i < columns.size(); ++i)
            cachedRow[i] = s.column(i);
        cachedKey = key;
    }
    return cachedRow;
}

qint64 Recordset::Impl::rowidOf(int row, int base) const {
    if (tableMode) return keys[size_t(row)];
    const Row& r = rows[size_t(row)];
    return base < r.rowids.size() ? r.rowids[base] : -1;
}

int Recordset::Impl::columnIndex(const QString& name) const {
    if (const auto it = columnByExactName.constFind(name); it != columnByExactName.constEnd())
        return it.value();
    const QString lower = name.toLower();
    if (const auto it = columnByName.constFind(lower); it != columnByName.constEnd())
        return it.value();
    // "table.field" names the field of that table.
    const qsizetype dot = lower.lastIndexOf(u'.');
    if (dot >= 0) {
        const QString table = lower.left(dot);
        const QString field = lower.mid(dot + 1);
        for (int i = 0; i < columns.size(); ++i) {
            const Column& c = columns[i];
            if (c.base >= 0 && c.baseColumn.toLower() == field &&
                bases[c.base].table.toLower() == table)
                return i;
        }
        if (const auto it = columnByName.constFind(field); it != columnByName.constEnd())
            return it.value();
    }
    return -1;
}

void Recordset::Impl::leaveEdit() {
    mode = NoEdit;
    std::fill(changed.begin(), changed.end(), false);
}

// ---------------------------------------------------------------------------------------------
// Writing

quint64 Recordset::Impl::changedMask() const {
    quint64 mask = 0;
    for (int i = 0; i < columns.size() && i < 64; ++i)
        if (changed[size_t(i)]) mask |= quint64(1) << i;
    return mask;
}

// The changed columns of one base table, in column order: ?1.. are their values, the last
// parameter the row's rowid.
QString Recordset::Impl::buildUpdateSql(int base) const {
    QStringList sets;
    for (int i = 0; i < columns.size(); ++i) {
        if (!changed[size_t(i)] || columns[i].base != base) continue;
        sets << QString("%1 = ?%2").arg(quoteName(columns[i].baseColumn)).arg(sets.size() + 1);
    }
    return QString("UPDATE %1 SET %2 WHERE rowid = ?%3")
        .arg(quoteName(bases[base].table), sets.join(", "))
        .arg(sets.size() + 1);
}

QString Recordset::Impl::buildInsertSql(int base) const {
    QStringList names, marks;
    for (int i = 0; i < columns.size(); ++i) {
        if (!changed[size_t(i)] || columns[i].base != base) continue;
        names << quoteName(columns[i].baseColumn);
        marks << QString("?%1").arg(marks.size() + 1);
    }
    const QString table = quoteName(bases[base].table);
    if (names.isEmpty()) return QString("INSERT INTO %1 DEFAULT VALUES").arg(table);
    return QString("INSERT INTO %1 (%2) VALUES (%3)")
        .arg(table, names.join(", "), marks.join(", "));
}

QString Recordset::Impl::writeSql(QHash<quint64, QString>& kept, bool keep, int base,
                                  QString (Impl::*build)(int) const) const {
    if (!keep || columns.size() > 64) return (this->*build)(base);
    const quint64 mask = changedMask();
    auto it = kept.find(mask);
    if (it == kept.end()) it = kept.insert(mask, (this->*build)(base));
    return it.value();
}

int Recordset::Impl::bindChanged(Stmt& statement, int base) const {
    int k = 0;
    for (int i = 0; i < columns.size(); ++i)
        if (changed[size_t(i)] && columns[i].base == base) statement.bind(++k, buffer[i]);
    return k;
}

void Recordset::Impl::writeEdit() {
    std::set<int> touched;
    for (int i = 0; i < columns.size(); ++i)
        if (changed[size_t(i)]) touched.insert(columns[i].base);
    for (const int b : touched) {
        const qint64 rowid = rowidOf(pos, b);
        if (rowid < 0)
            fail(
                err::kFieldNotUpdatable,
                QString("Field can't be updated: the row of '%1' is missing.").arg(bases[b].table));
        // A table recordset has one base, so the changed columns tell its statement.
        Stmt s = conn->prepare(writeSql(updateSql, tableMode, b, &Impl::buildUpdateSql));
        s.bind(bindChanged(s, b) + 1, rowid);
        s.step();
    }
    if (tableMode) {
        cachedKey = -1;
    } else {
        Row& row = rows[size_t(pos)];
        for (int i = 0; i < columns.size(); ++i)
            if (changed[size_t(i)]) row.values[i] = buffer[i];
    }
}

void Recordset::Impl::writeNew() {
    std::set<int> touched;
    for (int i = 0; i < columns.size(); ++i)
        if (changed[size_t(i)]) touched.insert(columns[i].base);
    if (touched.empty() && bases.size() == 1) touched.insert(0);
    if (touched.size() != 1)
        fail(err::kReadOnly, "Cannot add the record: its fields belong to more than one table.");
    const int b = *touched.begin();
    Stmt s = conn->prepare(writeSql(insertSql, true, b, &Impl::buildInsertSql));
    bindChanged(s, b);
    s.step();
    const qint64 rowid = sqlite3_last_insert_rowid(conn->db());
    // The new row joins the end of the recordset; the current row stays current.
    if (tableMode) {
        const auto at = std::upper_bound(keys.begin(), keys.end(), rowid);
        const int index = int(at - keys.begin());
        keys.insert(at, rowid);
        if (index <= pos && pos >= 0) ++pos;
    } else {
        Row row;
        row.values = buffer;
        for (int i = 0; i < columns.size(); ++i)
            if (!changed[size_t(i)]) row.values[i] = QVariant();
        row.rowids = QVector<qint64>(bases.size(), -1);
        row.rowids[b] = rowid;
        const bool atEnd = pos >= count();
        rows.push_back(std::move(row));
        if (atEnd) pos = count();
    }
}

// ---------------------------------------------------------------------------------------------
// Finding

int Recordset::Impl::findFrom(int start, const QString& criterion) {
    if (start >= count()) return -1;
    return tableMode ? findInTable(start, criterion) : findInRows(start, criterion);
}

int Recordset::Impl::findInTable(int start, const QString& criterion) {
    // The import finds every key with a criterion of the same shape (ItemKey="..."): the
    // shape is looked up, and only a new shape is translated.
    QList<QVariant> literals;
    const QString shape = sql::criterionShape(criterion, &literals);
    auto it = findByShape.find(shape);
    if (it == findByShape.end()) {
        sql::Options options;
        options.parameterizeLiterals = true;
        const sql::Translation t = sql::translateCriterion(criterion, options);
        FindStatement f;
        f.literalCount = int(t.parameters.size());
        f.sql = QString("SELECT rowid FROM %1 WHERE (%2) AND rowid >= ?%3 ORDER BY rowid")
                    .arg(quoteName(bases[0].table), t.sql)
                    .arg(f.literalCount + 1);
        it = findByShape.insert(shape, f);
    }
    if (it->literalCount != literals.size())
        fail(err::kSyntax, QString("Syntax error in criterion '%1'.").arg(criterion));
    // The criterion goes to the table's indexes; only rows of this recordset count.
    Stmt s = conn->prepare(it->sql);
    for (int k = 0; k < literals.size(); ++k)
        s.bind(k + 1, literals[k]);
    s.bind(it->literalCount + 1, keys[size_t(start)]);
    while (s.step()) {
        const qint64 rowid = sqlite3_column_int64(s.get(), 0);
        const auto found = std::lower_bound(keys.begin() + start, keys.end(), rowid);
        if (found != keys.end() && *found == rowid) return int(found - keys.begin());
    }
    return -1;
}

int Recordset::Impl::findInRows(int start, const QString& criterion) {
    QHash<QString, int> fields;
    for (int i = 0; i < columns.size(); ++i) {
        const QString key = columns[i].name.toLower();
        if (!fields.contains(key)) fields.insert(key, i);
        if (!columns[i].baseColumn.isEmpty() && !fields.contains(columns[i].baseColumn.toLower()))
            fields.insert(columns[i].baseColumn.toLower(), i);
    }
    sql::Options options;
    options.fieldParameters = &fields;
    const sql::Translation t = sql::translateCriterion(criterion, options);
    Stmt s = conn->prepare(QString("SELECT CASE WHEN (%1) THEN 1 ELSE 0 END").arg(t.sql));
    for (int r = start; r < count(); ++r) {
        for (int k = 0; k < t.parameters.size(); ++k) {
            const sql::Parameter& p = t.parameters[k];
            s.bind(k + 1, p.field >= 0 ? rows[size_t(r)].values[p.field] : p.literal);
        }
        const bool match = s.step() && sqlite3_column_int(s.get(), 0) == 1;
        s.reset();
        if (match) return r;
    }
    return -1;
}

// ---------------------------------------------------------------------------------------------
// The public face

Recordset::Recordset() = default;
Recordset::~Recordset() = default;
Recordset::Recordset(Recordset&&) noexcept = default;
Recordset& Recordset::operator=(Recordset&&) noexcept = default;
Recordset::Recordset(std::unique_ptr<Impl> impl) : d_(std::move(impl)) {}

Recordset::Impl& Recordset::impl() const {
    if (!d_) fail(err::kClosed, "Object invalid or no longer set (the recordset is closed).");
    return *d_;
}

bool Recordset::isOpen() const {
    return bool(d_);
}
void Recordset::close() {
    d_.reset();
}

void Recordset::requery() {
    Impl& d = impl();
    d.load();
}

bool Recordset::bof() const {
    const Impl& d = impl();
    return d.count() == 0 || d.pos < 0;
}

bool Recordset::eof() const {
    const Impl& d = impl();
    return d.count() == 0 || d.pos >= d.count();
}

int Recordset::recordCount() const {
    return impl().count();
}

int Recordset::absolutePosition() const {
    const Impl& d = impl();
    return d.onRow() ? d.pos : -1;
}

void Recordset::setAbsolutePosition(int position) {
    Impl& d = impl();
    if (position < 0 || position >= d.count())
        fail(err::kInvalidArgument, QString("Position %1 is outside the recordset's %2 rows.")
                                        .arg(position)
                                        .arg(d.count()));
    d.leaveEdit();
    d.pos = position;
    d.currentDeleted = false;
}

void Recordset::moveFirst() {
    Impl& d = impl();
    if (d.count() == 0) noCurrentRecord();
    d.leaveEdit();
    d.pos = 0;
    d.currentDeleted = false;
}

void Recordset::moveLast() {
    Impl& d = impl();
    if (d.count() == 0) noCurrentRecord();
    d.leaveEdit();
    d.pos = d.count() - 1;
    d.currentDeleted = false;
}

void Recordset::moveNext() {
    Impl& d = impl();
    if (eof()) noCurrentRecord();
    d.leaveEdit();
    // After a delete the next row has already moved into the current place.
    if (d.currentDeleted)
        d.currentDeleted = false;
    else
        ++d.pos;
}

void Recordset::movePrevious() {
    Impl& d = impl();
    if (bof()) noCurrentRecord();
    d.leaveEdit();
    d.currentDeleted = false;
    --d.pos;
}

void Recordset::findFirst(const QString& criterion) {
    Impl& d = impl();
    d.leaveEdit();
    const int found = d.findFrom(0, criterion);
    d.noMatch = found < 0;
    if (found >= 0) {
        d.pos = found;
        d.currentDeleted = false;
    }
}

void Recordset::findNext(const QString& criterion) {
    Impl& d = impl();
    d.leaveEdit();
    const int start = d.currentDeleted ? d.pos : d.pos + 1;
    const int found = d.findFrom(std::max(0, start), criterion);
    d.noMatch = found < 0;
    if (found >= 0) {
        d.pos = found;
        d.currentDeleted = false;
    }
}

bool Recordset::noMatch() const {
    return impl().noMatch;
}

int Recordset::fieldCount() const {
    return int(impl().columns.size());
}

QString Recordset::fieldName(int index) const {
    const Impl& d = impl();
    if (index < 0 || index >= d.columns.size())
        fail(err::kItemNotFound, "Item not found in this collection.");
    return d.columns[index].name;
}

int Recordset::fieldIndex(const QString& name) const {
    return impl().columnIndex(name);
}

const FieldDef* Recordset::fieldDef(int index) const {
    const Impl& d = impl();
    if (index < 0 || index >= d.columns.size()) return nullptr;
    return d.columns[index].def ? &*d.columns[index].def : nullptr;
}

bool Recordset::isUpdatable(int index) const {
    const Impl& d = impl();
    return index >= 0 && index < d.columns.size() && d.columns[index].base >= 0;
}

QVariant Recordset::value(int index) const {
    const Impl& d = impl();
    if (index < 0 || index >= d.columns.size())
        fail(err::kItemNotFound, "Item not found in this collection.");
    const FieldDef* def = fieldDef(index);
    if (d.mode != NoEdit && d.changed[size_t(index)])
        return detail::fromStored(d.buffer[index], def);
    if (d.mode == Adding) return QVariant();
    return detail::fromStored(d.currentStored()[index], def);
}

QVariant Recordset::value(const QString& name) const {
    const int index = fieldIndex(name);
    if (index < 0)
        fail(err::kItemNotFound,
             QString("Item not found in this collection (field '%1').").arg(name));
    return value(index);
}

void Recordset::setValue(int index, const QVariant& value) {
    Impl& d = impl();
    if (index < 0 || index >= d.columns.size())
        fail(err::kItemNotFound, "Item not found in this collection.");
    if (d.mode == NoEdit)
        fail(err::kUpdateWithoutEdit, "Update or CancelUpdate without AddNew or Edit.");
    const Impl::Column& c = d.columns[index];
    if (c.base < 0 || !c.def)
        fail(err::kFieldNotUpdatable, QString("Field '%1' can't be updated.").arg(c.name));
    d.buffer[index] = detail::toStored(value, *c.def, d.bases[c.base].table);
    d.changed[size_t(index)] = true;
}

void Recordset::setValue(const QString& name, const QVariant& value) {
    const int index = fieldIndex(name);
    if (index < 0)
        fail(err::kItemNotFound,
             QString("Item not found in this collection (field '%1').").arg(name));
    setValue(index, value);
}

void Recordset::addNew() {
    Impl& d = impl();
    d.leaveEdit();
    d.mode = Adding;
}

void Recordset::edit() {
    Impl& d = impl();
    d.requireRow();
    d.leaveEdit();
    d.mode = Editing;
}

void Recordset::update() {
    Impl& d = impl();
    if (d.mode == NoEdit)
        fail(err::kUpdateWithoutEdit, "Update or CancelUpdate without AddNew or Edit.");
    if (d.mode == Editing) {
        d.requireRow();
        d.writeEdit();
    } else {
        d.writeNew();
    }
    d.leaveEdit();
}

void Recordset::cancelUpdate() {
    Impl& d = impl();
    if (d.mode == NoEdit)
        fail(err::kUpdateWithoutEdit, "Update or CancelUpdate without AddNew or Edit.");
    d.leaveEdit();
}

void Recordset::deleteRecord() {
    Impl& d = impl();
    d.leaveEdit();
    d.requireRow();
    // A row of a join is deleted from the first table of the join.
    int base = 0;
    while (base < d.bases.size() && d.rowidOf(d.pos, base) < 0)
        ++base;
    if (base >= d.bases.size())
        fail(err::kReadOnly, "Cannot delete: the record belongs to no table.");
    Stmt s = d.conn->prepare(
        QString("DELETE FROM %1 WHERE rowid = ?1").arg(quoteName(d.bases[base].table)));
    s.bind(1, d.rowidOf(d.pos, base));
    s.step();
    if (d.tableMode) {
        d.keys.erase(d.keys.begin() + d.pos);
        d.cachedKey = -1;
    } else {
        d.rows.erase(d.rows.begin() + d.pos);
    }
    d.currentDeleted = true;
}

Recordset::EditMode Recordset::editMode() const {
    return impl().mode;
}

}  // namespace etq::jet
