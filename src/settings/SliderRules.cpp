#include "settings/SliderRules.h"

namespace sliders {

namespace {

// A shifted value lands this far inside the window's near edge.
constexpr qint64 kLandingInset = 5;

} // namespace

Scale SoundQueueDefault() {
    return {kSoundQueueDefaultMin, kSoundQueueDefaultMax, kSoundQueueDefault};
}

Scale ShiftSoundQueue(const Scale& scale, int keyAscii) {
    // Wide arithmetic: the bounds may come from anywhere (a loaded file), and stepping past
    // the ends of int must not overflow.
    qint64 lo = scale.min;
    qint64 hi = scale.max;
    qint64 value = scale.value;
    const bool up = keyAscii == kKeyShiftUp;
    const bool down = keyAscii == kKeyShiftDown;
    if (up) {
        lo += kSoundQueueStep;
        hi += kSoundQueueStep;
    } else if (down) {
        lo -= kSoundQueueStep;
        hi -= kSoundQueueStep;
    }

    // Hold the window inside the scale before looking at the value, so that a shift which
    // cannot move the window cannot move the value either.
    const Scale window = soundQueueOnScale(lo, hi, lo);
    if (down && value > window.max)
        value = window.max - kLandingInset;
    if (up && value < window.min)
        value = window.min + kLandingInset;
    return soundQueueOnScale(window.min, window.max, value);
}

QString FormatThousands(qint64 value, const QString& separator) {
    // The magnitude as unsigned, so that the lowest qint64 has one too.
    const bool negative = value < 0;
    const quint64 magnitude =
        negative ? 0 - static_cast<quint64>(value) : static_cast<quint64>(value);
    const QString digits = QString::number(magnitude);
    QString text;
    text.reserve(digits.size() + (digits.size() / 3) * separator.size() + 1);
    if (negative)
        text += QLatin1Char('-');
    for (qsizetype i = 0; i < digits.size(); ++i) {
        if (i > 0 && (digits.size() - i) % 3 == 0)
            text += separator;
        text += digits.at(i);
    }
    return text;
}

QString SoundQueueText(int value, const QLocale& locale) {
    return FormatThousands(value, locale.groupSeparator());
}

QString PlainText(int value) {
    return QString::number(value);
}

} // namespace sliders
