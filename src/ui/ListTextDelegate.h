#pragma once

#include <QHash>
#include <QStyledItemDelegate>
#include <QTextLayout>

#include <memory>
#include <vector>

// Paints a one-line text cell as the style would, but lays its text out once: the style's
// own item drawing shapes the text three to five times (size, elision, drawing), and a big
// list repaints a screenful of cells on every scroll. Cells with an icon, a check box,
// wrapping, a line break, an editor or a vertical alignment of their own are left to the
// style.
class ListTextDelegate : public QStyledItemDelegate {
    Q_OBJECT
public:
    using QStyledItemDelegate::QStyledItemDelegate;
    ~ListTextDelegate() override;

    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override;
    // Where a column's text is cut when it does not fit (the view's mode otherwise).
    void setElideMode(int column, Qt::TextElideMode mode) { m_elide[column] = mode; }

protected:
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;

private:
    QHash<int, Qt::TextElideMode> m_elide;
    // The last text laid out in each column: a folder column shows one text all the way
    // down the list, so it is shaped and cut to width once.
    struct Line {
        QString text;
        QFont font;
        int width = -1;
        Qt::LayoutDirection direction = Qt::LeftToRight;
        Qt::Alignment alignment;
        Qt::TextElideMode elideMode = Qt::ElideRight;
        std::unique_ptr<QTextLayout> layout; // the text as shown, cut to width
        int height = 0;                      // of the whole text's line
    };
    const Line& laidOut(int column, const QString& text, const QStyleOptionViewItem& opt,
                        int width) const;

    mutable std::vector<Line> m_lines;
};
