#include "platform/Platform.h"

#include "platform/IniSettingsStore.h"

#include <QFileInfo>
#include <QStandardPaths>

UserFolders desktopUserFolders() {
    const auto under = [](QStandardPaths::StandardLocation where) {
        return QStandardPaths::writableLocation(where) + QStringLiteral("/lum");
    };
    const QString cache = under(QStandardPaths::GenericCacheLocation);
    const QString runtime = qEnvironmentVariable("XDG_RUNTIME_DIR");
    return {QFileInfo(IniSettingsStore::defaultFilePath()).absolutePath(), cache,
            under(QStandardPaths::GenericDataLocation),
            runtime.isEmpty() ? cache : runtime + QStringLiteral("/lum")};
}
