// The 172-byte option record as a .lum file may hold it: any bytes, decoded against the
// settings window's real list sizes.
#include "FuzzSupport.h"

#include "emulator/ConfigRecord.h"
#include "emulator/LeadingNumber.h"
#include "settings/OptionLists.h"

namespace {

const ConfigLimits kLimits{int(kVideoModeEntries.size()), int(kControllerEntries.size()),
                           int(kGameTypeEntries.size())};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QByteArray bytes = fuzz::bytes(data, size);
    const ConfigDecode decoded = decodeConfig(bytes, kLimits);

    if (bytes.size() < ConfigRecord::kSize) {
        FUZZ_CHECK(decoded.status == ConfigStatus::Short && decoded.applicableCount() == 0);
        return 0;
    }
    FUZZ_CHECK(decoded.status == ConfigStatus::Ok || decoded.status == ConfigStatus::Invalid);
    FUZZ_CHECK(decoded.ok() == !decoded.firstBad.has_value());

    // Every field a load applies is one the window accepts; the first one it stops at is
    // not.
    const int applied = decoded.applicableCount();
    FUZZ_CHECK(applied >= 0 && applied <= kConfigFieldCount);
    for (int i = 0; i < applied; ++i)
        FUZZ_CHECK(configFieldAcceptable(decoded.record, ConfigField(i), kLimits));
    if (decoded.firstBad)
        FUZZ_CHECK(!configFieldAcceptable(decoded.record, *decoded.firstBad, kLimits));

    // What the window shows of each applied value.
    for (int i = 0; i < applied; ++i) {
        const ConfigFieldInfo& info = configFieldInfo(ConfigField(i));
        const float single = configSingle(decoded.record, info.field);
        switch (info.kind) {
        case ConfigFieldKind::Text: {
            // The text a load writes reads back, by the field's own parse, as the value.
            const QString text = shortestDecimalText(single);
            FUZZ_CHECK(leadingSingle(text) == single);
            break;
        }
        case ConfigFieldKind::Slider:
            FUZZ_CHECK(sliderValueFor(single).has_value());
            break;
        case ConfigFieldKind::SoundQueue: {
            const std::optional<SoundQueueScale> scale = soundQueueScaleFor(single);
            FUZZ_CHECK(scale && scale->min <= scale->value && scale->value <= scale->max);
            break;
        }
        default:
            break;
        }
    }

    // A valid record saves to bytes that load as the same record: the save loses nothing
    // a load accepted.
    if (decoded.ok()) {
        const QByteArray saved = decoded.record.encode();
        FUZZ_CHECK(saved.size() == ConfigRecord::kSize);
        const ConfigDecode again = decodeConfig(saved, kLimits);
        FUZZ_CHECK(again.ok() && again.record == decoded.record);
        FUZZ_CHECK(again.record.encode() == saved);

        // The window holds its sliders as whole numbers; what it saves then loads too.
        ConfigRecord held = decoded.record;
        for (const ConfigFieldInfo& info : configFields())
            if (info.kind == ConfigFieldKind::Slider || info.kind == ConfigFieldKind::SoundQueue)
                setConfigSingle(
                    held, info.field,
                    static_cast<float>(*sliderValueFor(configSingle(held, info.field))));
        FUZZ_CHECK(decodeConfig(held.encode(), kLimits).ok());
    }
    return 0;
}
