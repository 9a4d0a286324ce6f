#pragma once

#include <QColor>
#include <QtGlobal>

// OLE colour numbers: 0x00BBGGRR, or, with the top bit set, a system colour whose index
// is in the low byte (0x8000000F is the button face).
QColor oleToColor(quint32 ole);
quint32 colorToOle(const QColor& colour);

inline constexpr quint32 kOleWhite = 0xFFFFFF;
inline constexpr quint32 kOleButtonFace = 0x8000000F;
