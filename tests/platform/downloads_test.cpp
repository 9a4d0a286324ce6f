#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/LocalHttpServer.h"

#include <gtest/gtest.h>

namespace {

// A success replaces the older file with the whole body, after redirects; a failure returns
// false (a silent server within the stall time, a trickling one by the deadline) and leaves
// the older file alone, nothing beside.
TEST(DownloadFileTest, StoresTheWholeBodyOrKeepsTheOlderFile) {
    QTemporaryDir dir;
    LocalHttpServer server;
    QtDownloader downloader{std::chrono::milliseconds(1000)};
    const QString target = dir.path() + "/file.bin";
    const QByteArray body(300000, 'x'); // several network reads
    server.responses["/old"] = {.status = 302, .location = (server.base() + "/new").toUtf8()};
    server.responses["/new"] = {.body = body};
    server.responses["/broken"] = {.status = 500};
    server.responses["/silent"] = {.silent = true};
    server.responses["/trickle"] = {.body = QByteArray(100, 'x'), .trickle = true}; // 5 s
    server.responses["/cut"] = {.body = body.left(1000), .claimedLength = body.size()};
    ASSERT_TRUE(putFile(target, "older"));
    EXPECT_TRUE(downloader.DownloadFile(server.base() + "/old", target));
    EXPECT_EQ(fileBytes(target), body);
    // Not found, an error, silence, trickling, a body cut off, refused, no web address, none,
    // a full disk.
    const DiskFull full(1000);
    for (const QString& url :
         {server.base() + "/gone", server.base() + "/broken", server.base() + "/silent",
          server.base() + "/trickle", server.base() + "/cut",
          LocalHttpServer::refusedBase() + "/any", QStringLiteral("file:///etc/hostname"),
          QString(), server.base() + "/new"}) {
        ASSERT_TRUE(putFile(target, "older"));
        EXPECT_FALSE(downloader.DownloadFile(url, target, {std::chrono::milliseconds(1500), {}}))
            << url.toStdString();
        EXPECT_EQ(fileBytes(target) + folderEntries(dir.path()).join(' ').toUtf8(), "olderfile.bin")
            << url.toStdString();
    }
}

// The one registry value the program asks for, the system information tool, is found on PATH.
TEST(ToolRegistryTest, AnswersTheToolLookupFromPath) {
    QTemporaryDir bin;
    const QString tool = bin.path() + "/hardinfo";
    ASSERT_TRUE(putFile(tool, {}) && QFile::setPermissions(tool, QFile::ExeOwner));
    const QByteArray savedPath = qgetenv("PATH");
    qputenv("PATH", bin.path().toUtf8());
    const auto value = ToolRegistry().QueryValue(
        kHkeyLocalMachine, "SOFTWARE\\Microsoft\\Shared Tools\\MSINFO", "PATH");
    qputenv("PATH", savedPath);
    EXPECT_TRUE(value && value->type == kRegString && value->data == tool.toUtf8() + '\0');
}

} // namespace
