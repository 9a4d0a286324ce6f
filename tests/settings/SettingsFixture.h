#pragma once

#include "support/Boxes.h"
#include "support/FakePlatform.h"
#include "support/WidgetDump.h"
#include "support/Widgets.h"

#include "settings/frmSettings.h"

#include <QCoreApplication>
#include <QDropEvent>
#include <QMimeData>
#include <QUrl>

#include <gtest/gtest.h>

#include <memory>

// A settings window over a fake platform, with helpers to lay out ROM folders and to act
// as a user would.
class SettingsFixture : public ::testing::Test {
protected:
    // The window as the user sees it: shown, so its folder counts are made.
    std::unique_ptr<frmSettings> open() {
        auto w = std::make_unique<frmSettings>(fake.platform);
        w->show();
        return w;
    }

    // Stores ROM folder entry n (counted from 1) with its flag, by the keys' names.
    void storeFolder(int n, const QString& path, bool enabled) {
        const QString number = n == 1 ? QString() : QString::number(n);
        fake.store.SaveSetting("Settings", "ROM" + number + "Path", path);
        fake.store.SaveSetting("Settings", "ROM" + number + "Checked", enabled ? "True" : "False");
    }

    // A folder under the temporary root holding empty files with these names.
    QString romFolder(const QString& name, const QStringList& files = {}) {
        const QString folder = fake.makeFolder(name);
        for (const QString& file : files)
            fake.writeFile(name + "/" + file);
        return folder;
    }

    // What the next start would read from the store, or "<missing>".
    QString stored(const QString& key, const QString& section = "Settings") const {
        return fake.reopenStore()->GetSetting(section, key, "<missing>");
    }

    // Drops local files on a control, as a file manager does: the drag enters first.
    static void drop(QWidget* target, const QList<QUrl>& urls) {
        QMimeData data;
        data.setUrls(urls);
        QDragEnterEvent enter(QPoint(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(target, &enter);
        QDropEvent dropped(QPointF(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(target, &dropped);
    }

    FakePlatform fake;
};
