#pragma once

#include "platform/Shell.h"

// Starts programs detached, their arguments byte for byte, and opens documents and addresses with
// the desktop's default applications.
class QtShell final : public Shell {
public:
    bool StartProgram(const QString& program, const QStringList& arguments,
                      const QString& workingFolder, QString* whyNot) override;
    bool OpenUrl(const QString& url) override;
    bool OpenTextFile(const QString& path) override;
    bool OpenFolder(const QString& path) override;
};
