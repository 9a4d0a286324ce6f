#include "support/DiskFull.h"
#include "support/FakePlatform.h"
#include "support/LocalHttpServer.h"
#include "support/Unreadable.h"

#include "about/UpdateCheck.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>

#include <csignal>
#include <functional>

#include <sys/resource.h>

#include <gtest/gtest.h>

namespace {

const QString kDescription = QStringLiteral("/programs/update.txt");
const QByteArray kHeader = "::lum (Windows Front End for z26)\r\n";

class BadUpdateInput : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;

    // Runs an update check and returns the title and text of the one box it shows.
    std::pair<QString, QString> check(bool forum = false) {
        fake.dialogs.boxes.clear();
        UpdateCheck(fake.platform, nullptr, server.base()).Run(forum);
        if (fake.dialogs.boxes.size() != 1)
            return {QStringLiteral("%1 boxes").arg(fake.dialogs.boxes.size()), QString()};
        return {fake.dialogs.boxes[0].title, fake.dialogs.boxes[0].text};
    }
    // A section offering a newer version, with the installer served.
    QByteArray newerSection(const QByteArray& fileName) const {
        return kHeader + "https://example.org/forum\r\n1049613\r\nsoon\r\n" +
               server.base().toUtf8() + "/setup.run\r\n" + fileName + "\r\n0\r\n";
    }
};

QByteArray noise(qsizetype size, quint32 seed) {
    QByteArray bytes(size, '\0');
    QRandomGenerator random(seed);
    for (char& c : bytes)
        c = static_cast<char>(random.bounded(256));
    return bytes;
}

} // namespace

// Descriptions that hold nothing usable for this product: the check says there is no
// update, and the forum button falls back to the general forum.
TEST_F(BadUpdateInput, EmptyGarbageAndOversizedDescriptionsFindNoSection) {
    const QByteArray cases[] = {
        QByteArray(), noise(64 * 1024, 3), QByteArray(8 * 1024 * 1024, 'x'), // one line of 8 MiB
        QByteArray("::lum (Windows Front End for z26)\0\r\n", 36),           // a NUL in the header
    };
    for (const QByteArray& body : cases) {
        SCOPED_TRACE(body.left(40).toStdString());
        server.serve(kDescription, body);
        EXPECT_EQ(check(), std::make_pair(QStringLiteral("No updates available"),
                                          QStringLiteral("No Updates Found")));
        fake.shell.urls.clear();
        check(true);
        EXPECT_EQ(fake.shell.urls, QStringList{server.base() + "/forum"});
    }
}

// A section after megabytes of other text is still found.
TEST_F(BadUpdateInput, AnOversizedDescriptionIsReadToItsSection) {
    QByteArray filler;
    while (filler.size() < 8 * 1024 * 1024)
        filler += "::Some other product\r\nhttps://example.org/other\r\n'" + noise(60, 5).toHex() +
                  "\r\n";
    server.serve(kDescription, filler + kHeader +
                                   "https://example.org/forum\r\n1049612\r\n"
                                   "today\r\nu\r\nn\r\n0\r\n");
    EXPECT_EQ(check().first, "No update needed");
}

// Garbage inside the section: a version that is no number, or a section that stops short,
// is a failed check; nothing is downloaded.
TEST_F(BadUpdateInput, GarbageInTheSectionIsAFailedCheck) {
    const QByteArray cases[] = {
        kHeader + "https://example.org/forum\r\n" + noise(100, 9).replace('\n', ' ') + "\r\n",
        kHeader + "https://example.org/forum\r\n99999999999999999999999\r\n",
        kHeader + "https://example.org/forum\r\n-5\r\n",
        kHeader,
    };
    for (const QByteArray& body : cases) {
        server.serve(kDescription, body);
        EXPECT_EQ(check().first, "Update Check Failed");
    }
    EXPECT_FALSE(QFileInfo::exists(fake.programFolder() + "/Update"));
}

// Folders in place of the files the check writes are left as they were: the description
// goes to a temporary folder instead, and an installer that cannot be stored is a failed
// download.
TEST_F(BadUpdateInput, FoldersInPlaceOfTheFilesItWrites) {
    const QString localCopy = fake.makeFolder("program/tmp");
    fake.writeFile("program/tmp/keep.txt", "mine");
    server.serve(kDescription, newerSection("setup.run"));
    fake.dialogs.boxes.clear();
    UpdateCheck(fake.platform, nullptr, server.base()).Run(false);
    ASSERT_FALSE(fake.dialogs.boxes.empty());
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Update available");
    EXPECT_EQ(QDir(localCopy).entryList(QDir::Files), QStringList{"keep.txt"});
    QDir(localCopy).removeRecursively();

    // The installer's name is taken by a folder.
    server.serve("/setup.run", "INSTALLER");
    fake.makeFolder("program/Update/setup.run");
    fake.dialogs.answers = {MsgResult::Yes};
    fake.dialogs.boxes.clear();
    UpdateCheck(fake.platform, nullptr, server.base()).Run(false);
    ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
    EXPECT_EQ(fake.dialogs.boxes[1].title, "Download Failed");
    EXPECT_TRUE(QFileInfo(fake.programFolder() + "/Update/setup.run").isDir());
    QDir(fake.programFolder() + "/Update").removeRecursively();

    // A file is where the Update folder belongs.
    fake.writeFile("program/Update", "not a folder");
    fake.dialogs.answers = {MsgResult::Yes};
    fake.dialogs.boxes.clear();
    UpdateCheck(fake.platform, nullptr, server.base()).Run(false);
    ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
    EXPECT_EQ(fake.dialogs.boxes[1].title, "Download Failed");
    EXPECT_TRUE(QFileInfo(fake.programFolder() + "/Update").isFile());
    EXPECT_TRUE(fake.shell.started.empty());
}

// A download that cannot be written whole (a full disk) fails, and neither a cut-off
// installer nor a cut-off description is left where the program would use it.
TEST_F(BadUpdateInput, ADownloadOnAFullDiskFailsAndLeavesNoCutOffFile) {
    const QString target = fake.writeFile("program/Update/setup.run", "OLD INSTALLER");
    // Small enough to be written in one piece when the download ends.
    server.serve("/setup.run", noise(8 * 1024, 1));
    {
        const DiskFull full(1024);
        EXPECT_FALSE(fake.network.DownloadFile(server.base() + "/setup.run", target));
    }
    QFile file(target);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll(), "OLD INSTALLER");
    EXPECT_EQ(QDir(fake.programFolder() + "/Update").entryList(QDir::Files | QDir::Hidden),
              QStringList{"setup.run"});
}

// A program folder where nothing may be written (an installed copy) still checks: the
// description goes to a temporary folder, and nothing is left behind.
TEST_F(BadUpdateInput, AReadOnlyProgramFolderStillChecks) {
    server.serve(kDescription, newerSection("setup.run"));
    ASSERT_TRUE(QFile::setPermissions(fake.programFolder(), QFile::ReadOwner | QFile::ExeOwner));
    fake.dialogs.boxes.clear();
    {
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        UpdateCheck(fake.platform, nullptr, server.base()).Run(false);
    }
    QFile::setPermissions(fake.programFolder(),
                          QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    ASSERT_FALSE(fake.dialogs.boxes.empty());
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Update available");
    EXPECT_TRUE(
        QDir(fake.programFolder())
            .isEmpty(QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot));
}

// Installers that do not arrive whole, arrive empty, or cannot be stored: "Download
// Failed", nothing is started, and an older installer of the same name is kept.
TEST_F(BadUpdateInput, InstallersThatCannotBeStoredWholeAreNotKept) {
    const QString installer = fake.programFolder() + "/Update/setup.run";
    const struct {
        const char* name;
        std::function<void()> serve;
        bool readOnlyFolder;
    } cases[] = {
        {"cut off", [&] { server.cutOff("/setup.run", noise(1000, 2), 100000); }, false},
        {"read-only Update folder", [&] { server.serve("/setup.run", "NEW INSTALLER"); }, true},
        {"empty", [&] { server.serve("/setup.run", QByteArray()); }, false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        server.serve(kDescription, newerSection("setup.run"));
        c.serve();
        fake.writeFile("program/Update/setup.run", "OLD INSTALLER");
        if (c.readOnlyFolder)
            QFile::setPermissions(fake.programFolder() + "/Update",
                                  QFile::ReadOwner | QFile::ExeOwner);
        fake.dialogs.answers = {MsgResult::Yes};
        fake.dialogs.boxes.clear();
        {
            const NoPermissionOverride asAnyone;
            ASSERT_TRUE(asAnyone.holds());
            UpdateCheck(fake.platform, nullptr, server.base()).Run(false);
        }
        QFile::setPermissions(fake.programFolder() + "/Update",
                              QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
        EXPECT_EQ(fake.dialogs.boxes[1].title, "Download Failed");
        EXPECT_EQ(QFileInfo(installer).size(), 13);
        EXPECT_EQ(QDir(fake.programFolder() + "/Update").entryList(QDir::Files | QDir::Hidden),
                  QStringList{"setup.run"});
    }
    EXPECT_TRUE(fake.shell.started.empty());
}
