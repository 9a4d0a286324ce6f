#pragma once

#include <QString>
#include <QStringList>
#include <QStringView>

#include <array>
#include <cstdint>

// The emulator's command-line rules that need no window: the controller table, how the
// numeric option fields are tidied, and how a switch text becomes an argument list.
namespace switches {

// One entry of the controller lists: what goes on the command line, the caption of the
// port's layout-picture button, and which PC devices can drive it.
struct Controller {
    const char* code; // empty for "AutoDetect"
    const char* layout;
    bool keyboard;
    bool mouse;
    bool joystick;
    bool stelladaptor;
};

inline constexpr std::array<Controller, 13> kControllers = {{
    {"", "Standard Control Layout", true, true, true, true},       // AutoDetect
    {"JS", "Standard Control Layout", true, true, true, true},     // Joystick
    {"PC", "Paddle Control Layout", true, true, true, true},       // Paddle Controller
    {"KP", "Keyboard Control Layout", true, false, false, false},  // Keypad
    {"DC", "Driving Control Layout", true, true, true, true},      // Driving Controller
    {"LG", "Standard Control Layout", false, true, false, false},  // LightGun
    {"CM", "Keyboard Control Layout", true, false, false, false},  // CompuMate Keyboard
    {"KV", "Standard Control Layout", true, false, false, false},  // Kid Vid Tape Player
    {"ML", "Standard Control Layout", false, true, false, false},  // Mindlink Controller
    {"ST", "Standard Control Layout", false, true, false, false},  // ST Mouse / CX-80
    {"TB", "Standard Control Layout", false, true, false, false},  // CX-22 Trak-Ball
    {"AM", "Standard Control Layout", false, true, false, false},  // Amiga Mouse
    {"NC", "Standard Control Layout", false, false, false, false}, // No Controller
}};

inline constexpr int kLightGunIndex = 5;

// The table entry of a list index, or null outside the table.
const Controller* controllerAt(int index);

// Whether the device named by one letter ("k", "m", "j", "s") can drive the controller at
// `index`; false for an index outside the table or any other text.
bool controllerUsesDevice(int index, const QString& device);

// The decimal text of a number: plain digits for whole numbers, the shortest text that
// reads back as the same value otherwise ("7", "2.5", "-1"). Minus zero is "0"; values
// that are not finite give "0".
QString numberText(double value);

// What a numeric field holds after tidying: the decimal text of its leading number
// ("007" is "7", "" is "0", "2.50" is "2.5", "12abc" is "12").
QString normalisedNumberText(QStringView text);

// The mouse-paddle switch from the selected paddle (0..3, or -1 for none) of each mouse:
// " -m1" and both digits, " -m" and the one digit, or empty.
QString mousePaddleSwitch(int mouse1, int mouse2);

// The switch of an emulated-controller pair (" -w" driving, " -y" keyboard) from the
// left and right check-box states (0 off, 1 on, 2 grayed), combined bit by bit: left
// only gives the 1 form, right only the 2 form, both the 3 form.
QString controllerPairSwitch(QChar letter, std::int16_t left, std::int16_t right);

// The switch text with one leading blank removed, if it has one.
QString withoutLeadingBlank(const QString& switchText);

// The emulator's arguments: the ROM's path as one argument, then the switch text split
// at blanks (any white space). Runs of blanks make no empty arguments.
QStringList emulatorArguments(const QString& romPath, const QString& switchText);

} // namespace switches
