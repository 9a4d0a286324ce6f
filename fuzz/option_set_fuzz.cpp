// The 172-byte option set as a .lum file may hold it: any bytes, applied to the options a
// window starts with.
#include "FuzzSupport.h"

#include "emulator/LeadingNumber.h"
#include "emulator/OptionFile.h"
#include "emulator/Switches.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QByteArray bytes = fuzz::bytes(data, size);
    const EmulatorOptions start;
    const OptionSetRead read = decodeOptions(bytes, start);

    if (bytes.size() < kOptionSetSize) {
        FUZZ_CHECK(read.status == OptionSetRead::Status::Short && read.options == start);
        return 0;
    }
    FUZZ_CHECK(read.ok() == (read.firstBad < 0));
    FUZZ_CHECK(read.firstBad < kOptionCount);

    // What a load took, a window shows: numbers as texts that read back as themselves, and
    // a sound queue inside the scale its value makes.
    for (const OptionRow& row : optionTable())
        if (row.kind == OptionKind::Number) {
            const float value = leadingSingle(read.options.*row.text);
            FUZZ_CHECK(shortestDecimalText(value) == read.options.*row.text ||
                       read.options.*row.text == start.*row.text);
        }
    const std::optional<SliderScale> scale =
        soundQueueScaleFor(static_cast<float>(read.options.soundQueue));
    FUZZ_CHECK(scale && scale->min <= scale->value && scale->value <= scale->max);

    // Whatever a load took, a save gives back: the saved set loads whole and saves the same.
    const QByteArray saved = encodeOptions(read.options);
    FUZZ_CHECK(saved.size() == kOptionSetSize);
    const OptionSetRead again = decodeOptions(saved, start);
    FUZZ_CHECK(again.ok());
    FUZZ_CHECK(encodeOptions(again.options) == saved);
    if (read.ok())
        FUZZ_CHECK(launchSwitches(again.options) == launchSwitches(read.options));
    return 0;
}
