#include "dialogs/bound_grid_model.h"

#include "jet/vb.h"

namespace etq {

BoundGridModel::BoundGridModel(QObject* parent) : QAbstractTableModel(parent) {}
BoundGridModel::~BoundGridModel() = default;

void BoundGridModel::refresh() {
    beginResetModel();
    recordset_.close();
    database_.close();
    try {
        database_ = jet::Database::open(databaseName_);
        recordset_ = database_.openRecordset(recordSource_);
    } catch (...) {
        recordset_.close();
        database_.close();
        endResetModel();
        throw;
    }
    endResetModel();
}

void BoundGridModel::close() {
    beginResetModel();
    recordset_.close();
    database_.close();
    endResetModel();
}

void BoundGridModel::reload() {
    beginResetModel();
    if (recordset_.isOpen()) recordset_.requery();
    endResetModel();
}

void BoundGridModel::showRows() {
    beginResetModel();
    endResetModel();
}

void BoundGridModel::setHeader(int column, const QString& text) {
    headers_[column] = text;
    Q_EMIT headerDataChanged(Qt::Horizontal, column, column);
}

void BoundGridModel::setAlignment(int column, Qt::Alignment alignment) {
    alignments_[column] = alignment;
    if (rowCount() > 0)
        Q_EMIT dataChanged(index(0, column), index(rowCount() - 1, column),
                           {Qt::TextAlignmentRole});
}

Qt::Alignment BoundGridModel::alignmentOfCode(int code) {
    switch (code) {
        case 1:
            return Qt::AlignLeft | Qt::AlignAbsolute | Qt::AlignVCenter;
        case 4:
            return Qt::AlignCenter;
        case 7:
            return Qt::AlignRight | Qt::AlignAbsolute | Qt::AlignVCenter;
        default:
            return Qt::AlignVCenter;
    }
}

int BoundGridModel::rowCount(const QModelIndex& parent) const {
    if (parent.isValid() || !recordset_.isOpen()) return 0;
    return recordset_.recordCount();
}

int BoundGridModel::columnCount(const QModelIndex& parent) const {
    if (parent.isValid() || !recordset_.isOpen()) return 0;
    return recordset_.fieldCount();
}

bool BoundGridModel::isCheckColumn(int column) const {
    const jet::FieldDef* def = recordset_.fieldDef(column);
    return def && def->type == jet::FieldType::Boolean;
}

QVariant BoundGridModel::cell(int row, int column) const {
    auto& rs = const_cast<jet::Recordset&>(recordset_);
    rs.setAbsolutePosition(row);
    return rs.value(column);
}

void BoundGridModel::writeCell(int row, int column, const QVariant& value) {
    recordset_.setAbsolutePosition(row);
    recordset_.edit();
    try {
        recordset_.setValue(column, value);
        recordset_.update();
    } catch (...) {
        recordset_.cancelUpdate();
        throw;
    }
    Q_EMIT dataChanged(index(row, column), index(row, column));
}

QVariant BoundGridModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || !recordset_.isOpen()) return {};
    if (role == Qt::TextAlignmentRole) {
        const auto it = alignments_.constFind(index.column());
        return it == alignments_.constEnd() ? QVariant() : QVariant(int(it.value()));
    }
    const bool check = isCheckColumn(index.column());
    if (check && role == Qt::CheckStateRole) {
        const QVariant v = cell(index.row(), index.column());
        return v.toBool() ? Qt::Checked : Qt::Unchecked;
    }
    if (check) return {};
    if (role != Qt::DisplayRole && role != Qt::EditRole) return {};
    const QVariant v = cell(index.row(), index.column());
    if (role == Qt::EditRole) return v;
    return vb::toText(v);
}

bool BoundGridModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (!index.isValid() || !recordset_.isOpen()) return false;
    QVariant written = value;
    if (isCheckColumn(index.column())) {
        if (role != Qt::CheckStateRole) return false;
        written = value.toInt() == Qt::Checked;
    } else if (role != Qt::EditRole) {
        return false;
    }
    // An emptied cell is Null: the engine keeps no empty texts.
    if (written.typeId() == QMetaType::QString && written.toString().isEmpty())
        written = QVariant();
    try {
        writeCell(index.row(), index.column(), written);
        lastError_.clear();
        return true;
    } catch (const jet::JetError& e) {
        lastError_ = e.description();
        return false;
    }
}

Qt::ItemFlags BoundGridModel::flags(const QModelIndex& index) const {
    Qt::ItemFlags f = QAbstractTableModel::flags(index);
    if (!index.isValid() || !recordset_.isOpen() || !recordset_.isUpdatable(index.column()))
        return f;
    if (isCheckColumn(index.column())) return f | Qt::ItemIsUserCheckable;
    return f | Qt::ItemIsEditable;
}

QVariant BoundGridModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole)
        return QAbstractTableModel::headerData(section, orientation, role);
    const auto it = headers_.constFind(section);
    if (it != headers_.constEnd()) return it.value();
    if (recordset_.isOpen() && section < recordset_.fieldCount())
        return recordset_.fieldName(section);
    return {};
}

}  // namespace etq
