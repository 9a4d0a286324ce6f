#include "LocalHttpServer.h"
#include "support/FakePlatform.h"

#include "about/UpdateCheck.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include <gtest/gtest.h>

namespace {

const QString kDescription = QStringLiteral("/programs/update.txt");
const QString kInstaller = QStringLiteral("/files/setup.run");

QByteArray readAll(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<missing>");
}

class UpdateCheckTest : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;

    // A description file with this product's section after another product's.
    void describe(qint64 version, const QByteArray& fileName = "setup.run",
                  const QByteArray& runFlag = "0", const QByteArray& messages = {}) {
        server.serve(kDescription, "::Other\r\nhttps://other.example/forum\r\n9999999\r\n"
                                   "::lum (Windows Front End for z26)\r\n"
                                   "https://example.org/forum/lum\r\n" +
                                       messages + QByteArray::number(version) + "\r\nJune 2nd\r\n" +
                                       server.base().toUtf8() + kInstaller.toUtf8() + "\r\n" +
                                       fileName + "\r\n" + runFlag + "\r\n");
        server.serve(kInstaller, "INSTALLER");
    }

    UpdateCheck::Outcome run(bool forum, Platform* platform = nullptr, QString base = {}) {
        UpdateCheck check(platform ? *platform : fake.platform, nullptr,
                          base.isEmpty() ? server.base() : base);
        return check.Run(forum);
    }

    QString updateFolder() const { return fake.programFolder() + "/Update"; }
    QString installerPath() const { return updateFolder() + "/setup.run"; }

    // The titles of the boxes shown, in order; forgets them.
    QStringList takeTitles() {
        QStringList titles;
        for (const auto& box : fake.dialogs.boxes)
            titles << box.title;
        fake.dialogs.boxes.clear();
        return titles;
    }
};

TEST_F(UpdateCheckTest, NoSectionForThisProduct) {
    server.serve(kDescription, "::lum (windows front end for z26)\r\nhttps://x/f\r\n1\r\n");
    EXPECT_EQ(run(false), UpdateCheck::Outcome::Finished);
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text, "No Updates Found");
    EXPECT_EQ(fake.dialogs.boxes[0].title, "No updates available");
    EXPECT_EQ(fake.dialogs.boxes[0].icon, MsgIcon::None);
    // The local copy stays in the program folder.
    EXPECT_TRUE(readAll(fake.programFolder() + "/tmp").startsWith("::lum (windows"));

    takeTitles();
    run(true);
    EXPECT_EQ(fake.shell.urls, QStringList{server.base() + "/forum"});
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(UpdateCheckTest, ForumModeOpensTheSectionsForumPage) {
    describe(1049613);
    run(true);
    // Something other than a web page is not opened; the general forum stands in.
    server.serve(kDescription,
                 "::lum (Windows Front End for z26)\r\nfile:///etc/passwd\r\n1049613\r\n");
    run(true);
    EXPECT_EQ(fake.shell.urls,
              (QStringList{"https://example.org/forum/lum", server.base() + "/forum"}));
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_FALSE(server.requests.contains(kInstaller));
}

TEST_F(UpdateCheckTest, SameOrOlderVersionOnTheServer) {
    const QString huh = QStringLiteral(
        "Huh, that's odd... \nThis Version is newer that what's available\non the internet.");
    describe(1049612, "setup.run", "0", "'Hello\r\n'World\r\n");
    run(false);
    ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Update Message");
    EXPECT_EQ(fake.dialogs.boxes[0].text, "\nHello\nWorld\n");
    EXPECT_EQ(fake.dialogs.boxes[0].icon, MsgIcon::Information);
    EXPECT_EQ(fake.dialogs.boxes[1].title, "No update needed");
    EXPECT_EQ(fake.dialogs.boxes[1].text,
              "You have the current version 1.1.12 Released June 2nd\nNo update is needed");
    EXPECT_EQ(fake.dialogs.boxes[1].icon, MsgIcon::None);

    takeTitles();
    describe(1049611);
    run(false);
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].title, "No update needed");
    EXPECT_EQ(fake.dialogs.boxes[0].text, huh);
    EXPECT_FALSE(server.requests.contains(kInstaller));
}

TEST_F(UpdateCheckTest, NoOrCancelDownloadsNothing) {
    const std::tuple<qint64, const char*, MsgResult> cases[] = {
        {1049613, "1.1.13", MsgResult::No}, {2098176, "2.1.0", MsgResult::Cancel}};
    for (const auto& [available, version, answer] : cases) {
        fake.dialogs.answers = {answer};
        describe(available);
        run(false);
        ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
        EXPECT_EQ(fake.dialogs.boxes[0].title, "Update available");
        EXPECT_EQ(fake.dialogs.boxes[0].text,
                  QStringLiteral("Version %1 released June 2nd is available.\n\n"
                                 "Do you wish to update now?")
                      .arg(QLatin1String(version)));
        EXPECT_EQ(fake.dialogs.boxes[0].buttons, MsgButtons::YesNoCancel);
        takeTitles();
    }
    EXPECT_FALSE(server.requests.contains(kInstaller));
    EXPECT_FALSE(QFileInfo::exists(updateFolder()));
}

TEST_F(UpdateCheckTest, DownloadAndKeep) {
    describe(1049613, "setup.run", "0");
    QDir().mkpath(updateFolder());
    QFile old(installerPath()); // an older installer of the same name is replaced
    ASSERT_TRUE(old.open(QIODevice::WriteOnly));
    old.write("OLD");
    old.close();

    EXPECT_EQ(run(false), UpdateCheck::Outcome::Finished);
    EXPECT_EQ(readAll(installerPath()), "INSTALLER");
    ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
    EXPECT_EQ(fake.dialogs.boxes[1].title, "Download Complete");
    EXPECT_EQ(fake.dialogs.boxes[1].text, "The update has been downloaded to " +
                                              QDir::toNativeSeparators(installerPath()) + "\n");
    EXPECT_EQ(fake.dialogs.boxes[1].icon, MsgIcon::Information);
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
    EXPECT_EQ(takeTitles(), QStringList{"Update available"});
    EXPECT_TRUE(fake.shell.folders.empty());

    // An installer that will not start leaves the program running and says where it is.
    fake.shell.succeed = false;
    EXPECT_EQ(run(false), UpdateCheck::Outcome::Finished);
    EXPECT_EQ(takeTitles(), (QStringList{"Update available", "Download Complete"}));
}

TEST_F(UpdateCheckTest, InstallerMissingOnTheServer) {
    describe(1049613);
    server.fail(kInstaller, 404);
    run(false);
    EXPECT_EQ(takeTitles(), (QStringList{"Update available", "Download Failed"}));
    EXPECT_TRUE(QFileInfo(updateFolder()).isDir());
    EXPECT_FALSE(QFileInfo::exists(installerPath()));
}

TEST_F(UpdateCheckTest, DescriptionUnreachable) {
    QtDownloader impatient{std::chrono::milliseconds(300)};
    Platform shortTimeout{fake.store,           fake.dialogs, fake.shell,
                          fake.programFolder(), impatient,    fake.registry};
    server.fail(kDescription, 404);
    run(false);
    run(true);
    run(false, nullptr, LocalHttpServer::refusedBase());
    server.stall(kDescription);
    run(false, &shortTimeout);
    ASSERT_EQ(fake.dialogs.boxes.size(), 4u);
    for (const auto& box : fake.dialogs.boxes) {
        EXPECT_EQ(box.title, "Update Check Failed");
        EXPECT_EQ(box.text, "Failed to connect to the internet");
        EXPECT_EQ(box.icon, MsgIcon::Information);
    }
    EXPECT_TRUE(fake.shell.urls.empty());
    EXPECT_FALSE(QFileInfo::exists(fake.programFolder() + "/tmp"));
}

// Unsafe installer names and broken sections are failed checks: nothing is asked or fetched.
TEST_F(UpdateCheckTest, UnsafeNamesAndBrokenSections) {
    for (const char* name : {"../evil.run", "/tmp/evil.run", "sub/evil.run", "", ".."}) {
        describe(1049613, name);
        run(false);
        EXPECT_EQ(takeTitles(), QStringList{"Update Check Failed"}) << name;
    }
    const QByteArray header = "::lum (Windows Front End for z26)\r\nhttps://f\r\n";
    for (const QByteArray& file : {header + "1.1.13\r\ndate\r\nurl\r\nname\r\n0\r\n",
                                   header + "1049613\r\ndate\r\n", header + "'note\r\n"}) {
        server.serve(kDescription, file);
        run(false);
        EXPECT_EQ(takeTitles(), QStringList{"Update Check Failed"}) << file.constData();
    }
    EXPECT_FALSE(server.requests.contains(kInstaller));
    EXPECT_FALSE(QFileInfo::exists(updateFolder()));
    EXPECT_FALSE(QFileInfo::exists(fake.root() + "/evil.run"));
}

} // namespace
