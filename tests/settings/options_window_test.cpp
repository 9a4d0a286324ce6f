#include "SettingsFixture.h"

#include "support/SampleOptions.h"

#include "emulator/Switches.h"
#include "settings/SliderRules.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <QLocale>

#include <climits>

namespace {

// The option controls as a user meets them: each edits the window's options, which the
// preview of the switches, the dependent controls and the bars then show.
class OptionControls : public SettingsFixture {
protected:
    void SetUp() override {
        // The sound queue's text follows the locale; these tests read it in English.
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates));
        w = open();
        ASSERT_TRUE(QTest::qWaitForWindowActive(w.get()));
    }
    void TearDown() override { QLocale::setDefault(m_savedLocale); }

    template <class T> T* get(const char* name) { return control<T>(*w, name); }
    QString preview() { return get<QLabel>("lblDOSOutput")->text(); }
    bool previewHas(const QString& sw) { return preview().split(u' ').contains(sw); }
    // A bar's window, value and text: "4500..4700 at 4608 '4,608'".
    std::string bar(const char* name) {
        const auto* b = get<vbalProgressBar>(name);
        return QString::asprintf("%d..%d at %d '%s'", b->Min(), b->Max(), b->Value(),
                                 qPrintable(b->Text()))
            .toStdString();
    }

    std::unique_ptr<frmSettings> w;
    QLocale m_savedLocale;
};

} // namespace

TEST_F(OptionControls, EachControlSpeaksThroughItsSwitch) {
    QSignalSpy changes(w.get(), &frmSettings::optionsChanged);
    // Clicked in this order; each leaves its switch in the preview.
    const std::pair<const char*, const char*> clicks[] = {
        {"chkAllow4", "-4"},        {"chkBW", "-b"},
        {"chkCodeTrace", "-t"},     {"chkFastCopy", "-z"},
        {"chkInterlaced", "-!"},    {"chkIPCJoystick", "-iJ"},
        {"chkMouseCapture", "-M0"}, {"chkP0Hard", "-0"},
        {"chkP1Hard", "-1"},        {"chkPALColorLoss", "-o"},
        {"chkPrintChecksum", "-x"}, {"chkQuiet", "-q"},
        {"chkShowScanline", "-n"},  {"chkSwapControl", "-w"},
        {"chkSyncWSound", "-R"},    {"chkScanLines", "-h0"},
        {"chkLineScan", "-u0"},     {"chkLowerSens", "-P1"},
        {"optCPNTSC", "-c0"},       {"optCPPAL", "-c1"},
        {"optCPSECAM", "-c2"},      {"optDSPLow", "-d1"},
        {"optDSPHigh", "-d2"},      {"optNarrow1", "-e1"},
        {"optNarrow2", "-e2"},      {"optSCBMP", "-B"},
        {"optVMWindow", "-v10"},    {"optVMFull", "-v0"},
        {"optFPSmonitor", "-r"},    {"optPaddleM1_3", "-m3"},
        {"optPaddleM2_1", "-m131"}, {"optPaddleM1None", "-m1"},
        {"optFPScustom", "-r"},
    };
    for (const auto& [name, sw] : clicks) {
        get<QAbstractButton>(name)->click();
        EXPECT_TRUE(previewHas(sw)) << name << ": " << preview().toStdString();
    }
    // The other buttons of a group take their switch away again.
    const std::pair<const char*, const char*> defaults[] = {
        {"optCPDefault", "-c"}, {"optDSPDefault", "-d"}, {"optNarrowNot", "-e"},
        {"optSCPCX", "-B"},     {"optVMDefault", "-v"},  {"optPaddleM2None", "-m"},
        {"optFPSDefault", "-r"}};
    for (const auto& [name, gone] : defaults) {
        get<QAbstractButton>(name)->click();
        EXPECT_FALSE(preview().contains(QLatin1String(gone))) << name;
    }
    for (const auto& [name, index] :
         {std::pair{"comboGT", 7}, {"comboLeftController", 2}, {"comboRightController", 12}})
        get<QComboBox>(name)->setCurrentIndex(index);
    for (const auto& [name, text] :
         {std::pair{"txtScanLines", "200"}, {"txtLineScan", "31"}, {"txtLowerSens", "5"}})
        get<QLineEdit>(name)->setText(text);
    for (const char* sw : {"-g7", "-)PC", "-(NC", "-h200", "-u31", "-P5"})
        EXPECT_TRUE(previewHas(sw)) << sw;
    EXPECT_EQ(preview(), launchSwitches(w->options()).mid(1));
    EXPECT_GE(changes.count(), 40);

    // Shown from outside, the options change the controls and report no edit.
    changes.clear();
    w->setOptions(EmulatorOptions());
    EXPECT_EQ(preview(), "-p8 -M1");
    EXPECT_EQ(changes.count(), 0);
}

// Options shown in one window and copied control by control into another, as a user
// would set them, give the same options: every control shows its own option.
TEST_F(OptionControls, WhatTheControlsShowTheyGiveBack) {
    EmulatorOptions o = sampleOptions();
    o.lightGun = Check::Off; // retired: no control shows them
    o.keyboardPaddle = Paddle::None;
    w->setOptions(o);
    EXPECT_EQ(w->options(), o);
    EXPECT_EQ(bar("BarColorSoundQueue"), "4900..5100 at 5000 '5,000'");

    auto copy = std::make_unique<frmSettings>(fake.platform);
    for (const QWidget* from : w->findChildren<QWidget*>()) {
        QWidget* to =
            from->objectName().isEmpty() ? nullptr : copy->findChild<QWidget*>(from->objectName());
        if (to == nullptr)
            continue;
        if (const auto* box = qobject_cast<const QCheckBox*>(from))
            static_cast<QCheckBox*>(to)->setCheckState(box->checkState());
        else if (const auto* button = qobject_cast<const QRadioButton*>(from))
            static_cast<QRadioButton*>(to)->setChecked(button->isChecked());
        else if (const auto* list = qobject_cast<const QComboBox*>(from))
            static_cast<QComboBox*>(to)->setCurrentIndex(list->currentIndex());
        else if (const auto* field = qobject_cast<const QLineEdit*>(from))
            static_cast<QLineEdit*>(to)->setText(field->text());
        else if (const auto* slider = qobject_cast<const vbalProgressBar*>(from)) {
            static_cast<vbalProgressBar*>(to)->setValue(slider->Value());
            emit static_cast<vbalProgressBar*>(to)->Change();
        }
    }
    EXPECT_EQ(copy->options(), o);
}

TEST_F(OptionControls, ThePortsDecideWhichControlsCanBeUsed) {
    // Which of the keyboard, mouse, joystick and Stelladaptor boxes, the light gun and the
    // keyboard paddle can be used.
    const auto usable = [this] {
        QString shown;
        for (const char* name : {"chkIPCKeyboard", "chkIPCMouse", "chkIPCJoystick", "chkIPCStella"})
            shown += get<QCheckBox>(name)->isEnabled() ? u'+' : u'-';
        for (const char* frame : {"fraLightgun", "fraPaddleSens"})
            shown += get<QGroupBox>(frame)->isHidden() ? " off" : " on";
        return shown;
    };
    get<QCheckBox>("chkIPCMouse")->click();
    get<QComboBox>("comboLeftController")->setCurrentIndex(3);  // Keypad
    get<QComboBox>("comboRightController")->setCurrentIndex(5); // LightGun
    EXPECT_EQ(usable(), "++-- on on");
    get<QCheckBox>("chkIPCKeyboard")->click();
    EXPECT_EQ(usable(), "++-- on off");
    get<QComboBox>("comboRightController")->setCurrentIndex(0);
    EXPECT_EQ(usable(), "++++ off off");
    EXPECT_TRUE(get<QCheckBox>("chkIPCMouse")->isChecked()); // disabled, never cleared
}

TEST_F(OptionControls, NumberFieldsTakeDigitsTidyUpAndAreSwitchedOnByTheirBoxes) {
    const std::tuple<const char*, const char*, const char*> switchedOn[] = {
        {"chkLineScan", "txtLineScan", "Debug"},
        {"chkScanLines", "txtScanLines", "Video"},
        {"chkLowerSens", "txtLowerSens", "PaddlesAudio"},
        {"optFPScustom", "txtFPScustom", "Video"}};
    for (const auto& [button, field, page] : switchedOn) {
        w->selectPage(page);
        const bool bBefore = get<QLineEdit>(field)->isEnabled();
        get<QAbstractButton>(button)->click();
        EXPECT_TRUE(!bBefore && get<QLineEdit>(field)->isEnabled()) << field;
        EXPECT_EQ(QApplication::focusWidget(), get<QLineEdit>(field)) << field;
    }
    for (const char* other : {"optFPSmonitor", "optFPSDefault"}) {
        get<QAbstractButton>("optFPScustom")->click();
        get<QAbstractButton>(other)->click();
        EXPECT_FALSE(get<QLineEdit>("txtFPScustom")->isEnabled()) << other;
    }

    get<QComboBox>("comboLeftController")->setCurrentIndex(5);
    get<QAbstractButton>("optFPScustom")->click();
    for (const char* name : {"txtFPScustom", "txtLightGunCycles", "txtLightGunScan", "txtLineScan",
                             "txtLowerSens", "txtScanLines"}) {
        QLineEdit* field = get<QLineEdit>(name);
        field->setText("9");
        field->selectAll();
        QTest::keyClicks(field, "1a-.2 +3,e");
        QTest::keyClick(field, Qt::Key_Return);
        EXPECT_EQ(field->text(), "123") << name;
    }
    // Fields the emulator reads as numbers show their number at once; the others keep
    // what the user left, even nothing.
    const std::pair<const char*, const char*> cleared[] = {
        {"txtScanLines", "0"},    {"txtLineScan", "0"}, {"txtLightGunCycles", "0"},
        {"txtLightGunScan", "0"}, {"txtLowerSens", ""}, {"txtFPScustom", ""}};
    for (const auto& [name, shown] : cleared) {
        get<QLineEdit>(name)->clear();
        EXPECT_EQ(get<QLineEdit>(name)->text(), shown) << name;
    }
}

TEST_F(OptionControls, PickingAVideoModeUnderDefaultWarnsEachTime) {
    auto* list = get<QComboBox>("comboVideoMode");
    const auto pick = [&](int index) {
        list->setCurrentIndex(index);
        emit list->activated(index);
        BalloonTip* tip = cTextBoxXP::shownOn(get<QLineEdit>("txtVidModeBalloon"));
        const QString shown =
            tip ? QString::number(tip->icon()) + ' ' + tip->title() + '|' + tip->text() : "none";
        if (tip)
            tip->close();
        return shown;
    };
    const QString warning = "1 Default Video Mode Selected|You need to select either "
                            "'Fullscreen' or\r\n'Window' for the Video Mode to be enabled.";
    for (const int index : {3, 3, 5}) // the same one again too
        EXPECT_EQ(pick(index), warning) << index;
    EXPECT_EQ(w->options().videoMode, 5); // the pick stays
    get<QAbstractButton>("optVMWindow")->click();
    EXPECT_EQ(pick(2), "none");

    // With its control at the screen's corner, a tip still shows whole on the screen.
    auto* anchor = get<QLineEdit>("txtVidModeBalloon");
    const QRect area = w->screen()->availableGeometry();
    w->move(w->pos() + area.bottomRight() - anchor->mapToGlobal(QPoint(10, 10)));
    w->showBalloonTip("txtVidModeBalloon", 2, "A title", "A text that takes some room");
    const BalloonTip* tip = cTextBoxXP::shownOn(anchor);
    ASSERT_NE(tip, nullptr);
    EXPECT_TRUE(area.contains(tip->geometry()));
}

TEST_F(OptionControls, EditSwitchesSwapsTheLabelForTheEditBoxUntilAnOptionChanges) {
    const auto shown = [this] {
        return QString::number(!get<QLineEdit>("txtDOSOutput")->isHidden()) +
               QString::number(!get<QLabel>("lblDOSSwitchInstruction")->isHidden()) +
               QString::number(!get<QLabel>("lblDOSOutput")->isHidden());
    };
    w->selectPage("Debug");
    get<QCheckBox>("chkDOSSwitch")->click();
    EXPECT_TRUE(w->switchEditing());
    EXPECT_EQ(shown(), "110");
    auto* edit = get<QLineEdit>("txtDOSOutput");
    EXPECT_EQ(QApplication::focusWidget(), edit);
    QTest::keyClicks(edit, " -x");
    EXPECT_EQ(w->editedSwitches(), "-p8 -M1 -x");
    get<QCheckBox>("chkQuiet")->click(); // an option change overwrites the edits
    EXPECT_EQ(w->editedSwitches(), "-p8 -M1 -q");
    get<QCheckBox>("chkDOSSwitch")->click();
    EXPECT_EQ(shown(), "001");

    // Pasted markup shows as typed.
    get<QAbstractButton>("optFPScustom")->click();
    get<QLineEdit>("txtFPScustom")->setText("<b>5");
    EXPECT_EQ(get<QLabel>("lblDOSOutput")->textFormat(), Qt::PlainText);
    EXPECT_TRUE(previewHas("-r<b>5"));
}

TEST_F(OptionControls, SliderBarsSetTheirOptionByMouseKeysAndMenu) {
    EXPECT_EQ(bar("BarColorPaddle") + bar("BarColorPhos") + bar("BarColorSoundQueue"),
              "1..15 at 8 '8'0..100 at 77 '77'4500..4700 at 4608 '4,608'");
    // A press at either end takes the bar's end value; a press beyond is held there.
    const std::tuple<const char*, const char*, const char*, const char*> ends[] = {
        {"BarColorPaddle", "Controls", "1..15 at 15 '15'", "-p15"},
        {"BarColorPhos", "Video", "0..100 at 0 '0'", "-f0"},
        {"BarColorSoundQueue", "PaddlesAudio", "4500..4700 at 4700 '4,700'", "-s4700"}};
    for (const auto& [name, page, state, sw] : ends) {
        w->selectPage(page);
        auto* b = get<vbalProgressBar>(name);
        const int x = std::string(name) == "BarColorPhos" ? -20 : b->width() + 20;
        QTest::mouseClick(b, Qt::LeftButton, {}, QPoint(x, 5));
        EXPECT_EQ(bar(name), state);
        EXPECT_TRUE(previewHas(sw)) << name;
    }
    QTest::mouseDClick(get<vbalProgressBar>("BarColorPhos"), Qt::LeftButton, {}, QPoint(5, 5));
    EXPECT_EQ(bar("BarColorPhos"), "0..100 at 77 '77'");

    // The sound queue: + and - move its scale, a value left behind lands inside; the
    // menu does the same and resets; the right button only opens the menu.
    auto* queue = get<vbalProgressBar>("BarColorSoundQueue");
    QTest::keyClicks(queue, "+++");
    EXPECT_EQ(bar("BarColorSoundQueue"), "4800..5000 at 4805 '4,805'");
    EXPECT_TRUE(previewHas("-s4805"));
    auto* menu = get<QMenu>("mnuSQPopup");
    QTest::mousePress(queue, Qt::RightButton, {}, QPoint(3, 5));
    EXPECT_TRUE(menu->isVisible());
    menu->hide();
    get<QAction>("mnuSQShiftDown")->trigger();
    EXPECT_EQ(bar("BarColorSoundQueue"), "4700..4900 at 4805 '4,805'");
    get<QAction>("mnuSQReset")->trigger();
    EXPECT_EQ(bar("BarColorSoundQueue"), "4500..4700 at 4608 '4,608'");
    EXPECT_EQ(preview(), "-p15 -M1");
}

TEST(SliderRules, SoundQueueShiftsStayOnTheScale) {
    using sliders::Scale;
    const Scale start{4500, 4700, 4608};
    // A scale, the keys pressed, the scale after.
    const std::tuple<Scale, std::string, Scale> cases[] = {
        {start, "-+", {4500, 4700, 4595}},                   // a value left behind lands inside
        {start, std::string(700, '-'), {1, 201, 196}},       // the bottom window is 1..201
        {{65300, 65500, 65310}, "+", {65339, 65536, 65344}}, // a partial step up to the top
        {{-100, 100, 0}, "x", {1, 201, 1}},                  // any key mends a window below
        {{INT_MAX - 200, INT_MAX, INT_MAX}, "+", {65339, 65536, 65536}}, // no overflow
    };
    for (const auto& [before, keys, after] : cases) {
        Scale scale = before;
        for (const char key : keys)
            scale = sliders::ShiftSoundQueue(scale, key);
        EXPECT_TRUE(scale == after)
            << keys << ": " << scale.min << ".." << scale.max << " at " << scale.value;
    }
    // Always grouped, even where the locale would leave a four-digit number alone.
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::Spanish, QLocale::Spain)), "4.608");
}
