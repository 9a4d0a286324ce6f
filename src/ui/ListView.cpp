#include "ui/ListView.h"

#include "ui/ListTextDelegate.h"
#include "ui/OleColor.h"
#include "ui/PictureFile.h"

#include <QContextMenuEvent>
#include <QFileInfo>
#include <QHeaderView>
#include <QKeyEvent>
#include <QMimeData>
#include <QMouseEvent>

namespace {

// The first local file of a drop, or the empty text.
QString firstDroppedFile(const QMimeData* data) {
    if (data != nullptr)
        for (const QUrl& url : data->urls())
            if (url.isLocalFile() && QFileInfo(url.toLocalFile()).isFile())
                return url.toLocalFile();
    return QString();
}

} // namespace

ListView::ListView(QWidget* parent) : QTreeView(parent) {
    setAcceptDrops(true);
    viewport()->setAcceptDrops(true);
    setRootIsDecorated(false);
    setItemsExpandable(false);
    setUniformRowHeights(true); // keeps 100,000 rows cheap to lay out
    setSelectionBehavior(QAbstractItemView::SelectRows);
    setSelectionMode(QAbstractItemView::SingleSelection);
    setEditTriggers(QAbstractItemView::NoEditTriggers);
    setAllColumnsShowFocus(true);
    setItemDelegate(new ListTextDelegate(this));
    header()->setStretchLastSection(false);
    connect(this, &QAbstractItemView::doubleClicked, this,
            [this](const QModelIndex& index) { emit itemDoubleClicked(index.row()); });
    applyPalette();
}

void ListView::setBackColor(quint32 ole) {
    m_backColor = ole;
    applyPalette();
}

void ListView::setForeColor(quint32 ole) {
    m_foreColor = ole;
    applyPalette();
}

void ListView::setPicture(const QString& file) {
    m_pictureFile = file;
    m_picture = QPixmap::fromImage(loadPictureFile(file));
    applyPalette();
}

void ListView::applyPalette() {
    QPalette p = palette();
    const QColor back = oleToColor(m_backColor);
    const QColor text = oleToColor(m_foreColor);
    if (m_picture.isNull()) {
        p.setBrush(QPalette::Base, back);
    } else {
        QBrush brush(back);
        brush.setTexture(m_picture);
        p.setBrush(QPalette::Base, brush);
    }
    p.setColor(QPalette::AlternateBase, back);
    p.setColor(QPalette::Text, text);
    p.setColor(QPalette::WindowText, text);
    setPalette(p);
    viewport()->update();
}

int ListView::selectedRow() const {
    const QModelIndex index = currentIndex();
    if (!index.isValid() || !selectionModel()->isRowSelected(index.row(), QModelIndex()))
        return -1;
    return index.row();
}

void ListView::setColumnElideMode(int column, Qt::TextElideMode mode) {
    static_cast<ListTextDelegate*>(itemDelegate())->setElideMode(column, mode);
}

void ListView::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Menu ||
        (event->key() == Qt::Key_F10 && event->modifiers() == Qt::ShiftModifier)) {
        requestPopupAtCurrentRow();
        return;
    }
    emit keyDown(event->key());
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter ||
        event->key() == Qt::Key_F5)
        return;
    QTreeView::keyPressEvent(event);
}

void ListView::mousePressEvent(QMouseEvent* event) {
    QTreeView::mousePressEvent(event);
    emit mouseDown(event->button(), event->globalPosition().toPoint());
}

void ListView::contextMenuEvent(QContextMenuEvent* event) {
    // The mouse's popup comes with its button press; this is the keyboard's.
    if (event->reason() == QContextMenuEvent::Keyboard)
        requestPopupAtCurrentRow();
}

void ListView::requestPopupAtCurrentRow() {
    const QRect row = visualRect(currentIndex());
    const QPoint at = row.isValid() ? row.bottomLeft() : QPoint(0, 0);
    emit popupKey(viewport()->mapToGlobal(at));
}

void ListView::dragEnterEvent(QDragEnterEvent* event) {
    if (!firstDroppedFile(event->mimeData()).isEmpty())
        event->acceptProposedAction();
}

void ListView::dragMoveEvent(QDragMoveEvent* event) {
    if (!firstDroppedFile(event->mimeData()).isEmpty())
        event->acceptProposedAction();
}

void ListView::dropEvent(QDropEvent* event) {
    const QString file = firstDroppedFile(event->mimeData());
    if (file.isEmpty())
        return;
    event->acceptProposedAction();
    emit fileDropped(file);
}
