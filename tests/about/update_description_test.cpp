#include "about/UpdateDescription.h"

#include <QBuffer>

#include <gtest/gtest.h>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");

// The section read from `content`; `end` receives how far the file was read.
UpdateSection read(const QByteArray& content, bool forumOnly = false, qint64* end = nullptr) {
    QBuffer buffer;
    buffer.setData(content);
    buffer.open(QIODevice::ReadOnly);
    UpdateSection section = readUpdateSection(buffer, kProduct, forumOnly);
    if (end)
        *end = buffer.pos();
    return section;
}

TEST(UpdateDescriptionTest, VersionArithmetic) {
    EXPECT_EQ(thisProduct().name, kProduct);
    EXPECT_EQ(versionNumber(thisProduct()), 1049612);
    EXPECT_EQ(versionText(thisProduct()), "1.1.12");
    // (1.1.13 and 2.1.0: see the update check's question.)
    EXPECT_EQ(versionTextFromNumber(0), "0.0.0");
    EXPECT_EQ(versionTextFromNumber(1048575), "0.1023.1023");
    EXPECT_EQ(parseVersionNumber(QStringLiteral(" 1049613\t")), 1049613);
    for (const char* bad : {"", "1.1.13", "+5", "12abc", "1 2"})
        EXPECT_FALSE(parseVersionNumber(QString::fromUtf8(bad))) << bad;
}

TEST(UpdateDescriptionTest, HeadersAndInstallerNames) {
    EXPECT_TRUE(isSectionHeader("::" + kProduct, kProduct));
    for (const QString& other : {"::" + kProduct.toUpper(), "::" + kProduct + " ", ":: " + kProduct,
                                 "x::" + kProduct, kProduct})
        EXPECT_FALSE(isSectionHeader(other, kProduct)) << other.toStdString();
    // Short lines never qualify, not even for an empty name.
    EXPECT_FALSE(isSectionHeader(QStringLiteral("::"), QString()));

    for (const char* good : {"setup.exe", "lum-1.1.13.run", "a b.bin"})
        EXPECT_TRUE(isSafeInstallerFileName(QString::fromUtf8(good))) << good;
    for (const char* bad : {"", " ", ".", "..", "../setup.exe", "/tmp/setup.exe", "sub/setup.exe",
                            "..\\setup.exe", "C:\\setup.exe", "bad\nname"})
        EXPECT_FALSE(isSafeInstallerFileName(QString::fromUtf8(bad))) << bad;
}

TEST(UpdateDescriptionTest, FindsTheSectionAndReadsNoFurther) {
    const QByteArray file =
        "\r\n::\r\nx\r\n"
        "::LUM (WINDOWS FRONT END FOR Z26)\r\nhttps://wrong\r\n"
        "::Other Program\r\nhttps://other\r\n2098176\r\n"
        "::lum (Windows Front End for z26)\r\nhttps://example.org/forum/lum\r\n"
        "1049613\r\nMay 1st\r\nhttps://example.org/setup.exe\r\nsetup.exe\r\n1\r\n"
        "after the run flag\r\n";
    qint64 end = 0;
    const UpdateSection s = read(file, false, &end);
    EXPECT_EQ(s.status, UpdateSection::Status::Complete);
    EXPECT_EQ(QStringList({s.forumUrl, s.message, QString::number(s.availableVersion),
                           s.releaseDate, s.installerUrl, s.installerFileName, s.runFlag}),
              QStringList({"https://example.org/forum/lum", "", "1049613", "May 1st",
                           "https://example.org/setup.exe", "setup.exe", "1"}));
    EXPECT_EQ(end, file.indexOf("after"));
    EXPECT_EQ(read(file, true, &end).status, UpdateSection::Status::Complete);
    EXPECT_EQ(end, file.indexOf("1049613"));
    for (const bool forum : {false, true})
        EXPECT_EQ(read(file.left(file.indexOf("::lum")), forum).status,
                  UpdateSection::Status::NotFound);
}

TEST(UpdateDescriptionTest, MessagesCutShortOrWithoutANumber) {
    // LF-only line ends are read as well.
    const UpdateSection two =
        read("::lum (Windows Front End for z26)\nf\n'Hello\n'World\n1049613\nd\nu\nn\n0\n");
    EXPECT_EQ(two.status, UpdateSection::Status::Complete);
    EXPECT_EQ(two.message, "\nHello\nWorld\n");
    EXPECT_EQ(two.availableVersion, 1049613);

    const QByteArray full = "::lum (Windows Front End for z26)\r\nf\r\n'note\r\n"
                            "1049613\r\ndate\r\nurl\r\nname\r\n0\r\n";
    for (qsizetype end = full.indexOf("\r\n"); end + 2 < full.size();
         end = full.indexOf("\r\n", end + 2))
        EXPECT_EQ(read(full.left(end + 2)).status, UpdateSection::Status::Truncated) << end;
    EXPECT_EQ(read(full.left(full.indexOf("\r\n") + 2), true).status,
              UpdateSection::Status::Truncated);
    QByteArray notANumber = full;
    notANumber.replace("1049613", "1.1.13");
    EXPECT_EQ(read(notANumber).status, UpdateSection::Status::BadVersion);
}

} // namespace
