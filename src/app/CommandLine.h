#pragma once

#include <QString>
#include <QStringList>

// What lum was asked to do by its command line.
struct CommandLine {
    enum class Mode {
        Window, // no arguments: the main window
        Print,  // --help or --version: `text` for standard output
        Fail,   // a wrong option: `text` for standard error
        Refuse, // a ROM file that cannot be opened: `text` for a box
        Launch, // a ROM file: start z26 on `romPath`
    };
    Mode mode = Mode::Window;
    QString text;
    QString romPath;
    int exitStatus = 0;
};

// Reads the arguments, the program's own name first. Needs no application object, so
// --help and --version work without a display.
CommandLine parseCommandLine(const QStringList& arguments);
