#include "emulator/EmulatorOptions.h"

#include <initializer_list>
#include <type_traits>

namespace {

using O = EmulatorOptions;
using K = OptionKind;

template <auto Member> int getMember(const O& options) {
    return static_cast<int>(options.*Member);
}

template <auto Member> void setMember(O& options, int value) {
    using T = std::remove_reference_t<decltype(options.*Member)>;
    options.*Member = static_cast<T>(value);
}

template <auto Member>
constexpr OptionRow row(K kind, std::initializer_list<OptionSlot> slotList, int entries,
                        int initial) {
    OptionRow r{kind, {}, 0, entries, &getMember<Member>, &setMember<Member>, nullptr, initial, ""};
    for (const OptionSlot& slot : slotList)
        r.slotList[static_cast<std::size_t>(r.slotCount++)] = slot;
    return r;
}

template <auto Member> constexpr OptionRow list(int offset, const char* control, int entries) {
    return row<Member>(K::List, {{offset, control}}, entries, 0);
}

template <auto Member>
constexpr OptionRow check(int offset, const char* control, Check initial = Check::Off) {
    return row<Member>(K::Check, {{offset, control}}, 0, static_cast<int>(initial));
}

// The buttons in the order of the member's values; the initial value is also what a set
// that selects none of them shows, as a group of option buttons always has one selected.
template <auto Member>
constexpr OptionRow choice(std::initializer_list<OptionSlot> buttons, auto initial) {
    return row<Member>(K::Choice, buttons, 0, static_cast<int>(initial));
}

template <auto Member>
constexpr OptionRow slider(K kind, int offset, const char* control, int initial) {
    return row<Member>(kind, {{offset, control}}, 0, initial);
}

constexpr OptionRow number(QString O::*member, int offset, const char* control,
                           const char* initial) {
    return {K::Number, {{{offset, control}}}, 1, 0, nullptr, nullptr, member, 0, initial};
}

// "Paddle 0" to "Paddle 3" at four flags in a row, and the frame's "None", which is not kept:
// four clear flags mean it.
template <auto Member>
constexpr OptionRow paddles(int offset, const char* p0, const char* p1, const char* p2,
                            const char* p3, const char* none) {
    return row<Member>(
        K::Choice, {{offset, p0}, {offset + 2, p1}, {offset + 4, p2}, {offset + 6, p3}, {-1, none}},
        0, static_cast<int>(Paddle::None));
}

// clang-format off
constexpr std::array<OptionRow, kOptionCount> kTable = {{
    list<&O::videoMode>(0, "comboVideoMode", int(kVideoModeEntries.size())),
    choice<&O::videoStart>({{2, "optVMDefault"}, {4, "optVMFull"}, {6, "optVMWindow"}},
                           VideoStart::Default),
    choice<&O::dsp>({{8, "optDSPDefault"}, {10, "optDSPLow"}, {12, "optDSPHigh"}},
                    DspLevel::Default),
    check<&O::player0Hard>(14, "chkP0Hard"),
    check<&O::player1Hard>(16, "chkP1Hard"),
    check<&O::blackAndWhite>(18, "chkBW"),
    choice<&O::screenCapture>({{20, "optSCPCX"}, {22, "optSCBMP"}}, CaptureFormat::Pcx),
    list<&O::leftController>(152, "comboLeftController", int(kControllerEntries.size())),
    list<&O::rightController>(154, "comboRightController", int(kControllerEntries.size())),
    check<&O::inactiveKeyboard>(156, "chkIPCKeyboard"),
    check<&O::inactiveMouse>(158, "chkIPCMouse"),
    check<&O::inactiveJoystick>(160, "chkIPCJoystick"),
    check<&O::inactiveStelladaptor>(162, "chkIPCStella"),
    // The sensitivity has no default of its own; a bar starts in the middle of 1..15.
    slider<&O::paddleSensitivity>(K::Slider, 60, "BarColorPaddle", 8),
    check<&O::lightGun>(42, nullptr),
    number(&O::lightGunCycles, 44, "txtLightGunCycles", "0"),
    number(&O::lightGunScanlines, 48, "txtLightGunScan", "0"),
    check<&O::swapPorts>(164, "chkSwapControl"),
    check<&O::quiet>(52, "chkQuiet"),
    slider<&O::soundQueue>(K::SoundQueue, 54, "BarColorSoundQueue", kSoundQueueDefault),
    check<&O::lowerSensitivity>(166, "chkLowerSens"),
    number(&O::lowerSensitivityBy, 168, "txtLowerSens", "1"),
    paddles<&O::keyboardPaddle>(68, nullptr, nullptr, nullptr, nullptr, nullptr),
    paddles<&O::mousePaddle1>(76, "optPaddleM1_0", "optPaddleM1_1", "optPaddleM1_2",
                              "optPaddleM1_3", "optPaddleM1None"),
    paddles<&O::mousePaddle2>(84, "optPaddleM2_0", "optPaddleM2_1", "optPaddleM2_2",
                              "optPaddleM2_3", "optPaddleM2None"),
    check<&O::palColorLoss>(92, "chkPALColorLoss"),
    check<&O::interlaced>(94, "chkInterlaced"),
    check<&O::syncWithSound>(150, "chkSyncWSound"),
    choice<&O::frameRate>({{96, "optFPSDefault"}, {98, "optFPSmonitor"}, {100, "optFPScustom"}},
                          FrameRate::Default),
    number(&O::customFrameRate, 102, "txtFPScustom", ""),
    choice<&O::narrow>({{106, "optNarrowNot"}, {108, "optNarrow1"}, {110, "optNarrow2"}},
                       NarrowMode::Off),
    choice<&O::palette>({{112, "optCPDefault"}, {114, "optCPNTSC"}, {116, "optCPPAL"},
                         {118, "optCPSECAM"}}, Palette::Default),
    slider<&O::phosphor>(K::Slider, 120, "BarColorPhos", kPhosphorDefault),
    check<&O::scanLineLimit>(124, "chkScanLines"),
    number(&O::scanLines, 126, "txtScanLines", "0"),
    check<&O::mouseCapture>(130, "chkMouseCapture", Check::On),
    check<&O::showScanline>(132, "chkShowScanline"),
    check<&O::codeTrace>(134, "chkCodeTrace"),
    check<&O::printChecksum>(136, "chkPrintChecksum"),
    check<&O::noFastCopy>(138, "chkFastCopy"),
    check<&O::allow4Directions>(140, "chkAllow4"),
    list<&O::gameType>(142, "comboGT", int(kGameTypeEntries.size())),
    check<&O::startLineEnabled>(144, "chkLineScan"),
    number(&O::startLine, 146, "txtLineScan", "0"),
}};
// clang-format on

constexpr int widthOf(K kind) {
    return kind == K::Number || kind == K::Slider || kind == K::SoundQueue ? 4 : 2;
}

// Every kept flag or value lies inside the record, and no two overlap.
constexpr bool slotsFitAndDoNotOverlap() {
    std::array<bool, kOptionSetSize> used{};
    for (const OptionRow& r : kTable) {
        for (int i = 0; i < r.slotCount; ++i) {
            const int offset = r.slotList[static_cast<std::size_t>(i)].offset;
            if (offset < 0)
                continue;
            if (offset + widthOf(r.kind) > kOptionSetSize)
                return false;
            for (int b = offset; b < offset + widthOf(r.kind); ++b) {
                if (used[static_cast<std::size_t>(b)])
                    return false;
                used[static_cast<std::size_t>(b)] = true;
            }
        }
    }
    return true;
}
static_assert(slotsFitAndDoNotOverlap());

} // namespace

const std::array<OptionRow, kOptionCount>& optionTable() {
    return kTable;
}

EmulatorOptions::EmulatorOptions() {
    for (const OptionRow& r : kTable) {
        if (r.kind == K::Number)
            this->*r.text = QLatin1String(r.initialText);
        else
            r.set(*this, r.initial);
    }
}
