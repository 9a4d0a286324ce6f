#include "emulator/ConfigRecord.h"

#include <QtEndian>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <set>
#include <vector>

namespace {

const ConfigLimits kLimits{9, 13, 14};

// A record where every field holds a value that differs from its neighbours'.
ConfigRecord knownRecord() {
    ConfigRecord r;
    r.comboVideoMode = 3;
    r.optVMFull = true;
    r.optDSPHigh = true;
    r.chkP0Hard = 1;
    r.chkP1Hard = 2;
    r.chkBW = 0;
    r.optSCBMP = true;
    r.chkLightGun = 1;
    r.txtLightGunCycles = 1.5f;
    r.txtLightGunScan = -2.5f;
    r.chkQuiet = 1;
    r.BarColorSoundQueue = 4608;
    r.BarColorPaddle = 8;
    r.optPaddleKey = {false, true, false, false};
    r.optPaddleM1 = {true, false, false, false};
    r.optPaddleM2 = {false, false, false, true};
    r.chkPALColorLoss = 1;
    r.chkInterlaced = 2;
    r.optFPScustom = true;
    r.txtFPScustom = 60;
    r.optNarrow2 = true;
    r.optCPSECAM = true;
    r.BarColorPhos = 77;
    r.chkScanLines = 1;
    r.txtScanLines = 262;
    r.chkMouseCapture = 1;
    r.chkShowScanline = 2;
    r.chkCodeTrace = 1;
    r.chkPrintChecksum = 2;
    r.chkFastCopy = 1;
    r.chkAllow4 = 2;
    r.comboGT = 13;
    r.chkLineScan = 1;
    r.txtLineScan = 30;
    r.chkSyncWSound = 1;
    r.comboLeftController = 2;
    r.comboRightController = -1;
    r.chkIPCKeyboard = 1;
    r.chkIPCMouse = 2;
    r.chkIPCJoystick = 1;
    r.chkIPCStella = 2;
    r.chkSwapControl = 1;
    r.chkLowerSens = 1;
    r.txtLowerSens = 0.25f;
    return r;
}

struct Expect {
    int offset;
    std::vector<unsigned char> bytes;
};

// The file layout, written out by hand: offset and little-endian bytes of each field of
// knownRecord(). Singles as IEEE bits: 1.5 = 3FC00000, -2.5 = C0200000, 4608 = 45900000,
// 8 = 41000000, 60 = 42700000, 77 = 429A0000, 262 = 43830000, 30 = 41F00000,
// 0.25 = 3E800000.
// clang-format off
const std::vector<Expect> kKnownBytes = {
    {0, {3, 0}}, {2, {0, 0}}, {4, {0xFF, 0xFF}}, {6, {0, 0}}, {8, {0, 0}},
    {10, {0, 0}}, {12, {0xFF, 0xFF}}, {14, {1, 0}}, {16, {2, 0}}, {18, {0, 0}},
    {20, {0, 0}}, {22, {0xFF, 0xFF}}, {42, {1, 0}}, {44, {0, 0, 0xC0, 0x3F}},
    {48, {0, 0, 0x20, 0xC0}}, {52, {1, 0}}, {54, {0, 0, 0x90, 0x45}},
    {60, {0, 0, 0, 0x41}}, {68, {0, 0}}, {70, {0xFF, 0xFF}}, {72, {0, 0}},
    {74, {0, 0}}, {76, {0xFF, 0xFF}}, {78, {0, 0}}, {80, {0, 0}}, {82, {0, 0}},
    {84, {0, 0}}, {86, {0, 0}}, {88, {0, 0}}, {90, {0xFF, 0xFF}}, {92, {1, 0}},
    {94, {2, 0}}, {96, {0, 0}}, {98, {0, 0}}, {100, {0xFF, 0xFF}},
    {102, {0, 0, 0x70, 0x42}}, {106, {0, 0}}, {108, {0, 0}}, {110, {0xFF, 0xFF}},
    {112, {0, 0}}, {114, {0, 0}}, {116, {0, 0}}, {118, {0xFF, 0xFF}},
    {120, {0, 0, 0x9A, 0x42}}, {124, {1, 0}}, {126, {0, 0, 0x83, 0x43}},
    {130, {1, 0}}, {132, {2, 0}}, {134, {1, 0}}, {136, {2, 0}}, {138, {1, 0}},
    {140, {2, 0}}, {142, {13, 0}}, {144, {1, 0}}, {146, {0, 0, 0xF0, 0x41}},
    {150, {1, 0}}, {152, {2, 0}}, {154, {0xFF, 0xFF}}, {156, {1, 0}}, {158, {2, 0}},
    {160, {1, 0}}, {162, {2, 0}}, {164, {1, 0}}, {166, {1, 0}},
    {168, {0, 0, 0x80, 0x3E}},
};
// clang-format on

bool inReservedArea(int offset) {
    return (offset >= 24 && offset < 42) || (offset >= 58 && offset < 60) ||
           (offset >= 64 && offset < 68);
}

void putInt16(QByteArray& data, int offset, qint16 value) {
    qToLittleEndian<qint16>(value, reinterpret_cast<uchar*>(data.data()) + offset);
}

void putSingle(QByteArray& data, int offset, float value) {
    qToLittleEndian<float>(value, reinterpret_cast<uchar*>(data.data()) + offset);
}

} // namespace

TEST(ConfigRecordEncode, EveryFieldLandsAtItsOffsetWithItsEncoding) {
    const QByteArray data = knownRecord().encode();
    ASSERT_EQ(data.size(), 172);

    std::set<int> covered;
    for (const Expect& e : kKnownBytes) {
        for (std::size_t i = 0; i < e.bytes.size(); ++i) {
            const int at = e.offset + static_cast<int>(i);
            EXPECT_EQ(static_cast<unsigned char>(data[at]), e.bytes[i]) << "byte " << at;
            EXPECT_TRUE(covered.insert(at).second) << "byte " << at << " described twice";
        }
    }
    // Every byte is either a field's or reserved, and the reserved ones are zero.
    for (int at = 0; at < 172; ++at) {
        EXPECT_NE(covered.count(at) == 1, inReservedArea(at)) << "byte " << at;
        if (inReservedArea(at)) {
            EXPECT_EQ(data[at], '\0') << "reserved byte " << at;
        }
    }
}

TEST(ConfigRecordEncode, FieldTableMatchesTheLayoutAndLoadOrder) {
    const auto& fields = configFields();
    ASSERT_EQ(fields.size(), std::size_t(65));
    EXPECT_STREQ(fields.front().control, "comboVideoMode");
    EXPECT_STREQ(fields.back().control, "txtLineScan");
    // The start-state check boxes follow the video mode and DSP flags, so a bad one
    // leaves exactly those seven applied.
    EXPECT_EQ(static_cast<int>(ConfigField::chkP0Hard), 7);
    EXPECT_EQ(configFieldInfo(ConfigField::chkP0Hard).offset, 14);
    EXPECT_EQ(configFieldInfo(ConfigField::optPaddleM2_3).offset, 90);
    EXPECT_STREQ(configFieldInfo(ConfigField::optPaddleM2_3).control, "optPaddleM2");
    EXPECT_EQ(configFieldInfo(ConfigField::optPaddleM2_3).element, 3);
}

// Reserved bytes are ignored on the way in and written back as zeros.
TEST(ConfigRecordDecode, RoundTripKeepsEveryFieldAndClearsTheReservedBytes) {
    QByteArray data = knownRecord().encode();
    for (int at = 0; at < 172; ++at)
        if (inReservedArea(at))
            data[at] = char(0xA5);
    const ConfigDecode decoded = decodeConfig(data, kLimits);
    ASSERT_TRUE(decoded.ok());
    EXPECT_EQ(decoded.applicableCount(), kConfigFieldCount);
    EXPECT_EQ(decoded.record, knownRecord());
    EXPECT_EQ(decoded.record.encode(), knownRecord().encode());

    // Every field through the generic accessors as well.
    ConfigRecord copy;
    for (const ConfigFieldInfo& f : configFields()) {
        switch (f.kind) {
        case ConfigFieldKind::ListIndex:
        case ConfigFieldKind::Check:
            setConfigInt(copy, f.field, configInt(knownRecord(), f.field));
            break;
        case ConfigFieldKind::Flag:
            setConfigFlag(copy, f.field, configFlag(knownRecord(), f.field));
            break;
        default:
            setConfigSingle(copy, f.field, configSingle(knownRecord(), f.field));
        }
    }
    EXPECT_EQ(copy, knownRecord());
}

TEST(ConfigRecordDecode, AnyNonZeroFlagSelectsAndFourZeroFlagsSelectNone) {
    ConfigRecord zeros;
    zeros.BarColorSoundQueue = 4608;
    QByteArray data = zeros.encode();
    putInt16(data, 2, 1);
    putInt16(data, 4, qint16(0x8000));
    putInt16(data, 70, 7);
    const ConfigDecode decoded = decodeConfig(data, kLimits);
    ASSERT_TRUE(decoded.ok());
    EXPECT_TRUE(decoded.record.optVMDefault);
    EXPECT_TRUE(decoded.record.optVMFull);
    EXPECT_EQ(decoded.record.optPaddleKey, (std::array<bool, 4>{false, true, false, false}));
    EXPECT_EQ(decoded.record.optPaddleM1, (std::array<bool, 4>{}));
    EXPECT_EQ(decoded.record.optPaddleM2, (std::array<bool, 4>{}));
    // Written back in the one form a selected button has.
    const QByteArray again = decoded.record.encode();
    EXPECT_EQ(again.mid(2, 4), QByteArray("\xFF\xFF\xFF\xFF", 4));
}

TEST(ConfigRecordDecode, ShortDataIsReportedAndNothingApplies) {
    const QByteArray full = knownRecord().encode();
    for (int size : {0, 1, 24, 171}) {
        const ConfigDecode decoded = decodeConfig(QByteArrayView(full).first(size), kLimits);
        EXPECT_EQ(decoded.status, ConfigStatus::Short) << size;
        EXPECT_EQ(decoded.applicableCount(), 0) << size;
    }
}

TEST(ConfigRecordDecode, TheFirstRejectedFieldInLoadOrderEndsTheLoad) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const float inf = std::numeric_limits<float>::infinity();
    const struct {
        const char* what;
        int offset;
        bool single;
        qint16 intValue;
        float singleValue;
        std::optional<ConfigField> firstBad;
    } cases[] = {
        {"check box of 3", 14, false, 3, 0, ConfigField::chkP0Hard},
        {"check box of -1", 140, false, -1, 0, ConfigField::chkAllow4},
        {"grayed check box", 164, false, 2, 0, std::nullopt},
        {"last video mode", 0, false, 8, 0, std::nullopt},
        {"video mode past the list", 0, false, 9, 0, ConfigField::comboVideoMode},
        {"no video mode selected", 0, false, -1, 0, std::nullopt},
        {"list index below -1", 152, false, -2, 0, ConfigField::comboLeftController},
        {"controller past the list", 154, false, 13, 0, ConfigField::comboRightController},
        {"game type past the list", 142, false, 14, 0, ConfigField::comboGT},
        {"text field not a number", 102, true, 0, nan, ConfigField::txtFPScustom},
        {"text field infinite", 168, true, 0, -inf, ConfigField::txtLowerSens},
        {"slider not a number", 120, true, 0, nan, ConfigField::BarColorPhos},
        {"slider beyond 32 bits", 60, true, 0, 3e9f, ConfigField::BarColorPaddle},
        {"sound queue outside its hundreds", 54, true, 0, 12.5f, ConfigField::BarColorSoundQueue},
    };
    for (const auto& c : cases) {
        QByteArray data = knownRecord().encode();
        if (c.single)
            putSingle(data, c.offset, c.singleValue);
        else
            putInt16(data, c.offset, c.intValue);
        const ConfigDecode decoded = decodeConfig(data, kLimits);
        EXPECT_EQ(decoded.firstBad, c.firstBad) << c.what;
        EXPECT_EQ(decoded.ok(), !c.firstBad) << c.what;
        if (c.firstBad) {
            EXPECT_EQ(decoded.status, ConfigStatus::Invalid) << c.what;
            EXPECT_EQ(decoded.applicableCount(), static_cast<int>(*c.firstBad)) << c.what;
        }
    }
}

TEST(ConfigRecordDecode, OnlyTheEarliestOfSeveralBadFieldsCounts) {
    QByteArray data = knownRecord().encode();
    putInt16(data, 144, 9);  // chkLineScan, applied last but one
    putInt16(data, 156, 42); // chkIPCKeyboard, applied early
    EXPECT_EQ(decodeConfig(data, kLimits).firstBad, ConfigField::chkIPCKeyboard);
}

TEST(SoundQueueScale, RangeIsCentredOnTheStoredHundreds) {
    const struct {
        float stored;
        std::optional<SoundQueueScale> scale;
    } cases[] = {
        {4608, SoundQueueScale{4500, 4700, 4608}},
        {50, SoundQueueScale{-100, 100, 50}},
        {150, SoundQueueScale{0, 200, 150}},
        {65536, SoundQueueScale{65400, 65600, 65536}},
        {-5, SoundQueueScale{-100, 100, -5}},
        // A fraction: the hundreds do not frame the value (12 lies outside 1100 to 1300).
        {12.5f, std::nullopt},
        {99.75f, std::nullopt},
        {3839.625f, std::nullopt},
        {0.5f, SoundQueueScale{-100, 100, 0}},
        {-0.75f, SoundQueueScale{-100, 100, -1}},
        {5, SoundQueueScale{-100, 100, 5}}, // one digit: what a save of the lowest window gives
        {0, SoundQueueScale{-100, 100, 0}},
        {1e12f, std::nullopt},
        {1e20f, std::nullopt},
        {std::numeric_limits<float>::quiet_NaN(), std::nullopt},
    };
    for (const auto& c : cases)
        EXPECT_EQ(soundQueueScaleFor(c.stored), c.scale) << c.stored;
}

TEST(SliderValue, RoundsHalvesToEvenWithinThirtyTwoBits) {
    EXPECT_EQ(sliderValueFor(7.5f), 8);
    EXPECT_EQ(sliderValueFor(8.5f), 8);
    EXPECT_EQ(sliderValueFor(-0.4f), 0);
    EXPECT_EQ(sliderValueFor(2147483520.0f), 2147483520);
    EXPECT_EQ(sliderValueFor(2147483648.0f), std::nullopt);
    EXPECT_EQ(sliderValueFor(std::numeric_limits<float>::infinity()), std::nullopt);
}
