#include "support/FakePlatform.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

MsgResult FakeDialogs::MsgBox(QWidget*, const QString& text, MsgButtons buttons, MsgIcon icon,
                              const QString& title) {
    boxes.push_back({title, text, buttons, icon});
    const bool bYes = buttons == MsgButtons::YesNo || buttons == MsgButtons::YesNoCancel;
    return next(answers, bYes ? MsgResult::Yes : MsgResult::Ok);
}

FakePlatform::FakePlatform()
    : store(iniPath()), platform{store,
                                 dialogs,
                                 shell,
                                 programFolder(),
                                 network,
                                 registry,
                                 root() + "/config/lum",
                                 root() + "/cache/lum",
                                 root() + "/data/lum",
                                 root() + "/run/lum"} {
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
