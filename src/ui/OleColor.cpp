#include "ui/OleColor.h"

#include <QGuiApplication>
#include <QPalette>

namespace {

// System colour indices as Windows numbers them, mapped to the nearest palette role.
QPalette::ColorRole systemRole(quint32 index) {
    switch (index) {
    case 1: // desktop
    case 4: // menu
    case 5: // window
        return QPalette::Base;
    case 6:  // window frame
    case 10: // active border
    case 11: // inactive border
        return QPalette::Mid;
    case 7: // menu text
    case 8: // window text
        return QPalette::Text;
    case 13: // highlight
        return QPalette::Highlight;
    case 14: // highlight text
        return QPalette::HighlightedText;
    case 16: // button shadow
        return QPalette::Dark;
    case 17: // gray text
        return QPalette::PlaceholderText;
    case 18: // button text
        return QPalette::ButtonText;
    case 20: // button highlight
        return QPalette::Light;
    case 23: // info text
        return QPalette::ToolTipText;
    case 24: // info background
        return QPalette::ToolTipBase;
    default: // 15, the button face, and anything unknown
        return QPalette::Button;
    }
}

} // namespace

QColor oleToColor(quint32 ole) {
    if ((ole & 0x80000000u) != 0)
        return QGuiApplication::palette().color(systemRole(ole & 0xFF));
    return QColor(ole & 0xFF, (ole >> 8) & 0xFF, (ole >> 16) & 0xFF);
}

quint32 colorToOle(const QColor& colour) {
    return static_cast<quint32>(colour.red()) | (static_cast<quint32>(colour.green()) << 8) |
           (static_cast<quint32>(colour.blue()) << 16);
}
