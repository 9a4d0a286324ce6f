#pragma once

#include "platform/SettingsStore.h"

#include <QString>
#include <QStringList>

#include <vector>

// Every value lum keeps in its settings store, each with its section, key, type and the one
// default a reader gets when the key is missing or its text does not convert. Readers and
// writers go through these, so no key is spelled anywhere else. (The subsystems below the
// application read some of them too, which is why they live beside the store.)

struct TextSetting {
    const char* section;
    const char* key;
    const char* fallback;
};
struct BoolSetting {
    const char* section;
    const char* key;
    bool fallback;
};
// An OLE colour number (0x00BBGGRR); anything else stored reads as the fallback.
struct ColourSetting {
    const char* section;
    const char* key;
    quint32 fallback;
};

// A window's place in twips: its keys "top", "left" and, for a window that keeps its size,
// "width" and "height".
struct WindowPlace {
    double top = 0;
    double left = 0;
    double width = 0;
    double height = 0;
};
struct PlaceSetting {
    const char* section;
    WindowPlace fallback;
    bool bSized;
};

namespace stored {

inline constexpr TextSetting z26Path{"Settings", "Z26Path", ""};
inline constexpr TextSetting romFilter{"Settings", "ROMFilter", "*.bin"};
// On: the folders below each ROM folder are listed too.
inline constexpr BoolSetting romSubfolders{"Settings", "ROMSubfolders", false};
inline constexpr ColourSetting backColor{"Settings", "BackColor", 0xFFFFFF};
inline constexpr ColourSetting textColor{"Settings", "TextColor", 0};
inline constexpr TextSetting backImg{"Settings", "BackImg", ""};
inline constexpr BoolSetting backImgEnabled{"Settings", "BackImgEnabled", true};
// Off: the list keeps its rows while the user types, until Enter.
inline constexpr BoolSetting searchAsYouType{"Settings", "SearchAsYouType", true};
// On: the list shows only the favourite ROMs among what the search matches.
inline constexpr BoolSetting favouritesOnly{"Settings", "FavouritesOnly", false};

inline constexpr PlaceSetting mainWindow{"winpos", {500, 500, 4905, 6570}, true};
inline constexpr BoolSetting mainWindowMaximized{"winpos", "max", false};
inline constexpr PlaceSetting settingsWindow{"setpos", {250, 250, 0, 0}, false};
inline constexpr PlaceSetting pictureWindow{"picpos", {300, 300, 11115, 5655}, true};

} // namespace stored

QString read(const SettingsStore& store, const TextSetting& setting);
bool read(const SettingsStore& store, const BoolSetting& setting);
quint32 read(const SettingsStore& store, const ColourSetting& setting);
WindowPlace read(const SettingsStore& store, const PlaceSetting& setting);

// Each returns false when the store could not keep the value.
bool write(SettingsStore& store, const TextSetting& setting, const QString& value);
bool write(SettingsStore& store, const BoolSetting& setting, bool value);
bool write(SettingsStore& store, const ColourSetting& setting, quint32 value);
bool write(SettingsStore& store, const PlaceSetting& setting, const WindowPlace& place);

// The ROM folders, kept as numbered entries in "Settings": ROMPath, ROM2Path, ROM3Path, ...
// with the flags ROMChecked, ROM2Checked, ... (missing: off).
struct RomFolder {
    QString path;
    bool enabled = false;

    bool operator==(const RomFolder&) const = default;
};

// The entries from 1 up to, not including, the first empty or missing path. Later ones
// are unreachable, for every reader alike.
std::vector<RomFolder> readRomFolders(const SettingsStore& store);

// Writes entries 1..k and then an empty path for entry k + 1, which ends the list even when
// a longer one was stored before. The flag of entry k + 1 is left alone.
void writeRomFolders(SettingsStore& store, const std::vector<RomFolder>& folders);

// The enabled folders' paths, in their stored order.
QStringList enabledRomFolders(const SettingsStore& store);

// The ROMs started last, newest first, kept as "Recent" ROM1..ROM10.
inline constexpr int kRecentRomCount = 10;
QStringList readRecentRoms(const SettingsStore& store);
// Writes the list and removes the entries past its end.
void writeRecentRoms(SettingsStore& store, const QStringList& roms);
// The list with `rom` on top, once, and no more than kRecentRomCount entries.
QStringList withRecentRom(QStringList roms, const QString& rom);

// The favourite ROMs by full path, kept as "Favourites" ROM1..ROMn up to the first empty or
// missing entry.
QStringList readFavourites(const SettingsStore& store);
// Writes the list and removes the entries that followed it.
void writeFavourites(SettingsStore& store, const QStringList& roms);
