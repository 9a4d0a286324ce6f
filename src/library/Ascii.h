#pragma once

#include <QStringView>

#include <algorithm>
#include <string_view>

// Whether text is plain ASCII: such names and terms take the quicker byte-wise paths.
inline bool isAscii(QStringView s) {
    return std::all_of(s.begin(), s.end(), [](QChar c) { return c.unicode() < 0x80; });
}

inline bool isAscii(std::string_view s) {
    return std::all_of(s.begin(), s.end(),
                       [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}
