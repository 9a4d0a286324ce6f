#pragma once

#include "support/Boxes.h"
#include "support/FakePlatform.h"
#include "support/WidgetDump.h"

#include "app/frmMain.h"
#include "library/RomListModel.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/cTextBoxXP.h"

#include <QAction>

#include <gtest/gtest.h>

#include <memory>

// A main window over a fake platform, with helpers to lay out the store and the ROM
// folders and to reach the windows' controls by name.
class AppFixture : public ::testing::Test {
protected:
    // Stores ROM folder entry n (counted from 1) with its flag, by the keys' names.
    void storeFolder(int n, const QString& path, bool enabled = true) {
        const QString number = n == 1 ? QString() : QString::number(n);
        fake.store.SaveSetting("Settings", "ROM" + number + "Path", path);
        fake.store.SaveSetting("Settings", "ROM" + number + "Checked", enabled ? "True" : "False");
    }
    // A folder under the temporary root holding empty files with these names.
    QString romFolder(const QString& name, const QStringList& files) {
        const QString folder = fake.makeFolder(name);
        for (const QString& file : files)
            fake.writeFile(name + "/" + file);
        return folder;
    }
    // Both paths known: the emulator z26 in "emu", the ROMs in "roms".
    QString storePaths(const QStringList& roms = {"a.bin"}) {
        fake.writeFile("emu/z26");
        fake.store.SaveSetting("Settings", "Z26Path", fake.root() + "/emu");
        storeFolder(1, romFolder("roms", roms));
        return fake.root() + "/roms";
    }
    // The window as the start-up routine makes it: built (its folders' listing starts),
    // loaded, shown.
    frmMain& load() {
        if (!window)
            window = std::make_unique<frmMain>(fake.platform);
        window->Form_Load();
        window->show();
        return *window;
    }

    QAction* action(const char* name) const { return control<QAction>(*window, name); }
    ListView* list() const { return control<ListView>(*window, "vbalListViewCtl1"); }
    frmSettings& settings() const { return window->settingsWindow(); }
    QStringList names() const {
        QStringList out;
        for (int row = 0; row < window->listModel().rowCount(); ++row)
            out << window->listModel().name(row);
        return out;
    }
    void selectRow(int row) const { list()->setCurrentIndex(window->listModel().index(row, 0)); }
    // What the next start would read from the store, or "<missing>".
    QString stored(const QString& key, const QString& section = "Settings") const {
        return fake.reopenStore()->GetSetting(section, key, "<missing>");
    }
    std::vector<std::string> boxes() const { return boxLines(fake.dialogs); }
    // The balloon tip shown on a control as "icon | title | text", or "none"; reading it
    // closes it, as the user's click would.
    static std::string balloon(QWidget* box) {
        BalloonTip* tip = cTextBoxXP::shownOn(box);
        if (!tip)
            return "none";
        const QString shown =
            QString::number(tip->icon()) + " | " + tip->title() + " | " + tip->text();
        tip->close();
        return shown.toStdString();
    }

    FakePlatform fake;
    std::unique_ptr<frmMain> window;
};
