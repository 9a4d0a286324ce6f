#include "library/RomArchive.h"

#include "support/Archives.h"
#include "support/FakePlatform.h"
#include "support/Files.h"

#include <gtest/gtest.h>

// Each archive (known by its extension in any case) gives its first file's bytes under its base
// name, or a reason and no file; nothing is written outside the folder.
TEST(RomArchive, ExtractsTheFirstFileOrSaysWhyNot) {
    FakePlatform fake;
    const QString into = fake.makeFolder("into"), in = fake.root() + '/';
    const QByteArray rom = "\x78\xD8\xA9";
    const std::pair<QString, QString> cases[] = {
        {writeArchive(in + "a.ZIP", "zip", {{"games", {}}, {"games/Pitfall.bin", rom}, {"b", "b"}}),
         "Pitfall.bin"},
        {writeArchive(in + "b.7z", "7zip", {{"River Raid.a26", rom}}), "River Raid.a26"},
        {writeArchive(in + "Combat.bin.gz", "raw", {{"data", rom}}), "Combat.bin"},
        {writeArchive(in + "up.zip", "zip", {{"../x.bin", rom}}), "x.bin"},
        {writeArchive(in + "dots.zip", "zip", {{"a/..", rom}}), "dots"},
        {fake.writeFile("cut.zip", fileBytes(writeArchive(in + "d", "zip", {{"a", rom}})).left(33)),
         "It is damaged or is not a zip, 7z or gzip file ("},
        {fake.writeFile("text.gz", "no archive"), "It is not a gzip file."},
        {writeArchive(in + "locked.zip", "zip", {{"a.bin", rom}}, "zip:encryption=zipcrypt"),
         "It is encrypted."},
        {writeArchive(in + "none.zip", "zip", {{"games", {}}}), "It holds no file."},
        {writeArchive(in + "big.zip", "zip", {{"big.bin", QByteArray(kLargestArchivedRom + 1, 0)}}),
         "Its first file, big.bin, is larger than 16 MiB: too large for a ROM."},
    };
    for (const auto& [archive, outcome] : cases) {
        EXPECT_TRUE(isRomArchiveName(archive)) << archive.toStdString();
        const ArchiveResult result = extractFirstRom(archive, into);
        // A reason may end in libarchive's own words.
        const QString got = result.path.isEmpty()
                                ? result.error.left(outcome.size())
                                : QString(result.path).remove(into + '/') +
                                      (fileBytes(result.path) == rom ? "" : " with other bytes");
        EXPECT_EQ(got, outcome) << archive.toStdString();
    }
    EXPECT_EQ(folderEntries(into).join(' '), "Combat.bin dots Pitfall.bin River Raid.a26 x.bin");
    EXPECT_EQ(folderEntries(fake.root()).filter(".bin").join(' '), "Combat.bin.gz");
    EXPECT_FALSE(isRomArchiveName("a.zip.bin") || isRomArchiveName("zip") ||
                 isRomArchiveName("a.tgz"));
}
