#pragma once

#include "emulator/EmulatorOptions.h"

#include <QByteArray>
#include <QByteArrayView>
#include <QString>

#include <optional>

// Option sets on disk: a .lum file is one 172-byte record of the options, little-endian,
// with no header; the bytes no option uses are zeros.

// What reading an option set gave.
struct OptionSetRead {
    enum class Status {
        Ok,
        Unreadable, // the file could not be opened or read
        Short,      // fewer than kOptionSetSize bytes
        Invalid,    // a value the window cannot show; see firstBad
    };
    Status status = Status::Ok;
    // The options the set was applied to, with every row of optionTable() before the
    // first bad one applied (all of them when the set is good, none when it is short).
    EmulatorOptions options;
    // The row of optionTable() that could not be applied, or -1.
    int firstBad = -1;
    // Why an Unreadable set could not be read, in the system's words where it gave some.
    QString error;

    bool ok() const { return status == Status::Ok; }
};

QByteArray encodeOptions(const EmulatorOptions& options);
// Applies the set in `bytes` to `base`, row by row, stopping at the first value the window
// cannot show (a check box state outside 0..2, a list entry the list does not have, a
// number that is not finite, a slider value that is no 32-bit whole number). Bytes after
// the record are ignored.
OptionSetRead decodeOptions(QByteArrayView bytes, const EmulatorOptions& base);

// The path a save writes to: unless its last four characters are ".lum" in any case,
// ".lum" is appended ("name" -> "name.lum", "NAME.LUM" stays, "x.lum.bak" ->
// "x.lum.bak.lum").
QString withLumExtension(const QString& path);

// Writes the set as the whole file. The bytes go to a temporary file in the same folder
// that is renamed into place, so a failure leaves any older file as it was and no
// half-written one. False when the file could not be written, with the reason in `whyNot`.
bool writeOptionFile(const QString& path, const EmulatorOptions& options,
                     QString* whyNot = nullptr);

// Reads a set and applies it to `base`. A path that is not a regular file or cannot be
// read is Unreadable and applies nothing.
OptionSetRead readOptionFile(const QString& path, const EmulatorOptions& base);

// A slider bar's visible range and value.
struct SliderScale {
    int min = 0;
    int max = 0;
    int value = 0;
    bool operator==(const SliderScale&) const = default;
};

// The sound queue's whole scale, of which its bar shows a window 200 wide; z26 takes no
// queue outside it.
inline constexpr int kSoundQueueLowest = 1;
inline constexpr int kSoundQueueHighest = 65536;

// The window held on the scale (1..201 at the bottom, 65339..65536 at the top: a window of
// 197 there), then the value held in the window.
SliderScale soundQueueOnScale(qint64 min, qint64 max, qint64 value);

// The sound queue's bar as a stored value shows it: the range re-centred on the value's
// hundreds (the decimal text without its last two digits), then the value, both held on the
// scale as above. Empty when the value cannot be shown that way (not a whole number within
// the range it makes, or beyond the bar's 32-bit range).
std::optional<SliderScale> soundQueueScaleFor(float stored);
