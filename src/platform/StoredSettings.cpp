#include "platform/StoredSettings.h"

#include <climits>

namespace {

const QString kSettings = QStringLiteral("Settings");
const QString kRecent = QStringLiteral("Recent");
const QString kFavourites = QStringLiteral("Favourites");

// Entry n of a numbered list of ROMs.
QString romKey(int n) {
    return QStringLiteral("ROM") + QString::number(n);
}

// The key of folder entry n: "ROM", n without blanks (nothing for 1), then the suffix.
QString folderKey(int n, QLatin1String suffix) {
    return QStringLiteral("ROM") + (n == 1 ? QString() : QString::number(n)) + suffix;
}

QString get(const SettingsStore& store, const char* section, const char* key) {
    return store.GetSetting(QLatin1String(section), QLatin1String(key));
}

bool put(SettingsStore& store, const char* section, const char* key, const QString& value) {
    return store.SaveSetting(QLatin1String(section), QLatin1String(key), value);
}

} // namespace

QString read(const SettingsStore& store, const TextSetting& setting) {
    return store.GetSetting(QLatin1String(setting.section), QLatin1String(setting.key),
                            QLatin1String(setting.fallback));
}

bool read(const SettingsStore& store, const BoolSetting& setting) {
    return parseBool(get(store, setting.section, setting.key), setting.fallback);
}

quint32 read(const SettingsStore& store, const ColourSetting& setting) {
    // The program stores only plain colours; a system colour here came from elsewhere and
    // may match the list's background.
    const quint32 colour = parseColour(get(store, setting.section, setting.key), setting.fallback);
    return colour <= 0xFFFFFF ? colour : setting.fallback;
}

WindowPlace read(const SettingsStore& store, const PlaceSetting& setting) {
    const auto number = [&](const char* key, double fallback) {
        return parseSingle(get(store, setting.section, key), fallback);
    };
    WindowPlace place{number("top", setting.fallback.top), number("left", setting.fallback.left),
                      setting.fallback.width, setting.fallback.height};
    if (setting.bSized) {
        place.width = number("width", setting.fallback.width);
        place.height = number("height", setting.fallback.height);
    }
    return place;
}

bool write(SettingsStore& store, const TextSetting& setting, const QString& value) {
    return put(store, setting.section, setting.key, value);
}

bool write(SettingsStore& store, const BoolSetting& setting, bool value) {
    return put(store, setting.section, setting.key, boolText(value));
}

bool write(SettingsStore& store, const ColourSetting& setting, quint32 value) {
    return put(store, setting.section, setting.key, QString::number(value));
}

bool write(SettingsStore& store, const PlaceSetting& setting, const WindowPlace& place) {
    bool bWritten = put(store, setting.section, "top", singleText(place.top));
    bWritten = put(store, setting.section, "left", singleText(place.left)) && bWritten;
    if (setting.bSized) {
        bWritten = put(store, setting.section, "height", singleText(place.height)) && bWritten;
        bWritten = put(store, setting.section, "width", singleText(place.width)) && bWritten;
    }
    return bWritten;
}

std::vector<RomFolder> readRomFolders(const SettingsStore& store) {
    std::vector<RomFolder> folders;
    for (int n = 1;; ++n) {
        QString path = store.GetSetting(kSettings, folderKey(n, QLatin1String("Path")));
        if (path.isEmpty())
            break;
        const bool bEnabled =
            parseBool(store.GetSetting(kSettings, folderKey(n, QLatin1String("Checked"))), false);
        folders.push_back({std::move(path), bEnabled});
    }
    return folders;
}

void writeRomFolders(SettingsStore& store, const std::vector<RomFolder>& folders) {
    int n = 1;
    for (const RomFolder& folder : folders) {
        store.SaveSetting(kSettings, folderKey(n, QLatin1String("Path")), folder.path);
        store.SaveSetting(kSettings, folderKey(n, QLatin1String("Checked")),
                          boolText(folder.enabled));
        ++n;
    }
    store.SaveSetting(kSettings, folderKey(n, QLatin1String("Path")), QString());
}

QStringList enabledRomFolders(const SettingsStore& store) {
    QStringList paths;
    for (const RomFolder& folder : readRomFolders(store))
        if (folder.enabled)
            paths << folder.path;
    return paths;
}

namespace {

// A numbered list of ROMs (ROM1, ROM2, ...) in its own section, read up to its first gap.
QStringList readRomList(const SettingsStore& store, const QString& section, int most) {
    QStringList roms;
    for (int n = 1; n <= most; ++n) {
        const QString rom = store.GetSetting(section, romKey(n));
        if (rom.isEmpty())
            break;
        roms << rom;
    }
    return roms;
}

// Writes the list and deletes the entries after it: those of a longer list stored before
// would otherwise come back at the next start. `most` keys are always cleared.
void writeRomList(SettingsStore& store, const QString& section, const QStringList& roms, int most) {
    int n = 1;
    for (const QString& rom : roms)
        store.SaveSetting(section, romKey(n++), rom);
    for (; n <= most || !store.GetSetting(section, romKey(n)).isEmpty(); ++n)
        store.DeleteSetting(section, romKey(n));
}

} // namespace

QStringList readRecentRoms(const SettingsStore& store) {
    return readRomList(store, kRecent, kRecentRomCount);
}

void writeRecentRoms(SettingsStore& store, const QStringList& roms) {
    writeRomList(store, kRecent, roms.mid(0, kRecentRomCount), kRecentRomCount);
}

QStringList withRecentRom(QStringList roms, const QString& rom) {
    roms.removeAll(rom);
    roms.prepend(rom);
    return roms.mid(0, kRecentRomCount);
}

QStringList readFavourites(const SettingsStore& store) {
    return readRomList(store, kFavourites, INT_MAX);
}

void writeFavourites(SettingsStore& store, const QStringList& roms) {
    writeRomList(store, kFavourites, roms, 0);
}
