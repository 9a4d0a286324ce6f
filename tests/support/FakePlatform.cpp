#include "support/FakePlatform.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

MsgResult FakeDialogs::MsgBox(QWidget*, const QString& text, MsgButtons buttons, MsgIcon icon,
                              const QString& title) {
    boxes.push_back({title, text, buttons, icon});
    if (!answers.empty()) {
        const MsgResult answer = answers.front();
        answers.pop_front();
        return answer;
    }
    switch (buttons) {
    case MsgButtons::Ok:
    case MsgButtons::OkCancel:
        return MsgResult::Ok;
    case MsgButtons::YesNo:
    case MsgButtons::YesNoCancel:
        return MsgResult::Yes;
    }
    return MsgResult::Ok;
}

QString FakeDialogs::ShowOpen(QWidget*, const FileDialogRequest& request) {
    fileRequests.push_back({false, request});
    if (paths.empty())
        return QString();
    const QString path = paths.front();
    paths.pop_front();
    return path;
}

QString FakeDialogs::ShowSave(QWidget*, const FileDialogRequest& request) {
    fileRequests.push_back({true, request});
    if (paths.empty())
        return QString();
    const QString path = paths.front();
    paths.pop_front();
    return path;
}

QString FakeDialogs::ShowFolder(QWidget*, const QString& title, const QString&) {
    folderTitles << title;
    if (paths.empty())
        return QString();
    const QString path = paths.front();
    paths.pop_front();
    return path;
}

std::optional<quint32> FakeDialogs::ShowColor(QWidget*, const QString& title,
                                              quint32 initialColour) {
    colourTitles << title;
    colourInitials.push_back(initialColour);
    if (colours.empty())
        return std::nullopt;
    const std::optional<quint32> colour = colours.front();
    colours.pop_front();
    return colour;
}

bool FakeShell::StartProgram(const QString& program, const QStringList& arguments,
                             const QString& workingFolder) {
    started.push_back({program, arguments, workingFolder});
    return succeed;
}

bool FakeShell::OpenUrl(const QString& url) {
    urls << url;
    return succeed;
}

bool FakeShell::OpenTextFile(const QString& path) {
    textFiles << path;
    return succeed;
}

bool FakeShell::OpenFolder(const QString& path) {
    folders << path;
    return succeed;
}

std::optional<RegistryValue> FakeRegistry::QueryValue(quint32 root, const QString& keyName,
                                                      const QString& valueName) {
    lookups.push_back({root, keyName, valueName});
    for (const auto& [where, value] : values)
        if (where.root == root && where.keyName == keyName && where.valueName == valueName)
            return value;
    return std::nullopt;
}

void FakeRegistry::set(quint32 root, const QString& keyName, const QString& valueName,
                       RegistryValue value) {
    values.push_back({{root, keyName, valueName}, std::move(value)});
}

FakePlatform::FakePlatform()
    : store(m_dir.path() + QStringLiteral("/config/lum/lum.ini")),
      platform{store,   dialogs, shell, m_dir.path() + QStringLiteral("/program"),
               network, registry} {
    QDir().mkpath(programFolder());
}

QString FakePlatform::writeFile(const QString& relativePath, const QByteArray& content) const {
    const QString path = m_dir.path() + u'/' + relativePath;
    QDir().mkpath(QFileInfo(path).absolutePath());
    QFile file(path);
    if (file.open(QIODevice::WriteOnly))
        file.write(content);
    return path;
}

QString FakePlatform::makeFolder(const QString& relativePath) const {
    const QString path = m_dir.path() + u'/' + relativePath;
    QDir().mkpath(path);
    return path;
}

std::unique_ptr<IniSettingsStore> FakePlatform::reopenStore() const {
    return std::make_unique<IniSettingsStore>(iniPath());
}
