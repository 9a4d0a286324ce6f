#pragma once

#include "emulator/EmulatorOptions.h"

#include <QString>
#include <QStringList>

#include <array>

// z26's command line from the options. Each builder returns an empty text or its switches,
// each written as a blank, a hyphen and the switch letters, maybe with a value (" -c1").
namespace switches {

// A switch that one check box decides: given while the box is on (a grayed one counts).
struct BoxSwitch {
    Check EmulatorOptions::*box;
    const char* text;
    QString operator()(const EmulatorOptions& o) const {
        return isOn(o.*box) ? QLatin1String(text) : QString();
    }
};

// A switch that a group of option buttons decides: one text per button, "" for none.
template <class Group, std::size_t N> struct ChoiceSwitch {
    Group EmulatorOptions::*group;
    std::array<const char*, N> texts;
    QString operator()(const EmulatorOptions& o) const {
        return QLatin1String(texts[static_cast<std::size_t>(o.*group)]);
    }
};

// A number given after its switch, left out at the value z26 takes without one.
struct NumberSwitch {
    int EmulatorOptions::*value;
    int unsaid;
    const char* text;
    QString operator()(const EmulatorOptions& o) const {
        return o.*value == unsaid ? QString() : QLatin1String(text) + QString::number(o.*value);
    }
};

// A number field's value after its switch, while its box is on.
struct FieldSwitch {
    Check EmulatorOptions::*box;
    QString EmulatorOptions::*field;
    const char* text;
    QString operator()(const EmulatorOptions& o) const;
};

using O = EmulatorOptions;
inline constexpr BoxSwitch Interlaced{&O::interlaced, " -!"};
inline constexpr BoxSwitch P0Hard{&O::player0Hard, " -0"};
inline constexpr BoxSwitch P1Hard{&O::player1Hard, " -1"};
inline constexpr BoxSwitch All4{&O::allow4Directions, " -4"};
inline constexpr BoxSwitch StartBW{&O::blackAndWhite, " -b"};
inline constexpr BoxSwitch ShowScanline{&O::showScanline, " -n"};
inline constexpr BoxSwitch PALColorLoss{&O::palColorLoss, " -o"};
inline constexpr BoxSwitch Quiet{&O::quiet, " -q"};
inline constexpr BoxSwitch CodeTrace{&O::codeTrace, " -t"};
inline constexpr BoxSwitch PrintChecksum{&O::printChecksum, " -x"};
inline constexpr BoxSwitch FastCopy{&O::noFastCopy, " -z"};
inline constexpr BoxSwitch SyncWSound{&O::syncWithSound, " -R"};
inline constexpr ChoiceSwitch<CaptureFormat, 2> ScreenCapture{&O::screenCapture, {"", " -B"}};
inline constexpr ChoiceSwitch<Palette, 4> ColorPalette{&O::palette, {"", " -c0", " -c1", " -c2"}};
inline constexpr ChoiceSwitch<DspLevel, 3> DSP{&O::dsp, {"", " -d1", " -d2"}};
inline constexpr ChoiceSwitch<NarrowMode, 3> Narrow{&O::narrow, {"", " -e1", " -e2"}};
inline constexpr NumberSwitch Phos{&O::phosphor, kPhosphorDefault, " -f"};
inline constexpr NumberSwitch SoundQueue{&O::soundQueue, kSoundQueueDefault, " -s"};
// Index 0 is "Automatic"; any other index, -1 for none too, is given.
inline constexpr NumberSwitch GameType{&O::gameType, 0, " -g"};
inline constexpr FieldSwitch ScanLines{&O::scanLineLimit, &O::scanLines, " -h"};
inline constexpr FieldSwitch LineScan{&O::startLineEnabled, &O::startLine, " -u"};

QString LeftController(const EmulatorOptions& o);
QString RightController(const EmulatorOptions& o);
// The PC controllers switched off, by letter; a box no selected controller can use never
// counts.
QString IPC(const EmulatorOptions& o);
// The keyboard paddle's sensitivity, while the keyboard is an active PC controller.
QString PaddleSens(const EmulatorOptions& o);
QString LowerSens(const EmulatorOptions& o);
QString Paddle(const EmulatorOptions& o);
QString MouseCapture(const EmulatorOptions& o);
QString LightGun(const EmulatorOptions& o);
QString FPS(const EmulatorOptions& o);
QString VideoMode(const EmulatorOptions& o);
QString SwapControl(const EmulatorOptions& o);

// The switch text with one leading blank removed, if it has one.
QString withoutLeadingBlank(const QString& switchText);

// The emulator's arguments: the ROM's path as one argument, then the switch text split
// at blanks (any white space). Runs of blanks make no empty arguments.
QStringList emulatorArguments(const QString& romPath, const QString& switchText);

} // namespace switches

// Every builder above, joined in the order z26 has always been given them; the text starts
// with the first switch's blank.
QString launchSwitches(const EmulatorOptions& options);
