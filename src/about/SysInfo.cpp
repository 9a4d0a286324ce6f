#include "about/SysInfo.h"

#include "platform/Dialogs.h"
#include "platform/FileSystem.h"
#include "platform/Platform.h"
#include "platform/Shell.h"

#include <algorithm>

std::optional<QString> registryValueText(const RegistryValue& value) {
    switch (value.type) {
    case kRegString: {
        const qsizetype end = value.data.indexOf('\0');
        return QString::fromUtf8(end < 0 ? value.data : value.data.left(end));
    }
    case kRegNumber: {
        // Stored lowest byte first; written highest first as one number, so that bytes
        // below 0x10 and zero bytes keep their places.
        quint32 number = 0;
        for (qsizetype i = std::min<qsizetype>(value.data.size(), 4) - 1; i >= 0; --i)
            number = (number << 8) | quint8(value.data.at(i));
        return QStringLiteral("&h") + QString::number(number, 16).toUpper();
    }
    default:
        return std::nullopt;
    }
}

bool GetKeyValue(Registry& registry, quint32 KeyRoot, const QString& KeyName,
                 const QString& SubKeyRef, QString& KeyVal) {
    const std::optional<RegistryValue> value = registry.QueryValue(KeyRoot, KeyName, SubKeyRef);
    if (!value) {
        KeyVal.clear();
        return false;
    }
    if (const std::optional<QString> text = registryValueText(*value))
        KeyVal = *text;
    return true;
}

void StartSysInfo(Platform& platform, QWidget* owner) {
    QString path;
    bool started = false;
    if (GetKeyValue(platform.registry, kHkeyLocalMachine, QString::fromLatin1(kSysInfoPathKey),
                    QString::fromLatin1(kSysInfoPathValue), path)) {
        started = platform.shell.StartProgram(path, {});
    } else if (GetKeyValue(platform.registry, kHkeyLocalMachine,
                           QString::fromLatin1(kSysInfoFolderKey),
                           QString::fromLatin1(kSysInfoFolderValue), path)) {
        const QString program = path + QStringLiteral("/MSINFO32.EXE");
        if (FileExist(program))
            started = platform.shell.StartProgram(program, {});
    }
    if (!started)
        platform.dialogs.MsgBox(owner,
                                QStringLiteral("System Information Is Unavailable At This Time"),
                                MsgButtons::Ok, MsgIcon::None);
}
