#include "emulator/Switches.h"

#include <gtest/gtest.h>

namespace {

using O = EmulatorOptions;

// The whole switch text for options changed from the window's start, written from what
// each switch means to z26. At the start only the keyboard paddle's sensitivity (the
// keyboard can drive the AutoDetect ports) and mouse capture (on) speak.
const struct {
    const char* what;
    void (*edit)(O&);
    const char* switches;
} kCases[] = {
    {"start", [](O&) {}, " -p8 -M1"},
    {"a typical set",
     [](O& o) {
         o.leftController = 1, o.rightController = 2, o.palette = Palette::Pal, o.gameType = 2;
         o.soundQueue = 4000, o.mouseCapture = Check::Off, o.paddleSensitivity = 6;
     },
     " -)JS -(PC -c1 -g2 -p6 -M0 -s4000"},
    {"no controller", [](O& o) { o.leftController = o.rightController = 12; }, " -)NC -(NC -M1"},
    {"phosphor off its default", [](O& o) { o.phosphor = 76; }, " -f76 -p8 -M1"},
    {"sound queue off its default", [](O& o) { o.soundQueue = 4607; }, " -p8 -M1 -s4607"},
    {"last game type", [](O& o) { o.gameType = 13; }, " -g13 -p8 -M1"},
    {"no game type selected", [](O& o) { o.gameType = -1; }, " -g-1 -p8 -M1"},
    {"scanline limit, tidied", [](O& o) { o.scanLineLimit = Check::On, o.scanLines = "0012"; },
     " -h12 -p8 -M1"},
    {"scanline limit off", [](O& o) { o.scanLines = "0012"; }, " -p8 -M1"},
    {"custom rate, trimmed",
     [](O& o) { o.frameRate = FrameRate::Custom, o.customFrameRate = " 60 "; }, " -p8 -M1 -r60"},
    {"custom rate as typed",
     [](O& o) { o.frameRate = FrameRate::Custom, o.customFrameRate = "5x"; }, " -p8 -M1 -r5x"},
    {"custom rate empty", [](O& o) { o.frameRate = FrameRate::Custom; }, " -p8 -M1 -r"},
    {"monitor speed", [](O& o) { o.frameRate = FrameRate::Monitor, o.customFrameRate = "50"; },
     " -p8 -M1 -r"},
    {"first mouse's paddle", [](O& o) { o.mousePaddle1 = Paddle::P3; }, " -p8 -m3 -M1"},
    {"second mouse's paddle", [](O& o) { o.mousePaddle2 = Paddle::P2; }, " -p8 -m2 -M1"},
    {"both mice", [](O& o) { o.mousePaddle1 = Paddle::P0, o.mousePaddle2 = Paddle::P3; },
     " -p8 -m103 -M1"},
    {"every PC controller inactive",
     [](O& o) {
         o.inactiveKeyboard = o.inactiveMouse = o.inactiveJoystick = o.inactiveStelladaptor =
             Check::On;
     },
     " -iKMJS -M1"},
    {"boxes a mouse-only pair of ports cannot use do not count",
     [](O& o) {
         o.leftController = o.rightController = 11;
         o.inactiveKeyboard = o.inactiveMouse = o.inactiveJoystick = Check::On;
     },
     " -)AM -(AM -iM -M1"},
    {"a grayed inactive box does not count",
     [](O& o) { o.inactiveKeyboard = Check::Grayed, o.inactiveStelladaptor = Check::On; },
     " -iS -p8 -M1"},
    {"light gun on the right port", [](O& o) { o.rightController = 5; }, " -(LG -p8 -M1 -l0 -a0"},
    {"light gun adjustments, tidied",
     [](O& o) { o.leftController = 5, o.lightGunCycles = "03", o.lightGunScanlines = ""; },
     " -)LG -p8 -M1 -l3 -a0"},
    {"video mode without a start", [](O& o) { o.videoMode = 3; }, " -p8 -M1"},
    {"fullscreen", [](O& o) { o.videoMode = 3, o.videoStart = VideoStart::Fullscreen; },
     " -p8 -M1 -v3"},
    {"window", [](O& o) { o.videoMode = 3, o.videoStart = VideoStart::Window; }, " -p8 -M1 -v13"},
    {"grayed swap and lower sensitivity need an exact check",
     [](O& o) { o.swapPorts = o.lowerSensitivity = Check::Grayed, o.lowerSensitivityBy = "3"; },
     " -p8 -M1"},
    {"lower sensitivity",
     [](O& o) { o.lowerSensitivity = Check::On, o.lowerSensitivityBy = "007"; }, " -p8 -P7 -M1"},
    {"lower sensitivity empty",
     [](O& o) { o.lowerSensitivity = Check::On, o.lowerSensitivityBy = ""; }, " -p8 -M1"},
    {"grayed boxes count as on elsewhere",
     [](O& o) { o.quiet = o.mouseCapture = o.interlaced = Check::Grayed; }, " -! -p8 -M1 -q"},
    {"everything, in z26's order",
     [](O& o) {
         o.interlaced = o.player0Hard = o.player1Hard = o.allow4Directions = o.blackAndWhite =
             o.scanLineLimit = o.inactiveMouse = o.lowerSensitivity = o.showScanline =
                 o.palColorLoss = o.quiet = o.startLineEnabled = o.codeTrace = o.swapPorts =
                     o.printChecksum = o.noFastCopy = o.syncWithSound = o.lightGun = Check::On;
         o.leftController = 1, o.rightController = 5, o.screenCapture = CaptureFormat::Bmp;
         o.palette = Palette::Secam, o.dsp = DspLevel::High, o.narrow = NarrowMode::Mode2;
         o.frameRate = FrameRate::Monitor, o.videoStart = VideoStart::Fullscreen;
         o.mousePaddle1 = Paddle::P2, o.keyboardPaddle = Paddle::P1, o.phosphor = 50;
         o.soundQueue = 4000, o.paddleSensitivity = 6, o.gameType = 4;
     },
     " -)JS -(LG -! -0 -1 -4 -b -B -c2 -d2 -e2 -f50 -g4 -h0 -iM -p6 -P1 -m2 -M1 -l0 -a0 -n -o -q "
     "-s4000 -r -u0 -t -v0 -w -x -z -R"},
};

} // namespace

TEST(Switches, EachOptionGivesItsSwitchInItsPlace) {
    for (const auto& c : kCases) {
        EmulatorOptions options;
        c.edit(options);
        EXPECT_EQ(launchSwitches(options), QLatin1String(c.switches)) << c.what;
    }
}

TEST(Switches, TheArgumentsAreTheRomThenTheSwitchesSplitAtBlanks) {
    EXPECT_EQ(switches::withoutLeadingBlank(QStringLiteral("  -c1")), " -c1");
    EXPECT_EQ(switches::emulatorArguments(QStringLiteral("/r/it's \"a b\".bin"),
                                          QStringLiteral("  -c1 \t-g2 ")),
              QStringList({"/r/it's \"a b\".bin", "-c1", "-g2"}));
    EXPECT_EQ(switches::emulatorArguments(QStringLiteral("/r/a"), QString()),
              QStringList({"/r/a"}));
}
