#include "about/UpdateDescription.h"

#include <QBuffer>

#include <gtest/gtest.h>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");
const QByteArray kHeader = "::lum (Windows Front End for z26)\r\n";
const std::string kNone = "NotFound |  |  | 0 |  |  |  | ";

// The section read from `content` as one line: status, then every field in file order.
// `end` receives how far the file was read.
std::string read(const QByteArray& content, bool forumOnly = false, qint64* end = nullptr) {
    QBuffer buffer;
    buffer.setData(content);
    buffer.open(QIODevice::ReadOnly);
    const UpdateSection s = readUpdateSection(buffer, kProduct, forumOnly);
    if (end)
        *end = buffer.pos();
    static const char* const statuses[] = {"NotFound", "Complete", "Truncated", "BadVersion"};
    const QStringList fields = {s.forumUrl,    s.message,      QString::number(s.availableVersion),
                                s.releaseDate, s.installerUrl, s.installerFileName,
                                s.runFlag};
    return statuses[static_cast<int>(s.status)] + (" | " + fields.join(" | ")).toStdString();
}

TEST(UpdateDescriptionTest, VersionArithmetic) {
    const std::pair<qint64, const char*> texts[] = {
        {0, "0.0.0"}, {1048575, "0.1023.1023"}, {1049613, "1.1.13"}, {2098176, "2.1.0"}};
    for (const auto& [number, text] : texts)
        EXPECT_EQ(versionTextFromNumber(number), text) << number;
    EXPECT_EQ(parseVersionNumber(QStringLiteral(" 1049613\t")), 1049613);
    for (const char* bad :
         {"", "1.1.13", "+5", "-5", "12abc", "1 2", "99999999999999999999999", "\u0661\u0662"})
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
    const QByteArray file = "\r\n::\r\nx\r\n::LUM (WINDOWS FRONT END FOR Z26)\r\nhttps://wrong\r\n"
                            "::Other Program\r\nhttps://other\r\n2098176\r\n" +
                            kHeader +
                            "https://example.org/forum/lum\r\n1049613\r\nMay 1st\r\n"
                            "https://example.org/setup.exe\r\nsetup.exe\r\n1\r\nafter the flag\r\n";
    QByteArray others, noise(64 * 1024, '\0');
    while (others.size() < 8 * 1024 * 1024)
        others += "::Some other product\r\nhttps://example.org/other\r\n'a message\r\n";
    for (qsizetype i = 0; i < noise.size(); ++i)
        noise[i] = static_cast<char>(i * 7919 % 251);
    const std::tuple<QByteArray, bool, std::string, qsizetype> rows[] = {
        {file, false,
         "Complete | https://example.org/forum/lum |  | 1049613 | May 1st | "
         "https://example.org/setup.exe | setup.exe | 1",
         file.indexOf("after")},
        {file, true, "Complete | https://example.org/forum/lum |  | 0 |  |  |  | ",
         file.indexOf("1049613")},
        {others + kHeader + "f\r\n1049612\r\nd\r\nu\r\nn\r\n0\r\n", false,
         "Complete | f |  | 1049612 | d | u | n | 0", -1},
        {"::lum (Windows Front End for z26)\nf\n'Hello\n'World\n1049613\nd\nu\nn\n0\n", false,
         "Complete | f | \nHello\nWorld\n | 1049613 | d | u | n | 0", -1},
        {kHeader + "f\r\n'note\r\n1.1.13\r\nd\r\n", false,
         "BadVersion | f | \nnote\n | 0 |  |  |  | ", -1},
    };
    for (const auto& [content, forumOnly, section, stop] : rows) {
        qint64 end = 0;
        EXPECT_EQ(read(content, forumOnly, &end), section) << content.left(80).toStdString();
        EXPECT_EQ(stop < 0 ? stop : end, stop);
    }
    // No section for this product: nothing, noise, one line of 8 MiB, a NUL after the name,
    // other sections only.
    const QByteArray none[] = {{},
                               noise,
                               QByteArray(8 * 1024 * 1024, 'x'),
                               QByteArray("::lum (Windows Front End for z26)\0\r\n", 36),
                               file.left(file.indexOf("::lum"))};
    for (const QByteArray& content : none)
        for (const bool forumOnly : {false, true})
            EXPECT_EQ(read(content, forumOnly), kNone) << content.left(80).toStdString();

    // Cut after any line of the section, it is incomplete.
    const QByteArray full = kHeader + "f\r\n'note\r\n1049613\r\ndate\r\nurl\r\nname\r\n0\r\n";
    for (qsizetype end = full.indexOf("\r\n"); end + 2 < full.size();
         end = full.indexOf("\r\n", end + 2))
        EXPECT_EQ(read(full.left(end + 2)).substr(0, 9), "Truncated") << end;
    EXPECT_EQ(read(kHeader, true), "Truncated |  |  | 0 |  |  |  | ");
}

} // namespace
