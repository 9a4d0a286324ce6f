#include "ui/ListTextDelegate.h"

#include <QApplication>
#include <QPainter>
#include <QTextLayout>

namespace {

bool isPlainLine(const QStyleOptionViewItem& opt) {
    const QStyleOptionViewItem::ViewItemFeatures own =
        QStyleOptionViewItem::HasDisplay | QStyleOptionViewItem::Alternate;
    if ((opt.features & ~own) || (opt.state & QStyle::State_Editing) ||
        (opt.displayAlignment & Qt::AlignVertical_Mask) != Qt::AlignVCenter)
        return false;
    for (QChar c : opt.text) {
        if (c == QLatin1Char('\n') || c == QChar::LineSeparator)
            return false;
    }
    return true;
}

QTextLine layOut(QTextLayout& layout, int width) {
    layout.beginLayout();
    QTextLine line = layout.createLine();
    line.setLineWidth(width);
    line.setPosition(QPointF(0, 0));
    layout.endLayout();
    return line;
}

} // namespace

ListTextDelegate::~ListTextDelegate() = default;

void ListTextDelegate::initStyleOption(QStyleOptionViewItem* option,
                                       const QModelIndex& index) const {
    QStyledItemDelegate::initStyleOption(option, index);
    if (const auto mode = m_elide.constFind(index.column()); mode != m_elide.cend())
        option->textElideMode = *mode;
}

const ListTextDelegate::Line& ListTextDelegate::laidOut(int column, const QString& text,
                                                        const QStyleOptionViewItem& opt,
                                                        int width) const {
    if (column < 0)
        column = 0;
    if (static_cast<size_t>(column) >= m_lines.size())
        m_lines.resize(static_cast<size_t>(column) + 1);
    Line& last = m_lines[static_cast<size_t>(column)];
    if (last.layout && last.width == width && last.direction == opt.direction &&
        last.alignment == opt.displayAlignment && last.elideMode == opt.textElideMode &&
        last.text == text && last.font == opt.font)
        return last;

    QTextOption textOption;
    textOption.setWrapMode(QTextOption::ManualWrap);
    textOption.setTextDirection(opt.direction);
    textOption.setAlignment(QStyle::visualAlignment(opt.direction, opt.displayAlignment));
    auto layout = std::make_unique<QTextLayout>(text, opt.font);
    layout->setTextOption(textOption);
    const QTextLine whole = layOut(*layout, width);
    // The whole text's height places the line, even when what is left after the cut is
    // shorter: the style does the same, and a name keeps its place as the column narrows.
    last.height = static_cast<int>(whole.height());
    if (whole.naturalTextWidth() > width) {
        layout->setText(QFontMetrics(opt.font).elidedText(text, opt.textElideMode, width));
        layOut(*layout, width);
    }
    last.text = text;
    last.font = opt.font;
    last.width = width;
    last.direction = opt.direction;
    last.alignment = opt.displayAlignment;
    last.elideMode = opt.textElideMode;
    last.layout = std::move(layout);
    return last;
}

void ListTextDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                             const QModelIndex& index) const {
    QStyleOptionViewItem opt = option;
    initStyleOption(&opt, index);
    if (!isPlainLine(opt)) {
        QStyledItemDelegate::paint(painter, option, index);
        return;
    }
    const QWidget* widget = opt.widget;
    const QStyle* style = widget ? widget->style() : QApplication::style();

    // The style draws the panel, the selection and the focus frame; only the text is ours.
    const QString text = std::exchange(opt.text, QString());
    opt.features &= ~QStyleOptionViewItem::HasDisplay;
    style->drawControl(QStyle::CE_ItemViewItem, &opt, painter, widget);
    if (text.isEmpty())
        return;

    QPalette::ColorGroup group =
        opt.state & QStyle::State_Enabled ? QPalette::Normal : QPalette::Disabled;
    if (group == QPalette::Normal && !(opt.state & QStyle::State_Active))
        group = QPalette::Inactive;
    const QPalette::ColorRole role =
        opt.state & QStyle::State_Selected ? QPalette::HighlightedText : QPalette::Text;

    const int margin = style->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, widget) + 1;
    const QRect textRect = opt.rect.adjusted(margin, 0, -margin, 0);

    const Line& line = laidOut(index.column(), text, opt, textRect.width());
    const int top = textRect.top() + (textRect.height() - line.height) / 2;

    painter->save();
    painter->setClipRect(opt.rect); // as the style does: a tall glyph stays in its cell
    painter->setPen(opt.palette.color(group, role));
    line.layout->draw(painter, QPointF(textRect.left(), top));
    painter->restore();
}
