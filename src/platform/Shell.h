#pragma once

#include <QString>
#include <QStringList>

// Starting other programs and opening documents. Nothing here goes through a command
// shell, and the program never waits for what it starts.
class Shell {
public:
    virtual ~Shell() = default;

    // Starts `program` with `arguments`, detached. False when it could not be started, with
    // the system's reason in `whyNot` when one is asked for.
    virtual bool StartProgram(const QString& program, const QStringList& arguments,
                              const QString& workingFolder = QString(),
                              QString* whyNot = nullptr) = 0;
    virtual bool OpenUrl(const QString& url) = 0;
    // Opens a text file in the user's text editor.
    virtual bool OpenTextFile(const QString& path) = 0;
    // Opens a file manager window on a folder.
    virtual bool OpenFolder(const QString& path) = 0;
};
