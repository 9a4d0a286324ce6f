#include "support/FakePlatform.h"
#include "support/Files.h"
#include "support/Unreadable.h"

#include "platform/SettingsStore.h"
#include "settings/frmPicPreview.h"
#include "settings/frmSettings.h"

#include <QComboBox>
#include <QCoreApplication>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QLabel>
#include <QLineEdit>
#include <QMimeData>
#include <QScreen>
#include <QTreeWidget>
#include <QUrl>

#include <gtest/gtest.h>

#include <functional>
#include <memory>

#include <sys/stat.h>

namespace {

const QString kSettings = QStringLiteral("Settings");

void drop(QWidget* target, QMimeData& data) {
    QDragEnterEvent enter(QPoint(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QCoreApplication::sendEvent(target, &enter);
    QDropEvent event(QPointF(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QCoreApplication::sendEvent(target, &event);
}

void dropUrls(QWidget* target, const QList<QUrl>& urls) {
    QMimeData data;
    data.setUrls(urls);
    drop(target, data);
}

QStringList rows(const frmSettings& w) {
    QStringList texts;
    for (int i = 0; i < w.vbalListDefPaths->topLevelItemCount(); ++i)
        texts << w.vbalListDefPaths->topLevelItem(i)->text(0);
    return texts;
}

} // namespace

// Items dropped on the emulator box that do not lead to the emulator: each is refused with
// the one message, and the stored path is kept.
TEST(BadInputDrops, TheEmulatorBoxRefusesWhatIsNotTheEmulator) {
    FakePlatform fake;
    const QString good = fake.writeFile("emu/z26", "#!/bin/sh\n");
    fake.store.SaveSetting(kSettings, "Z26Path", good);
    const QString cases[] = {
        fake.root() + "/missing",                   // missing
        fake.makeFolder("empty"),                   // a folder without the emulator
        fake.makeFolder("nested/z26"),              // a folder named like the emulator
        fake.makeFolder("trap/z26/z26").chopped(4), // the emulator's name taken by a folder
        fake.writeFile("notes.txt", "hello"),       // some other file
        fake.root() + "/bad\nname\x01/z26",         // garbage in the name
    };
    auto w = std::make_unique<frmSettings>(fake.platform);
    for (const QString& path : cases) {
        SCOPED_TRACE(path.toStdString());
        fake.dialogs.boxes.clear();
        dropUrls(w->txtDefPathz26, {QUrl::fromLocalFile(path)});
        ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
        EXPECT_EQ(fake.dialogs.boxes[0].title, "Non-z26 Folder Chosen.");
        EXPECT_EQ(w->txtDefPathz26->text(), good);
        EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "Z26Path"), good);
    }
}

// Drops that carry no local item at all (text, a web address, nothing) are ignored quietly.
TEST(BadInputDrops, DropsWithoutALocalItemAreIgnored) {
    FakePlatform fake;
    auto w = std::make_unique<frmSettings>(fake.platform);
    QMimeData text;
    text.setText(fake.root());
    QMimeData empty;
    QMimeData noUrls;
    noUrls.setUrls({});
    for (QMimeData* data : {&text, &empty, &noUrls}) {
        drop(w->vbalListDefPaths->viewport(), *data);
        drop(w->txtDefPathz26, *data);
    }
    dropUrls(w->txtDefPathz26, {QUrl("ftp://example.org/z26")});
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_TRUE(rows(*w).isEmpty());
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "Z26Path", "<missing>"), "<missing>");
}

// A folder whose name holds the characters of the store's own syntax is stored and read
// back exactly, and still counted.
TEST(BadInputDrops, FolderNamesWithStoreSyntaxSurviveARestart) {
    FakePlatform fake;
    const QString odd = fake.makeFolder(QStringLiteral("[Settings]=;#\\n \nline two "));
    fake.writeFile(QStringLiteral("[Settings]=;#\\n \nline two /a.bin"));
    {
        auto w = std::make_unique<frmSettings>(fake.platform);
        dropUrls(w->vbalListDefPaths->viewport(), {QUrl::fromLocalFile(odd)});
        ASSERT_EQ(rows(*w), QStringList{odd});
    }
    const auto reopened = fake.reopenStore();
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROMPath"), odd);
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROMChecked"), "True");
    EXPECT_EQ(reopened->GetSetting(kSettings, "ROM2Path", "<missing>"), "");
}

// Stored folder entries that are damaged: a file or a missing folder where a folder
// belongs is dropped from the page, and a flag that is not a Boolean reads as off.
TEST(BadInputStoredFolders, DamagedEntriesAreDroppedOrReadAsOff) {
    FakePlatform fake;
    const QString good = fake.makeFolder("roms");
    fake.store.SaveSetting(kSettings, "ROMPath", fake.writeFile("file.bin"));
    fake.store.SaveSetting(kSettings, "ROMChecked", "True");
    fake.store.SaveSetting(kSettings, "ROM2Path", fake.root() + "/gone");
    fake.store.SaveSetting(kSettings, "ROM2Checked", "True");
    fake.store.SaveSetting(kSettings, "ROM3Path", good);
    fake.store.SaveSetting(kSettings, "ROM3Checked", "maybe");
    auto w = std::make_unique<frmSettings>(fake.platform);
    EXPECT_EQ(rows(*w), QStringList{good});
    EXPECT_EQ(w->vbalListDefPaths->topLevelItem(0)->checkState(0), Qt::Unchecked);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROMPath"), good);
}

// A folder dropped on the list that cannot be read is taken like any folder: it counts no
// files, and nothing is said.
TEST(BadInputDrops, AnUnreadableFolderIsListedWithNoFiles) {
    FakePlatform fake;
    const QString locked = fake.makeFolder("locked");
    fake.writeFile("locked/a.bin");
    ASSERT_TRUE(QFile::setPermissions(locked, {}));
    auto w = std::make_unique<frmSettings>(fake.platform);
    {
        const NoPermissionOverride asAnyone;
        ASSERT_TRUE(asAnyone.holds());
        dropUrls(w->vbalListDefPaths->viewport(), {QUrl::fromLocalFile(locked)});
        w->show();
    }
    ASSERT_EQ(rows(*w), QStringList{locked});
    EXPECT_EQ(w->vbalListDefPaths->topLevelItem(0)->text(1), "0");
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_EQ(fake.reopenStore()->GetSetting(kSettings, "ROMPath"), locked);
    QFile::setPermissions(locked, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
}

namespace {

// The window's start state saved as an option set, with the game type changed so that a
// load of it shows.
QByteArray sampleOptionSet(FakePlatform& fake) {
    frmSettings w(fake.platform);
    w.comboGT->setCurrentIndex(7);
    const QString path = fake.root() + "/sample.lum";
    fake.dialogs.paths.push_back(path);
    w.cmdSaveDat_Click();
    QFile file(path);
    file.open(QIODevice::ReadOnly);
    return file.readAll();
}

} // namespace

// Option sets in every bad shape through the Load button: the caption and the one message
// box say the file is corrupt, and the window keeps what it showed; an oversized file loads
// its first record.
TEST(BadInputOptionSets, TheLoadButtonReportsEveryBadShape) {
    const struct {
        const char* name;
        std::function<QString(FakePlatform&, const QByteArray& good)> make;
        bool loads;
    } cases[] = {
        {"missing", [](FakePlatform& f, const QByteArray&) { return f.root() + "/gone.lum"; },
         false},
        {"empty", [](FakePlatform& f, const QByteArray&) { return f.writeFile("set.lum"); }, false},
        {"truncated",
         [](FakePlatform& f, const QByteArray& good) {
             return f.writeFile("set.lum", good.left(171));
         },
         false},
        {"oversized",
         [](FakePlatform& f, const QByteArray& good) {
             return f.writeFile("set.lum", good + QByteArray(1024 * 1024, '\xFF'));
         },
         true},
        {"garbage",
         [](FakePlatform& f, const QByteArray&) {
             return f.writeFile("set.lum", QByteArray(172, '\xFF'));
         },
         false},
        {"unreadable",
         [](FakePlatform& f, const QByteArray& good) {
             return makeUnreadable(f.root() + "/set.lum", good);
         },
         false},
        {"a folder", [](FakePlatform& f, const QByteArray&) { return f.makeFolder("set.lum"); },
         false},
        {"a FIFO", // must not block the window
         [](FakePlatform& f, const QByteArray&) {
             const QString path = f.root() + "/set.lum";
             ::mkfifo(QFile::encodeName(path).constData(), 0600);
             return path;
         },
         false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        const QByteArray good = sampleOptionSet(fake);
        ASSERT_EQ(good.size(), 172);
        const QString path = c.make(fake, good);
        const QString name = QFileInfo(path).fileName();
        frmSettings w(fake.platform);
        fake.dialogs.boxes.clear();
        fake.dialogs.paths.push_back(path);
        w.cmdLoadDat_Click();
        if (c.loads) {
            EXPECT_EQ(w.lblConfig->text(), name + " was succesfully loaded");
            EXPECT_EQ(w.comboGT->currentIndex(), 7);
            EXPECT_TRUE(fake.dialogs.boxes.empty());
        } else {
            EXPECT_EQ(w.lblConfig->text(),
                      name + " is corrupt.  Plese verify settings an re-save to correct the "
                             "problem");
            EXPECT_EQ(w.comboGT->currentIndex(), 0);
            ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
            EXPECT_EQ(fake.dialogs.boxes[0].text,
                      ".lum file is corrupt\r\nPlease verify settings and re-save to correct "
                      "this problem");
        }
    }
}

// Save targets in every bad shape: a file there, whatever it holds, is replaced by the whole
// record; a target that cannot be written says "error saving" and what was there stays.
TEST(BadInputOptionSets, TheSaveButtonReplacesOrReportsEveryShape) {
    const struct {
        const char* name;
        std::function<QString(FakePlatform&)> make; // the path chosen
        bool saves;
    } cases[] = {
        {"missing", [](FakePlatform& f) { return f.root() + "/set.lum"; }, true},
        {"empty", [](FakePlatform& f) { return f.writeFile("set.lum"); }, true},
        {"truncated", [](FakePlatform& f) { return f.writeFile("set.lum", "\x01\x02"); }, true},
        {"oversized",
         [](FakePlatform& f) { return f.writeFile("set.lum", QByteArray(1024 * 1024, 'x')); },
         true},
        {"garbage", [](FakePlatform& f) { return f.writeFile("set.lum", QByteArray(172, '\xA5')); },
         true},
        {"a missing folder", [](FakePlatform& f) { return f.root() + "/gone/set.lum"; }, false},
        {"a read-only folder",
         [](FakePlatform& f) {
             const QString path = f.writeFile("locked/set.lum", "older");
             QFile::setPermissions(f.root() + "/locked", QFile::ReadOwner | QFile::ExeOwner);
             return path;
         },
         false},
        {"a folder",
         [](FakePlatform& f) {
             f.writeFile("set.lum/keep.txt", "older");
             return f.root() + "/set.lum";
         },
         false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        const QString path = c.make(fake);
        const QFileInfo info(path);
        const QByteArray before = info.isDir() ? fileBytes(path + "/keep.txt") : fileBytes(path);
        frmSettings w(fake.platform);
        fake.dialogs.paths.push_back(path);
        {
            const NoPermissionOverride asAnyone;
            ASSERT_TRUE(asAnyone.holds());
            w.cmdSaveDat_Click();
        }
        const QString name = info.fileName();
        if (c.saves) {
            EXPECT_EQ(w.lblConfig->text(), name + " was succesfully saved");
            EXPECT_EQ(fileBytes(path).size(), 172);
            frmSettings again(fake.platform);
            EXPECT_TRUE(again.LoadSettings(path));
        } else {
            EXPECT_EQ(w.lblConfig->text(), "error saving " + name);
            if (info.isDir())
                EXPECT_EQ(fileBytes(path + "/keep.txt"), before);
            else
                EXPECT_EQ(fileBytes(path), before);
        }
        QFile::setPermissions(fake.root() + "/locked",
                              QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    }
}

namespace {

QByteArray jpeg(int width, int height) {
    return encodedPicture(width, height, "JPG");
}

// A JPEG whose frame header claims the given size; the picture data after it is cut.
QByteArray claimedJpeg(quint16 width, quint16 height) {
    QByteArray bytes = jpeg(8, 8);
    const qsizetype frame = bytes.indexOf("\xFF\xC0");
    bytes[frame + 5] = static_cast<char>(height >> 8);
    bytes[frame + 6] = static_cast<char>(height & 0xFF);
    bytes[frame + 7] = static_cast<char>(width >> 8);
    bytes[frame + 8] = static_cast<char>(width & 0xFF);
    return bytes.left(frame + 40);
}

} // namespace

// Controller layout pictures in bad shapes: "Error loading pic", and no window opens.
TEST(BadInputPictures, ControllerPicturesThatCannotBeShownAreReported) {
    const struct {
        const char* name;
        std::function<QString(FakePlatform&)> make;
    } cases[] = {
        {"empty", [](FakePlatform& f) { return f.writeFile("program/lum Paddles.jpg"); }},
        {"truncated",
         [](FakePlatform& f) {
             return f.writeFile("program/lum Paddles.jpg", jpeg(64, 64).left(100));
         }},
        {"oversized",
         [](FakePlatform& f) {
             return f.writeFile("program/lum Paddles.jpg", claimedJpeg(60000, 60000));
         }},
        {"garbage",
         [](FakePlatform& f) { return f.writeFile("program/lum Paddles.jpg", "\xFF\xD8junk"); }},
        {"unreadable",
         [](FakePlatform& f) {
             return makeUnreadable(f.programFolder() + "/lum Paddles.jpg", jpeg(4, 4));
         }},
        {"a folder", [](FakePlatform& f) { return f.makeFolder("program/lum Paddles.jpg"); }},
        {"a FIFO",
         [](FakePlatform& f) {
             const QString path = f.programFolder() + "/lum Paddles.jpg";
             ::mkfifo(QFile::encodeName(path).constData(), 0600);
             return path;
         }},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        FakePlatform fake;
        const QString path = c.make(fake);
        auto* preview = new frmPicPreview(fake.platform);
        EXPECT_FALSE(preview->showPicture(path, "Paddle Control Layout"));
        ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
        EXPECT_EQ(fake.dialogs.boxes[0].text, "Error loading pic");
        EXPECT_FALSE(preview->isVisible());
        delete preview;
    }
}

// Stored placements of the settings and preview windows that make no sense: the windows
// open within the desktop's reach at a size they can be drawn at.
TEST(BadInputPlacement, AbsurdStoredPlacesGiveWindowsThatCanBeDrawn) {
    const QSize screen = QGuiApplication::primaryScreen()->virtualSize();
    const int limit = 2 * std::max(screen.width(), screen.height());
    for (const char* value : {"1e30", "-1e30", "3e9", "-3e9"}) {
        SCOPED_TRACE(value);
        FakePlatform fake;
        for (const char* section : {"setpos", "picpos"})
            for (const char* key : {"height", "width", "top", "left"})
                fake.store.SaveSetting(section, key, value);
        frmSettings settings(fake.platform);
        EXPECT_LE(std::abs(settings.x()), limit);
        EXPECT_LE(std::abs(settings.y()), limit);
        auto* preview = new frmPicPreview(fake.platform);
        EXPECT_LE(preview->width(), limit);
        EXPECT_LE(preview->height(), limit);
        EXPECT_LE(std::abs(preview->x()), limit);
        EXPECT_FALSE(preview->grab().isNull());
        delete preview;
    }
}
