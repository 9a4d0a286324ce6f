#include "support/FakePlatform.h"

#include "platform/SettingsStore.h"
#include "settings/frmSettings.h"

#include <QCoreApplication>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QLineEdit>
#include <QMimeData>
#include <QTreeWidget>
#include <QUrl>

#include <gtest/gtest.h>

#include <memory>

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
