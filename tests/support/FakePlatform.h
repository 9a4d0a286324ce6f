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
#include <tuple>
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
    QString ShowOpen(QWidget*, const FileDialogRequest& r) override { return path(false, r); }
    QString ShowSave(QWidget*, const FileDialogRequest& r) override { return path(true, r); }
    QString ShowFolder(QWidget*, const QString& title, const QString&) override {
        folderTitles << title;
        return next(paths, QString());
    }
    std::optional<quint32> ShowColor(QWidget*, const QString& title, quint32 initial) override {
        colourTitles << title;
        colourInitials.push_back(initial);
        return next(colours, std::optional<quint32>());
    }

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

private:
    template <class T> static T next(std::deque<T>& queue, T empty) {
        if (queue.empty())
            return empty;
        T front = std::move(queue.front());
        queue.pop_front();
        return front;
    }
    QString path(bool bSave, const FileDialogRequest& request) {
        fileRequests.push_back({bSave, request});
        return next(paths, QString());
    }
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
                      const QString& workingFolder, QString* whyNot) override {
        started.push_back({program, arguments, workingFolder});
        if (!succeed && whyNot)
            *whyNot = QStringLiteral("Permission denied");
        return succeed;
    }
    bool OpenUrl(const QString& url) override { return record(urls, url); }
    bool OpenTextFile(const QString& path) override { return record(textFiles, path); }
    bool OpenFolder(const QString& path) override { return record(folders, path); }

    bool succeed = true;
    std::vector<Start> started;
    QStringList urls;
    QStringList textFiles;
    QStringList folders;

private:
    bool record(QStringList& calls, const QString& call) {
        calls << call;
        return succeed;
    }
};

// A registry that answers from a script: one value under a key and name.
class FakeRegistry final : public Registry {
public:
    std::optional<RegistryValue> QueryValue(quint32 root, const QString& keyName,
                                            const QString& valueName) override {
        for (const auto& [where, value] : values)
            if (where == std::tuple{root, keyName, valueName})
                return value;
        return std::nullopt;
    }
    void set(quint32 root, const QString& keyName, const QString& valueName, RegistryValue value) {
        values.push_back({{root, keyName, valueName}, std::move(value)});
    }

    std::vector<std::pair<std::tuple<quint32, QString, QString>, RegistryValue>> values;
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
    // The same platform with a real shell or another downloader in it.
    Platform with(Shell& other) { return with(other, network); }
    Platform with(Downloader& other) { return with(shell, other); }
    Platform with(Shell& otherShell, Downloader& otherNetwork) {
        const Platform& p = platform;
        return {p.store,    p.dialogs,    otherShell,    p.programFolder, otherNetwork,
                p.registry, p.userFolder, p.cacheFolder, p.dataFolder,    p.runtimeFolder};
    }
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
