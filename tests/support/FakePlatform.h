#pragma once

#include "platform/Dialogs.h"
#include "platform/Downloader.h"
#include "platform/IniSettingsStore.h"
#include "platform/Platform.h"
#include "platform/Registry.h"
#include "platform/Shell.h"

#include <QStringList>
#include <QTemporaryDir>

#include <deque>
#include <memory>
#include <optional>
#include <vector>

// Dialogs that answer from scripts and record every box they were asked to show.
class FakeDialogs final : public Dialogs {
public:
    struct Box {
        QString title;
        QString text;
        MsgButtons buttons;
        MsgIcon icon;
    };
    struct FileRequest {
        bool save;
        FileDialogRequest request;
    };

    MsgResult MsgBox(QWidget* owner, const QString& text, MsgButtons buttons, MsgIcon icon,
                     const QString& title) override;
    QString ShowOpen(QWidget* owner, const FileDialogRequest& request) override;
    QString ShowSave(QWidget* owner, const FileDialogRequest& request) override;
    QString ShowFolder(QWidget* owner, const QString& title, const QString& initialFolder) override;
    std::optional<quint32> ShowColor(QWidget* owner, const QString& title,
                                     quint32 initialColour) override;

    // Scripted answers, used in order; when a queue is empty a box answers with its
    // first button and a chooser is cancelled.
    std::deque<MsgResult> answers;
    std::deque<QString> paths;
    std::deque<std::optional<quint32>> colours;

    std::vector<Box> boxes;
    std::vector<FileRequest> fileRequests;
    QStringList folderTitles;
    QStringList colourTitles;
    std::vector<quint32> colourInitials;
};

// A shell that starts nothing and records every call.
class FakeShell final : public Shell {
public:
    struct Start {
        QString program;
        QStringList arguments;
        QString workingFolder;
    };
    bool StartProgram(const QString& program, const QStringList& arguments,
                      const QString& workingFolder) override;
    bool OpenUrl(const QString& url) override;
    bool OpenTextFile(const QString& path) override;
    bool OpenFolder(const QString& path) override;

    bool succeed = true;
    std::vector<Start> started;
    QStringList urls;
    QStringList textFiles;
    QStringList folders;
};

// A registry that answers from a script and records every lookup.
class FakeRegistry final : public Registry {
public:
    struct Lookup {
        quint32 root;
        QString keyName;
        QString valueName;
    };
    std::optional<RegistryValue> QueryValue(quint32 root, const QString& keyName,
                                            const QString& valueName) override;
    void set(quint32 root, const QString& keyName, const QString& valueName, RegistryValue value);

    std::vector<std::pair<Lookup, RegistryValue>> values;
    std::vector<Lookup> lookups;
};

// A whole fake platform over a temporary folder: the store is a real INI file in it and
// the program folder is a subfolder of it.
class FakePlatform {
public:
    FakePlatform();

    QString root() const { return m_dir.path(); }
    QString programFolder() const { return m_dir.path() + QStringLiteral("/program"); }
    QString iniPath() const { return m_dir.path() + QStringLiteral("/config/lum/lum.ini"); }
    // Writes a file (and its folders) under the temporary folder; returns its path.
    QString writeFile(const QString& relativePath, const QByteArray& content = {}) const;
    // Makes a folder under the temporary folder; returns its path.
    QString makeFolder(const QString& relativePath) const;
    // A fresh store read back from the INI file, as the next start would see it.
    std::unique_ptr<IniSettingsStore> reopenStore() const;

    QTemporaryDir m_dir;
    IniSettingsStore store;
    FakeDialogs dialogs;
    FakeShell shell;
    // Downloads are real; tests serve them from 127.0.0.1.
    QtDownloader network{std::chrono::seconds(5)};
    FakeRegistry registry;
    Platform platform;
};
