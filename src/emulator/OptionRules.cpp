#include "emulator/OptionRules.h"

#include "emulator/LeadingNumber.h"

namespace {

constexpr std::array<bool, 4> kAll = {true, true, true, true};
constexpr std::array<bool, 4> kKeyboard = {true, false, false, false};
constexpr std::array<bool, 4> kMouse = {false, true, false, false};
constexpr std::array<bool, 4> kNone = {false, false, false, false};

constexpr std::array<Controller, 13> kControllers = {{
    {"", "Standard Control Layout", kAll},        // AutoDetect
    {"JS", "Standard Control Layout", kAll},      // Joystick
    {"PC", "Paddle Control Layout", kAll},        // Paddle Controller
    {"KP", "Keyboard Control Layout", kKeyboard}, // Keypad
    {"DC", "Driving Control Layout", kAll},       // Driving Controller
    {"LG", "Standard Control Layout", kMouse},    // LightGun
    {"CM", "Keyboard Control Layout", kKeyboard}, // CompuMate Keyboard
    {"KV", "Standard Control Layout", kKeyboard}, // Kid Vid Tape Player
    {"ML", "Standard Control Layout", kMouse},    // Mindlink Controller
    {"ST", "Standard Control Layout", kMouse},    // ST Mouse / CX-80 Trak-Ball
    {"TB", "Standard Control Layout", kMouse},    // CX-22 Trak-Ball
    {"AM", "Standard Control Layout", kMouse},    // Amiga Mouse
    {"NC", "Standard Control Layout", kNone},     // No Controller Connnected
}};
static_assert(kControllers.size() == kControllerEntries.size());

bool usable(const EmulatorOptions& o, PcDevice device) {
    return controllerUsesDevice(o.leftController, device) ||
           controllerUsesDevice(o.rightController, device);
}

const char* layoutOf(int index) {
    const Controller* controller = controllerAt(index);
    return controller ? controller->layout : nullptr;
}

} // namespace

const Controller* controllerAt(int index) {
    if (index < 0 || index >= static_cast<int>(kControllers.size()))
        return nullptr;
    return &kControllers[static_cast<std::size_t>(index)];
}

bool controllerUsesDevice(int index, PcDevice device) {
    const Controller* controller = controllerAt(index);
    return controller && controller->devices[static_cast<std::size_t>(device)];
}

Check inactivation(const EmulatorOptions& o, PcDevice device) {
    switch (device) {
    case PcDevice::Keyboard:
        return o.inactiveKeyboard;
    case PcDevice::Mouse:
        return o.inactiveMouse;
    case PcDevice::Joystick:
        return o.inactiveJoystick;
    case PcDevice::Stelladaptor:
        return o.inactiveStelladaptor;
    }
    return Check::Off;
}

bool pcDeviceInactive(const EmulatorOptions& o, PcDevice device) {
    return inactivation(o, device) == Check::On || !usable(o, device);
}

OptionStates optionStates(const EmulatorOptions& o) {
    OptionStates s;
    s.lightGun =
        o.leftController == kLightGunController || o.rightController == kLightGunController;
    for (const PcDevice device :
         {PcDevice::Keyboard, PcDevice::Mouse, PcDevice::Joystick, PcDevice::Stelladaptor})
        s.pcDevices[static_cast<std::size_t>(device)] = usable(o, device);
    s.keyboardPaddle = !pcDeviceInactive(o, PcDevice::Keyboard);
    s.scanLinesField = isOn(o.scanLineLimit);
    s.startLineField = isOn(o.startLineEnabled);
    s.lowerSensitivityField = isOn(o.lowerSensitivity);
    // "Default" greys the custom rate too: it is not used then, as with "Monitor Speed".
    s.customFrameRateField = o.frameRate == FrameRate::Custom;
    s.leftLayout = layoutOf(o.leftController);
    s.rightLayout = layoutOf(o.rightController);
    return s;
}

QString normalisedNumberText(QStringView text) {
    return shortestDecimalText(leadingNumber(text));
}

EmulatorOptions withTidyNumbers(EmulatorOptions o) {
    for (QString* field : {&o.scanLines, &o.startLine, &o.lightGunCycles, &o.lightGunScanlines})
        *field = normalisedNumberText(*field);
    return o;
}

std::vector<LaunchGuard> launchGuards(const EmulatorOptions& o) {
    std::vector<LaunchGuard> guards;
    if (pcDeviceInactive(o, PcDevice::Keyboard) && pcDeviceInactive(o, PcDevice::Joystick) &&
        pcDeviceInactive(o, PcDevice::Mouse) && pcDeviceInactive(o, PcDevice::Stelladaptor))
        guards.push_back({QStringLiteral("It's going to be difficult playing the game\nwith all "
                                         "the available Controllers inactive\n\nDo you still "
                                         "want to load the ROM?"),
                          QStringLiteral("Controls"), QStringLiteral("txtIPC4Balloon"), 1,
                          QStringLiteral("There Are No Active Controllers"),
                          QStringLiteral("Allowing at least one controller to be\r\nactive will "
                                         "make gameplay much easier.")});
    const auto zero = [&guards](const QString& page, const QString& field) {
        guards.push_back({QString(), page, field, 3, QStringLiteral("Zero Value"),
                          QStringLiteral("Number Cannot Be Zero")});
    };
    if (o.lowerSensitivity == Check::On && leadingNumber(o.lowerSensitivityBy) == 0)
        zero(QStringLiteral("PaddlesAudio"), QStringLiteral("txtLowerSens"));
    if (o.frameRate == FrameRate::Custom && leadingNumber(o.customFrameRate) == 0)
        zero(QStringLiteral("Video"), QStringLiteral("txtFPScustom"));
    return guards;
}
