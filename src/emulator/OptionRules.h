#pragma once

#include "emulator/EmulatorOptions.h"

#include <QString>

#include <array>
#include <vector>

// The rules between options that need no window: which controls a value enables or shows,
// how number fields are tidied, and what a launch must settle first.

// The PC input devices that can drive an Atari controller, in the order the rules check
// them.
enum class PcDevice { Keyboard, Mouse, Joystick, Stelladaptor };

// One entry of the controller lists: what goes on the command line (empty for
// "AutoDetect"), the caption of the port's layout-picture button, and which PC devices can
// drive it.
struct Controller {
    const char* code;
    const char* layout;
    std::array<bool, 4> devices; // by PcDevice
};

inline constexpr int kLightGunController = 5;

// The entry of a list index, or null outside the list.
const Controller* controllerAt(int index);
// Whether the controller at `index` can be driven by the device; false outside the list.
bool controllerUsesDevice(int index, PcDevice device);

// The states of the window's controls that follow from the options.
struct OptionStates {
    bool lightGun = false;              // fraLightgun: a port holds a light gun
    std::array<bool, 4> pcDevices{};    // chkIPCKeyboard .. chkIPCStella: a port can use it
    bool keyboardPaddle = false;        // fraPaddleSens: the keyboard is an active device
    bool scanLinesField = false;        // txtScanLines
    bool startLineField = false;        // txtLineScan
    bool lowerSensitivityField = false; // txtLowerSens
    bool customFrameRateField = false;  // txtFPScustom
    const char* leftLayout = nullptr;   // cmdLeftControlPic's caption; null keeps it
    const char* rightLayout = nullptr;  // cmdRightControlPic's caption
    bool operator==(const OptionStates&) const = default;
};
OptionStates optionStates(const EmulatorOptions& options);

// The device's "Inactivate PC-controller" box.
Check inactivation(const EmulatorOptions& options, PcDevice device);
// Whether the device is out of play: switched off exactly, or usable by neither port.
bool pcDeviceInactive(const EmulatorOptions& options, PcDevice device);

// What a number field holds after tidying: the decimal text of its leading number
// ("007" is "7", "" is "0", "2.50" is "2.5", "12abc" is "12").
QString normalisedNumberText(QStringView text);
// The options with the four fields that the emulator reads as numbers tidied: the
// scanline limit, the start line and the light gun's two adjustments. The custom frame
// rate and the lower sensitivity keep their text, which may stay empty.
EmulatorOptions withTidyNumbers(EmulatorOptions options);

// Something a launch must settle before it starts the emulator. With a question, only the
// answer Yes lets the launch go on; without one, the launch stops. Either way it stops by
// showing the settings window on `page` with a balloon tip at `anchor` (an objectName).
struct LaunchGuard {
    QString question;
    QString page;
    QString anchor;
    int icon = 0; // 1 information, 3 error
    QString title;
    QString text;
    bool operator==(const LaunchGuard&) const = default;
};
// The guards the options raise, in the order a launch meets them.
std::vector<LaunchGuard> launchGuards(const EmulatorOptions& options);
