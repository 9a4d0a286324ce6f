#include "emulator/OptionFile.h"

#include "emulator/LeadingNumber.h"

#include <QFile>
#include <QFileInfo>
#include <QSaveFile>
#include <QtEndian>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>

namespace {

using K = OptionKind;

// Round half to even, as a whole-number control takes a value; empty when the result is
// not a 32-bit integer.
std::optional<int> roundToInt(double value) {
    if (!std::isfinite(value))
        return std::nullopt;
    const double r = std::nearbyint(value);
    if (r < std::numeric_limits<int>::min() || r > std::numeric_limits<int>::max())
        return std::nullopt;
    return static_cast<int>(r);
}

void putInt16(uchar* at, int value) {
    qToLittleEndian<qint16>(static_cast<qint16>(value), at);
}

void putSingle(uchar* at, float value) {
    quint32 bits = 0;
    std::memcpy(&bits, &value, sizeof bits);
    qToLittleEndian<quint32>(bits, at);
}

float singleAt(const uchar* at) {
    const quint32 bits = qFromLittleEndian<quint32>(at);
    float value = 0;
    std::memcpy(&value, &bits, sizeof value);
    return value;
}

// Applies one row's stored value to `options`; false when the window cannot show it.
bool applyRow(const OptionRow& row, const uchar* bytes, EmulatorOptions& options) {
    const uchar* at = bytes + row.slot().offset;
    switch (row.kind) {
    case K::List: {
        const int index = qFromLittleEndian<qint16>(at);
        if (index < -1 || index >= row.entries)
            return false;
        row.set(options, index);
        return true;
    }
    case K::Check: {
        const int state = qFromLittleEndian<qint16>(at);
        if (state < 0 || state > 2)
            return false;
        row.set(options, state);
        return true;
    }
    case K::Choice: {
        // Any non-zero flag selects its button, and selecting one clears the others.
        int chosen = row.initial;
        for (int i = 0; i < row.slotCount; ++i) {
            const int offset = row.slotList[static_cast<std::size_t>(i)].offset;
            if (offset >= 0 && qFromLittleEndian<qint16>(bytes + offset) != 0)
                chosen = i;
        }
        row.set(options, chosen);
        return true;
    }
    case K::Number: {
        const float value = singleAt(at);
        if (!std::isfinite(value))
            return false;
        options.*row.text = shortestDecimalText(value);
        return true;
    }
    case K::Slider: {
        const std::optional<int> value = roundToInt(singleAt(at));
        if (!value)
            return false;
        row.set(options, *value);
        return true;
    }
    case K::SoundQueue: {
        const std::optional<SliderScale> scale = soundQueueScaleFor(singleAt(at));
        if (!scale)
            return false;
        row.set(options, scale->value);
        return true;
    }
    }
    return false;
}

} // namespace

QByteArray encodeOptions(const EmulatorOptions& options) {
    // Cleared first, so the unused bytes are zeros whatever a file held before.
    QByteArray out(kOptionSetSize, '\0');
    auto* bytes = reinterpret_cast<uchar*>(out.data());
    for (const OptionRow& row : optionTable()) {
        uchar* at = bytes + row.slot().offset;
        switch (row.kind) {
        case K::List:
        case K::Check:
            putInt16(at, row.get(options));
            break;
        case K::Choice:
            for (int i = 0; i < row.slotCount; ++i) {
                const int offset = row.slotList[static_cast<std::size_t>(i)].offset;
                if (offset >= 0)
                    putInt16(bytes + offset, row.get(options) == i ? -1 : 0);
            }
            break;
        case K::Number:
            putSingle(at, leadingSingle(options.*row.text));
            break;
        case K::Slider:
        case K::SoundQueue:
            putSingle(at, static_cast<float>(row.get(options)));
            break;
        }
    }
    return out;
}

OptionSetRead decodeOptions(QByteArrayView bytes, const EmulatorOptions& base) {
    OptionSetRead read;
    read.options = base;
    if (bytes.size() < kOptionSetSize) {
        // A short file is no option set: nothing of it is applied.
        read.status = OptionSetRead::Status::Short;
        return read;
    }
    const auto* data = reinterpret_cast<const uchar*>(bytes.data());
    const auto& table = optionTable();
    for (int i = 0; i < kOptionCount; ++i) {
        if (!applyRow(table[static_cast<std::size_t>(i)], data, read.options)) {
            read.status = OptionSetRead::Status::Invalid;
            read.firstBad = i;
            break;
        }
    }
    return read;
}

std::optional<SliderScale> soundQueueScaleFor(float stored) {
    if (!std::isfinite(stored))
        return std::nullopt;
    const QString text = shortestDecimalText(stored);
    // The hundreds: the text without its last two characters, which must be a number in
    // its own right. An empty remainder counts as 0, also for a single digit: the slider
    // can hold one and the window's own save writes it, so a load must take it back.
    const QString head = text.size() > 2 ? text.chopped(2) : QString();
    double hundreds = 0;
    if (!head.isEmpty()) {
        const std::optional<double> whole = wholeDecimalNumber(head);
        if (!whole)
            return std::nullopt;
        hundreds = *whole;
    }
    const std::optional<int> min = roundToInt((hundreds - 1) * 100);
    const std::optional<int> max = roundToInt((hundreds + 1) * 100);
    const std::optional<int> value = roundToInt(stored);
    // A value with a fraction ("3839.625") has hundreds that do not frame it: the slider
    // would refuse a value outside its range.
    if (!min || !max || !value || *value < *min || *value > *max)
        return std::nullopt;
    // A set of one or two digits re-centres below 1, where the bar must not go: z26 takes
    // no queue of 0 or less.
    return soundQueueOnScale(*min, *max, *value);
}

SliderScale soundQueueOnScale(qint64 min, qint64 max, qint64 value) {
    constexpr qint64 kTopWindowMin = 65339;
    constexpr qint64 kBottomWindowMax = 201;
    if (max > kSoundQueueHighest) {
        max = kSoundQueueHighest;
        min = kTopWindowMin;
    }
    if (min < kSoundQueueLowest) {
        min = kSoundQueueLowest;
        max = kBottomWindowMax;
    }
    return {static_cast<int>(min), static_cast<int>(max),
            static_cast<int>(std::clamp(value, min, max))};
}

QString withLumExtension(const QString& path) {
    if (path.right(4).toLower() == QLatin1String(".lum"))
        return path;
    return path + QStringLiteral(".lum");
}

bool writeOptionFile(const QString& path, const EmulatorOptions& options, QString* whyNot) {
    const QByteArray bytes = encodeOptions(options);
    QSaveFile file(path);
    // Unbuffered, so a short write (a full disk) shows here: a buffered one is flushed by
    // commit(), which does not notice it and would put a cut-off file in place.
    const bool bWritten = file.open(QIODevice::WriteOnly | QIODevice::Unbuffered) &&
                          file.write(bytes) == bytes.size() && file.commit();
    if (!bWritten) {
        if (whyNot)
            *whyNot = file.errorString();
        file.cancelWriting();
    }
    return bWritten;
}

OptionSetRead readOptionFile(const QString& path, const EmulatorOptions& base) {
    OptionSetRead unreadable;
    unreadable.status = OptionSetRead::Status::Unreadable;
    unreadable.options = base;

    // Only regular files: a folder cannot be read and a pipe or device could block.
    const QFileInfo info(path);
    if (!info.isFile()) {
        unreadable.error = info.exists() ? QStringLiteral("It is not a file.")
                                         : QStringLiteral("No such file or directory");
        return unreadable;
    }
    QFile file(path);
    QByteArray bytes;
    bytes.reserve(kOptionSetSize);
    if (file.open(QIODevice::ReadOnly)) {
        // read() may return less than asked for before the end, so read until full or done.
        while (bytes.size() < kOptionSetSize) {
            const QByteArray chunk = file.read(kOptionSetSize - bytes.size());
            if (chunk.isEmpty())
                break;
            bytes += chunk;
        }
    }
    if (file.error() != QFileDevice::NoError) {
        unreadable.error = file.errorString();
        return unreadable;
    }
    return decodeOptions(bytes, base);
}
