#include "ui/ListTextDelegate.h"
#include "ui/ListView.h"

#include <QCoreApplication>
#include <QHeaderView>
#include <QStandardItemModel>

#include <gtest/gtest.h>

// The list's own text drawing must be indistinguishable from the style's, whatever the
// name: short, cut off with an ellipsis, not Latin, right to left, empty, selected; and it
// must follow the column's width and the list's font when they change.
TEST(ListText, PaintsTheSamePixelsAsTheStyle) {
    const QStringList names =
        QString(
            "Adventure.bin|A very long name that cannot fit in the column at all (1982).bin|"
            "ファイナルファンタジー.a26|לוח משחק.bin|Ünïcödé Ça Marche.bin||   spaced   out   .bin|"
            "Tab\there.bin|Mixed עברית and English that runs long.bin|W")
            .split(u'|');
    // The middle column repeats one folder down the list, as the ROM list does.
    QStandardItemModel model(static_cast<int>(names.size()), 3);
    for (int row = 0; row < names.size(); ++row) {
        model.setItem(row, 0, new QStandardItem(names[row]));
        model.setItem(row, 1, new QStandardItem("/home/player/roms/atari 2600"));
        model.setItem(row, 2, new QStandardItem(QString::number(row * 4096)));
        model.item(row, 2)->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
    }
    ListTextDelegate ours; // outlive the view
    QStyledItemDelegate style;
    ListView view;
    view.setModel(&model);
    view.resize(420, 260);
    view.header()->setMinimumSectionSize(1);
    view.setCurrentIndex(model.index(1, 0));
    view.setForeColor(0x0000FF);
    // Widths down to less than the text's margins, then (column -1) a font 5 points larger.
    for (const auto& [column, width] :
         {std::pair{2, 60}, {1, 170}, {0, 150}, {1, 250}, {1, 90}, {0, 30}, {0, 3}, {-1, 5}}) {
        if (column < 0)
            view.setFont(QFont(view.font().family(), view.font().pointSize() + width));
        else
            view.header()->resizeSection(column, width);
        QCoreApplication::processEvents(); // lets the scroll bars follow the columns
        view.setItemDelegate(&ours);
        const QImage fast = view.grab().toImage();
        view.setItemDelegate(&style);
        EXPECT_TRUE(view.grab().toImage() == fast) << column << ": " << width;
    }
}
