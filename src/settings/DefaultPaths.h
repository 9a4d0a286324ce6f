#pragma once

#include <QString>

#include <vector>

class SettingsStore;

// The store layout of the ROM folders and the rules of the emulator path, kept apart from
// the settings window so that they can be checked without one.

// One stored ROM folder: its path and whether the main list includes it.
struct RomFolder {
    QString path;
    bool enabled = false;

    bool operator==(const RomFolder&) const = default;
};

// The keys of folder entry n (counted from 1) in the "Settings" section: ROMPath, ROM2Path,
// ROM3Path, ... and ROMChecked, ROM2Checked, ...
QString romPathKey(int n);
QString romCheckedKey(int n);

// The stored entries from 1 up to, not including, the first empty or missing path. Later
// entries are unreachable, as they are for every other reader.
std::vector<RomFolder> readRomFolders(const SettingsStore& store);

// Writes entries 1..k and then an empty path for entry k + 1, which ends the list even
// when a longer one was stored before. The flag of entry k + 1 is left alone.
void writeRomFolders(SettingsStore& store, const std::vector<RomFolder>& folders);

// The stored entries whose folders still exist. When some have vanished from disk the
// store is rewritten without them at once, so the folders stored after a vanished one
// stay reachable for the main list.
std::vector<RomFolder> loadExistingRomFolders(SettingsStore& store);

// The stored file pattern of the ROM list, "*.bin" when none is stored.
QString storedRomFilter(const SettingsStore& store);

// True when a dropped item's name marks an archive: longer than four characters and
// ending in ".rar" in any letter case.
bool isArchiveName(const QString& item);

// The emulator's file name on this platform.
QString z26FileName();

// The path of the emulator that `path` names: a folder gets the emulator's file name
// appended; a path that already ends in a separator and that name (any letter case) is
// kept as it is.
QString completeZ26Path(const QString& path);

// What the emulator box shows for the stored path: the trimmed text, completed as above
// once it is at least as long as the separator and the file name.
QString z26PathForDisplay(const QString& stored);
