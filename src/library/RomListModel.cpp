#include "library/RomListModel.h"

#include "platform/FileSystem.h"

#include <QDir>

QModelIndex RomListModel::index(int row, int column, const QModelIndex& parent) const {
    if (parent.isValid() || row < 0 || column < 0 || row >= m_names.size() ||
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
    return parent.isValid() ? 0 : static_cast<int>(m_names.size());
}

int RomListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_columns.size());
}

QVariant RomListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= rowCount())
        return QVariant();
    if (index.column() == 0 && role == Qt::DisplayRole) {
        if (isFavourite(index.row()))
            return QStringLiteral("\u2605 ") + readableName(m_names.at(index.row()));
        return readableName(m_names.at(index.row()));
    }
    // The folder's whole path also as a tip: the column shows it cut in the middle.
    if (index.column() == 1 && (role == Qt::DisplayRole || role == Qt::ToolTipRole))
        return QDir::toNativeSeparators(m_folders[m_rowFolders[static_cast<size_t>(index.row())]]);
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
    if (m_names.isEmpty() && m_folders.isEmpty())
        return;
    beginResetModel();
    m_names = NameList();
    m_rowFolders = std::vector<int>();
    m_favourite = std::vector<bool>();
    m_folders.clear();
    endResetModel();
}

void RomListModel::setRows(QStringList folders, NameList names, std::vector<int> rowFolders,
                           std::vector<bool> favourite) {
    beginResetModel();
    m_folders = std::move(folders);
    m_names = std::move(names);
    m_rowFolders = std::move(rowFolders);
    m_favourite = std::move(favourite);
    endResetModel();
}

bool RomListModel::isFavourite(int row) const {
    return row >= 0 && static_cast<size_t>(row) < m_favourite.size() &&
           m_favourite[static_cast<size_t>(row)];
}

void RomListModel::setFavourite(int row, bool bFavourite) {
    if (row < 0 || row >= rowCount() || isFavourite(row) == bFavourite)
        return;
    m_favourite.resize(static_cast<size_t>(rowCount()));
    m_favourite[static_cast<size_t>(row)] = bFavourite;
    // Only the one name is repainted.
    emit dataChanged(index(row, 0), index(row, 0), {Qt::DisplayRole});
}

QString RomListModel::name(int row) const {
    if (row < 0 || row >= rowCount())
        return QString();
    return m_names.at(row).toString();
}

QString RomListModel::rowPath(int row) const {
    if (row < 0 || row >= rowCount())
        return QString();
    const QString& folder = m_folders[m_rowFolders[static_cast<size_t>(row)]];
    const QStringView name = m_names.at(row);
    QString path;
    path.reserve(folder.size() + 1 + name.size());
    return path.append(folder).append(u'/').append(name);
}
