#include "support/Files.h"
#include "support/LocalHttpServer.h"

#include "platform/Downloader.h"
#include "platform/Registry.h"

#include <QElapsedTimer>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

// A success replaces the older file with the whole body, after redirects. Every failure
// returns false, in bounded time, and leaves the older file exactly as it was, with no
// temporary file beside it.
TEST(DownloadFileTest, StoresTheWholeBodyOrKeepsTheOlderFile) {
    QTemporaryDir dir;
    LocalHttpServer server;
    QtDownloader patient, downloader{std::chrono::milliseconds(300)};
    const QString target = dir.path() + "/file.bin";
    const QByteArray body(300000, 'x'); // several network reads
    server.redirect("/old", server.base() + "/new");
    server.serve("/new", body);
    ASSERT_TRUE(putFile(target, "older"));
    EXPECT_TRUE(patient.DownloadFile(server.base() + "/old", target));
    EXPECT_EQ(fileBytes(target), body);
    EXPECT_EQ(server.requests, (QStringList{"/old", "/new"}));
    EXPECT_FALSE(downloader.DownloadFile(server.base() + "/new", dir.path() + "/no/such/file"));

    server.fail("/broken", 500);
    server.stall("/silent");
    for (const QString& url : {server.base() + "/gone", server.base() + "/broken",
                               server.base() + "/silent", LocalHttpServer::refusedBase() + "/any",
                               QStringLiteral("file:///etc/hostname"), QString()}) {
        ASSERT_TRUE(putFile(target, "older"));
        QElapsedTimer clock;
        clock.start();
        EXPECT_FALSE(downloader.DownloadFile(url, target)) << url.toStdString();
        EXPECT_LT(clock.elapsed(), 10000);
        EXPECT_EQ(fileBytes(target), "older");
        EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), QStringList{"file.bin"});
    }
}

TEST(ToolRegistryTest, AnswersTheToolLookupFromPathOnly) {
    QTemporaryDir bin;
    const QByteArray savedPath = qgetenv("PATH");
    qputenv("PATH", bin.path().toUtf8());
    ToolRegistry registry;
    const QString key = QStringLiteral("SOFTWARE\\Microsoft\\Shared Tools\\MSINFO");
    EXPECT_FALSE(registry.QueryValue(kHkeyLocalMachine, key, "PATH"));
    for (const char* tool : {"gnome-system-monitor", "hardinfo"}) {
        ASSERT_TRUE(putFile(bin.path() + u'/' + tool, "#!/bin/sh\n"));
        QFile::setPermissions(bin.path() + u'/' + tool, QFile::ReadOwner | QFile::ExeOwner);
    }
    const auto value = registry.QueryValue(kHkeyLocalMachine, key, "PATH");
    ASSERT_TRUE(value);
    EXPECT_EQ(value->type, kRegString);
    EXPECT_EQ(value->data, (bin.path() + "/hardinfo").toUtf8() + '\0'); // best tool first
    EXPECT_FALSE(registry.QueryValue(kHkeyLocalMachine,
                                     "SOFTWARE\\Microsoft\\Shared Tools Location", "MSINFO"));
    EXPECT_FALSE(registry.QueryValue(0x80000001u, key, "PATH"));
    qputenv("PATH", savedPath);
}

} // namespace
