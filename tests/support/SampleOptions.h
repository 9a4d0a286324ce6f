#pragma once

#include "emulator/EmulatorOptions.h"

// Options in which every value differs from the start and, where it can, from its
// neighbours': grayed boxes, the last entries of lists, numbers with fractions.
inline EmulatorOptions sampleOptions() {
    EmulatorOptions o;
    o.videoMode = 3;
    o.videoStart = VideoStart::Fullscreen;
    o.dsp = DspLevel::High;
    o.screenCapture = CaptureFormat::Bmp;
    o.leftController = 2;
    o.rightController = -1;
    o.player0Hard = o.lightGun = o.quiet = o.palColorLoss = o.scanLineLimit = o.codeTrace =
        o.noFastCopy = o.startLineEnabled = o.syncWithSound = o.inactiveKeyboard =
            o.inactiveJoystick = o.swapPorts = o.lowerSensitivity = Check::On;
    o.player1Hard = o.interlaced = o.showScanline = o.printChecksum = o.allow4Directions =
        o.inactiveMouse = o.inactiveStelladaptor = Check::Grayed;
    o.mouseCapture = Check::Off;
    o.lightGunCycles = "1.5";
    o.lightGunScanlines = "-2.5";
    o.paddleSensitivity = 11;
    o.soundQueue = 5000;
    o.keyboardPaddle = Paddle::P1;
    o.mousePaddle1 = Paddle::P0;
    o.mousePaddle2 = Paddle::P3;
    o.frameRate = FrameRate::Custom;
    o.customFrameRate = "60";
    o.narrow = NarrowMode::Mode2;
    o.palette = Palette::Secam;
    o.phosphor = 40;
    o.scanLines = "262";
    o.gameType = 13;
    o.startLine = "30";
    o.lowerSensitivityBy = "0.25";
    return o;
}
