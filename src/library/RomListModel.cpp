#include "library/RomListModel.h"

#include <QDir>

QModelIndex RomListModel::index(int row, int column, const QModelIndex& parent) const {
    if (parent.isValid() || row < 0 || column < 0 || static_cast<size_t>(row) >= m_rows.size() ||
        static_cast<size_t>(column) >= m_columns.size())
        return QModelIndex();
    return createIndex(row, column);
}

Qt::ItemFlags RomListModel::flags(const QModelIndex& index) const {
    if (!index.isValid())
        return Qt::NoItemFlags;
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemNeverHasChildren;
}

int RomListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_rows.size());
}

int RomListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_columns.size());
}

QVariant RomListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= rowCount() || role != Qt::DisplayRole)
        return QVariant();
    const Row& r = m_rows[static_cast<size_t>(index.row())];
    if (index.column() == 0)
        return r.name;
    if (index.column() == 1)
        return QDir::toNativeSeparators(m_folders[r.folder]);
    return QVariant();
}

QVariant RomListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || section < 0 || section >= columnCount())
        return QVariant();
    const Column& c = m_columns[static_cast<size_t>(section)];
    if (role == Qt::DisplayRole)
        return c.header;
    if (role == Qt::ToolTipRole)
        return c.toolTip;
    return QVariant();
}

void RomListModel::addColumn(const Column& column) {
    const int at = columnCount();
    beginInsertColumns(QModelIndex(), at, at);
    m_columns.push_back(column);
    endInsertColumns();
}

void RomListModel::clear() {
    if (m_rows.empty() && m_folders.isEmpty())
        return;
    beginResetModel();
    m_rows.clear();
    m_rows.shrink_to_fit();
    m_folders.clear();
    endResetModel();
}

void RomListModel::setRows(QStringList folders, std::vector<Row> rows) {
    beginResetModel();
    m_folders = std::move(folders);
    m_rows = std::move(rows);
    endResetModel();
}

QString RomListModel::rowPath(int index) const {
    if (index < 0 || index >= rowCount())
        return QString();
    const Row& r = m_rows[static_cast<size_t>(index)];
    return m_folders[r.folder] + u'/' + r.name;
}
