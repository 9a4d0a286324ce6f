#pragma once

#include <QString>
#include <QtGlobal>

#include <array>

// Every option of z26 that lum keeps: what the settings window edits, what an option set
// (.lum file) holds, and what the command line is made from. Each member names the
// control that shows it. Its initial value, its place in an option set and its control
// are declared once, in optionTable().

// A check box as option sets keep it. Grayed comes only from a file; it counts as on.
enum class Check : qint16 { Off = 0, On = 1, Grayed = 2 };
constexpr bool isOn(Check check) {
    return check != Check::Off;
}

// Option button groups; each value is one button, in the order the table lists them.
enum class VideoStart { Default, Fullscreen, Window };
enum class DspLevel { Default, Low, High };
enum class CaptureFormat { Pcx, Bmp };
enum class FrameRate { Default, Monitor, Custom };
enum class NarrowMode { Off, Mode1, Mode2 };
enum class Palette { Default, Ntsc, Pal, Secam };
enum class Paddle { P0, P1, P2, P3, None };

struct EmulatorOptions {
    // The options as the settings window starts.
    EmulatorOptions();

    // Settings page: how the game starts.
    int videoMode{};               // comboVideoMode, an entry of kVideoModeEntries (-1 none)
    VideoStart videoStart{};       // optVMDefault, optVMFull, optVMWindow
    CaptureFormat screenCapture{}; // optSCPCX, optSCBMP
    DspLevel dsp{};                // optDSPDefault, optDSPLow, optDSPHigh
    // Settings page: "Start game with...".
    Check player0Hard{};   // chkP0Hard
    Check player1Hard{};   // chkP1Hard
    Check blackAndWhite{}; // chkBW

    // Controls page: the ports and the PC devices that drive them.
    int leftController{};    // comboLeftController, an entry of kControllerEntries
    int rightController{};   // comboRightController
    Check swapPorts{};       // chkSwapControl
    int paddleSensitivity{}; // BarColorPaddle
    // Controls page: "Inactivate PC-controller".
    Check inactiveKeyboard{};     // chkIPCKeyboard
    Check inactiveMouse{};        // chkIPCMouse
    Check inactiveJoystick{};     // chkIPCJoystick
    Check inactiveStelladaptor{}; // chkIPCStella
    // Controls page: the light gun's adjustments, and its retired box.
    QString lightGunCycles;    // txtLightGunCycles
    QString lightGunScanlines; // txtLightGunScan
    Check lightGun{};          // chkLightGun: kept in option sets only, never shown

    // Paddles / Audio page.
    Check lowerSensitivity{};   // chkLowerSens
    QString lowerSensitivityBy; // txtLowerSens, in scanlines
    Check quiet{};              // chkQuiet
    int soundQueue{};           // BarColorSoundQueue
    // Paddles / Audio page: the mice's paddles, and the keyboard's, which is retired.
    Paddle mousePaddle1{};   // optPaddleM1_0 .. optPaddleM1_3, optPaddleM1None
    Paddle mousePaddle2{};   // optPaddleM2_0 .. optPaddleM2_3, optPaddleM2None
    Paddle keyboardPaddle{}; // optPaddleKey: kept in option sets only, never shown

    // Video page.
    Check scanLineLimit{};   // chkScanLines
    QString scanLines;       // txtScanLines
    FrameRate frameRate{};   // optFPSDefault, optFPSmonitor, optFPScustom
    QString customFrameRate; // txtFPScustom
    // Video page: the picture.
    NarrowMode narrow{};   // optNarrowNot, optNarrow1, optNarrow2
    Palette palette{};     // optCPDefault, optCPNTSC, optCPPAL, optCPSECAM
    int phosphor{};        // BarColorPhos
    Check palColorLoss{};  // chkPALColorLoss
    Check interlaced{};    // chkInterlaced
    Check syncWithSound{}; // chkSyncWSound

    // Debugging page.
    Check startLineEnabled{}; // chkLineScan
    QString startLine;        // txtLineScan
    int gameType{};           // comboGT, an entry of kGameTypeEntries
    Check mouseCapture{};     // chkMouseCapture
    // Debugging page: what z26 shows and writes.
    Check showScanline{};     // chkShowScanline
    Check codeTrace{};        // chkCodeTrace
    Check printChecksum{};    // chkPrintChecksum
    Check noFastCopy{};       // chkFastCopy
    Check allow4Directions{}; // chkAllow4

    bool operator==(const EmulatorOptions&) const = default;
};

// Where the emulator's own defaults lie: at these values the switch is left out.
inline constexpr int kPhosphorDefault = 77;
inline constexpr int kSoundQueueDefault = 4608;

// The entries of the three drop-down lists, in their fixed order: an option set and the
// command line carry an entry's index.
inline constexpr std::array<const char*, 14> kGameTypeEntries = {
    "Automatic (Don't override)",
    "Commavid extra RAM",
    "8K Superchip",
    "8K Parker Brothers",
    "8K Tigervision",
    "8K Decathlon & Robot Tank",
    "16K Superchip",
    "16K M-Network",
    "32K Superchip",
    "8K Atari -- banks swapped",
    "Spectravideo Compumate",
    "32K - 512K Extended Tigervision",
    "8k UA Ltd.",
    "64K Homestar Runner / Ormsby",
};

inline constexpr std::array<const char*, 9> kVideoModeEntries = {
    "Mode 0 -- 400x300 default",
    "Mode 1 -- 320x240",
    "Mode 2 -- 320x200",
    "Mode 3 -- 800x600 scanline/interlaced",
    "Mode 4 -- 640x480 scanline/interlaced",
    "Mode 5 -- 640x400 scanline/interlaced",
    "Mode 6 -- 800x600 double scanline",
    "Mode 7 -- 640x480 double scanline",
    "Mode 8 -- 640x400 double scanline",
};

inline constexpr std::array<const char*, 13> kControllerEntries = {
    "AutoDetect",
    "Joystick",
    "Paddle Controller",
    "Keypad",
    "Driving Controller",
    "LightGun",
    "CompuMate Keyboard",
    "Kid Vid Tape Player",
    "Mindlink Controller",
    "ST Mouse / CX-80 Trak-Ball",
    "CX-22 Trak-Ball",
    "Amiga Mouse",
    "No Controller Connnected",
};

// How an option is kept in an option set and shown in the window.
enum class OptionKind {
    List,       // a drop-down list's entry: int16, -1 for none
    Check,      // a check box: int16 0, 1 or 2
    Choice,     // option buttons, one flag each (0 or -1); the last set flag wins
    Number,     // a number field's text, kept as the single of its leading number
    Slider,     // a slider bar's whole-number value, kept as a single
    SoundQueue, // the same, but the bar's scale follows the value when it is shown
};

// One place of an option: where its flag or value lies in the 172-byte record (-1 for a
// button that is not kept, a frame's "None") and the objectName of the control that shows
// it (null for a retired option no window shows).
struct OptionSlot {
    int offset;
    const char* control;
};

// One option. Every member of EmulatorOptions has exactly one row.
struct OptionRow {
    OptionKind kind;
    // A Choice has one slot per value of its member, in the enum's order; the rest one.
    std::array<OptionSlot, 5> slotList;
    int slotCount;
    // The entries of a List.
    int entries;
    // Every kind but Number reads and writes its member as a whole number.
    int (*get)(const EmulatorOptions&);
    void (*set)(EmulatorOptions&, int);
    QString EmulatorOptions::*text;
    int initial;
    const char* initialText;

    const OptionSlot& slot() const { return slotList[0]; }
};

inline constexpr int kOptionCount = 44;
inline constexpr int kOptionSetSize = 172;

// The rows in the order an option set is applied: a load that meets a value the window
// cannot show keeps every row before it.
const std::array<OptionRow, kOptionCount>& optionTable();
