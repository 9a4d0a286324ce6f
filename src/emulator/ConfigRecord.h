#pragma once

#include <QByteArray>
#include <QByteArrayView>
#include <QtGlobal>

#include <array>
#include <optional>

// One option set as a .lum file holds it: a snapshot of the settings window's option
// controls. Members carry the names of the controls they come from. Flags are option
// buttons (selected or not); check boxes keep their raw state (0 unchecked, 1 checked,
// 2 grayed) so that a bad value read from a file can be reported rather than guessed at;
// list indexes count from 0 with -1 for "nothing selected"; the six text fields hold the
// value of their leading number; the three sliders hold a whole number.
struct ConfigRecord {
    qint16 comboVideoMode = 0;
    bool optVMDefault = false;
    bool optVMFull = false;
    bool optVMWindow = false;
    bool optDSPDefault = false;
    bool optDSPLow = false;
    bool optDSPHigh = false;
    qint16 chkP0Hard = 0;
    qint16 chkP1Hard = 0;
    qint16 chkBW = 0;
    bool optSCPCX = false;
    bool optSCBMP = false;
    qint16 chkLightGun = 0;
    float txtLightGunCycles = 0;
    float txtLightGunScan = 0;
    qint16 chkQuiet = 0;
    float BarColorSoundQueue = 0;
    float BarColorPaddle = 0;
    // "Paddle 0" to "Paddle 3"; four clear flags mean the frame's "None" button.
    std::array<bool, 4> optPaddleKey{};
    std::array<bool, 4> optPaddleM1{};
    std::array<bool, 4> optPaddleM2{};
    qint16 chkPALColorLoss = 0;
    qint16 chkInterlaced = 0;
    bool optFPSDefault = false;
    bool optFPSmonitor = false;
    bool optFPScustom = false;
    float txtFPScustom = 0;
    bool optNarrowNot = false;
    bool optNarrow1 = false;
    bool optNarrow2 = false;
    bool optCPDefault = false;
    bool optCPNTSC = false;
    bool optCPPAL = false;
    bool optCPSECAM = false;
    float BarColorPhos = 0;
    qint16 chkScanLines = 0;
    float txtScanLines = 0;
    qint16 chkMouseCapture = 0;
    qint16 chkShowScanline = 0;
    qint16 chkCodeTrace = 0;
    qint16 chkPrintChecksum = 0;
    qint16 chkFastCopy = 0;
    qint16 chkAllow4 = 0;
    qint16 comboGT = 0;
    qint16 chkLineScan = 0;
    float txtLineScan = 0;
    qint16 chkSyncWSound = 0;
    qint16 comboLeftController = 0;
    qint16 comboRightController = 0;
    qint16 chkIPCKeyboard = 0;
    qint16 chkIPCMouse = 0;
    qint16 chkIPCJoystick = 0;
    qint16 chkIPCStella = 0;
    qint16 chkSwapControl = 0;
    qint16 chkLowerSens = 0;
    float txtLowerSens = 0;

    static constexpr qsizetype kSize = 172;

    // Exactly kSize bytes, little-endian, zeros in the reserved areas.
    QByteArray encode() const;

    bool operator==(const ConfigRecord&) const = default;
};

// The record's fields in the order a load applies them to the window (a save fills them
// in the same order). A load stops at the first field the window cannot accept, keeping
// what it applied before it.
enum class ConfigField : int {
    comboVideoMode,
    optVMDefault,
    optVMFull,
    optVMWindow,
    optDSPDefault,
    optDSPLow,
    optDSPHigh,
    chkP0Hard,
    chkP1Hard,
    chkBW,
    optSCPCX,
    optSCBMP,
    comboLeftController,
    comboRightController,
    chkIPCKeyboard,
    chkIPCMouse,
    chkIPCJoystick,
    chkIPCStella,
    BarColorPaddle,
    chkLightGun,
    txtLightGunCycles,
    txtLightGunScan,
    chkSwapControl,
    chkQuiet,
    BarColorSoundQueue,
    chkLowerSens,
    txtLowerSens,
    optPaddleKey0,
    optPaddleKey1,
    optPaddleKey2,
    optPaddleKey3,
    optPaddleM1_0,
    optPaddleM1_1,
    optPaddleM1_2,
    optPaddleM1_3,
    optPaddleM2_0,
    optPaddleM2_1,
    optPaddleM2_2,
    optPaddleM2_3,
    chkPALColorLoss,
    chkInterlaced,
    chkSyncWSound,
    optFPSDefault,
    optFPSmonitor,
    optFPScustom,
    txtFPScustom,
    optNarrowNot,
    optNarrow1,
    optNarrow2,
    optCPDefault,
    optCPNTSC,
    optCPPAL,
    optCPSECAM,
    BarColorPhos,
    chkScanLines,
    txtScanLines,
    chkMouseCapture,
    chkShowScanline,
    chkCodeTrace,
    chkPrintChecksum,
    chkFastCopy,
    chkAllow4,
    comboGT,
    chkLineScan,
    txtLineScan,
};
inline constexpr int kConfigFieldCount = static_cast<int>(ConfigField::txtLineScan) + 1;

enum class ConfigFieldKind {
    ListIndex,  // int16 selected entry
    Flag,       // option button, stored 0 / -1
    Check,      // check box state
    Text,       // text field's number, single
    Slider,     // whole-number slider value, single
    SoundQueue, // the sound-queue slider, whose range follows its value on a load
};

// The drop-down list a list index belongs to.
enum class ConfigList { None, VideoMode, Controller, GameType };

struct ConfigFieldInfo {
    ConfigField field;
    // The control's name; for the paddle arrays the array's name with `element` 0 to 3.
    const char* control;
    int element;
    int offset;
    ConfigFieldKind kind;
    ConfigList list;
};

// Every field in load order, with its place in the file.
const std::array<ConfigFieldInfo, kConfigFieldCount>& configFields();
const ConfigFieldInfo& configFieldInfo(ConfigField field);

// Generic access by field, for loaders and savers that walk configFields(). Each reads or
// writes only fields of the matching kind (ListIndex and Check share the int16 access;
// Text, Slider and SoundQueue share the single access) and ignores the others.
qint16 configInt(const ConfigRecord& record, ConfigField field);
void setConfigInt(ConfigRecord& record, ConfigField field, qint16 value);
bool configFlag(const ConfigRecord& record, ConfigField field);
void setConfigFlag(ConfigRecord& record, ConfigField field, bool value);
float configSingle(const ConfigRecord& record, ConfigField field);
void setConfigSingle(ConfigRecord& record, ConfigField field, float value);

// How many entries each drop-down list of the settings window has, so that an index the
// list cannot select is caught before it is applied.
struct ConfigLimits {
    int videoModes = 0;
    int controllers = 0;
    int gameTypes = 0;
};

// The sound-queue slider's window as a load sets it: the range re-centred around the
// stored value's hundreds, then the value. Empty when the value cannot be shown that way
// (its decimal text is shorter than two characters, the hundreds do not form a number,
// or the numbers leave the slider's 32-bit range).
struct SoundQueueScale {
    int min = 0;
    int max = 0;
    int value = 0;
    bool operator==(const SoundQueueScale&) const = default;
};
std::optional<SoundQueueScale> soundQueueScaleFor(float stored);

// A slider value as the window takes it: rounded to a whole number, halves to even.
// Empty when it is not a finite number within the slider's 32-bit range.
std::optional<int> sliderValueFor(float stored);

// Whether the window accepts the field's stored value.
bool configFieldAcceptable(const ConfigRecord& record, ConfigField field,
                           const ConfigLimits& limits);

enum class ConfigStatus {
    Ok,
    Unreadable, // the file could not be opened or read
    Short,      // fewer than ConfigRecord::kSize bytes
    Invalid,    // a field the window rejects; see firstBad
};

struct ConfigDecode {
    ConfigStatus status = ConfigStatus::Ok;
    ConfigRecord record;
    // The first field in load order that must not be applied: the load applies every
    // field before it and then reports the file as corrupt. For short or unreadable data
    // it is the first field, so nothing is applied.
    std::optional<ConfigField> firstBad;

    bool ok() const { return status == ConfigStatus::Ok; }
    // The number of leading fields (in load order) that a load applies.
    int applicableCount() const {
        return firstBad ? static_cast<int>(*firstBad) : kConfigFieldCount;
    }
};

// Reads the first ConfigRecord::kSize bytes of `data`; never reads past its end. Bytes
// beyond the record are ignored, as are the reserved areas.
ConfigDecode decodeConfig(QByteArrayView data, const ConfigLimits& limits);
