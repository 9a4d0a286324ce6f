#include "support/Boxes.h"
#include "support/LocalHttpServer.h"
#include "support/WidgetDump.h"

#include "about/AboutArt.h"
#include "about/AboutRules.h"
#include "about/SysInfo.h"
#include "about/frmAbout.h"
#include "ui/Twips.h"

#include <QFileInfo>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QSignalSpy>
#include <QTest>
#include <QTimer>

#include <gtest/gtest.h>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");
const QString kMsinfoKey = QString::fromLatin1(kSysInfoPathKey);
const QColor kCyan(0, 255, 255), kHover(78, 136, 255);

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

TEST(AboutRulesTest, ShrinkToFitAndTiles) {
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
    fake.writeFile("msinfo/MSINFO32.EXE");
    fake.makeFolder("empty");
    const std::string none = "lum | System Information Is Unavailable At This Time | Ok | None";
    // The registered tool, the registered folder, whether starting works: what happens.
    const std::tuple<QString, QString, bool, std::string> rows[] = {
        {"/usr/bin/hardinfo", "msinfo", true, "start /usr/bin/hardinfo"},
        {"/usr/bin/hardinfo", "", false, none},
        {"", "msinfo", true, "start " + fake.root().toStdString() + "/msinfo/MSINFO32.EXE"},
        {"", "empty", true, none},
        {"", "", true, none},
    };
    for (const auto& [path, folder, works, did] : rows) {
        fake.registry.values.clear();
        if (!path.isEmpty())
            fake.registry.set(kHkeyLocalMachine, kMsinfoKey, "PATH", {kRegString, path.toUtf8()});
        if (!folder.isEmpty())
            fake.registry.set(kHkeyLocalMachine, QString::fromLatin1(kSysInfoFolderKey), "MSINFO",
                              {kRegString, (fake.root() + u'/' + folder).toUtf8() + '\0'});
        fake.shell.succeed = works;
        QTest::mouseClick(window->cmdSysInfo, Qt::LeftButton);
        Lines lines = boxLines(fake.dialogs);
        if (works && !fake.shell.started.empty())
            lines.push_back("start " + fake.shell.started.back().program.toStdString());
        EXPECT_EQ(lines, Lines{did});
        fake.dialogs.boxes.clear();
        fake.shell.started.clear();
    }
}

TEST_F(AboutWindowTest, GoldenTextsColoursAndATiledBackground) {
    QString dump = dumpWidgetTree(*window);
    for (const QLabel* label : window->findChildren<QLabel*>())
        if (!label->text().isEmpty())
            dump +=
                label->objectName() + QStringLiteral(" colour ") + textColour(label).name() + u'\n';
    expectGolden("frmAbout", dump);
    EXPECT_LT(window->lblProgram->font().pointSizeF(), 29.25);
    EXPECT_LE(QFontMetrics(window->lblProgram->font()).horizontalAdvance(kProduct),
              twips::toPixelsX(4900));

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
    moveMouse(window->lblEmail, QPoint(2, 2));
    EXPECT_EQ(textColour(window->lblEmail), kHover);
    moveMouse(window, window->cmdOK->geometry().center()); // over another control: no change
    EXPECT_EQ(textColour(window->lblEmail), kHover);
    moveMouse(window, QPoint(2, 2)); // the window's own surface
    EXPECT_EQ(textColour(window->lblEmail), kCyan);

    for (QWidget* link :
         std::initializer_list<QWidget*>{window->lblEmail, window->cmdWeb, window->cmdDonate})
        QTest::mouseClick(link, Qt::LeftButton);
    EXPECT_EQ(
        fake.shell.urls,
        (QStringList{"mailto:support@lum.example.org?Subject=" + kProduct + " v1.1.12 Question",
                     "https://lum.example.org/",
                     "https://www.paypal.com/xclick/business=donate%40lum.example.org"
                     "&item_name=lum.example.org&no_note=1&tax=0&currency_code=USD"}));
}

// After a forum lookup, whatever its outcome, the Update button checks for updates.
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

    server.fail("/programs/update.txt", 404);
    QTest::mouseClick(window->cmdForum, Qt::LeftButton);
    EXPECT_FALSE(window->m_bForumRequest);
    EXPECT_EQ(fake.shell.urls.size(), 1);
}

// Closing it while a download waits would delete it under the check.
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

// OK closes it as the close box does, and closing deletes it.
TEST_F(AboutWindowTest, OkClosesAndDeletesIt) {
    window->show();
    QTest::mouseClick(window->cmdOK, Qt::LeftButton);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(window.isNull());
}

} // namespace
