#include "support/Boxes.h"
#include "support/LocalHttpServer.h"

#include "about/AboutArt.h"
#include "about/AboutRules.h"
#include "about/SysInfo.h"
#include "about/frmAbout.h"
#include "ui/Twips.h"

#include <QApplication>
#include <QFileInfo>
#include <QFontMetrics>
#include <QLabel>
#include <QMouseEvent>
#include <QPointer>
#include <QPushButton>
#include <QSignalSpy>
#include <QTest>
#include <QTimer>

#include <gtest/gtest.h>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");
const QString kMsinfoKey = QString::fromLatin1(kSysInfoPathKey);

QColor textColour(const QLabel* label) {
    return label->palette().color(QPalette::WindowText);
}

void moveMouse(QWidget* widget, QPoint position) {
    QMouseEvent move(QEvent::MouseMove, position, widget->mapToGlobal(position), Qt::NoButton,
                     Qt::NoButton, Qt::NoModifier);
    QApplication::sendEvent(widget, &move);
}

class AboutWindowTest : public ::testing::Test {
protected:
    FakePlatform fake;
    LocalHttpServer server;
    QPointer<frmAbout> window = new frmAbout(fake.platform, nullptr, server.base());

    ~AboutWindowTest() override { delete window.data(); }
};

TEST(AboutRulesTest, ShrinkTilesAndLinks) {
    QFont font(QStringLiteral("Arial"));
    font.setBold(true);
    font.setPointSizeF(29.25);
    auto width = [font](double points) mutable {
        font.setPointSizeF(points);
        return QFontMetrics(font).horizontalAdvance(kProduct);
    };
    const double fitted = shrinkToFit(font, kProduct, 327);
    EXPECT_DOUBLE_EQ(fitted - std::floor(fitted), 0.25); // whole points off 29.25
    EXPECT_LE(width(fitted), 327);
    EXPECT_GT(width(fitted + 1), 327);
    EXPECT_DOUBLE_EQ(shrinkToFit(font, QStringLiteral("lum"), 327), 29.25);
    EXPECT_DOUBLE_EQ(shrinkToFit(font, kProduct, 0), 1.0); // stops instead of looping

    // Column by column, both bounds inclusive.
    EXPECT_EQ(tileOrigins(QSize(300, 100), QSize(128, 96)),
              (std::vector<QPoint>{{0, 0}, {0, 96}, {128, 0}, {128, 96}, {256, 0}, {256, 96}}));
    EXPECT_EQ(tileOrigins(QSize(256, 96), QSize(128, 96)).size(), 6u);
    EXPECT_TRUE(tileOrigins(QSize(300, 100), QSize(0, 96)).empty());

    EXPECT_EQ(mailtoAddress("me@example.org", kProduct, "1.1.12"),
              "mailto:me@example.org?Subject=lum (Windows Front End for z26) v1.1.12 Question");
    EXPECT_EQ(donationAddress("https://pay.example", "give@example.org", "example.org"),
              "https://pay.example/xclick/business=give%40example.org&item_name=example.org"
              "&no_note=1&tax=0&currency_code=USD");
}

TEST_F(AboutWindowTest, GetKeyValue) {
    const std::pair<RegistryValue, std::optional<QString>> values[] = {
        {{kRegNumber, QByteArray("\x78\x56\x34\x12", 4)}, "&h12345678"}, // last byte first
        {{kRegNumber, QByteArray("\x0F\x0A\x00\x00", 4)}, "&hA0F"},      // inner zeros kept
        {{kRegString, QByteArray("/usr/bin/hardinfo\0junk", 22)}, "/usr/bin/hardinfo"},
        {{3, QByteArray("\x01", 1)}, std::nullopt}, // no text form
    };
    for (const auto& [value, text] : values)
        EXPECT_EQ(registryValueText(value), text) << value.data.toHex().constData();
    fake.registry.set(kHkeyLocalMachine, kMsinfoKey, "Blob", values[3].first);
    QString value = QStringLiteral("before");
    EXPECT_TRUE(window->GetKeyValue(kHkeyLocalMachine, kMsinfoKey, "Blob", value));
    EXPECT_EQ(value, "before"); // left alone
    EXPECT_FALSE(window->GetKeyValue(0x80000001u, kMsinfoKey, "PATH", value));
    EXPECT_EQ(value, "");
}

TEST_F(AboutWindowTest, SystemInformation) {
    const QString folder = fake.makeFolder("msinfo");
    // path registered, folder registered, MSINFO32.EXE there, start works -> started
    const std::tuple<bool, bool, bool, bool, const char*> cases[] = {
        {true, true, true, true, "/usr/bin/hardinfo"}, {true, false, false, false, nullptr},
        {false, true, true, true, "/MSINFO32.EXE"},    {false, true, false, true, nullptr},
        {false, false, false, true, nullptr},
    };
    for (const auto& [path, location, there, works, started] : cases) {
        fake.registry.values.clear();
        fake.shell.started.clear();
        fake.dialogs.boxes.clear();
        fake.shell.succeed = works;
        QFile::remove(folder + "/MSINFO32.EXE");
        if (path)
            fake.registry.set(kHkeyLocalMachine, kMsinfoKey, "PATH",
                              {kRegString, "/usr/bin/hardinfo"});
        if (location)
            fake.registry.set(kHkeyLocalMachine, QString::fromLatin1(kSysInfoFolderKey), "MSINFO",
                              {kRegString, folder.toUtf8() + '\0'});
        if (there)
            fake.writeFile("msinfo/MSINFO32.EXE");
        QTest::mouseClick(window->cmdSysInfo, Qt::LeftButton);
        if (started) {
            ASSERT_EQ(fake.shell.started.size(), 1u);
            EXPECT_TRUE(fake.shell.started[0].program.endsWith(QLatin1String(started)));
        }
        EXPECT_EQ(boxLines(fake.dialogs),
                  started
                      ? Lines{}
                      : Lines{"lum | System Information Is Unavailable At This Time | Ok | None"});
    }
}

TEST_F(AboutWindowTest, LoadsNameVersionColoursAndTiledBackground) {
    EXPECT_EQ(window->lblProgram->text(), kProduct);
    EXPECT_EQ(window->lblVersion->text(), "Version 1.1.12");
    EXPECT_LT(window->lblProgram->font().pointSizeF(), 29.25);
    EXPECT_LE(QFontMetrics(window->lblProgram->font()).horizontalAdvance(kProduct),
              twips::toPixelsX(4900));
    EXPECT_EQ(textColour(window->lblProgram), QColor(0, 255, 0));
    EXPECT_EQ(textColour(window->lblCorwen), QColor(0, 255, 0));
    EXPECT_EQ(textColour(window->lblMain), QColor(255, 255, 0));
    EXPECT_EQ(textColour(window->lblEmail), QColor(0, 255, 255));

    window->show();
    const QImage shot = window->grab().toImage().convertToFormat(QImage::Format_RGB32);
    const QImage tile = aboutBackgroundTile();
    ASSERT_GT(shot.width(), 2 * tile.width());
    // The top strip and the left edge hold no control: tiles only, the last ones cut.
    for (int x = 0; x < shot.width(); ++x)
        ASSERT_EQ(shot.pixel(x, 3), tile.pixel(x % tile.width(), 3)) << x;
    for (int y = 0; y < shot.height(); ++y)
        ASSERT_EQ(shot.pixel(3, y), tile.pixel(3, y % tile.height())) << y;
}

TEST_F(AboutWindowTest, EmailHoverAndLinks) {
    window->show(); // lays the controls out
    const QColor hover(78, 136, 255);
    moveMouse(window->lblEmail, QPoint(2, 2));
    EXPECT_EQ(textColour(window->lblEmail), hover);
    moveMouse(window->cmdOK, QPoint(2, 2)); // another control: no change
    moveMouse(window, window->cmdOK->geometry().center());
    EXPECT_EQ(textColour(window->lblEmail), hover);
    moveMouse(window, QPoint(2, 2)); // the window's own surface
    EXPECT_EQ(textColour(window->lblEmail), QColor(0, 255, 255));

    for (QWidget* link :
         std::initializer_list<QWidget*>{window->lblEmail, window->cmdWeb, window->cmdDonate})
        QTest::mouseClick(link, Qt::LeftButton);
    ASSERT_EQ(fake.shell.urls.size(), 3);
    EXPECT_TRUE(fake.shell.urls[0].startsWith("mailto:"));
    EXPECT_TRUE(fake.shell.urls[0].endsWith(" v1.1.12 Question"));
    EXPECT_TRUE(fake.shell.urls[1].startsWith("https://"));
    EXPECT_TRUE(fake.shell.urls[2].startsWith("https://"));
    EXPECT_TRUE(fake.shell.urls[2].contains("/xclick/business="));
}

TEST_F(AboutWindowTest, ForumThenUpdateAndAnInstallerThatEndsTheProgram) {
    server.serve("/programs/update.txt",
                 "::lum (Windows Front End for z26)\r\nhttps://example.org/forum/lum\r\n"
                 "1049613\r\nJune 2nd\r\n" +
                     server.base().toUtf8() + "/setup.run\r\nsetup.run\r\n1\r\n");
    server.serve("/setup.run", "INSTALLER");
    QTest::mouseClick(window->cmdForum, Qt::LeftButton);
    EXPECT_EQ(fake.shell.urls, QStringList{"https://example.org/forum/lum"});
    EXPECT_FALSE(window->m_bForumRequest);

    QSignalSpy ended(window.data(), &frmAbout::endProgramRequested);
    QTest::mouseClick(window->cmdUpdate, Qt::LeftButton);
    EXPECT_EQ(ended.count(), 1);
    EXPECT_EQ(fake.shell.started.size(), 1u);
    EXPECT_FALSE(QFileInfo::exists(fake.iniPath())); // nothing saved

    // A failed forum lookup clears the request too.
    server.fail("/programs/update.txt", 404);
    QTest::mouseClick(window->cmdForum, Qt::LeftButton);
    EXPECT_FALSE(window->m_bForumRequest);
    EXPECT_EQ(fake.shell.urls.size(), 1);
}

TEST_F(AboutWindowTest, StaysOpenWhileADownloadWaits) {
    QtDownloader impatient{std::chrono::milliseconds(300)};
    Platform platform{fake.store,           fake.dialogs, fake.shell,
                      fake.programFolder(), impatient,    fake.registry};
    QPointer<frmAbout> busy = new frmAbout(platform, nullptr, server.base());
    busy->show();
    server.stall("/programs/update.txt");
    QTimer::singleShot(50, busy, [&] { busy->close(); });
    QTest::mouseClick(busy->cmdUpdate, Qt::LeftButton);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_FALSE(busy.isNull());
    EXPECT_TRUE(busy->isVisible());
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u); // the failed check, shown over a live window
    delete busy.data();
}

TEST_F(AboutWindowTest, OkAndEscapeCloseAndDeleteIt) {
    for (const bool escape : {false, true}) {
        if (!window)
            window = new frmAbout(fake.platform, nullptr, server.base());
        window->show();
        if (escape)
            QTest::keyClick(window, Qt::Key_Escape);
        else
            QTest::mouseClick(window->cmdOK, Qt::LeftButton);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        EXPECT_TRUE(window.isNull());
    }
}

} // namespace
