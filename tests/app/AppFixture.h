#pragma once

#include "support/FakePlatform.h"

#include "app/frmMain.h"

#include <memory>

// A main window over a fake platform, with helpers to lay out ROM folders.
class AppFixture {
public:
    // Stores ROM folder n (1-based) with its enabled flag.
    void storeFolder(int n, const QString& path, bool enabled = true) {
        const QString suffix = n == 1 ? QString() : QString::number(n);
        fake.store.SaveSetting("Settings", "ROM" + suffix + "Path", path);
        fake.store.SaveSetting("Settings", "ROM" + suffix + "Checked", enabled ? "True" : "False");
    }
    // A folder under the temporary root holding empty files with these names.
    QString romFolder(const QString& name, const QStringList& files) {
        const QString folder = fake.makeFolder(name);
        for (const QString& f : files)
            fake.writeFile(name + "/" + f);
        return folder;
    }
    // Both paths known, so that the start goes straight to the list: the emulator folder and
    // one ROM folder holding a.bin.
    void storePaths() {
        fake.store.SaveSetting("Settings", "Z26Path", fake.root());
        storeFolder(1, romFolder("roms", {"a.bin"}));
    }
    frmMain& load() {
        window = std::make_unique<frmMain>(fake.platform);
        window->Form_Load();
        window->show(); // as the start-up routine does
        return *window;
    }

    FakePlatform fake;
    std::unique_ptr<frmMain> window;
};
