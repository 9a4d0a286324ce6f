#include "support/Boxes.h"
#include "support/Files.h"
#include "support/LocalHttpServer.h"
#include "support/WidgetDump.h"
#include "support/Widgets.h"

#include "about/AboutArt.h"
#include "about/SysInfo.h"
#include "about/UpdateDescription.h"
#include "about/frmAbout.h"
#include "ui/Twips.h"

#include <QPointer>
#include <QProgressDialog>
#include <QTimer>

#include <gtest/gtest.h>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");
const QByteArray kHeader = "::lum (Windows Front End for z26)\r\n";
const std::string kAsk = "Update available | Version 1.1.13 released June 2nd is available.\n\n"
                         "Do you wish to update now? | YesNoCancel | None\n";
const std::string kFailedCheck = "Update Check Failed | ";

// The section read from `content` as one line: status, then every field in file order.
std::string read(QByteArray content, bool forumOnly = false) {
    QBuffer buffer(&content);
    buffer.open(QIODevice::ReadOnly);
    const UpdateSection s = readUpdateSection(buffer, kProduct, forumOnly);
    static const char* const statuses[] = {"NotFound", "Complete", "Truncated", "BadVersion"};
    const QStringList fields = {s.forumUrl,    s.message,      QString::number(s.availableVersion),
                                s.releaseDate, s.installerUrl, s.installerFileName,
                                s.runFlag};
    return statuses[static_cast<int>(s.status)] + (" | " + fields.join(" | ")).toStdString();
}

TEST(UpdateDescription, VersionsHeadersAndInstallerNames) {
    EXPECT_EQ(parseVersionNumber(QStringLiteral(" 1049613\t")), 1049613);
    for (const char* bad :
         {"", "1.1.13", "+5", "-5", "12abc", "1 2", "99999999999999999999999", "\u0661\u0662"})
        EXPECT_FALSE(parseVersionNumber(QString::fromUtf8(bad))) << bad;
    EXPECT_TRUE(isSectionHeader("::" + kProduct, kProduct));
    for (const QString& other : {"::" + kProduct.toUpper(), "::" + kProduct + " ", ":: " + kProduct,
                                 "x::" + kProduct, kProduct})
        EXPECT_FALSE(isSectionHeader(other, kProduct)) << other.toStdString();

    for (const char* good : {"setup.exe", "lum-1.1.13.run", "a b.bin"})
        EXPECT_TRUE(isSafeInstallerFileName(QString::fromUtf8(good))) << good;
    for (const char* bad : {"", " ", ".", "..", "../setup.exe", "/tmp/setup.exe", "sub/setup.exe",
                            "..\\setup.exe", "C:\\setup.exe", "bad\nname"})
        EXPECT_FALSE(isSafeInstallerFileName(QString::fromUtf8(bad))) << bad;

    // Installers only over https from the update server's host (the About tests try http).
    for (const char* good : {"https://lum.example.org/setup.run", "https://LUM.example.org:8443/s"})
        EXPECT_TRUE(isTrustedInstallerAddress(good, "https://lum.example.org")) << good;
    for (const char* bad :
         {"http://lum.example.org/s", "https://example.org/s", "https://lum.example.org.evil.com/s",
          "https://lum.example.org@evil.com/s", "ftp://lum.example.org/s", "file:///tmp/s",
          "setup.run", ""})
        EXPECT_FALSE(isTrustedInstallerAddress(bad, "https://lum.example.org")) << bad;
}

// The forum line alone in forum mode, every line otherwise; CR LF or LF; after 8 MiB of
// other sections.
TEST(UpdateDescription, FindsTheSection) {
    const QByteArray full = kHeader + "forum\r\n'note\r\n1049613\r\ndate\r\nurl\r\nname\r\n1\r\n";
    const QByteArray file = "::Other\r\nhttps://other\r\n2098176\r\n" + full + "after the flag\r\n";
    const QByteArray others = QByteArray("::Other\r\nforum\r\n'a message\r\n").repeated(300000);
    const std::string complete = "Complete | forum | \nnote\n | 1049613 | date | url | name | 1";
    const std::tuple<QByteArray, bool, std::string> rows[] = {
        {file, false, complete},
        {file, true, "Complete | forum |  | 0 |  |  |  | "},
        {others + QByteArray(full).replace("\r\n", "\n"), false, complete},
        {kHeader + "f\r\n'n\r\n1.1.13\r\nd\r\n", false, "BadVersion | f | \nn\n | 0 |  |  |  | "},
        {kHeader, true, "Truncated |  |  | 0 |  |  |  | "},
    };
    for (const auto& [content, forumOnly, section] : rows)
        EXPECT_EQ(read(content, forumOnly), section) << content.left(80).toStdString();
    // No section for this product: nothing, binary noise, one line of 8 MiB, a NUL after the
    // name, other sections only.
    const QByteArray none[] = {QByteArray(), QByteArray("\0\xff\r::\x80\r\n\x01:\n", 11),
                               QByteArray(8 * 1024 * 1024, 'x'), kHeader.chopped(2) + '\0' + "\r\n",
                               file.left(file.indexOf("::lum"))};
    for (const QByteArray& content : none)
        for (const bool forumOnly : {false, true})
            EXPECT_EQ(read(content, forumOnly), "NotFound |  |  | 0 |  |  |  | ")
                << content.left(80).toStdString();
    // Cut after any line before the run flag's end, it is incomplete.
    for (qsizetype end = 0; (end = full.indexOf('\n', end) + 1) < full.size();)
        EXPECT_EQ(read(full.left(end)).substr(0, 9), "Truncated") << end;
}

class About : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;
    // The update server named as a mirror's would be, trailing slash and all.
    bool bMirror = qputenv("LUM_UPDATE_URL", server.base().toUtf8() + '/');
    QPointer<frmAbout> window = new frmAbout(fake.platform);
    QSignalSpy ends{window.data(), &frmAbout::endProgramRequested};

    ~About() override {
        delete window.data();
        qunsetenv("LUM_UPDATE_URL");
    }

    // What the user saw and the program did since the last call, a line each: boxes, pages
    // and folders opened, programs started, the program ended.
    std::string happened() {
        std::string out;
        for (const std::string& box : boxLines(fake.dialogs))
            out += box + '\n';
        for (const QString& url : fake.shell.urls)
            out += "open " + url.toStdString() + '\n';
        for (const QString& folder : fake.shell.folders)
            out += "show " + folder.toStdString() + '\n';
        for (const FakeShell::Start& s : fake.shell.started)
            out += "start " + (QStringList{s.program} + s.arguments).join(' ').toStdString() + '\n';
        if (!ends.isEmpty())
            out += "end program\n";
        ends.clear();
        fake.dialogs.boxes.clear();
        fake.shell = FakeShell(); // forgets, and works again
        return out;
    }
    // Clicks Forum or Update with `file` on the server (an empty one is not found).
    std::string check(bool forum, const QByteArray& file, MsgResult answer = MsgResult::Yes) {
        server.responses["/programs/update.txt"] = {file.isEmpty() ? 404 : 200, file, {}, false};
        fake.dialogs.answers = {answer};
        QTest::mouseClick(forum ? window->cmdForum : window->cmdUpdate, Qt::LeftButton);
        return happened();
    }
    // A description file with this product's section.
    QByteArray section(const QByteArray& version, const QByteArray& messages = {},
                       const QByteArray& fileName = "setup.run", const QByteArray& run = "0") {
        return kHeader + "https://example.org/forum/lum\r\n" + messages + version +
               "\r\nJune 2nd\r\n" + server.base().toUtf8() + "/files/setup.run\r\n" + fileName +
               "\r\n" + run + "\r\n";
    }
};

// The texts and colours; the product name as large as fits its place; background tiles
// all over: the top strip and the left edge show tiles only, the last ones cut. The address
// lights up under the mouse until it moves onto the window's own surface; the links open
// their pages; OK closes the window as the close box does, which deletes it.
TEST_F(About, LooksHoverLinksSystemInformationAndOk) {
    QString dump = dumpWidgetTree(*window);
    for (const QLabel* label : window->findChildren<QLabel*>())
        if (!label->text().isEmpty())
            dump += label->objectName() + " colour " +
                    label->palette().color(QPalette::WindowText).name() + u'\n';
    expectGolden("frmAbout", dump);
    QFont font = window->lblProgram->font();
    EXPECT_LE(QFontMetrics(font).horizontalAdvance(kProduct), twips::toPixelsX(4900));
    font.setPointSizeF(font.pointSizeF() + 1);
    EXPECT_GT(QFontMetrics(font).horizontalAdvance(kProduct), twips::toPixelsX(4900));

    window->show();
    const QImage shot = window->grab().toImage().convertToFormat(QImage::Format_RGB32);
    const QImage tile = aboutBackgroundTile();
    ASSERT_GT(shot.width(), 2 * tile.width());
    for (int x = 0; x < shot.width(); ++x)
        ASSERT_EQ(shot.pixel(x, 3), tile.pixel(x % tile.width(), 3)) << x;
    for (int y = 0; y < shot.height(); ++y)
        ASSERT_EQ(shot.pixel(3, y), tile.pixel(3, y % tile.height())) << y;

    const auto moveTo = [this](QWidget* widget, QPoint position) {
        QTest::mouseMove(widget, position);
        return window->lblEmail->palette().color(QPalette::WindowText).name();
    };
    EXPECT_EQ(moveTo(window->lblEmail, QPoint(2, 2)), "#4e88ff");
    EXPECT_EQ(moveTo(window, window->cmdOK->geometry().center()), "#4e88ff");
    EXPECT_EQ(moveTo(window, QPoint(2, 2)), "#00ffff");

    for (QWidget* link : QWidgetList{window->lblEmail, window->cmdWeb, window->cmdDonate})
        QTest::mouseClick(link, Qt::LeftButton);
    EXPECT_EQ(happened(), "open mailto:support@lum.example.org?Subject=" + kProduct.toStdString() +
                              " v1.1.12 Question\nopen https://lum.example.org/\n"
                              "open https://www.paypal.com/xclick/business=donate%40lum.example.org"
                              "&item_name=lum.example.org&no_note=1&tax=0&currency_code=USD\n");
    // System Information by the registered tool, the registered folder, whether starting
    // works: what happens.
    fake.writeFile("msinfo/MSINFO32.EXE");
    const std::string none = "lum | System Information Is Unavailable At This Time | Ok | None\n";
    const std::tuple<QString, QString, bool, std::string> rows[] = {
        {"/usr/bin/hardinfo", "msinfo", true, "start /usr/bin/hardinfo\n"},
        {"/usr/bin/hardinfo", "", false, none + "start /usr/bin/hardinfo\n"},
        {"", "msinfo", true, "start " + fake.root().toStdString() + "/msinfo/MSINFO32.EXE\n"},
        {"", "gone", true, none},
    };
    for (const auto& [path, folder, works, did] : rows) {
        fake.registry.values.clear();
        if (!path.isEmpty())
            fake.registry.set(kHkeyLocalMachine, kSysInfoPathKey, "PATH",
                              {kRegString, path.toUtf8()});
        if (!folder.isEmpty())
            fake.registry.set(kHkeyLocalMachine, kSysInfoFolderKey, "MSINFO",
                              {kRegString, (fake.root() + u'/' + folder).toUtf8() + '\0'});
        fake.shell.succeed = works;
        QTest::mouseClick(window->cmdSysInfo, Qt::LeftButton);
        EXPECT_EQ(happened(), did);
    }
    QTest::mouseClick(window->cmdOK, Qt::LeftButton);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(window.isNull());
}

// Everything short of a download: nothing is fetched and nothing made but the local copy.
// After a forum lookup, whatever its outcome, Update checks for updates.
TEST_F(About, WhatEachDescriptionLeadsTo) {
    using enum MsgResult;
    const std::string forum = "open " + server.base().toStdString() + "/forum\n";
    const std::tuple<bool, QByteArray, MsgResult, std::string> rows[] = {
        {true, {}, Ok, kFailedCheck + "Failed to connect to the internet | Ok | Information\n"},
        {false, section("1049612", "'Hello\r\n'World\r\n"), Ok,
         "Update Message | \nHello\nWorld\n | Ok | Information\nNo update needed | You have the "
         "current version 1.1.12 Released June 2nd\nNo update is needed | Ok | None\n"},
        {true, section("1049612"), Ok, "open https://example.org/forum/lum\n"},
        {true, kHeader + "file:///etc/passwd\r\n", Ok, forum}, // web pages only
        {true, "::Other\r\n", Ok, forum},
        {false, "::Other\r\n", Ok, "No updates available | No Updates Found | Ok | None\n"},
        {false, section("1049611"), Ok,
         "No update needed | Huh, that's odd... \nThis Version is newer that what's available\n"
         "on the internet. | Ok | None\n"},
        {false, section("1049613"), No, kAsk},
        {false, section("1049613"), Cancel, kAsk},
        {false, kHeader + "f\r\n", Ok,
         kFailedCheck + "The update information is incomplete. | Ok | Information\n"},
        {false, kHeader + "f\r\n1.1.13\r\n", Ok,
         kFailedCheck + "The update information holds no valid version. | Ok | Information\n"},
        {false, section("1049613", {}, "../setup.run"), Yes,
         kFailedCheck + "The update names an installer file that cannot be accepted: "
                        "\"../setup.run\" | Ok | Information\n"},
        {false, section("1049613").replace("127.0.0.1", "localhost"), Yes,
         kFailedCheck +
             "The update offers its installer from an address that cannot be trusted: \"" +
             server.base().replace("127.0.0.1", "localhost").toStdString() +
             "/files/setup.run\"\nUpdates are only downloaded over https from 127.0.0.1. | Ok | "
             "Information\n"},
    };
    for (const auto& [forumMode, description, answer, did] : rows)
        EXPECT_EQ(check(forumMode, description, answer), did) << description.toStdString();
    EXPECT_FALSE(server.requests.contains("/files/setup.run"));
    EXPECT_EQ(folderEntries(fake.platform.cacheFolder).join(' ') + " | " +
                  folderEntries(fake.programFolder()).join(' '),
              "tmp | ");
}

// Run flag 1 starts the installer and ends the program, unless it will not start. A failed
// or cancelled download leaves the Update folder as it was. A read-only cache folder keeps
// the description elsewhere, so the check still works.
TEST_F(About, Downloads) {
    enum Limit { None, WontStart, ReadOnly, Cancel };
    const QString program = fake.programFolder(), cache = fake.makeFolder("cache/lum"),
                  update = cache + "/Update";
    const std::string installer = update.toStdString() + "/setup.run";
    const std::string kept = "Download Complete | The update has been downloaded to " + installer +
                             "\n | Ok | Information\nshow " + update.toStdString() + '\n';
    const std::string start =
        "start " + installer + " /SP- /silent /noicons /dir=" + program.toStdString() + '\n';
    const std::string failed = "Download Failed | Failed to Download Update | Ok | None\n";
    const auto writable = QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner;
    // What was there, what the server has (none: not found), the run flag: what happens,
    // then the Update folder's entries and the installer's bytes.
    const std::tuple<const char*, const char*, QByteArray, Limit, std::string> rows[] = {
        {"OLD", "NEW", "0", None, kAsk + kept + "setup.run NEW"},
        {"OLD", "NEW", "1", None, kAsk + start + "end program\nsetup.run NEW"},
        {nullptr, "NEW", "1", WontStart, kAsk + kept + start + "setup.run NEW"},
        {nullptr, nullptr, "0", None, kAsk + failed + " <unreadable>"},
        {"OLD", "", "0", None, kAsk + failed + "setup.run OLD"},
        {"OLD", "NEW", "0", Cancel, kAsk + "setup.run OLD"},
        {nullptr, "NEW", "0", ReadOnly, kAsk + failed + " <unreadable>"},
        {"/", "NEW", "0", None, kAsk + failed + "setup.run <unreadable>"}, // a folder in its place
    };
    for (const auto& [before, body, runFlag, limit, did] : rows) {
        QFile::setPermissions(cache, writable);
        QDir(update).removeRecursively();
        if (before && *before == '/')
            fake.makeFolder("cache/lum/Update/setup.run");
        else if (before)
            fake.writeFile("cache/lum/Update/setup.run", before);
        server.responses["/files/setup.run"] = {body ? 200 : 404, body, {}, limit == Cancel};
        if (limit == Cancel) // once the download waits, as the user would
            QTimer::singleShot(300, window, [this] {
                auto* progress = window->findChild<QProgressDialog*>();
                ASSERT_TRUE(progress && progress->isVisible());
                EXPECT_EQ(progress->findChild<QLabel*>()->textFormat(), Qt::PlainText);
                QTest::mouseClick(progress->findChild<QPushButton*>(), Qt::LeftButton);
            });
        fake.shell.succeed = limit != WontStart;
        QFile::setPermissions(cache, limit == ReadOnly ? writable ^ QFile::WriteOwner : writable);
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        std::string seen = check(false, section("1049613", {}, "setup.run", runFlag));
        seen += folderEntries(update).join(u' ').toStdString() + ' ';
        EXPECT_EQ(seen + fileBytes(update + "/setup.run").toStdString(), did);
        EXPECT_TRUE(runFlag == "0" || QFileInfo(update + "/setup.run").isExecutable());
    }
}

// Closing it while a download waits would delete it under the check.
TEST_F(About, StaysOpenWhileADownloadWaits) {
    QtDownloader impatient{std::chrono::milliseconds(300)};
    Platform platform = fake.with(impatient);
    QPointer<frmAbout> busy = new frmAbout(platform, nullptr, server.base());
    busy->show();
    server.responses["/programs/update.txt"] = {.silent = true};
    QTimer::singleShot(50, busy, [&] { busy->close(); });
    QTest::mouseClick(busy->cmdUpdate, Qt::LeftButton);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_FALSE(busy.isNull());
    EXPECT_TRUE(busy->isVisible());
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u); // the failed check, shown over a live window
    delete busy.data();
}

} // namespace
