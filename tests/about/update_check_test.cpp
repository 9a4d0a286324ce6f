#include "support/Boxes.h"
#include "support/DiskFull.h"
#include "support/Files.h"
#include "support/LocalHttpServer.h"
#include "support/Unreadable.h"

#include "about/UpdateCheck.h"

#include <QDirIterator>

#include <optional>

#include <gtest/gtest.h>

namespace {

const QString kInstaller = QStringLiteral("/files/setup.run");
const QByteArray kHeader = "::lum (Windows Front End for z26)\r\n";
const std::string kAsk = "Update available | Version 1.1.13 released June 2nd is available.\n\n"
                         "Do you wish to update now? | YesNoCancel | None";
const std::string kFailedCheck = "Update Check Failed | ";

LocalHttpServer::Response reply(const QByteArray& body, int status = 200) {
    return {status, body, {}, false, -1};
}

class UpdateCheckTest : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;

    // A description file with this product's section after another product's.
    QByteArray section(const QByteArray& version, const QByteArray& messages = {},
                       const QByteArray& fileName = "setup.run", const QByteArray& run = "0") {
        return "::Other\r\nhttps://other.example/forum\r\n9999999\r\n" + kHeader +
               "https://example.org/forum/lum\r\n" + messages + version + "\r\nJune 2nd\r\n" +
               server.base().toUtf8() + kInstaller.toUtf8() + "\r\n" + fileName + "\r\n" + run +
               "\r\n";
    }
    // Runs a check on `description` (an empty one is not found on the server) and returns
    // what it did, one line each: boxes, pages and folders opened, programs started. A box
    // that is not scripted answers with its first button.
    Lines run(bool forum, const QByteArray& description, std::deque<MsgResult> answers = {}) {
        if (description.isEmpty())
            server.fail("/programs/update.txt", 404);
        else
            server.serve("/programs/update.txt", description);
        fake.dialogs.answers = std::move(answers);
        const auto outcome = UpdateCheck(fake.platform, nullptr, server.base()).Run(forum);
        Lines lines = boxLines(fake.dialogs);
        for (const QString& url : fake.shell.urls)
            lines.push_back("open " + url.toStdString());
        for (const QString& folder : fake.shell.folders)
            lines.push_back("show " + folder.toStdString());
        for (const FakeShell::Start& start : fake.shell.started)
            lines.push_back(
                ("start " + start.program + u' ' + start.arguments.join(u' ')).toStdString());
        if (outcome == UpdateCheck::Outcome::EndProgram)
            lines.push_back("end program");
        fake.dialogs.boxes.clear();
        fake.shell.urls.clear();
        fake.shell.folders.clear();
        fake.shell.started.clear();
        return lines;
    }
    // The program folder besides the description's local copy: "name=content" for a file,
    // "name/" for a folder.
    QString programFiles() const {
        QStringList entries;
        QDirIterator it(fake.programFolder(),
                        QDir::AllEntries | QDir::Hidden | QDir::NoDotAndDotDot,
                        QDirIterator::Subdirectories);
        while (it.hasNext()) {
            const QString name = it.next().mid(fake.programFolder().size() + 1);
            if (it.fileInfo().isDir())
                entries << name + u'/';
            else if (name != u"tmp")
                entries << name + u'=' + QString::fromUtf8(fileBytes(it.filePath()));
        }
        entries.sort();
        return entries.join(u' ');
    }
};

// Everything short of a download: nothing is fetched and nothing made but the local copy.
TEST_F(UpdateCheckTest, WhatEachDescriptionLeadsTo) {
    const std::string offline =
        kFailedCheck + "Failed to connect to the internet | Ok | Information";
    EXPECT_EQ(run(false, {}), Lines{offline});
    EXPECT_EQ(run(true, {}), Lines{offline});
    EXPECT_FALSE(QFileInfo::exists(fake.programFolder() + "/tmp"));

    EXPECT_EQ(run(false, section("1049612", "'Hello\r\n'World\r\n")),
              (Lines{"Update Message | \nHello\nWorld\n | Ok | Information",
                     "No update needed | You have the current version 1.1.12 Released June 2nd\n"
                     "No update is needed | Ok | None"}));
    const std::string forum = "open " + server.base().toStdString() + "/forum";
    const std::tuple<bool, QByteArray, MsgResult, std::string> rows[] = {
        {true, kHeader + "file:///etc/passwd\r\n", MsgResult::Ok, forum}, // web pages only
        {true, "::Other\r\n", MsgResult::Ok, forum},
        {false, "::Other\r\n", MsgResult::Ok,
         "No updates available | No Updates Found | Ok | None"},
        {false, section("1049611"), MsgResult::Ok,
         "No update needed | Huh, that's odd... \nThis Version is newer that what's available\n"
         "on the internet. | Ok | None"},
        {false, section("1049613"), MsgResult::No, kAsk},
        {false, section("1049613"), MsgResult::Cancel, kAsk},
        {false, kHeader + "f\r\n", MsgResult::Ok,
         kFailedCheck + "The update information is incomplete. | Ok | Information"},
        {false, kHeader + "f\r\n1.1.13\r\n", MsgResult::Ok,
         kFailedCheck + "The update information holds no valid version. | Ok | Information"},
        {false, section("1049613", {}, "../setup.run"), MsgResult::Yes,
         kFailedCheck + "The update names an installer file that cannot be accepted: "
                        "\"../setup.run\" | Ok | Information"},
    };
    for (const auto& [forumMode, description, answer, did] : rows)
        EXPECT_EQ(run(forumMode, description, {answer}), Lines{did}) << description.toStdString();
    EXPECT_FALSE(server.requests.contains(kInstaller));
    EXPECT_EQ(programFiles(), "");
    EXPECT_TRUE(fileBytes(fake.programFolder() + "/tmp").startsWith("::Other"));
}

// Run flag 0 keeps the installer and shows the program folder; run flag 1 starts it and
// ends the program, unless it will not start. An installer that arrives empty or cannot be
// stored is a failed download: nothing starts and the Update folder keeps what it held. A
// local copy of the description that cannot be written is kept elsewhere.
TEST_F(UpdateCheckTest, Downloads) {
    enum Limit { None, WontStart, FullDisk, ReadOnlyUpdate, ReadOnlyProgram };
    const QString program = fake.programFolder(), installer = program + "/Update/setup.run";
    const std::string kept = "Download Complete | The update has been downloaded to " +
                             QDir::toNativeSeparators(installer).toStdString() +
                             "\n | Ok | Information";
    const std::string show = "show " + program.toStdString();
    const std::string start = (QStringLiteral("start ") + installer +
                               " /SP- /silent /noicons /dir=" + QDir::toNativeSeparators(program))
                                  .toStdString();
    const std::string failed = "Download Failed | Failed to Download Update | Ok | None";
    const QString old = "Update/setup.run=OLD", oldKept = "Update/ Update/setup.run=OLD",
                  newKept = "Update/ Update/setup.run=NEW";
    const struct {
        QString before;
        LocalHttpServer::Response response;
        QByteArray runFlag;
        Limit limit;
        Lines did;
        QString after;
    } rows[] = {
        {old, reply("NEW"), "0", None, {kAsk, kept, show}, newKept},
        {old, reply("NEW"), "1", None, {kAsk, start, "end program"}, newKept},
        {"", reply("NEW"), "1", WontStart, {kAsk, kept, show, start}, newKept},
        {"tmp/keep=1", reply("NEW"), "0", None, {kAsk, kept, show}, newKept + " tmp/ tmp/keep=1"},
        {"", reply({}, 404), "0", None, {kAsk, failed}, "Update/"}, // the folder made for it stays
        {old, reply({}), "0", None, {kAsk, failed}, oldKept},
        {old, reply(QByteArray(8192, 'x')), "0", FullDisk, {kAsk, failed}, oldKept},
        {old, reply("NEW"), "0", ReadOnlyUpdate, {kAsk, failed}, oldKept},
        {"", reply("NEW"), "0", ReadOnlyProgram, {kAsk, failed}, ""},
        {"Update/setup.run/", reply("NEW"), "0", None, {kAsk, failed}, "Update/ Update/setup.run/"},
        {"Update=file", reply("NEW"), "0", None, {kAsk, failed}, "Update=file"},
    };
    for (const auto& row : rows) {
        for (const char* name : {"/Update", "/tmp"}) {
            QDir(program + name).removeRecursively();
            QFile::remove(program + name);
        }
        const qsizetype split = row.before.indexOf(u'=');
        if (row.before.endsWith(u'/'))
            fake.makeFolder("program/" + row.before);
        else if (split > 0)
            fake.writeFile("program/" + row.before.left(split), row.before.mid(split + 1).toUtf8());
        server.responses[kInstaller] = row.response;
        fake.shell.succeed = row.limit != WontStart;
        const QString locked = row.limit == ReadOnlyUpdate ? program + "/Update" : program;
        Lines did;
        {
            std::optional<DiskFull> full;
            std::optional<NoPermissionOverride> asAnyone;
            if (row.limit == FullDisk)
                full.emplace(1024);
            if (row.limit >= ReadOnlyUpdate) {
                QFile::setPermissions(locked, QFile::ReadOwner | QFile::ExeOwner);
                ASSERT_TRUE(asAnyone.emplace().holds());
            }
            did = run(false, section("1049613", {}, "setup.run", row.runFlag), {MsgResult::Yes});
        }
        QFile::setPermissions(locked, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        EXPECT_EQ(did, row.did) << row.before.toStdString() << row.limit;
        EXPECT_EQ(programFiles(), row.after) << row.before.toStdString() << row.limit;
        EXPECT_TRUE(row.runFlag == "0" || QFileInfo(installer).isExecutable());
    }
}

} // namespace
