#include "platform/Platform.h"

#include "platform/IniSettingsStore.h"

#include <QFileInfo>
#include <QStandardPaths>

UserFolders desktopUserFolders() {
    const auto under = [](QStandardPaths::StandardLocation where) {
        return QStandardPaths::writableLocation(where) + QStringLiteral("/lum");
    };
    return {QFileInfo(IniSettingsStore::defaultFilePath()).absolutePath(),
            under(QStandardPaths::GenericCacheLocation),
            under(QStandardPaths::GenericDataLocation)};
}
