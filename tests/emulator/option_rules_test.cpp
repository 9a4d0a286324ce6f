#include "emulator/OptionRules.h"

#include <gtest/gtest.h>

TEST(OptionRules, ThePortsDecideTheLightGunTheDevicesAndTheLayouts) {
    // Which of the keyboard, mouse, joystick and Stelladaptor boxes can be used ("kmjs", "-"
    // for a disabled box).
    const auto usableDevices = [](const OptionStates& s) {
        QString letters;
        for (std::size_t i = 0; i < 4; ++i)
            letters += QLatin1Char(s.pcDevices[i] ? "kmjs"[i] : '-');
        return letters;
    };
    // The ports: the light gun, the usable devices, the left port's layout.
    const std::tuple<int, int, bool, const char*, const char*> cases[] = {
        {0, 0, false, "kmjs", "Standard Control Layout"},
        {3, 3, false, "k---", "Keyboard Control Layout"},   // Keypad: keyboard only
        {12, 12, false, "----", "Standard Control Layout"}, // no controller
        {0, 12, false, "kmjs", "Standard Control Layout"},
        {11, 11, false, "-m--", "Standard Control Layout"}, // Amiga Mouse
        {3, 5, true, "km--", "Keyboard Control Layout"},    // Keypad, LightGun
        {2, 4, false, "kmjs", "Paddle Control Layout"},     // Paddle, Driving
        {4, 6, false, "kmjs", "Driving Control Layout"},    // Driving, CompuMate
        {-1, 5, true, "-m--", nullptr},                     // nothing selected on the left
    };
    for (const auto& [left, right, lightGun, devices, leftLayout] : cases) {
        EmulatorOptions o;
        o.leftController = left;
        o.rightController = right;
        const OptionStates s = optionStates(o);
        SCOPED_TRACE(testing::Message() << left << ' ' << right);
        EXPECT_EQ(s.lightGun, lightGun);
        EXPECT_EQ(usableDevices(s), devices);
        // The keyboard paddle needs a keyboard.
        EXPECT_EQ(s.keyboardPaddle, devices[0] == 'k');
        EXPECT_STREQ(s.leftLayout, leftLayout);
    }
}

TEST(OptionRules, TidyingGivesTheNumberFieldsTheirLeadingNumber) {
    for (const auto& [typed, tidy] :
         {std::pair{"0012", "12"}, {"", "0"}, {"2.50", "2.5"}, {"12abc", "12"}, {"abc", "0"}}) {
        EmulatorOptions o;
        o.scanLines = o.startLine = o.lightGunCycles = o.lightGunScanlines = typed;
        o.customFrameRate = o.lowerSensitivityBy = typed;
        const EmulatorOptions t = withTidyNumbers(o);
        EXPECT_EQ(t.scanLines + t.startLine + t.lightGunCycles + t.lightGunScanlines,
                  QString(tidy).repeated(4))
            << typed;
        // The frame rate and lower sensitivity keep what was typed; they may stay empty.
        EXPECT_EQ(t.customFrameRate + t.lowerSensitivityBy, QString(typed).repeated(2)) << typed;
    }
}

TEST(OptionRules, ALaunchAsksAboutNoControllersThenStopsAtAZero) {
    const LaunchGuard noControllers{
        "It's going to be difficult playing the game\nwith all the available Controllers "
        "inactive\n\nDo you still want to load the ROM?",
        "Controls",
        "txtIPC4Balloon",
        1,
        "There Are No Active Controllers",
        "Allowing at least one controller to be\r\nactive will make gameplay much easier."};
    const LaunchGuard lowerZero{"", "PaddlesAudio", "txtLowerSens",
                                3,  "Zero Value",   "Number Cannot Be Zero"};
    const LaunchGuard rateZero{"", "Video",      "txtFPScustom",
                               3,  "Zero Value", "Number Cannot Be Zero"};
    using O = EmulatorOptions;
    const std::pair<void (*)(O&), std::vector<LaunchGuard>> cases[] = {
        {[](O&) {}, {}},
        {[](O& o) {
             o.inactiveKeyboard = o.inactiveMouse = o.inactiveJoystick = o.inactiveStelladaptor =
                 Check::On;
         },
         {noControllers}},
        {[](O& o) { o.leftController = o.rightController = 12; }, {noControllers}},
        // Grayed boxes leave a device in play, and a grayed lower sensitivity is off.
        {[](O& o) {
             o.inactiveKeyboard = o.inactiveMouse = Check::On,
             o.inactiveJoystick = o.inactiveStelladaptor = Check::Grayed;
         },
         {}},
        {[](O& o) { o.lowerSensitivity = Check::On, o.lowerSensitivityBy = "0"; }, {lowerZero}},
        {[](O& o) { o.lowerSensitivity = Check::Grayed, o.lowerSensitivityBy = "0"; }, {}},
        {[](O& o) { o.frameRate = FrameRate::Custom; }, {rateZero}},
        // All at once, in the order a launch meets them.
        {[](O& o) {
             o.leftController = o.rightController = 12, o.lowerSensitivity = Check::On,
             o.lowerSensitivityBy = "", o.frameRate = FrameRate::Custom, o.customFrameRate = "abc";
         },
         {noControllers, lowerZero, rateZero}},
    };
    for (std::size_t n = 0; const auto& [edit, guards] : cases) {
        EmulatorOptions o;
        edit(o);
        EXPECT_TRUE(launchGuards(o) == guards) << "case " << n++;
    }
}
