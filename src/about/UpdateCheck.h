#pragma once

#include "about/UpdateDescription.h"

#include <QPointer>
#include <QString>
#include <QWidget>

struct Platform;

// The update check behind the About window's Update and Forum buttons: fetch the update
// description file, find this product's section, then either open its forum page or
// report the version situation and, when the user agrees, fetch and start a newer
// installer. Runs synchronously; the downloads hold back user input while they last.
class UpdateCheck {
public:
    enum class Outcome {
        Finished,
        // The installer was started: the program must end at once, saving nothing.
        EndProgram,
    };

    // `serverBase` is the scheme and host that serve the description file and the forum,
    // without a trailing slash.
    UpdateCheck(Platform& platform, QWidget* owner, QString serverBase,
                ProductVersion product = thisProduct());

    Outcome Run(bool forumRequest);

    // Where the description file is kept: "tmp" in the cache folder (a private temporary
    // folder when that cannot be written). The program folder is read-only once installed.
    QString localCopyPath() const;
    // Where installers go: "Update" in the cache folder.
    QString updateFolder() const;

private:
    Outcome runUpdate(const UpdateSection& section);
    void openForum(const UpdateSection& section);
    enum class Fetched { Whole, Failed, Cancelled };
    bool downloadDescription(const QString& localFilename);
    // Shows the download's progress with a Cancel button, over the owner.
    Fetched downloadInstaller(const QString& url, const QString& localFilename);
    // Whether a file can be written at `path` (an existing one replaced).
    static bool canWrite(const QString& path);
    void reportFailedCheck(const QString& text);

    Platform& m_platform;
    // Message boxes sit over the owner for as long as it exists.
    QPointer<QWidget> m_owner;
    QString m_serverBase;
    ProductVersion m_product;
};
