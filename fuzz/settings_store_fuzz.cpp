// The settings store: any bytes as lum.ini, and every value in it through the typed readers
// (numbers, Booleans, colours) that the windows use.
#include "FuzzSupport.h"

#include "platform/IniSettingsStore.h"

#include <QStringList>

#include <cmath>
#include <limits>

namespace {

using Sections = std::vector<IniSettingsStore::Section>;

bool sameSections(const Sections& a, const Sections& b) {
    // Sections without entries are not written, so they do not come back.
    auto filled = [](const Sections& all) {
        Sections out;
        for (const auto& s : all)
            if (!s.entries.empty())
                out.push_back(s);
        return out;
    };
    const Sections x = filled(a), y = filled(b);
    if (x.size() != y.size())
        return false;
    for (std::size_t i = 0; i < x.size(); ++i) {
        if (x[i].name != y[i].name || x[i].entries.size() != y[i].entries.size())
            return false;
        for (std::size_t j = 0; j < x[i].entries.size(); ++j)
            if (x[i].entries[j].key != y[i].entries[j].key ||
                x[i].entries[j].value != y[i].entries[j].value)
                return false;
    }
    return true;
}

void checkReaders(const IniSettingsStore::Entry& entry) {
    const double single = parseSingle(entry.value, 12345.5);
    FUZZ_CHECK(std::isfinite(single) && static_cast<double>(static_cast<float>(single)) == single);
    // What the windows write back reads as the same number.
    FUZZ_CHECK(parseSingle(singleText(single), -1.0) == single);

    const bool flag = parseBool(entry.value, true);
    FUZZ_CHECK(parseBool(boolText(flag), !flag) == flag);

    constexpr quint32 def = 0x00123456;
    const quint32 colour = parseColour(entry.value, def);
    if (const std::optional<qint64> stored = tryParseLong(entry.value);
        stored && *stored >= std::numeric_limits<qint32>::min() &&
        *stored <= std::numeric_limits<quint32>::max())
        FUZZ_CHECK(colour == static_cast<quint32>(*stored));
    else
        FUZZ_CHECK(colour == def);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QByteArray text = fuzz::bytes(data, size);
    const Sections sections = IniSettingsStore::parse(text);

    // A rewrite keeps every section, key and value as read.
    const QByteArray written = IniSettingsStore::format(sections);
    FUZZ_CHECK(sameSections(IniSettingsStore::parse(written), sections));
    FUZZ_CHECK(IniSettingsStore::format(IniSettingsStore::parse(written)) == written);

    for (const auto& section : sections)
        for (const auto& entry : section.entries)
            checkReaders(entry);

    // Any text the program stores under its own keys comes back unchanged: the input, cut
    // at its \x01 bytes, gives the values (paths and patterns are the user's text, line
    // breaks and all).
    const QString all = QString::fromUtf8(text);
    Sections stored{{QStringLiteral("Settings"), {}}};
    const QStringList values = all.split(u'\x01');
    for (qsizetype i = 0; i < values.size() && i < 64; ++i)
        stored[0].entries.push_back({QStringLiteral("ROM%1Path").arg(i), values[i]});
    const Sections reread = IniSettingsStore::parse(IniSettingsStore::format(stored));
    FUZZ_CHECK(sameSections(reread, stored));
    return 0;
}
