#include "emulator/ConfigRecord.h"

#include "emulator/LeadingNumber.h"

#include <QtEndian>

#include <cmath>
#include <cstring>
#include <limits>

namespace {

using R = ConfigRecord;
using F = ConfigField;
using K = ConfigFieldKind;
using L = ConfigList;

// A field's place in the file and its member in the record.
struct Slot {
    ConfigFieldInfo info;
    qint16 R::*i16 = nullptr;
    bool R::*flag = nullptr;
    std::array<bool, 4> R::*flags = nullptr;
    float R::*single = nullptr;
};

constexpr Slot listIndex(F f, const char* name, int offset, L list, qint16 R::*m) {
    return {{f, name, 0, offset, K::ListIndex, list}, m, nullptr, nullptr, nullptr};
}
constexpr Slot check(F f, const char* name, int offset, qint16 R::*m) {
    return {{f, name, 0, offset, K::Check, L::None}, m, nullptr, nullptr, nullptr};
}
constexpr Slot flag(F f, const char* name, int offset, bool R::*m) {
    return {{f, name, 0, offset, K::Flag, L::None}, nullptr, m, nullptr, nullptr};
}
constexpr Slot arrayFlag(F f, const char* name, int element, int offset,
                         std::array<bool, 4> R::*m) {
    return {
        {f, name, element, offset + 2 * element, K::Flag, L::None}, nullptr, nullptr, m, nullptr};
}
constexpr Slot single(F f, const char* name, int offset, K kind, float R::*m) {
    return {{f, name, 0, offset, kind, L::None}, nullptr, nullptr, nullptr, m};
}

// Load order; the offsets are those of the file.
constexpr std::array<Slot, kConfigFieldCount> kSlots = {{
    listIndex(F::comboVideoMode, "comboVideoMode", 0, L::VideoMode, &R::comboVideoMode),
    flag(F::optVMDefault, "optVMDefault", 2, &R::optVMDefault),
    flag(F::optVMFull, "optVMFull", 4, &R::optVMFull),
    flag(F::optVMWindow, "optVMWindow", 6, &R::optVMWindow),
    flag(F::optDSPDefault, "optDSPDefault", 8, &R::optDSPDefault),
    flag(F::optDSPLow, "optDSPLow", 10, &R::optDSPLow),
    flag(F::optDSPHigh, "optDSPHigh", 12, &R::optDSPHigh),
    check(F::chkP0Hard, "chkP0Hard", 14, &R::chkP0Hard),
    check(F::chkP1Hard, "chkP1Hard", 16, &R::chkP1Hard),
    check(F::chkBW, "chkBW", 18, &R::chkBW),
    flag(F::optSCPCX, "optSCPCX", 20, &R::optSCPCX),
    flag(F::optSCBMP, "optSCBMP", 22, &R::optSCBMP),
    listIndex(F::comboLeftController, "comboLeftController", 152, L::Controller,
              &R::comboLeftController),
    listIndex(F::comboRightController, "comboRightController", 154, L::Controller,
              &R::comboRightController),
    check(F::chkIPCKeyboard, "chkIPCKeyboard", 156, &R::chkIPCKeyboard),
    check(F::chkIPCMouse, "chkIPCMouse", 158, &R::chkIPCMouse),
    check(F::chkIPCJoystick, "chkIPCJoystick", 160, &R::chkIPCJoystick),
    check(F::chkIPCStella, "chkIPCStella", 162, &R::chkIPCStella),
    single(F::BarColorPaddle, "BarColorPaddle", 60, K::Slider, &R::BarColorPaddle),
    check(F::chkLightGun, "chkLightGun", 42, &R::chkLightGun),
    single(F::txtLightGunCycles, "txtLightGunCycles", 44, K::Text, &R::txtLightGunCycles),
    single(F::txtLightGunScan, "txtLightGunScan", 48, K::Text, &R::txtLightGunScan),
    check(F::chkSwapControl, "chkSwapControl", 164, &R::chkSwapControl),
    check(F::chkQuiet, "chkQuiet", 52, &R::chkQuiet),
    single(F::BarColorSoundQueue, "BarColorSoundQueue", 54, K::SoundQueue, &R::BarColorSoundQueue),
    check(F::chkLowerSens, "chkLowerSens", 166, &R::chkLowerSens),
    single(F::txtLowerSens, "txtLowerSens", 168, K::Text, &R::txtLowerSens),
    arrayFlag(F::optPaddleKey0, "optPaddleKey", 0, 68, &R::optPaddleKey),
    arrayFlag(F::optPaddleKey1, "optPaddleKey", 1, 68, &R::optPaddleKey),
    arrayFlag(F::optPaddleKey2, "optPaddleKey", 2, 68, &R::optPaddleKey),
    arrayFlag(F::optPaddleKey3, "optPaddleKey", 3, 68, &R::optPaddleKey),
    arrayFlag(F::optPaddleM1_0, "optPaddleM1", 0, 76, &R::optPaddleM1),
    arrayFlag(F::optPaddleM1_1, "optPaddleM1", 1, 76, &R::optPaddleM1),
    arrayFlag(F::optPaddleM1_2, "optPaddleM1", 2, 76, &R::optPaddleM1),
    arrayFlag(F::optPaddleM1_3, "optPaddleM1", 3, 76, &R::optPaddleM1),
    arrayFlag(F::optPaddleM2_0, "optPaddleM2", 0, 84, &R::optPaddleM2),
    arrayFlag(F::optPaddleM2_1, "optPaddleM2", 1, 84, &R::optPaddleM2),
    arrayFlag(F::optPaddleM2_2, "optPaddleM2", 2, 84, &R::optPaddleM2),
    arrayFlag(F::optPaddleM2_3, "optPaddleM2", 3, 84, &R::optPaddleM2),
    check(F::chkPALColorLoss, "chkPALColorLoss", 92, &R::chkPALColorLoss),
    check(F::chkInterlaced, "chkInterlaced", 94, &R::chkInterlaced),
    check(F::chkSyncWSound, "chkSyncWSound", 150, &R::chkSyncWSound),
    flag(F::optFPSDefault, "optFPSDefault", 96, &R::optFPSDefault),
    flag(F::optFPSmonitor, "optFPSmonitor", 98, &R::optFPSmonitor),
    flag(F::optFPScustom, "optFPScustom", 100, &R::optFPScustom),
    single(F::txtFPScustom, "txtFPScustom", 102, K::Text, &R::txtFPScustom),
    flag(F::optNarrowNot, "optNarrowNot", 106, &R::optNarrowNot),
    flag(F::optNarrow1, "optNarrow1", 108, &R::optNarrow1),
    flag(F::optNarrow2, "optNarrow2", 110, &R::optNarrow2),
    flag(F::optCPDefault, "optCPDefault", 112, &R::optCPDefault),
    flag(F::optCPNTSC, "optCPNTSC", 114, &R::optCPNTSC),
    flag(F::optCPPAL, "optCPPAL", 116, &R::optCPPAL),
    flag(F::optCPSECAM, "optCPSECAM", 118, &R::optCPSECAM),
    single(F::BarColorPhos, "BarColorPhos", 120, K::Slider, &R::BarColorPhos),
    check(F::chkScanLines, "chkScanLines", 124, &R::chkScanLines),
    single(F::txtScanLines, "txtScanLines", 126, K::Text, &R::txtScanLines),
    check(F::chkMouseCapture, "chkMouseCapture", 130, &R::chkMouseCapture),
    check(F::chkShowScanline, "chkShowScanline", 132, &R::chkShowScanline),
    check(F::chkCodeTrace, "chkCodeTrace", 134, &R::chkCodeTrace),
    check(F::chkPrintChecksum, "chkPrintChecksum", 136, &R::chkPrintChecksum),
    check(F::chkFastCopy, "chkFastCopy", 138, &R::chkFastCopy),
    check(F::chkAllow4, "chkAllow4", 140, &R::chkAllow4),
    listIndex(F::comboGT, "comboGT", 142, L::GameType, &R::comboGT),
    check(F::chkLineScan, "chkLineScan", 144, &R::chkLineScan),
    single(F::txtLineScan, "txtLineScan", 146, K::Text, &R::txtLineScan),
}};

constexpr bool slotsInLoadOrder() {
    for (int i = 0; i < kConfigFieldCount; ++i)
        if (static_cast<int>(kSlots[i].info.field) != i)
            return false;
    return true;
}
static_assert(slotsInLoadOrder(), "the table must list every field once, in load order");

constexpr int widthOf(K kind) {
    return kind == K::Text || kind == K::Slider || kind == K::SoundQueue ? 4 : 2;
}

constexpr bool slotsFitTheRecord() {
    for (const Slot& s : kSlots)
        if (s.info.offset < 0 || s.info.offset + widthOf(s.info.kind) > R::kSize)
            return false;
    return true;
}
static_assert(slotsFitTheRecord());

const Slot& slotOf(F field) {
    return kSlots[static_cast<std::size_t>(field)];
}

bool* flagRef(R& record, const Slot& s) {
    if (s.flag)
        return &(record.*s.flag);
    if (s.flags)
        return &(record.*s.flags)[static_cast<std::size_t>(s.info.element)];
    return nullptr;
}

bool flagValue(const R& record, const Slot& s) {
    if (s.flag)
        return record.*s.flag;
    if (s.flags)
        return (record.*s.flags)[static_cast<std::size_t>(s.info.element)];
    return false;
}

// Round half to even, as the window's whole-number properties take a value; empty when
// the result is not a 32-bit integer.
std::optional<int> roundToInt(double value) {
    if (!std::isfinite(value))
        return std::nullopt;
    const double r = std::nearbyint(value);
    if (r < std::numeric_limits<int>::min() || r > std::numeric_limits<int>::max())
        return std::nullopt;
    return static_cast<int>(r);
}

int listCount(L list, const ConfigLimits& limits) {
    switch (list) {
    case L::VideoMode:
        return limits.videoModes;
    case L::Controller:
        return limits.controllers;
    case L::GameType:
        return limits.gameTypes;
    case L::None:
        break;
    }
    return 0;
}

} // namespace

const std::array<ConfigFieldInfo, kConfigFieldCount>& configFields() {
    static const std::array<ConfigFieldInfo, kConfigFieldCount> infos = [] {
        std::array<ConfigFieldInfo, kConfigFieldCount> out{};
        for (std::size_t i = 0; i < out.size(); ++i)
            out[i] = kSlots[i].info;
        return out;
    }();
    return infos;
}

const ConfigFieldInfo& configFieldInfo(ConfigField field) {
    return slotOf(field).info;
}

qint16 configInt(const ConfigRecord& record, ConfigField field) {
    const Slot& s = slotOf(field);
    return s.i16 ? record.*s.i16 : qint16(0);
}

void setConfigInt(ConfigRecord& record, ConfigField field, qint16 value) {
    const Slot& s = slotOf(field);
    if (s.i16)
        record.*s.i16 = value;
}

bool configFlag(const ConfigRecord& record, ConfigField field) {
    return flagValue(record, slotOf(field));
}

void setConfigFlag(ConfigRecord& record, ConfigField field, bool value) {
    if (bool* b = flagRef(record, slotOf(field)))
        *b = value;
}

float configSingle(const ConfigRecord& record, ConfigField field) {
    const Slot& s = slotOf(field);
    return s.single ? record.*s.single : 0.0f;
}

void setConfigSingle(ConfigRecord& record, ConfigField field, float value) {
    const Slot& s = slotOf(field);
    if (s.single)
        record.*s.single = value;
}

QByteArray ConfigRecord::encode() const {
    // Cleared first, so the reserved areas are zeros whatever a file held before.
    QByteArray out(kSize, '\0');
    auto* bytes = reinterpret_cast<uchar*>(out.data());
    for (const Slot& s : kSlots) {
        uchar* at = bytes + s.info.offset;
        switch (s.info.kind) {
        case K::ListIndex:
        case K::Check:
            qToLittleEndian<qint16>(this->*s.i16, at);
            break;
        case K::Flag:
            qToLittleEndian<qint16>(flagValue(*this, s) ? qint16(-1) : qint16(0), at);
            break;
        case K::Text:
        case K::Slider:
        case K::SoundQueue: {
            quint32 bits = 0;
            const float value = this->*s.single;
            std::memcpy(&bits, &value, sizeof bits);
            qToLittleEndian<quint32>(bits, at);
            break;
        }
        }
    }
    return out;
}

std::optional<SoundQueueScale> soundQueueScaleFor(float stored) {
    if (!std::isfinite(stored))
        return std::nullopt;
    const QString text = shortestDecimalText(stored);
    // The hundreds: the text without its last two characters, which must be a number in
    // its own right. An empty remainder counts as 0, also for a single digit: the slider
    // can hold one and the window's own save writes it, so a load must take it back.
    const QString head = text.size() > 2 ? text.chopped(2) : QString();
    double hundreds = 0;
    if (!head.isEmpty()) {
        const std::optional<double> whole = wholeDecimalNumber(head);
        if (!whole)
            return std::nullopt;
        hundreds = *whole;
    }
    const std::optional<int> min = roundToInt((hundreds - 1) * 100);
    const std::optional<int> max = roundToInt((hundreds + 1) * 100);
    const std::optional<int> value = roundToInt(stored);
    // A value with a fraction ("3839.625") has hundreds that do not frame it: the slider
    // would refuse a value outside its range.
    if (!min || !max || !value || *value < *min || *value > *max)
        return std::nullopt;
    return SoundQueueScale{*min, *max, *value};
}

std::optional<int> sliderValueFor(float stored) {
    return roundToInt(stored);
}

bool configFieldAcceptable(const ConfigRecord& record, ConfigField field,
                           const ConfigLimits& limits) {
    const Slot& s = slotOf(field);
    switch (s.info.kind) {
    case K::ListIndex: {
        const qint16 index = record.*s.i16;
        return index >= -1 && index < listCount(s.info.list, limits);
    }
    case K::Check: {
        const qint16 state = record.*s.i16;
        return state >= 0 && state <= 2;
    }
    case K::Flag:
        return true;
    case K::Text:
        return std::isfinite(record.*s.single);
    case K::Slider:
        return sliderValueFor(record.*s.single).has_value();
    case K::SoundQueue:
        return soundQueueScaleFor(record.*s.single).has_value();
    }
    return false;
}

ConfigDecode decodeConfig(QByteArrayView data, const ConfigLimits& limits) {
    ConfigDecode result;
    if (data.size() < ConfigRecord::kSize) {
        // A short file is not an option set: nothing of it is applied.
        result.status = ConfigStatus::Short;
        result.firstBad = ConfigField::comboVideoMode;
        return result;
    }
    const auto* bytes = reinterpret_cast<const uchar*>(data.data());
    ConfigRecord& r = result.record;
    for (const Slot& s : kSlots) {
        const uchar* at = bytes + s.info.offset;
        switch (s.info.kind) {
        case K::ListIndex:
        case K::Check:
            r.*s.i16 = qFromLittleEndian<qint16>(at);
            break;
        case K::Flag:
            // Any non-zero value selects the button.
            *flagRef(r, s) = qFromLittleEndian<qint16>(at) != 0;
            break;
        case K::Text:
        case K::Slider:
        case K::SoundQueue: {
            const quint32 bits = qFromLittleEndian<quint32>(at);
            float value = 0;
            std::memcpy(&value, &bits, sizeof value);
            r.*s.single = value;
            break;
        }
        }
    }
    for (const Slot& s : kSlots) {
        if (!configFieldAcceptable(r, s.info.field, limits)) {
            result.status = ConfigStatus::Invalid;
            result.firstBad = s.info.field;
            break;
        }
    }
    return result;
}
