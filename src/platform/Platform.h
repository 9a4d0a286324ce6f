#pragma once

#include <QString>

class Dialogs;
class Downloader;
class Registry;
class SettingsStore;
class Shell;

// Everything of the operating system that the windows use. The program builds the real
// one in main(); the tests build a fake that scripts answers and records what happened.
struct Platform {
    SettingsStore& store;
    Dialogs& dialogs;
    Shell& shell;
    // The folder that holds the executable and its data files (no trailing separator).
    QString programFolder;
    Downloader& network;
    Registry& registry;
    // The user's own folders (no trailing separator): the one that holds lum.ini and the
    // user's option sets, the one for copies that may be fetched again, and the one for
    // what z26 writes when its own folder is read-only.
    QString userFolder;
    QString cacheFolder;
    QString dataFolder;
    // The user's private folder for files that live only while lum runs (ROMs taken out of
    // archives).
    QString runtimeFolder;
};

// The user's folders as the desktop names them: $XDG_CONFIG_HOME/lum, $XDG_CACHE_HOME/lum,
// $XDG_DATA_HOME/lum and $XDG_RUNTIME_DIR/lum (the cache folder when the session has none).
struct UserFolders {
    QString user;
    QString cache;
    QString data;
    QString runtime;
};
UserFolders desktopUserFolders();
