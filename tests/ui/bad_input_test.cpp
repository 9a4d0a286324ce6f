#include "support/FakePlatform.h"
#include "support/Files.h"

#include "ui/PictureFile.h"
#include "ui/Twips.h"

#include <QGuiApplication>
#include <QScreen>

#include <sys/stat.h>

#include <gtest/gtest.h>

// Stored placements come back through these conversions: values no window can have (from
// a damaged or hand-edited store) are held to twice the desktop instead of overflowing.
TEST(BadInputTwips, AbsurdValuesStayWithinTheDesktop) {
    const QScreen* screen = QGuiApplication::primaryScreen();
    const int limit = 2 * std::max(screen->virtualSize().width(), screen->virtualSize().height());
    const std::pair<double, int> cases[] = {{1e30, limit},  {3e9, limit},  {-1e30, -limit},
                                            {-3e9, -limit}, {HUGE_VAL, 0}, {-HUGE_VAL, 0},
                                            {NAN, 0}};
    for (const auto& [value, pixels] : cases) {
        EXPECT_EQ(twips::toPixelsX(value), pixels) << value;
        EXPECT_EQ(twips::toPixelsY(value), pixels) << value;
    }
    // Ordinary values are untouched: 1440 twips to the inch.
    EXPECT_EQ(twips::toPixelsX(4905), std::lround(4905 * screen->logicalDotsPerInchX() / 1440));
    EXPECT_EQ(twips::toPixelsY(-500), std::lround(-500 * screen->logicalDotsPerInchY() / 1440));
}

// Background and controller pictures: whatever is at the path, a picture or none.
TEST(BadInputPictures, AnythingButAPictureOfModestSizeGivesNone) {
    FakePlatform fake;
    // A JPEG whose header claims 60000 x 60000, its data cut.
    QByteArray huge = encodedPicture(8, 8, "JPG");
    const qsizetype frame = huge.indexOf("\xFF\xC0");
    huge = huge.left(frame + 40).replace(frame + 5, 4, "\xEA\x60\xEA\x60");
    ASSERT_EQ(::mkfifo(QFile::encodeName(fake.root() + "/fifo.jpg"), 0600), 0);
    const QString none[] = {QString(),
                            fake.root() + "/missing.jpg",
                            fake.writeFile("empty.jpg"),
                            fake.writeFile("cut.jpg", encodedPicture(64, 64, "JPG").left(100)),
                            fake.writeFile("huge.jpg", huge),
                            fake.writeFile("garbage.jpg", "\xFF\xD8junk"),
                            makeUnreadable(fake.root() + "/lock.jpg", encodedPicture(8, 8, "PNG")),
                            fake.makeFolder("folder.jpg"),
                            fake.root() + "/fifo.jpg"};
    for (const QString& path : none)
        EXPECT_TRUE(loadPictureFile(path).isNull()) << qPrintable(path);
    EXPECT_EQ(loadPictureFile(fake.writeFile("ok.png", encodedPicture(9, 7, "PNG"))).size(),
              QSize(9, 7));
}
