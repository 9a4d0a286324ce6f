#pragma once

#include "emulator/EmulatorOptions.h"

#include <QString>
#include <QStringList>

// z26's command line from the options. Each builder returns an empty text or its switches,
// each written as a blank, a hyphen and the switch letters, maybe with a value (" -c1").
namespace switches {

QString LeftController(const EmulatorOptions& o);
QString RightController(const EmulatorOptions& o);
QString Interlaced(const EmulatorOptions& o);
QString P0Hard(const EmulatorOptions& o);
QString P1Hard(const EmulatorOptions& o);
QString All4(const EmulatorOptions& o);
QString StartBW(const EmulatorOptions& o);
QString ScreenCapture(const EmulatorOptions& o);
QString ColorPalette(const EmulatorOptions& o);
QString DSP(const EmulatorOptions& o);
QString Narrow(const EmulatorOptions& o);
QString Phos(const EmulatorOptions& o);
QString GameType(const EmulatorOptions& o);
QString ScanLines(const EmulatorOptions& o);
QString IPC(const EmulatorOptions& o);
QString PaddleSens(const EmulatorOptions& o);
QString LowerSens(const EmulatorOptions& o);
QString Paddle(const EmulatorOptions& o);
QString MouseCapture(const EmulatorOptions& o);
QString LightGun(const EmulatorOptions& o);
QString ShowScanline(const EmulatorOptions& o);
QString PALColorLoss(const EmulatorOptions& o);
QString Quiet(const EmulatorOptions& o);
QString SoundQueue(const EmulatorOptions& o);
QString FPS(const EmulatorOptions& o);
QString LineScan(const EmulatorOptions& o);
QString CodeTrace(const EmulatorOptions& o);
QString VideoMode(const EmulatorOptions& o);
QString SwapControl(const EmulatorOptions& o);
QString PrintChecksum(const EmulatorOptions& o);
QString FastCopy(const EmulatorOptions& o);
QString SyncWSound(const EmulatorOptions& o);

// The switch text with one leading blank removed, if it has one.
QString withoutLeadingBlank(const QString& switchText);

// The emulator's arguments: the ROM's path as one argument, then the switch text split
// at blanks (any white space). Runs of blanks make no empty arguments.
QStringList emulatorArguments(const QString& romPath, const QString& switchText);

} // namespace switches

// Every builder above, joined in the order z26 has always been given them; the text starts
// with the first switch's blank.
QString launchSwitches(const EmulatorOptions& options);
