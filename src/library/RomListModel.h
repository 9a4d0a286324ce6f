#pragma once

#include "library/NameList.h"

#include <QAbstractTableModel>
#include <QStringList>

#include <vector>

// The rows of the ROM list: each row is a file name and the folder it was found in.
// Columns are added by the window (none at first); the first shows the name, the second
// the folder. Rows are replaced in one batch so a refresh costs one model reset, and their
// names are held in one buffer.
class RomListModel final : public QAbstractTableModel {
    Q_OBJECT
public:
    struct Column {
        QString key;
        QString header;
        QString toolTip;
    };

    using QAbstractTableModel::QAbstractTableModel;

    // index() and flags() answer without the base class's range checks through virtual
    // calls: the view asks for every row when it lays out 100,000 of them.
    QModelIndex index(int row, int column,
                      const QModelIndex& parent = QModelIndex()) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    int rowCount(const QModelIndex& parent = QModelIndex()) const override;
    int columnCount(const QModelIndex& parent = QModelIndex()) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

    void addColumn(const Column& column);
    const std::vector<Column>& columns() const { return m_columns; }

    void clear();
    // Row i is names[i], found in folders[rowFolders[i]], a favourite when favourite[i] (none
    // when favourite is empty).
    void setRows(QStringList folders, NameList names, std::vector<int> rowFolders,
                 std::vector<bool> favourite = {});

    // A favourite row's name shows a star; the file name itself stays as it is.
    bool isFavourite(int row) const;
    void setFavourite(int row, bool bFavourite);

    // A row's file name, or the empty text for a row that does not exist.
    QString name(int row) const;
    // The full path of a row's file: its own folder, '/', its name.
    QString rowPath(int row) const;

private:
    QStringList m_folders;
    NameList m_names;
    std::vector<int> m_rowFolders;
    std::vector<bool> m_favourite;
    std::vector<Column> m_columns;
};
