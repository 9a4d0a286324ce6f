#include "support/Boxes.h"
#include "support/Files.h"
#include "support/LocalHttpServer.h"

#include "about/UpdateCheck.h"

#include <QDir>
#include <QFileInfo>

#include <gtest/gtest.h>

namespace {

const QString kDescription = QStringLiteral("/programs/update.txt");
const QString kInstaller = QStringLiteral("/files/setup.run");
const QByteArray kHeader = "::lum (Windows Front End for z26)\r\n";
const std::string kAsk = "Update available | Version 1.1.13 released June 2nd is available.\n\n"
                         "Do you wish to update now? | YesNoCancel | None";

class UpdateCheckTest : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;

    // A description file with this product's section after another product's.
    void describe(qint64 version, const QByteArray& fileName = "setup.run",
                  const QByteArray& runFlag = "0", const QByteArray& messages = {}) {
        server.serve(kDescription, "::Other\r\nhttps://other.example/forum\r\n9999999\r\n" +
                                       kHeader + "https://example.org/forum/lum\r\n" + messages +
                                       QByteArray::number(version) + "\r\nJune 2nd\r\n" +
                                       server.base().toUtf8() + kInstaller.toUtf8() + "\r\n" +
                                       fileName + "\r\n" + runFlag + "\r\n");
        server.serve(kInstaller, "INSTALLER");
    }

    UpdateCheck::Outcome run(bool forum) {
        return UpdateCheck(fake.platform, nullptr, server.base()).Run(forum);
    }

    // The boxes shown since the last call.
    Lines takeBoxes() {
        Lines lines = boxLines(fake.dialogs);
        fake.dialogs.boxes.clear();
        return lines;
    }

    QString updateFolder() const { return fake.programFolder() + "/Update"; }
    QString installerPath() const { return updateFolder() + "/setup.run"; }
};

TEST_F(UpdateCheckTest, ForumModeOpensTheSectionsWebPageOnly) {
    describe(1049613);
    run(true);
    // Something other than a web page is not opened; the general forum stands in.
    server.serve(kDescription, kHeader + "file:///etc/passwd\r\n1049613\r\n");
    run(true);
    EXPECT_EQ(fake.shell.urls,
              (QStringList{"https://example.org/forum/lum", server.base() + "/forum"}));
    EXPECT_TRUE(takeBoxes().empty());
    EXPECT_FALSE(server.requests.contains(kInstaller));
}

TEST_F(UpdateCheckTest, VersionsAreComparedAndOnlyYesDownloads) {
    describe(1049612, "setup.run", "0", "'Hello\r\n'World\r\n");
    run(false);
    EXPECT_EQ(takeBoxes(), (Lines{"Update Message | \nHello\nWorld\n | Ok | Information",
                                  "No update needed | You have the current version 1.1.12 "
                                  "Released June 2nd\nNo update is needed | Ok | None"}));
    const struct {
        qint64 available;
        MsgResult answer;
        std::string box;
    } cases[] = {{1049611, MsgResult::Ok,
                  "No update needed | Huh, that's odd... \nThis Version is newer that what's "
                  "available\non the internet. | Ok | None"},
                 {1049613, MsgResult::No, kAsk},
                 {2098176, MsgResult::Cancel,
                  "Update available | Version 2.1.0 released June 2nd is available.\n\n"
                  "Do you wish to update now? | YesNoCancel | None"}};
    for (const auto& c : cases) {
        fake.dialogs.answers = {c.answer};
        describe(c.available);
        run(false);
        EXPECT_EQ(takeBoxes(), Lines{c.box}) << c.available;
    }
    EXPECT_FALSE(server.requests.contains(kInstaller));
    EXPECT_FALSE(QFileInfo::exists(updateFolder()));
    // The local copy of the description stays in the program folder.
    EXPECT_TRUE(fileBytes(fake.programFolder() + "/tmp").startsWith("::Other"));
}

TEST_F(UpdateCheckTest, DownloadAndKeepReplacingAnOlderInstaller) {
    describe(1049613);
    server.fail(kInstaller, 404);
    run(false);
    EXPECT_EQ(takeBoxes(),
              (Lines{kAsk, "Download Failed | Failed to Download Update | Ok | None"}));
    EXPECT_TRUE(QFileInfo(updateFolder()).isDir()); // made for the download, and kept
    EXPECT_FALSE(QFileInfo::exists(installerPath()));

    fake.writeFile("program/Update/setup.run", "OLD");
    server.serve(kInstaller, "INSTALLER");
    EXPECT_EQ(run(false), UpdateCheck::Outcome::Finished);
    EXPECT_EQ(fileBytes(installerPath()), "INSTALLER");
    EXPECT_EQ(takeBoxes(),
              (Lines{kAsk, "Download Complete | The update has been downloaded to " +
                               QDir::toNativeSeparators(installerPath()).toStdString() +
                               "\n | Ok | Information"}));
    // The folder window shows the program folder, not Update.
    EXPECT_EQ(fake.shell.folders, QStringList{fake.programFolder()});
    EXPECT_TRUE(fake.shell.started.empty());
}

TEST_F(UpdateCheckTest, DownloadAndRunEndsTheProgram) {
    describe(1049613, "setup.run", "1");
    EXPECT_EQ(run(false), UpdateCheck::Outcome::EndProgram);
    EXPECT_TRUE(QFileInfo(installerPath()).isExecutable());
    ASSERT_EQ(fake.shell.started.size(), 1u);
    EXPECT_EQ(fake.shell.started[0].program, installerPath());
    EXPECT_EQ(fake.shell.started[0].arguments,
              (QStringList{"/SP-", "/silent", "/noicons",
                           "/dir=" + QDir::toNativeSeparators(fake.programFolder())}));
    EXPECT_EQ(takeBoxes(), Lines{kAsk});
    EXPECT_TRUE(fake.shell.folders.empty());

    // An installer that will not start leaves the program running and says where it is.
    fake.shell.succeed = false;
    EXPECT_EQ(run(false), UpdateCheck::Outcome::Finished);
    EXPECT_EQ(takeBoxes().size(), 2u); // asked, then told where the installer is
    EXPECT_EQ(fake.shell.folders, QStringList{fake.programFolder()});
}

TEST_F(UpdateCheckTest, AnUnreachableDescriptionIsAFailedCheckInBothModes) {
    server.fail(kDescription, 404);
    run(false);
    run(true);
    EXPECT_EQ(takeBoxes(),
              Lines(2, "Update Check Failed | Failed to connect to the internet | Ok | "
                       "Information"));
    EXPECT_TRUE(fake.shell.urls.empty());
    EXPECT_FALSE(QFileInfo::exists(fake.programFolder() + "/tmp"));
}

// An installer name that leads out of the Update folder is a failed check: nothing is asked
// or fetched. (Broken sections are failed checks too: see bad_input_test.cpp.)
TEST_F(UpdateCheckTest, UnsafeInstallerNames) {
    for (const char* name : {"../evil.run", "/tmp/evil.run", ""}) {
        describe(1049613, name);
        run(false);
        const Lines boxes = takeBoxes();
        ASSERT_EQ(boxes.size(), 1u) << name;
        EXPECT_TRUE(boxes[0].starts_with("Update Check Failed | ")) << boxes[0];
    }
    EXPECT_FALSE(server.requests.contains(kInstaller));
    EXPECT_FALSE(QFileInfo::exists(updateFolder()));
    EXPECT_FALSE(QFileInfo::exists(fake.root() + "/evil.run"));
}

} // namespace
