#pragma once

#include "emulator/OptionFile.h"

#include <QLocale>
#include <QString>

// The arithmetic of the settings window's three slider bars, free of any widget: their
// ranges and defaults, the sound queue's movable scale and the texts the bars show.
namespace sliders {

// Keyboard paddle sensitivity and phosphorescent effect.
inline constexpr int kPaddleMin = 1;
inline constexpr int kPaddleMax = 15;
inline constexpr int kPhosMin = 0;
inline constexpr int kPhosMax = 100;

// Size of the sound queue: the bar shows a window of 200 of the whole scale 1..65536.
inline constexpr int kSoundQueueDefaultMin = 4500;
inline constexpr int kSoundQueueDefaultMax = 4700;
inline constexpr int kSoundQueueStep = 100;

// The characters that shift the sound queue's scale.
inline constexpr int kKeyShiftUp = '+';
inline constexpr int kKeyShiftDown = '-';

using Scale = SliderScale;

// The sound queue's window and value as a reset leaves them: 4500..4700 at 4608.
Scale SoundQueueDefault();

// The sound queue after a key press on its bar. + moves the window a step up, - a step
// down; a value the window leaves behind lands 5 inside the window's near edge. The window
// then stays within the scale: 1..201 at the bottom, 65339..65536 at the top. Any key,
// also one that shifts nothing, brings the value into the window. At either end of the
// scale a shift that cannot move the window leaves the value alone.
Scale ShiftSoundQueue(const Scale& scale, int keyAscii);

// The value grouped by thousands with separator ("#,##0"): 4608 gives "4,608" with ",".
QString FormatThousands(qint64 value, const QString& separator);

// The sound queue bar's text: the value grouped with the locale's thousands separator.
QString SoundQueueText(int value, const QLocale& locale = QLocale());

// The paddle and phosphor bars' text: the plain number.
QString PlainText(int value);

} // namespace sliders
