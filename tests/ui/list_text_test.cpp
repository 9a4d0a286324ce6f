#include "ui/ListTextDelegate.h"
#include "ui/ListView.h"

#include <QCoreApplication>
#include <QHeaderView>
#include <QImage>
#include <QStandardItemModel>

#include <gtest/gtest.h>

#include <functional>

namespace {

QImage paintedWith(ListView& view, QAbstractItemDelegate* delegate) {
    view.setItemDelegate(delegate);
    view.viewport()->update();
    return view.grab().toImage();
}

// Where the two pictures first differ, for a readable failure.
QString firstDifference(const QImage& a, const QImage& b) {
    if (a.size() != b.size())
        return QStringLiteral("sizes differ");
    for (int y = 0; y < a.height(); ++y)
        for (int x = 0; x < a.width(); ++x)
            if (a.pixel(x, y) != b.pixel(x, y))
                return QStringLiteral("pixel %1,%2").arg(x).arg(y);
    return QString();
}

} // namespace

// The list's own text drawing must be indistinguishable from the style's, whatever the
// name: short, cut off with an ellipsis, not Latin, right to left, empty, selected; and it
// must follow the column's width, the elision and the list's font when they change.
TEST(ListText, PaintsTheSamePixelsAsTheStyle) {
    const QStringList names = {
        QStringLiteral("Adventure.bin"),
        QStringLiteral("A very long name that cannot fit in the column at all (1982).bin"),
        QStringLiteral("ファイナルファンタジー.a26"),
        QStringLiteral("לוח משחק.bin"),
        QStringLiteral("Ünïcödé Ça Marche.bin"),
        QString(),
        QStringLiteral("   spaced   out   .bin"),
        QStringLiteral("Tab\there.bin"),
        QStringLiteral("Mixed עברית and English that runs long.bin"),
        QStringLiteral("W"),
    };
    // The middle column repeats one folder down the list, as the ROM list does.
    QStandardItemModel model(static_cast<int>(names.size()), 3);
    for (int row = 0; row < names.size(); ++row) {
        model.setItem(row, 0, new QStandardItem(names[row]));
        model.setItem(row, 1, new QStandardItem(QStringLiteral("/home/player/roms/atari 2600")));
        auto* right = new QStandardItem(QString::number(row * 4096));
        right->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
        model.setItem(row, 2, right);
    }

    for (const Qt::LayoutDirection direction : {Qt::LeftToRight, Qt::RightToLeft}) {
        ListView view;
        view.setLayoutDirection(direction);
        view.setModel(&model);
        view.resize(420, 260);
        view.header()->resizeSection(0, 150);
        view.header()->resizeSection(1, 170);
        view.header()->resizeSection(2, 60);
        view.setCurrentIndex(model.index(1, 0));
        view.setForeColor(0x0000FF);
        auto* ours = new ListTextDelegate(&view);
        auto* style = new QStyledItemDelegate(&view);

        const std::function<void()> changes[] = {
            [] {},
            [&] { view.header()->resizeSection(1, 250); },
            [&] { view.header()->resizeSection(1, 90); },
            [&] { view.setTextElideMode(Qt::ElideMiddle); },
            [&] { view.header()->resizeSection(0, 30); }, // little more than the ellipsis
            [&] {                                         // narrower than the text's margins
                view.header()->setMinimumSectionSize(1);
                view.header()->resizeSection(0, 3);
            },
            [&] {
                QFont bigger = view.font();
                bigger.setPointSize(bigger.pointSize() + 5);
                view.setFont(bigger);
            },
        };
        for (size_t step = 0; step < std::size(changes); ++step) {
            changes[step]();
            QCoreApplication::processEvents(); // lets the scroll bars follow the columns
            const QImage fast = paintedWith(view, ours);
            const QImage reference = paintedWith(view, style);
            EXPECT_EQ(firstDifference(fast, reference), QString())
                << "direction " << int(direction) << ", step " << step;
        }
    }
}
