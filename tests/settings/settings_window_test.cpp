#include "support/Boxes.h"

#include "platform/SettingsStore.h"
#include "settings/frmSettings.h"
#include "ui/PictureBox.h"
#include "ui/Twips.h"

#include <QAbstractButton>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMimeData>
#include <QPushButton>
#include <QRadioButton>
#include <QTabBar>
#include <QTabWidget>
#include <QTest>
#include <QTreeWidget>
#include <QUrl>

#include <gtest/gtest.h>

#include <memory>

namespace {

const QString kSettings = QStringLiteral("Settings");
const QString kMissing = QStringLiteral("<missing>");

class SettingsWindow : public ::testing::Test {
protected:
    // The window as the user sees it: shown, so its folder counts are made.
    std::unique_ptr<frmSettings> open() {
        auto w = std::make_unique<frmSettings>(fake.platform);
        w->show();
        return w;
    }

    // Stores folder entry n.
    void storeFolder(int n, const QString& path, bool enabled) {
        const QString number = n == 1 ? QString() : QString::number(n);
        fake.store.SaveSetting(kSettings, "ROM" + number + "Path", path);
        fake.store.SaveSetting(kSettings, "ROM" + number + "Checked", boolText(enabled));
    }

    // A folder holding the given files.
    QString romFolder(const QString& name, const QStringList& files = {}) {
        const QString folder = fake.makeFolder(name);
        for (const QString& file : files)
            fake.writeFile(name + "/" + file);
        return folder;
    }

    // The folder list's rows as "path count on|off".
    static QStringList rows(const frmSettings& w) {
        QStringList texts;
        for (int i = 0; i < w.vbalListDefPaths->topLevelItemCount(); ++i) {
            const QTreeWidgetItem* row = w.vbalListDefPaths->topLevelItem(i);
            texts << row->text(0) + " " + row->text(1) +
                         (row->checkState(0) == Qt::Checked ? " on" : " off");
        }
        return texts;
    }

    static void selectRow(frmSettings& w, int index) {
        w.vbalListDefPaths->setCurrentItem(w.vbalListDefPaths->topLevelItem(index));
    }

    static void drop(QWidget* target, const QList<QUrl>& urls) {
        // As a file manager drops: the drag enters first, which makes the target current.
        QMimeData data;
        data.setUrls(urls);
        QDragEnterEvent enter(QPoint(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(target, &enter);
        QDropEvent drop(QPointF(5, 5), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(target, &drop);
    }

    QString stored(const QString& key, const QString& section = kSettings) const {
        return fake.reopenStore()->GetSetting(section, key, kMissing);
    }

    FakePlatform fake;
};

} // namespace

TEST_F(SettingsWindow, SixTabsEachWithItsPageAndControls) {
    auto w = open();
    EXPECT_EQ(w->windowTitle(), "Settings");
    // Key, caption, page, and the controls on it.
    const char* const tabs[][4] = {
        {"Settings", "Settings", "picSettings",
         "fraConfig cmdSaveDat cmdLoadDat lblConfig fraVideoMode comboVideoMode optVMWindow "
         "optVMFull optVMDefault txtVidModeBalloon fraScreenCapture optSCPCX optSCBMP fraDSP "
         "optDSPLow optDSPHigh optDSPDefault fraStart chkP0Hard chkP1Hard chkBW"},
        {"Controls", "Controls", "picControls",
         "cmdLeftControlPic cmdRightControlPic fraPaddleSens BarColorPaddle fraInactiveControll "
         "chkIPCStella chkIPCJoystick chkIPCMouse chkIPCKeyboard txtIPC4Balloon fraRightController "
         "comboRightController fraLeftController comboLeftController fraLightgun "
         "txtLightGunCycles txtLightGunScan chkSwapControl"},
        {"PaddlesAudio", "Paddles / Audio", "picPaddlesAudio",
         "fraLowerSens txtLowerSens chkLowerSens fraSoundQueue BarColorSoundQueue fraPaddleMouse "
         "optPaddleM1_0 optPaddleM1_3 optPaddleM1None optPaddleM2_0 optPaddleM2_3 "
         "optPaddleM2None chkQuiet"},
        {"Video", "Video", "picVideo",
         "fraScanLines txtScanLines chkScanLines lblScanLines chkSyncWSound chkInterlaced "
         "fraFrameRate optFPScustom optFPSmonitor optFPSDefault txtFPScustom fraNarrow "
         "optNarrowNot optNarrow1 optNarrow2 fraPhos BarColorPhos fraColorPalette optCPNTSC "
         "optCPPAL optCPSECAM optCPDefault chkPALColorLoss"},
        {"Debug", "Debugging", "picDebug",
         "fraLineScan txtLineScan chkLineScan fraGameType comboGT chkMouseCapture chkAllow4 "
         "chkFastCopy chkPrintChecksum chkCodeTrace chkShowScanline fraDOSOutput txtDOSOutput "
         "chkDOSSwitch lblDOSSwitchInstruction lblDOSOutput"},
        {"DefaultPaths", "Default Paths", "picDefPaths",
         "fraDefPathFilter txtDefPathFilter fraDefPathz26 txtDefPathz26 cmdAddZ26Path "
         "fraDefPathRom vbalListDefPaths"},
        {nullptr, nullptr, "picGraveyard",
         "cmdStandard cmdDriving cmdKeyboard cmdMindlink chkKeyLeft chkKeyRight chkDriveLeft "
         "chkDriveRight optPaddleKey_0 optPaddleKey_3 optPaddleKeyNone optJoyDefault optJoyKey "
         "optJoyRev chkMindlinkLeft chkMindlinkRight chkLightGun"},
    };
    ASSERT_EQ(w->vbalDTabControl1->count(), 6);
    const int draws = w->Logo().drawCount();
    for (int i = 0; i < 7; ++i) {
        const auto* page = w->findChild<QWidget*>(QLatin1String(tabs[i][2]));
        ASSERT_NE(page, nullptr) << tabs[i][2];
        for (const QString& name : QString::fromLatin1(tabs[i][3]).split(u' ')) {
            const auto* control = w->findChild<QWidget*>(name);
            EXPECT_TRUE(control && page->isAncestorOf(control)) << qPrintable(name);
        }
        if (i == 6)
            break; // the graveyard has no tab
        EXPECT_EQ(w->vbalDTabControl1->widget(i), page);
        EXPECT_EQ(w->vbalDTabControl1->tabText(i), tabs[i][1]);
        EXPECT_FALSE(w->vbalDTabControl1->tabIcon(i).isNull());
        w->SelectTab(tabs[i][0]);
        EXPECT_EQ(w->SelectedTabKey(), tabs[i][0]);
        EXPECT_EQ(w->Logo().Caption(), tabs[i][1]); // the side strip names the tab
    }
    EXPECT_GT(w->Logo().drawCount(), draws);
    w->SelectTab("Nowhere");
    EXPECT_EQ(w->SelectedTabKey(), "DefaultPaths");
}

TEST_F(SettingsWindow, CaptionsAndToolTipsAreKeptAsTheyAreSpelt) {
    auto w = open();
    const auto captionOf = [&w](const char* name) -> QString {
        const QWidget* widget = w->findChild<QWidget*>(QLatin1String(name));
        if (const auto* button = qobject_cast<const QAbstractButton*>(widget))
            return button->text();
        if (const auto* frame = qobject_cast<const QGroupBox*>(widget))
            return frame->title();
        const auto* label = qobject_cast<const QLabel*>(widget);
        return label ? label->text() : QStringLiteral("<no caption>");
    };
    // Typos and ampersands are part of the texts.
    const std::pair<const char*, const char*> captions[] = {
        {"fraDefPathz26", "Drag && Drop z26 Path Here..."},
        {"fraDefPathRom", "Drag && Drop ROM's Paths Here..."},
        {"cmdSaveDat", "&Save"},
        {"fraInactiveControll", "Inactivate PC-controller"},
        {"fraLowerSens", "Lower Sesitivity"},
        {"lblLowerSens", "Lower sesitivity for PC Joysticks / Stelladaptor in Paddle Emulation, "
                         "and delay the paddle read-bit flipping by..."},
        {"fraDOSOutput", "DOS Command Switches Outputed"},
        {"cmdStandard", "Joystick Controlls"},
        {"fraDriveCont", "Emulate Driving Controler"},
        {"optPaddleM2_2", "Paddle 2"},
    };
    for (const auto& [name, caption] : captions)
        EXPECT_EQ(captionOf(name), QString::fromUtf8(caption)) << name;
    EXPECT_EQ(w->comboRightController->itemText(12), "No Controller Connnected");
    EXPECT_EQ(QStringList({w->optSCBMP->toolTip(), w->chkSwapControl->toolTip(),
                           w->BarColorSoundQueue->toolTip()}),
              QStringList({"Works with phosphorescent games.", "For All Controller Types",
                           "Double click to reset value to the default"}));
    const QTreeWidgetItem* header = w->vbalListDefPaths->headerItem();
    EXPECT_EQ(QStringList({header->text(1), header->toolTip(0), header->toolTip(1)}),
              QStringList({"# ROM's", "ROM's Path", "The number of ROM's found"}));
}

TEST_F(SettingsWindow, OptionControlsStartInTheirInitialStates) {
    auto w = open();
    QStringList selected;
    for (const QRadioButton* button : w->findChildren<QRadioButton*>())
        if (button->isChecked())
            selected << button->objectName();
    selected.sort();
    EXPECT_EQ(selected,
              QStringList({"optCPDefault", "optDSPDefault", "optFPSDefault", "optJoyDefault",
                           "optNarrowNot", "optPaddleKeyNone", "optPaddleM1None", "optPaddleM2None",
                           "optSCPCX", "optVMDefault"}));
    for (const QCheckBox* box : w->findChildren<QCheckBox*>())
        EXPECT_EQ(box->checkState(), box == w->chkMouseCapture ? Qt::Checked : Qt::Unchecked)
            << qPrintable(box->objectName());

    // Text and whether the field can be typed into.
    const std::tuple<QLineEdit*, const char*, bool> fields[] = {
        {w->txtLineScan, "0", false},    {w->txtScanLines, "0", false},
        {w->txtLowerSens, "1", false},   {w->txtLightGunCycles, "0", true},
        {w->txtLightGunScan, "0", true}, {w->txtFPScustom, "", false}};
    for (const auto& [field, text, enabled] : fields) {
        EXPECT_EQ(field->text(), text) << qPrintable(field->objectName());
        EXPECT_EQ(field->isEnabledTo(field->parentWidget()), enabled)
            << qPrintable(field->objectName());
    }
    for (const QWidget* hidden : std::initializer_list<const QWidget*>{
             w->fraLightgun, w->txtDOSOutput, w->lblDOSSwitchInstruction, w->txtIPC4Balloon,
             w->txtVidModeBalloon, w->picGraveyard})
        EXPECT_TRUE(hidden->isHidden()) << qPrintable(hidden->objectName());
    EXPECT_FALSE(w->lblDOSOutput->isHidden());
    EXPECT_FALSE(w->fraLightgun->isEnabled());

    const std::tuple<QComboBox*, int, const char*> lists[] = {
        {w->comboGT, 14, "Automatic (Don't override)"},
        {w->comboVideoMode, 9, "Mode 0 -- 400x300 default"},
        {w->comboLeftController, 13, "AutoDetect"},
        {w->comboRightController, 13, "AutoDetect"}};
    for (const auto& [list, count, first] : lists) {
        EXPECT_EQ(list->count(), count);
        EXPECT_EQ(list->currentText(), first);
    }
}

TEST_F(SettingsWindow, SizeFollowsTheSideStripAndTheTabControl) {
    auto w = open();
    const QRect tab = w->vbalDTabControl1->geometry();
    EXPECT_EQ(tab.topLeft(), QPoint(w->picSideText->width(), 0));
    EXPECT_GE(tab.width(), twips::toPixelsX(6495));
    EXPECT_GE(tab.height(), twips::toPixelsY(4095));
    EXPECT_EQ(w->width(), w->picSideText->width() + tab.width() + twips::toPixelsX(100));
    EXPECT_EQ(w->height(), tab.height() + twips::toPixelsY(500));
    // Every tab shows without scrolling the tab bar.
    EXPECT_LE(w->vbalDTabControl1->tabBar()->sizeHint().width(), tab.width());

    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    EXPECT_EQ(w->picSideText->height(), w->height());
    // The hidden balloon anchors lie over the controls their tips are about.
    EXPECT_EQ(w->txtVidModeBalloon->geometry(), w->comboVideoMode->geometry());
    w->SelectTab("Controls");
    EXPECT_EQ(w->txtIPC4Balloon->geometry(), w->chkIPCStella->geometry());
}

TEST_F(SettingsWindow, OpensWhereItWasWhenTheProgramLastExitedOrAt250) {
    const auto placeFor = [](const char* top, const char* left) {
        FakePlatform local;
        if (top) {
            local.store.SaveSetting("setpos", "top", top);
            local.store.SaveSetting("setpos", "left", left);
        }
        return frmSettings(local.platform).pos();
    };
    const QPoint start(twips::toPixelsX(250), twips::toPixelsY(250));
    EXPECT_EQ(placeFor(nullptr, nullptr), start); // the first run
    EXPECT_EQ(placeFor("high", ""), start);
    EXPECT_EQ(placeFor("1500", "3000"), QPoint(twips::toPixelsX(3000), twips::toPixelsY(1500)));

    // The close box only hides the window: every option stays and nothing is saved.
    const QString a = romFolder("a");
    storeFolder(1, a, true);
    storeFolder(3, romFolder("c"), true); // behind a gap
    auto w = open();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    w->chkBW->setChecked(true);
    w->move(twips::toPixelsX(2400), twips::toPixelsY(1200));
    EXPECT_FALSE(w->close());
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(stored("top", "setpos"), kMissing);
    w->show();
    EXPECT_TRUE(w->chkBW->isChecked());

    // Unload saves the place and the folder list, whose save ends it after the first.
    w->Unload();
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(parseSingle(stored("left", "setpos"), 0), twips::fromPixelsX(twips::toPixelsX(2400)));
    EXPECT_EQ(stored("ROM2Path"), "");
    EXPECT_EQ(open()->pos(), QPoint(twips::toPixelsX(2400), twips::toPixelsY(1200)));
}

TEST_F(SettingsWindow, LoadListsExistingFoldersWithCountsAndStoredFlags) {
    fake.store.SaveSetting(kSettings, "ROMFilter", "*.bin;*.A26");
    const QString a = romFolder("a", {"x.bin", "y.a26", "z.txt", ".hidden.bin"});
    const QString b = romFolder("b with blank");
    storeFolder(1, a, false);
    storeFolder(2, fake.root() + "/gone", true);
    storeFolder(3, b, true);
    auto w = open();
    EXPECT_EQ(w->txtDefPathFilter->text(), "*.bin;*.A26");
    EXPECT_EQ(rows(*w), QStringList({a + " 2 off", b + " 0 on"}));
    // A reload and a save keep the flags as they were stored.
    w->LoadDefaultPaths();
    w->SaveDefaultPaths();
    EXPECT_EQ(stored("ROMChecked"), "False");
    EXPECT_EQ(stored("ROM2Checked"), "True");
    EXPECT_EQ(stored("ROM3Path"), "");

    // Choosing the tab reads the store again, also when it is the tab already shown.
    QDir(a).removeRecursively();
    w->SelectTab("DefaultPaths");
    EXPECT_EQ(rows(*w), QStringList({b + " 0 on"}));
    EXPECT_EQ(stored("ROMPath"), b);
    storeFolder(2, romFolder("a", {"1.bin"}), true);
    QTabBar* bar = w->vbalDTabControl1->tabBar();
    QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(bar->currentIndex()).center());
    EXPECT_EQ(rows(*w), QStringList({b + " 0 on", a + " 1 on"}));
}

TEST_F(SettingsWindow, APatternChangeRecountsEveryRowAndIsStoredAtOnce) {
    const QString a = romFolder("a", {"1.bin", "2.bin", "3.a26"});
    const QString b = romFolder("b", {"4.A26", "5.a26"});
    storeFolder(1, a, true);
    storeFolder(2, b, false);
    auto w = open();
    EXPECT_EQ(rows(*w), QStringList({a + " 2 on", b + " 0 off"}));
    w->txtDefPathFilter->setText("*.a26");
    EXPECT_EQ(rows(*w), QStringList({a + " 1 on", b + " 2 off"}));
    EXPECT_EQ(stored("ROMFilter"), "*.a26");
    EXPECT_EQ(stored("ROM2Checked"), "False"); // the folders are left as they were
    QTest::keyClick(w->txtDefPathFilter, Qt::Key_Backspace);
    EXPECT_EQ(rows(*w), QStringList({a + " 0 on", b + " 0 off"}));
    EXPECT_EQ(stored("ROMFilter"), "*.a2");
}

TEST_F(SettingsWindow, FoldersAreAddedEnabledByCallDialogOrDropAndTheRestRefused) {
    const QString a = romFolder("a", {"1.bin"});
    const QString b = romFolder("b", {"1.bin", "2.bin"});
    auto w = open();
    w->mnuROMSAdd->trigger(); // cancelled
    EXPECT_EQ(fake.dialogs.folderTitles, QStringList({"Choose ROMs path"}));
    fake.dialogs.paths = {a};
    w->mnuROMSAdd->trigger();
    w->AddRomFolder(a, false); // twice: two rows, two entries
    drop(w->vbalListDefPaths->viewport(), {QUrl::fromLocalFile(b), QUrl::fromLocalFile(a)});
    EXPECT_EQ(rows(*w), QStringList({a + " 1 on", a + " 1 on", b + " 2 on"}));
    EXPECT_EQ(stored("ROM3Path"), b);
    EXPECT_EQ(stored("ROM3Checked"), "True");
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    // A name ending in .rar is refused as an archive, even when it is a folder.
    w->AddRomFolder(fake.writeFile("game.bin"), false);
    w->AddRomFolder(fake.root() + "/missing", false);
    drop(w->vbalListDefPaths->viewport(), {QUrl::fromLocalFile(romFolder("games.RAR"))});
    const std::string notAFolder = "Add Folders Not Files. | That doesn't appear to be a valid "
                                   "folder.\nChoose another one. | Ok | None";
    EXPECT_EQ(boxLines(fake.dialogs),
              (Lines{notAFolder, notAFolder, "lum | .rar files aren't supported yet | Ok | None"}));
    EXPECT_EQ(rows(*w).size(), 3);
    EXPECT_EQ(stored("ROM4Path"), "");
}

TEST_F(SettingsWindow, RemoveAsksFirstAndOnlyYesRemoves) {
    const QString a = romFolder("a");
    const QString b = romFolder("b");
    storeFolder(1, a, true);
    storeFolder(2, b, false);
    auto w = open();
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete); // no selected row: nothing
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    selectRow(*w, 0);
    fake.dialogs.answers = {MsgResult::No, MsgResult::Cancel, MsgResult::Yes};
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete);
    w->mnuROMSRemove->trigger();
    EXPECT_EQ(rows(*w), QStringList({a + " 0 on", b + " 0 off"}));
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete);
    EXPECT_EQ(boxLines(fake.dialogs), Lines(3, ("Remove Path? | Are you sure you want to remove " +
                                                a + " from the list? | YesNoCancel | Question")
                                                   .toStdString()));
    EXPECT_EQ(rows(*w), QStringList({b + " 0 off"}));
    EXPECT_EQ(stored("ROMPath"), b);
    EXPECT_EQ(stored("ROMChecked"), "False");
    EXPECT_EQ(stored("ROM2Path"), "");

    // Removing the only folder leaves no ROM path at all.
    selectRow(*w, 0);
    fake.dialogs.answers = {MsgResult::Yes};
    w->mnuROMSRemove->trigger();
    EXPECT_TRUE(rows(*w).isEmpty());
    EXPECT_EQ(stored("ROMPath"), "");
}

TEST_F(SettingsWindow, ListKeysAndPopupMenu) {
    const QString a = romFolder("a", {"1.bin"});
    const QString b = romFolder("b");
    storeFolder(1, a, true);
    storeFolder(2, b, true);
    auto w = open();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));

    // Enter toggles the selected folder, stored at once, so that a reload of the page keeps
    // it and the main list's next refresh leaves the folder out.
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Return); // no selected row: nothing
    selectRow(*w, 1);
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Return);
    EXPECT_EQ(stored("ROM2Checked"), "False");
    w->SelectTab("DefaultPaths");
    EXPECT_EQ(rows(*w), QStringList({a + " 1 on", b + " 0 off"}));
    selectRow(*w, 1);
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Enter);
    EXPECT_EQ(stored("ROM2Checked"), "True");

    // F5 and Refresh count again.
    fake.writeFile("a/2.bin");
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_F5);
    EXPECT_EQ(rows(*w)[0], a + " 2 on");
    fake.writeFile("a/3.bin");
    w->mnuROMSRefresh->trigger();
    EXPECT_EQ(rows(*w)[0], a + " 3 on");

    // The right button pops up the menu, with Remove only for a selected row.
    w->vbalListDefPaths->setCurrentItem(nullptr);
    w->vbalListDefPaths_MouseDown(Qt::LeftButton, QPoint(5, 5));
    EXPECT_FALSE(w->mnuROMSPopup->isVisible());
    for (const bool withRow : {false, true}) {
        if (withRow)
            selectRow(*w, 0);
        w->vbalListDefPaths_MouseDown(Qt::RightButton, QPoint(5, 5));
        EXPECT_TRUE(w->mnuROMSPopup->isVisible());
        EXPECT_EQ(w->mnuROMSRemove->isVisible(), withRow);
        EXPECT_TRUE(w->mnuROMSRefresh->isVisible() && w->mnuROMSAdd->isVisible());
        w->mnuROMSPopup->close();
    }
}

TEST_F(SettingsWindow, TheEmulatorPathIsCompletedCheckedAndStored) {
    const QString emu = fake.makeFolder("emu");
    const QString executable = fake.writeFile("emu/z26");
    const QString upper = fake.writeFile("other/Z26");
    auto w = open();
    EXPECT_EQ(w->txtDefPathz26->text(), fake.programFolder() + "/z26");

    w->cmdAddZ26Path->click(); // cancelled
    ASSERT_EQ(fake.dialogs.fileRequests.size(), 1u);
    const FileDialogRequest& request = fake.dialogs.fileRequests[0].request;
    EXPECT_FALSE(fake.dialogs.fileRequests[0].save);
    EXPECT_EQ(QStringList({request.title, request.filter, request.initialFolder}),
              QStringList({"Choose z26 path", "z26 executable (z26)|z26|All Files (*.*)|*.*",
                           fake.programFolder()}));
    EXPECT_EQ(request.filterIndex, 1);
    EXPECT_EQ(request.flags, 0x1800u);
    EXPECT_EQ(stored("Z26Path"), kMissing);

    fake.dialogs.paths = {emu};
    w->cmdAddZ26Path->click(); // a folder is completed
    EXPECT_EQ(w->txtDefPathz26->text(), executable);
    EXPECT_EQ(stored("Z26Path"), executable);
    // Typing into the box changes nothing; dropping the executable, in any case, does.
    QTest::keyClicks(w->txtDefPathz26, "xyz");
    EXPECT_EQ(w->txtDefPathz26->text(), executable);
    drop(w->txtDefPathz26, {QUrl::fromLocalFile(upper), QUrl::fromLocalFile(emu)});
    EXPECT_EQ(w->txtDefPathz26->text(), upper);
    EXPECT_EQ(stored("z26path"), upper);
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    w->SetZ26Path(fake.makeFolder("empty"));
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"Non-z26 Folder Chosen. | z26 doesn't exist in that "
                                            "path. \nChoose another one. | Ok | None"});
    EXPECT_EQ(w->txtDefPathz26->text(), upper);
    EXPECT_EQ(stored("Z26Path"), upper);
    EXPECT_EQ(open()->txtDefPathz26->text(), upper); // the next load shows what was stored
}

TEST_F(SettingsWindow, AHiddenWindowCountsItsFoldersOnlyWhenShown) {
    storeFolder(1, romFolder("roms", {"a.bin"}), true);
    frmSettings w(fake.platform);
    ASSERT_EQ(w.vbalListDefPaths->topLevelItemCount(), 1);
    EXPECT_EQ(w.vbalListDefPaths->topLevelItem(0)->text(1), QString());
    w.show();
    EXPECT_EQ(w.vbalListDefPaths->topLevelItem(0)->text(1), "1");
}
