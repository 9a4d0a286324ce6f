#include "support/FakePlatform.h"

#include "QtPrinters.h"

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

QString captionOf(const QWidget* widget) {
    if (const auto* button = qobject_cast<const QAbstractButton*>(widget))
        return button->text();
    if (const auto* frame = qobject_cast<const QGroupBox*>(widget))
        return frame->title();
    if (const auto* label = qobject_cast<const QLabel*>(widget))
        return label->text();
    return QStringLiteral("<no caption>");
}

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
    QString romFolder(const QString& name, const QStringList& files) {
        const QString folder = fake.makeFolder(name);
        for (const QString& file : files)
            fake.writeFile(name + "/" + file);
        return folder;
    }

    static QStringList rows(const frmSettings& w, int column = 0) {
        QStringList texts;
        for (int i = 0; i < w.vbalListDefPaths->topLevelItemCount(); ++i)
            texts << w.vbalListDefPaths->topLevelItem(i)->text(column);
        return texts;
    }

    static QList<bool> checks(const frmSettings& w) {
        QList<bool> flags;
        for (int i = 0; i < w.vbalListDefPaths->topLevelItemCount(); ++i)
            flags << (w.vbalListDefPaths->topLevelItem(i)->checkState(0) == Qt::Checked);
        return flags;
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

    QString stored(const QString& key) const {
        return fake.reopenStore()->GetSetting(kSettings, key, kMissing);
    }

    FakePlatform fake;
};

} // namespace

TEST_F(SettingsWindow, HasSixTabsInOrderWithKeysCaptionsAndIcons) {
    auto w = open();
    EXPECT_EQ(w->windowTitle(), "Settings");
    const struct {
        const char* key;
        const char* caption;
        const char* page;
    } tabs[] = {
        {"Settings", "Settings", "picSettings"},
        {"Controls", "Controls", "picControls"},
        {"PaddlesAudio", "Paddles / Audio", "picPaddlesAudio"},
        {"Video", "Video", "picVideo"},
        {"Debug", "Debugging", "picDebug"},
        {"DefaultPaths", "Default Paths", "picDefPaths"},
    };
    ASSERT_EQ(w->vbalDTabControl1->count(), 6);
    for (int i = 0; i < 6; ++i) {
        EXPECT_EQ(w->vbalDTabControl1->tabText(i), tabs[i].caption);
        EXPECT_EQ(w->vbalDTabControl1->widget(i)->objectName(), tabs[i].page);
        EXPECT_FALSE(w->vbalDTabControl1->tabIcon(i).isNull());
        w->SelectTab(tabs[i].key);
        EXPECT_EQ(w->SelectedTabKey(), tabs[i].key);
    }
    w->SelectTab("Nowhere");
    EXPECT_EQ(w->SelectedTabKey(), "DefaultPaths");
}

TEST_F(SettingsWindow, EveryControlIsOnItsPage) {
    auto w = open();
    const struct {
        const char* page;
        std::initializer_list<const char*> names;
    } pages[] = {
        {"picSettings", {"fraConfig",         "cmdSaveDat",       "cmdLoadDat",
                         "lblConfig",         "fraVideoMode",     "comboVideoMode",
                         "optVMWindow",       "optVMFull",        "optVMDefault",
                         "txtVidModeBalloon", "fraScreenCapture", "optSCPCX",
                         "optSCBMP",          "fraDSP",           "optDSPLow",
                         "optDSPHigh",        "optDSPDefault",    "fraStart",
                         "chkP0Hard",         "chkP1Hard",        "chkBW"}},
        {"picControls",
         {"cmdLeftControlPic", "cmdRightControlPic", "fraPaddleSens", "BarColorPaddle",
          "fraInactiveControll", "chkIPCStella", "chkIPCJoystick", "chkIPCMouse", "chkIPCKeyboard",
          "txtIPC4Balloon", "fraRightController", "comboRightController", "fraLeftController",
          "comboLeftController", "fraLightgun", "txtLightGunCycles", "txtLightGunScan",
          "chkSwapControl"}},
        {"picPaddlesAudio",
         {"fraLowerSens", "txtLowerSens", "chkLowerSens", "fraSoundQueue", "BarColorSoundQueue",
          "fraPaddleMouse", "optPaddleM1_0", "optPaddleM1_3", "optPaddleM1None", "optPaddleM2_0",
          "optPaddleM2_3", "optPaddleM2None", "chkQuiet"}},
        {"picVideo",
         {"fraScanLines",  "txtScanLines", "chkScanLines",    "lblScanLines",  "chkSyncWSound",
          "chkInterlaced", "fraFrameRate", "optFPScustom",    "optFPSmonitor", "optFPSDefault",
          "txtFPScustom",  "fraNarrow",    "optNarrowNot",    "optNarrow1",    "optNarrow2",
          "fraPhos",       "BarColorPhos", "fraColorPalette", "optCPNTSC",     "optCPPAL",
          "optCPSECAM",    "optCPDefault", "chkPALColorLoss"}},
        {"picDebug",
         {"fraLineScan", "txtLineScan", "chkLineScan", "fraGameType", "comboGT", "chkMouseCapture",
          "chkAllow4", "chkFastCopy", "chkPrintChecksum", "chkCodeTrace", "chkShowScanline",
          "fraDOSOutput", "txtDOSOutput", "chkDOSSwitch", "lblDOSSwitchInstruction",
          "lblDOSOutput"}},
        {"picDefPaths",
         {"fraDefPathFilter", "txtDefPathFilter", "fraDefPathz26", "txtDefPathz26", "cmdAddZ26Path",
          "fraDefPathRom", "vbalListDefPaths"}},
        {"picGraveyard",
         {"cmdStandard", "cmdDriving", "cmdKeyboard", "cmdMindlink", "chkKeyLeft", "chkKeyRight",
          "chkDriveLeft", "chkDriveRight", "optPaddleKey_0", "optPaddleKey_3", "optPaddleKeyNone",
          "optJoyDefault", "optJoyKey", "optJoyRev", "chkMindlinkLeft", "chkMindlinkRight",
          "chkLightGun"}},
    };
    for (const auto& p : pages) {
        const auto* page = w->findChild<QWidget*>(QLatin1String(p.page));
        ASSERT_NE(page, nullptr) << p.page;
        for (const char* name : p.names) {
            const auto* control = w->findChild<QWidget*>(QLatin1String(name));
            ASSERT_NE(control, nullptr) << name;
            EXPECT_TRUE(page->isAncestorOf(control)) << name << " not on " << p.page;
        }
    }
}

TEST_F(SettingsWindow, CaptionsAndToolTipsAreKeptAsTheyAreSpelt) {
    auto w = open();
    // Typos and ampersands are part of the texts.
    const struct {
        const char* name;
        const char* caption;
    } captions[] = {
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
    for (const auto& c : captions)
        EXPECT_EQ(captionOf(w->findChild<QWidget*>(QLatin1String(c.name))),
                  QString::fromUtf8(c.caption))
            << c.name;
    EXPECT_EQ(w->comboRightController->itemText(12), "No Controller Connnected");

    EXPECT_EQ(w->optSCBMP->toolTip(), "Works with phosphorescent games.");
    EXPECT_EQ(w->chkSwapControl->toolTip(), "For All Controller Types");
    EXPECT_EQ(w->BarColorSoundQueue->toolTip(), "Double click to reset value to the default");
    EXPECT_EQ(w->vbalListDefPaths->headerItem()->text(1), "# ROM's");
    EXPECT_EQ(w->vbalListDefPaths->headerItem()->toolTip(0), "ROM's Path");
    EXPECT_EQ(w->vbalListDefPaths->headerItem()->toolTip(1), "The number of ROM's found");
}

TEST_F(SettingsWindow, OptionControlsStartInTheirInitialStates) {
    auto w = open();
    for (QRadioButton* selected :
         {w->optVMDefault, w->optDSPDefault, w->optCPDefault, w->optNarrowNot, w->optFPSDefault,
          w->optSCPCX, w->optPaddleM1None, w->optPaddleM2None, w->optPaddleKeyNone,
          w->optJoyDefault})
        EXPECT_TRUE(selected->isChecked()) << qPrintable(selected->objectName());
    int selectedCount = 0;
    for (const QRadioButton* button : w->findChildren<QRadioButton*>())
        selectedCount += button->isChecked() ? 1 : 0;
    EXPECT_EQ(selectedCount, 10);

    for (const QCheckBox* box : w->findChildren<QCheckBox*>())
        EXPECT_EQ(box->checkState(), box == w->chkMouseCapture ? Qt::Checked : Qt::Unchecked)
            << qPrintable(box->objectName());

    const struct {
        QLineEdit* field;
        const char* text;
        bool enabled;
    } fields[] = {
        {w->txtLineScan, "0", false},    {w->txtScanLines, "0", false},
        {w->txtLowerSens, "1", false},   {w->txtLightGunCycles, "0", true},
        {w->txtLightGunScan, "0", true}, {w->txtFPScustom, "", false},
    };
    for (const auto& f : fields) {
        EXPECT_EQ(f.field->text(), f.text) << qPrintable(f.field->objectName());
        EXPECT_EQ(f.field->isEnabledTo(f.field->parentWidget()), f.enabled)
            << qPrintable(f.field->objectName());
    }

    for (QWidget* hidden :
         {static_cast<QWidget*>(w->fraLightgun), static_cast<QWidget*>(w->txtDOSOutput),
          static_cast<QWidget*>(w->lblDOSSwitchInstruction),
          static_cast<QWidget*>(w->txtIPC4Balloon), static_cast<QWidget*>(w->txtVidModeBalloon),
          w->picGraveyard})
        EXPECT_TRUE(hidden->isHidden()) << qPrintable(hidden->objectName());
    EXPECT_FALSE(w->lblDOSOutput->isHidden());
    EXPECT_FALSE(w->fraLightgun->isEnabled());

    const struct {
        QComboBox* combo;
        int count;
        const char* first;
    } combos[] = {
        {w->comboGT, 14, "Automatic (Don't override)"},
        {w->comboVideoMode, 9, "Mode 0 -- 400x300 default"},
        {w->comboLeftController, 13, "AutoDetect"},
        {w->comboRightController, 13, "AutoDetect"},
    };
    for (const auto& c : combos) {
        EXPECT_EQ(c.combo->count(), c.count);
        EXPECT_EQ(c.combo->currentIndex(), 0);
        EXPECT_EQ(c.combo->currentText(), c.first);
    }

    // Each mouse's paddle buttons form a group of their own.
    w->optPaddleM1[2]->setChecked(true);
    w->optPaddleM2[0]->setChecked(true);
    EXPECT_TRUE(w->optPaddleM1[2]->isChecked());
    EXPECT_FALSE(w->optPaddleM1None->isChecked());
    EXPECT_FALSE(w->optPaddleM2None->isChecked());
    w->optDSPLow->setChecked(true);
    EXPECT_FALSE(w->optDSPDefault->isChecked());
    EXPECT_TRUE(w->optCPDefault->isChecked());
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

    w->show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    EXPECT_EQ(w->picSideText->height(), w->height());
    // The hidden balloon anchors lie over the controls their tips are about.
    EXPECT_EQ(w->txtVidModeBalloon->geometry(), w->comboVideoMode->geometry());
    w->SelectTab("Controls");
    EXPECT_EQ(w->txtIPC4Balloon->geometry(), w->chkIPCStella->geometry());
}

TEST_F(SettingsWindow, OpensAtTheStoredPositionOrAt250) {
    const struct {
        const char* top;
        const char* left;
        double expectedTop;
        double expectedLeft;
    } cases[] = {
        {nullptr, nullptr, 250, 250},
        {"1500", "3000", 1500, 3000},
        {"high", "", 250, 250},
    };
    for (const auto& c : cases) {
        FakePlatform local;
        if (c.top != nullptr) {
            local.store.SaveSetting("setpos", "top", c.top);
            local.store.SaveSetting("setpos", "left", c.left);
        }
        frmSettings w(local.platform);
        EXPECT_EQ(w.pos(),
                  QPoint(twips::toPixelsX(c.expectedLeft), twips::toPixelsY(c.expectedTop)))
            << (c.top ? c.top : "first run");
    }
}

TEST_F(SettingsWindow, ReopensWhereItWasWhenTheProgramLastExited) {
    {
        auto w = open();
        w->move(twips::toPixelsX(2400), twips::toPixelsY(1200));
        w->Unload();
    }
    EXPECT_EQ(parseSingle(fake.reopenStore()->GetSetting("setpos", "left"), 0),
              twips::fromPixelsX(twips::toPixelsX(2400)));
    auto again = open();
    EXPECT_EQ(again->pos(), QPoint(twips::toPixelsX(2400), twips::toPixelsY(1200)));
}

TEST_F(SettingsWindow, TheCloseBoxOnlyHidesAndKeepsEveryOption) {
    auto w = open();
    w->show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    w->chkBW->setChecked(true);
    w->optNarrow2->setChecked(true);

    EXPECT_FALSE(w->close());
    EXPECT_TRUE(w->isHidden());
    EXPECT_EQ(fake.store.GetSetting("setpos", "top", kMissing), kMissing);

    w->show();
    EXPECT_TRUE(w->chkBW->isChecked());
    EXPECT_TRUE(w->optNarrow2->isChecked());

    w->Unload();
    EXPECT_TRUE(w->isHidden());
    EXPECT_NE(fake.store.GetSetting("setpos", "top", kMissing), kMissing);
}

TEST_F(SettingsWindow, TheSideStripShowsTheSelectedTabsCaption) {
    auto w = open();
    EXPECT_EQ(w->Logo().Caption(), "Settings");
    const int draws = w->Logo().drawCount();
    w->SelectTab("PaddlesAudio");
    EXPECT_EQ(w->Logo().Caption(), "Paddles / Audio");
    EXPECT_GT(w->Logo().drawCount(), draws);
    w->SelectTab("Debug");
    EXPECT_EQ(w->Logo().Caption(), "Debugging");
}

TEST_F(SettingsWindow, ChoosingDefaultPathsRereadsTheFolders) {
    const QString a = romFolder("a", {"1.bin"});
    const QString b = romFolder("b", {"1.bin", "2.bin"});
    storeFolder(1, a, true);
    storeFolder(2, b, true);
    auto w = open();
    w->show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));
    EXPECT_EQ(rows(*w), QStringList({a, b}));

    QDir(a).removeRecursively();
    w->SelectTab("DefaultPaths");
    EXPECT_EQ(rows(*w), QStringList({b}));
    EXPECT_EQ(stored("ROMPath"), b);

    // Clicking the tab that is already shown reads the store again too.
    fake.store.SaveSetting(kSettings, "ROM2Path", a);
    QDir().mkpath(a);
    QTabBar* bar = w->vbalDTabControl1->tabBar();
    QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(bar->currentIndex()).center());
    EXPECT_EQ(rows(*w), QStringList({b, a}));
}

TEST_F(SettingsWindow, LoadListsExistingFoldersWithCountsAndStoredFlags) {
    fake.store.SaveSetting(kSettings, "ROMFilter", "*.bin;*.A26");
    const QString a = romFolder("a", {"x.bin", "y.a26", "z.txt", ".hidden.bin"});
    const QString b = romFolder("b with blank", {});
    storeFolder(1, a, false);
    storeFolder(2, fake.root() + "/gone", true);
    storeFolder(3, b, true);
    auto w = open();
    EXPECT_EQ(w->txtDefPathFilter->text(), "*.bin;*.A26");
    EXPECT_EQ(rows(*w), QStringList({a, b}));
    EXPECT_EQ(rows(*w, 1), QStringList({"2", "0"}));
    EXPECT_EQ(checks(*w), QList<bool>({false, true}));

    // A reload and a save keep the flags as they were stored.
    w->LoadDefaultPaths();
    w->SaveDefaultPaths();
    EXPECT_EQ(stored("ROMChecked"), "False");
    EXPECT_EQ(stored("ROM2Path"), b);
    EXPECT_EQ(stored("ROM2Checked"), "True");
    EXPECT_EQ(stored("ROM3Path"), "");
}

TEST_F(SettingsWindow, AGapInTheStoreEndsTheListAndIsSavedAgainAtUnload) {
    const QString a = romFolder("a", {});
    const QString c = romFolder("c", {});
    storeFolder(1, a, true);
    storeFolder(3, c, true);
    auto w = open();
    EXPECT_EQ(rows(*w), QStringList({a}));
    w->Unload();
    EXPECT_EQ(stored("ROMPath"), a);
    EXPECT_EQ(stored("ROM2Path"), "");
    EXPECT_EQ(stored("ROM3Path"), c);
}

TEST_F(SettingsWindow, APatternChangeRecountsEveryRowAndIsStoredAtOnce) {
    const QString a = romFolder("a", {"1.bin", "2.bin", "3.a26"});
    const QString b = romFolder("b", {"4.A26", "5.a26"});
    storeFolder(1, a, true);
    storeFolder(2, b, false);
    auto w = open();
    EXPECT_EQ(rows(*w, 1), QStringList({"2", "0"}));

    w->txtDefPathFilter->setText("*.a26");
    EXPECT_EQ(rows(*w, 1), QStringList({"1", "2"}));
    EXPECT_EQ(stored("ROMFilter"), "*.a26");
    // The folders themselves are left as they were.
    EXPECT_EQ(stored("ROMPath"), a);
    EXPECT_EQ(stored("ROM2Checked"), "False");

    QTest::keyClick(w->txtDefPathFilter, Qt::Key_Backspace);
    EXPECT_EQ(rows(*w, 1), QStringList({"0", "0"}));
    EXPECT_EQ(stored("ROMFilter"), "*.a2");
}

TEST_F(SettingsWindow, AddRomFolderAddsEnabledFoldersAndRefusesTheRest) {
    const QString a = romFolder("a", {"1.bin"});
    const QString file = fake.writeFile("game.bin");
    auto w = open();

    w->AddRomFolder(a, false);
    w->AddRomFolder(a, false);
    EXPECT_EQ(rows(*w), QStringList({a, a}));
    EXPECT_EQ(rows(*w, 1), QStringList({"1", "1"}));
    EXPECT_EQ(checks(*w), QList<bool>({true, true}));
    EXPECT_EQ(stored("ROM2Path"), a);
    EXPECT_EQ(stored("ROM2Checked"), "True");
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    w->AddRomFolder(file, false);
    w->AddRomFolder(fake.root() + "/missing", false);
    w->AddRomFolder(a + ".rar", true);
    ASSERT_EQ(fake.dialogs.boxes.size(), 3u);
    for (int i : {0, 1}) {
        EXPECT_EQ(fake.dialogs.boxes[i].title, "Add Folders Not Files.");
        EXPECT_EQ(fake.dialogs.boxes[i].text,
                  "That doesn't appear to be a valid folder.\nChoose another one.");
        EXPECT_EQ(fake.dialogs.boxes[i].buttons, MsgButtons::Ok);
    }
    EXPECT_EQ(fake.dialogs.boxes[2].title, "lum");
    EXPECT_EQ(fake.dialogs.boxes[2].text, ".rar files aren't supported yet");
    EXPECT_EQ(rows(*w), QStringList({a, a}));
    EXPECT_EQ(stored("ROM3Path"), "");
}

TEST_F(SettingsWindow, DroppingOntoTheFolderListAddsTheFirstItemOnly) {
    const QString a = romFolder("a", {"1.bin", "2.bin"});
    const QString b = romFolder("b", {});
    const QString archiveFolder = romFolder("games.RAR", {});
    auto w = open();
    QWidget* list = w->vbalListDefPaths->viewport();

    drop(list, {QUrl::fromLocalFile(a), QUrl::fromLocalFile(b)});
    EXPECT_EQ(rows(*w), QStringList({a}));
    EXPECT_EQ(rows(*w, 1), QStringList({"2"}));
    EXPECT_EQ(stored("ROMPath"), a);

    // A name ending in .rar is refused as an archive, even when it is a folder.
    drop(list, {QUrl::fromLocalFile(archiveFolder)});
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].text, ".rar files aren't supported yet");

    // Something that is no local file is not taken.
    drop(list, {QUrl("https://example.org/roms")});
    EXPECT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(rows(*w), QStringList({a}));
}

TEST_F(SettingsWindow, RemoveAsksFirstAndOnlyYesRemoves) {
    const QString a = romFolder("a", {});
    const QString b = romFolder("b", {});
    storeFolder(1, a, true);
    storeFolder(2, b, false);
    auto w = open();

    // Without a selected row the key does nothing.
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete);
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    selectRow(*w, 0);
    fake.dialogs.answers = {MsgResult::No, MsgResult::Cancel};
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete);
    w->mnuROMSRemove->trigger();
    EXPECT_EQ(rows(*w), QStringList({a, b}));
    ASSERT_EQ(fake.dialogs.boxes.size(), 2u);
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Remove Path?");
    EXPECT_EQ(fake.dialogs.boxes[0].text,
              "Are you sure you want to remove " + a + " from the list?");
    EXPECT_EQ(fake.dialogs.boxes[0].buttons, MsgButtons::YesNoCancel);
    EXPECT_EQ(fake.dialogs.boxes[0].icon, MsgIcon::Question);

    fake.dialogs.answers = {MsgResult::Yes};
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Delete);
    EXPECT_EQ(rows(*w), QStringList({b}));
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

TEST_F(SettingsWindow, EnterTogglesTheSelectedFolderAndTheStoreFollows) {
    const QString a = romFolder("a", {});
    const QString b = romFolder("b", {});
    storeFolder(1, a, true);
    storeFolder(2, b, true);
    auto w = open();

    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Return);
    EXPECT_EQ(checks(*w), QList<bool>({true, true}));

    selectRow(*w, 1);
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Return);
    EXPECT_EQ(checks(*w), QList<bool>({true, false}));
    // Stored at once, so that a reload of the page keeps it and the main list's next
    // refresh leaves the folder out.
    EXPECT_EQ(stored("ROM2Checked"), "False");
    w->SelectTab("DefaultPaths");
    EXPECT_EQ(checks(*w), QList<bool>({true, false}));

    selectRow(*w, 1);
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_Enter);
    EXPECT_EQ(stored("ROM2Checked"), "True");
}

TEST_F(SettingsWindow, RefreshRecountsTheFolders) {
    const QString a = romFolder("a", {"1.bin"});
    storeFolder(1, a, true);
    auto w = open();
    EXPECT_EQ(rows(*w, 1), QStringList({"1"}));
    fake.writeFile("a/2.bin");
    QTest::keyClick(w->vbalListDefPaths, Qt::Key_F5);
    EXPECT_EQ(rows(*w, 1), QStringList({"2"}));
    fake.writeFile("a/3.bin");
    w->mnuROMSRefresh->trigger();
    EXPECT_EQ(rows(*w, 1), QStringList({"3"}));
}

TEST_F(SettingsWindow, ThePopupOffersRemoveOnlyWithASelectedRow) {
    const QString a = romFolder("a", {});
    storeFolder(1, a, true);
    auto w = open();
    w->show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(w.get()));

    w->vbalListDefPaths_MouseDown(Qt::LeftButton, QPoint(5, 5));
    EXPECT_FALSE(w->mnuROMSPopup->isVisible());

    w->vbalListDefPaths_MouseDown(Qt::RightButton, QPoint(5, 5));
    EXPECT_TRUE(w->mnuROMSPopup->isVisible());
    EXPECT_FALSE(w->mnuROMSRemove->isVisible());
    EXPECT_TRUE(w->mnuROMSRefresh->isVisible());
    EXPECT_TRUE(w->mnuROMSAdd->isVisible());
    w->mnuROMSPopup->close();

    selectRow(*w, 0);
    w->vbalListDefPaths_MouseDown(Qt::RightButton, QPoint(5, 5));
    EXPECT_TRUE(w->mnuROMSRemove->isVisible());
    w->mnuROMSPopup->close();
}

TEST_F(SettingsWindow, AddPathChoosesAFolder) {
    const QString a = romFolder("a", {"1.bin"});
    auto w = open();

    w->mnuROMSAdd->trigger(); // cancelled
    EXPECT_TRUE(rows(*w).isEmpty());
    EXPECT_EQ(fake.dialogs.folderTitles, QStringList({"Choose ROMs path"}));
    EXPECT_TRUE(fake.dialogs.fileRequests.empty());

    fake.dialogs.paths = {a};
    w->mnuROMSAdd->trigger();
    EXPECT_EQ(rows(*w), QStringList({a}));
    EXPECT_EQ(checks(*w), QList<bool>({true}));
    EXPECT_EQ(stored("ROMPath"), a);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(SettingsWindow, SetZ26PathCompletesFoldersAndRefusesPathsWithoutTheEmulator) {
    const QString emu = fake.makeFolder("emu");
    const QString executable = fake.writeFile("emu/z26");
    const QString upper = fake.writeFile("other/Z26");
    const QString empty = fake.makeFolder("empty");
    auto w = open();
    EXPECT_EQ(w->txtDefPathz26->text(), fake.programFolder() + "/z26");

    w->SetZ26Path(emu);
    EXPECT_EQ(w->txtDefPathz26->text(), executable);
    EXPECT_EQ(stored("Z26Path"), executable);

    w->SetZ26Path(upper);
    EXPECT_EQ(w->txtDefPathz26->text(), upper);
    EXPECT_EQ(stored("z26path"), upper);
    EXPECT_TRUE(fake.dialogs.boxes.empty());

    w->SetZ26Path(empty);
    ASSERT_EQ(fake.dialogs.boxes.size(), 1u);
    EXPECT_EQ(fake.dialogs.boxes[0].title, "Non-z26 Folder Chosen.");
    EXPECT_EQ(fake.dialogs.boxes[0].text, "z26 doesn't exist in that path. \nChoose another one.");
    EXPECT_EQ(fake.dialogs.boxes[0].buttons, MsgButtons::Ok);
    EXPECT_EQ(w->txtDefPathz26->text(), upper);
    EXPECT_EQ(stored("Z26Path"), upper);

    // The next load shows what was stored.
    auto again = open();
    EXPECT_EQ(again->txtDefPathz26->text(), upper);
}

TEST_F(SettingsWindow, TheEmulatorIsChosenByDialogOrByDrop) {
    const QString emu = fake.makeFolder("emu");
    const QString executable = fake.writeFile("emu/z26");
    auto w = open();

    w->cmdAddZ26Path->click(); // cancelled
    ASSERT_EQ(fake.dialogs.fileRequests.size(), 1u);
    const FileDialogRequest& request = fake.dialogs.fileRequests[0].request;
    EXPECT_FALSE(fake.dialogs.fileRequests[0].save);
    EXPECT_EQ(request.title, "Choose z26 path");
    EXPECT_EQ(request.filter, "z26 executable (z26)|z26|All Files (*.*)|*.*");
    EXPECT_EQ(request.filterIndex, 1);
    EXPECT_EQ(request.initialFolder, fake.programFolder());
    EXPECT_EQ(request.flags, 0x1800u);
    EXPECT_EQ(stored("Z26Path"), kMissing);

    fake.dialogs.paths = {executable};
    w->cmdAddZ26Path->click();
    EXPECT_EQ(stored("Z26Path"), executable);

    // Typing into the box changes nothing; dropping a folder onto it does.
    const QString other = fake.makeFolder("other");
    const QString otherExecutable = fake.writeFile("other/z26");
    QTest::keyClicks(w->txtDefPathz26, "xyz");
    EXPECT_EQ(w->txtDefPathz26->text(), executable);
    drop(w->txtDefPathz26, {QUrl::fromLocalFile(other), QUrl::fromLocalFile(emu)});
    EXPECT_EQ(w->txtDefPathz26->text(), otherExecutable);
    EXPECT_EQ(stored("Z26Path"), otherExecutable);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(SettingsWindow, AHiddenWindowCountsItsFoldersOnlyWhenShown) {
    const QString roms = fake.makeFolder("roms");
    fake.writeFile("roms/a.bin");
    storeFolder(1, roms, true);
    frmSettings w(fake.platform);
    ASSERT_EQ(w.vbalListDefPaths->topLevelItemCount(), 1);
    EXPECT_EQ(w.vbalListDefPaths->topLevelItem(0)->text(1), QString());
    w.show();
    EXPECT_EQ(w.vbalListDefPaths->topLevelItem(0)->text(1), "1");
}
