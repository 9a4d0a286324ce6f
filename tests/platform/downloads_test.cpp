#include "support/DiskFull.h"
#include "support/Files.h"
#include "support/LocalHttpServer.h"

#include "platform/Downloader.h"
#include "platform/Registry.h"

#include <QElapsedTimer>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <optional>

namespace {

// A success replaces the older file with the whole body, after redirects; a failure returns
// false in bounded time and leaves the older file as it was, with nothing beside it.
TEST(DownloadFileTest, StoresTheWholeBodyOrKeepsTheOlderFile) {
    QTemporaryDir dir;
    LocalHttpServer server;
    QtDownloader downloader{std::chrono::milliseconds(1000)};
    const QString target = dir.path() + "/file.bin";
    const QByteArray body(300000, 'x'); // several network reads
    server.redirect("/old", server.base() + "/new");
    server.serve("/new", body);
    server.fail("/broken", 500);
    server.stall("/silent");
    server.cutOff("/cut", body.left(1000), body.size());
    ASSERT_TRUE(putFile(target, "older"));
    EXPECT_TRUE(downloader.DownloadFile(server.base() + "/old", target));
    EXPECT_EQ(fileBytes(target), body);
    EXPECT_EQ(server.requests, (QStringList{"/old", "/new"}));

    EXPECT_FALSE(downloader.DownloadFile(server.base() + "/new", dir.path() + "/no/such/file"));
    // Not found, a server error, silence, a body cut off, a refused connection, an address
    // that is not on the web, none at all, and the good one on a full disk.
    for (const QString& url :
         {server.base() + "/gone", server.base() + "/broken", server.base() + "/silent",
          server.base() + "/cut", LocalHttpServer::refusedBase() + "/any",
          QStringLiteral("file:///etc/hostname"), QString(), server.base() + "/new"}) {
        SCOPED_TRACE(url.toStdString());
        ASSERT_TRUE(putFile(target, "older"));
        std::optional<DiskFull> full;
        if (url.endsWith("/new"))
            full.emplace(1000);
        QElapsedTimer clock;
        clock.start();
        EXPECT_FALSE(downloader.DownloadFile(url, target));
        EXPECT_LT(clock.elapsed(), 10000);
        EXPECT_EQ(fileBytes(target), "older");
        EXPECT_EQ(folderEntries(dir.path()), QStringList{"file.bin"});
    }
}

// The one registry value the program asks for, the system information tool, is found on PATH.
TEST(ToolRegistryTest, AnswersTheToolLookupFromPathOnly) {
    QTemporaryDir bin;
    const QByteArray savedPath = qgetenv("PATH");
    qputenv("PATH", bin.path().toUtf8());
    ToolRegistry registry;
    const QString key = QStringLiteral("SOFTWARE\\Microsoft\\Shared Tools\\MSINFO");
    EXPECT_FALSE(registry.QueryValue(kHkeyLocalMachine, key, "PATH"));
    const QString tool = bin.path() + "/hardinfo";
    ASSERT_TRUE(putFile(tool, "#!/bin/sh\n"));
    QFile::setPermissions(tool, QFile::ReadOwner | QFile::ExeOwner);
    const auto value = registry.QueryValue(kHkeyLocalMachine, key, "PATH");
    ASSERT_TRUE(value);
    EXPECT_EQ(value->type, kRegString);
    EXPECT_EQ(value->data, tool.toUtf8() + '\0');
    EXPECT_FALSE(registry.QueryValue(kHkeyLocalMachine,
                                     "SOFTWARE\\Microsoft\\Shared Tools Location", "MSINFO"));
    EXPECT_FALSE(registry.QueryValue(0x80000001u, key, "PATH"));
    qputenv("PATH", savedPath);
}

} // namespace
