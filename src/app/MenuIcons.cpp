#include "app/MenuIcons.h"

#include <QApplication>
#include <QStyle>

QIcon menuIcon(int index) {
    struct Entry {
        const char* theme;
        QStyle::StandardPixmap fallback;
    };
    static constexpr Entry kIcons[] = {
        {"preferences-system", QStyle::SP_FileDialogDetailedView},
        {"preferences-desktop-wallpaper", QStyle::SP_DirIcon},
        {"image-x-generic", QStyle::SP_FileIcon},
        {"application-exit", QStyle::SP_DialogCloseButton},
        {"format-text-color", QStyle::SP_FileDialogContentsView},
        {"help-about", QStyle::SP_MessageBoxInformation},
        {"text-x-generic", QStyle::SP_FileIcon},
        {"go-home", QStyle::SP_DirHomeIcon},
        {"applications-internet", QStyle::SP_DriveNetIcon},
        {"document-open", QStyle::SP_DialogOpenButton},
        {"document-save", QStyle::SP_DialogSaveButton},
    };
    if (index < 0 || index >= static_cast<int>(std::size(kIcons)))
        return QIcon();
    const Entry& e = kIcons[index];
    return QIcon::fromTheme(QLatin1String(e.theme),
                            QApplication::style()->standardIcon(e.fallback));
}
