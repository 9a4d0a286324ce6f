#pragma once

#include <QByteArray>
#include <QString>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>

// Helpers shared by the fuzz targets.
namespace fuzz {

// A broken promise of the code under test: print it and abort, so libFuzzer keeps the input.
[[noreturn]] inline void fail(const char* what, const char* file, int line) {
    std::fprintf(stderr, "%s:%d: check failed: %s\n", file, line, what);
    std::abort();
}

inline QByteArray bytes(const std::uint8_t* data, std::size_t size) {
    return QByteArray(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
}

// Splits the input at its first NUL byte: the text before and the text after (the second
// part is empty when there is no NUL). Two texts from one input keep the corpus readable.
inline std::pair<QString, QString> twoTexts(const std::uint8_t* data, std::size_t size) {
    const std::string_view all(reinterpret_cast<const char*>(data), size);
    const auto cut = all.find('\0');
    if (cut == std::string_view::npos)
        return {QString::fromUtf8(all.data(), qsizetype(all.size())), QString()};
    const std::string_view first = all.substr(0, cut);
    const std::string_view second = all.substr(cut + 1);
    return {QString::fromUtf8(first.data(), qsizetype(first.size())),
            QString::fromUtf8(second.data(), qsizetype(second.size()))};
}

} // namespace fuzz

#define FUZZ_CHECK(condition)                                                                      \
    do {                                                                                           \
        if (!(condition))                                                                          \
            ::fuzz::fail(#condition, __FILE__, __LINE__);                                          \
    } while (false)
