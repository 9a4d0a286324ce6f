#include "platform/Registry.h"

#include <QStandardPaths>

QStringList ToolRegistry::systemInformationTools() {
    return {QStringLiteral("hardinfo2"), QStringLiteral("hardinfo"), QStringLiteral("kinfocenter"),
            QStringLiteral("gnome-system-monitor")};
}

std::optional<RegistryValue> ToolRegistry::QueryValue(quint32 root, const QString& keyName,
                                                      const QString& valueName) {
    if (root != kHkeyLocalMachine ||
        keyName.compare(u"SOFTWARE\\Microsoft\\Shared Tools\\MSINFO", Qt::CaseInsensitive) != 0 ||
        valueName.compare(u"PATH", Qt::CaseInsensitive) != 0)
        return std::nullopt;
    for (const QString& tool : systemInformationTools()) {
        const QString path = QStandardPaths::findExecutable(tool);
        if (!path.isEmpty())
            return RegistryValue{kRegString, path.toUtf8() + '\0'};
    }
    return std::nullopt;
}
