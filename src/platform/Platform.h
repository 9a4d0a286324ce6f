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
};
