#pragma once

#include <QPixmap>
#include <QTreeView>

// A flat, multi-column list over a model, with the background colour, text colour and
// background picture (tiled) that the windows set on it.
class ListView : public QTreeView {
    Q_OBJECT
public:
    explicit ListView(QWidget* parent = nullptr);

    quint32 BackColor() const { return m_backColor; }
    void setBackColor(quint32 ole);
    quint32 ForeColor() const { return m_foreColor; }
    void setForeColor(quint32 ole);
    // The background picture's file; the empty text removes it, and a file that is
    // missing or not a picture shows none.
    QString Picture() const { return m_pictureFile; }
    void setPicture(const QString& file);
    bool hasPicture() const { return !m_picture.isNull(); }

    // The 0-based row of the current item, or -1 when no row is selected.
    int selectedRow() const;
    // Where a column's text is cut when it does not fit.
    void setColumnElideMode(int column, Qt::TextElideMode mode);

signals:
    void itemDoubleClicked(int row);
    void keyDown(int key);
    void mouseDown(Qt::MouseButton button, QPoint globalPos);
    // The Menu key or Shift+F10: a popup for the current row, at that row.
    void popupKey(QPoint globalPos);
    // A file dropped from a file manager: the first file of the drop, folders passed over.
    void fileDropped(const QString& path);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dragMoveEvent(QDragMoveEvent* event) override;
    void dropEvent(QDropEvent* event) override;

private:
    void requestPopupAtCurrentRow();

    void applyPalette();

    quint32 m_backColor = 0xFFFFFF;
    quint32 m_foreColor = 0;
    QString m_pictureFile;
    QPixmap m_picture;
};
