#pragma once

#include "support/Boxes.h"
#include "support/Files.h"
#include "support/WidgetDump.h"
#include "support/Widgets.h"

#include "about/frmAbout.h"
#include "app/frmMain.h"
#include "library/RomListModel.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <gtest/gtest.h>

// A main window over a fake platform; helpers lay out the store and tell what happened.
class MainWindow : public ::testing::Test {
protected:
    void set(const QString& key, const QString& to) { fake.store.SaveSetting("Settings", key, to); }
    // ROM folder entry n (from 1) by its keys' names: a folder with empty files, or "".
    void storeFolder(int n, const QString& name, const QStringList& files = {},
                     const QString& checked = "True") {
        for (const QString& file : files)
            fake.writeFile(name + "/" + file);
        const QString number = n == 1 ? QString() : QString::number(n);
        set("ROM" + number + "Path", name.isEmpty() ? name : fake.makeFolder(name));
        set("ROM" + number + "Checked", checked);
    }
    // Both paths known: the emulator z26 in "emu", the ROMs in "roms".
    void storePaths(const QStringList& roms = {"a.bin"}) {
        set("Z26Path", fake.writeFile("emu/z26").chopped(4));
        storeFolder(1, "roms", roms);
    }
    // As the start-up routine makes it: built (its listing starts), loaded, shown.
    frmMain& load() {
        if (!window)
            window = std::make_unique<frmMain>(fake.platform);
        window->Form_Load();
        window->show();
        return *window;
    }
    frmMain& reload() { return window.reset(), load(); } // the next start: the old one gone

    QAction* action(const char* name) const { return control<QAction>(*window, name); }
    QString listing() const {
        QStringList names;
        for (int row = 0; row < window->listModel().rowCount(); ++row)
            names << window->listModel().name(row);
        return window->windowTitle() + " | " + names.join(", ");
    }
    ListView* list() const { return control<ListView>(*window, "vbalListViewCtl1"); }
    frmSettings& settings() const { return window->settingsWindow(); }
    // What the next start would read from the store, or "<missing>".
    QString stored(const QString& key, const QString& section = "Settings") const {
        return fake.reopenStore()->GetSetting(section, key, "<missing>");
    }
    // Since the last call, one line each, the root written "~": programs started, files and
    // pages opened, boxes, the other windows showing and balloon tips (closed, as by a click).
    QString happened() {
        QStringList seen, windows;
        for (const FakeShell::Start& start : fake.shell.started)
            seen << (QStringList{start.program} + start.arguments).join(' ') + " in " +
                        start.workingFolder;
        for (const QString& opened : fake.shell.textFiles + fake.shell.urls)
            seen << "open " + opened;
        for (const FakeDialogs::Box& box : fake.dialogs.boxes)
            seen << QString::fromStdString(boxLine(box));
        for (QWidget* shown : QApplication::topLevelWidgets()) {
            if (auto* page = qobject_cast<frmSettings*>(shown); page && page->isVisible())
                windows << "page " + page->selectedPage();
            if (qobject_cast<frmAbout*>(shown) && shown->isVisible())
                windows << "about";
            if (auto* tip = qobject_cast<BalloonTip*>(shown);
                tip && tip->isVisible() && tip->close())
                windows << "tip " + tip->parentWidget()->objectName() + ' ' +
                               QString::number(tip->icon()) + " | " + tip->title() + " | " +
                               tip->text();
        }
        windows.sort(); // about, page, tip: in no particular order otherwise
        fake.shell = FakeShell();
        fake.dialogs.boxes.clear();
        return (seen + windows).join('\n').replace(fake.root(), "~");
    }

    FakePlatform fake;
    std::unique_ptr<frmMain> window;
};
