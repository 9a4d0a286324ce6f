#include "AppFixture.h"
#include "support/Boxes.h"

#include "about/frmAbout.h"

#include <QPointer>

#include <gtest/gtest.h>

namespace {

struct DocumentCase {
    const char* stored; // relative to the root, "" for an empty path
    bool opens;
};

} // namespace

TEST(EmulatorDocuments, FolderOrExecutablePathOpensTheSameReadme) {
    const DocumentCase cases[] = {
        {"emu", true},      // the folder
        {"emu/z26", true},  // the executable
        {"emu/Z26", true},  // the executable, in capitals
        {"", false},        // no emulator path
        {"nowhere", false}, // a folder without the document
    };
    for (const DocumentCase& c : cases) {
        AppFixture app;
        const QString readme = app.fake.writeFile("emu/README.TXT", "read me");
        app.fake.writeFile("emu/z26");
        app.fake.writeFile("emu/Z26");
        app.fake.makeFolder("nowhere");
        const QString stored = *c.stored ? app.fake.root() + "/" + c.stored : QString();
        app.fake.store.SaveSetting("Settings", "Z26Path", stored);
        frmMain& w = app.load();
        app.fake.dialogs.boxes.clear();
        w.mnuAboutz26Readme->trigger();
        if (c.opens) {
            EXPECT_EQ(app.fake.shell.textFiles, QStringList{readme}) << c.stored;
            EXPECT_TRUE(app.fake.dialogs.boxes.empty()) << c.stored;
        } else {
            EXPECT_TRUE(app.fake.shell.textFiles.isEmpty()) << c.stored;
            EXPECT_EQ(boxLines(app.fake.dialogs),
                      Lines{"Error | Error loading README.TXT | Ok | Exclamation"})
                << c.stored;
        }
    }
}

TEST(EmulatorDocuments, CopyingFindsALowerCaseNameAndReportsAFailedOpen) {
    AppFixture app;
    const QString copying = app.fake.writeFile("emu/copying.txt", "GPL");
    app.fake.store.SaveSetting("Settings", "Z26Path", app.fake.root() + "/emu");
    frmMain& w = app.load();
    app.fake.dialogs.boxes.clear();
    w.mnuAboutCopying->trigger();
    EXPECT_EQ(app.fake.shell.textFiles, QStringList{copying});
    app.fake.shell.succeed = false;
    w.mnuAboutCopying->trigger();
    EXPECT_EQ(boxLines(app.fake.dialogs),
              Lines{"Error | Error loading COPYING.TXT | Ok | Exclamation"});
}

TEST(MainMenuCommands, HomePagesAndAboutOpen) {
    AppFixture app;
    frmMain& w = app.load();
    w.mnuAboutz26HomePage->trigger();
    w.mnuAboutlumHomePage->trigger();
    ASSERT_EQ(app.fake.shell.urls.size(), 2);
    EXPECT_TRUE(app.fake.shell.urls[0].startsWith("https://"));
    EXPECT_TRUE(app.fake.shell.urls[1].startsWith("https://"));
    EXPECT_NE(app.fake.shell.urls[0], app.fake.shell.urls[1]);
    w.mnuAboutlumAbout->trigger();
    QPointer<frmAbout> about = w.findChild<frmAbout*>();
    ASSERT_FALSE(about.isNull());
    EXPECT_TRUE(about->isVisible());
    // Exit closes the About window with the rest.
    w.mnuFileExit->trigger();
    EXPECT_TRUE(about.isNull() || !about->isVisible());
}
