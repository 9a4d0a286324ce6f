#include "support/QtPrinters.h"

#include "settings/SliderRules.h"

#include <gtest/gtest.h>

#include <limits>

using sliders::Scale;

namespace sliders {
void PrintTo(const Scale& s, std::ostream* os) {
    *os << s.min << ".." << s.max << " at " << s.value;
}
} // namespace sliders

namespace {

TEST(SliderRules, SoundQueueShiftSequences) {
    constexpr int kIntMin = std::numeric_limits<int>::min();
    constexpr int kIntMax = std::numeric_limits<int>::max();
    const Scale start = sliders::SoundQueueDefault();
    EXPECT_EQ(start, (Scale{4500, 4700, 4608}));
    const struct {
        const char* what;
        Scale start;
        std::string keys;
        Scale expected;
    } cases[] = {
        {"up moves the window, not a value inside it", start, "+", {4600, 4800, 4608}},
        {"up twice leaves the value behind", start, "++", {4700, 4900, 4705}},
        {"down leaves the value above", start, "-", {4400, 4600, 4595}},
        {"down then up", start, "-+", {4500, 4700, 4595}},
        {"other keys shift nothing", start, "a0 =\r", {4500, 4700, 4608}},
        {"the top window is 197 wide", start, std::string(700, '+'), {65339, 65536, 65344}},
        {"the bottom window is 1..201", start, std::string(700, '-'), {1, 201, 196}},
        {"up at the top keeps the value", {65339, 65536, 65400}, "+", {65339, 65536, 65400}},
        {"down at the bottom keeps the value", {1, 201, 150}, "-", {1, 201, 150}},
        {"partial step up to the top", {65300, 65500, 65310}, "+", {65339, 65536, 65344}},
        {"any key brings a high value in", {65339, 65536, 70000}, "x", {65339, 65536, 65536}},
        {"any key brings a low value in", {1, 201, -3}, "x", {1, 201, 1}},
        {"any key mends a window below", {-100, 100, 0}, "x", {1, 201, 1}},
        {"no overflow up from the top of int",
         {kIntMax - 200, kIntMax, kIntMax},
         "+",
         {65339, 65536, 65536}},
        {"no overflow down from the bottom of int",
         {kIntMin, kIntMin + 200, kIntMin},
         "-",
         {1, 201, 1}},
    };
    for (const auto& c : cases) {
        Scale scale = c.start;
        for (const char key : c.keys)
            scale = sliders::ShiftSoundQueue(scale, key);
        EXPECT_EQ(scale, c.expected) << c.what;
    }

    // Wander up and down across both ends: every shift leaves a window of the scale with
    // the value inside it.
    Scale scale = start;
    for (const char key :
         std::string(40, '-') + std::string(700, '+') + "+-+-" + std::string(650, '-')) {
        scale = sliders::ShiftSoundQueue(scale, key);
        ASSERT_TRUE(1 <= scale.min && scale.min <= scale.value && scale.value <= scale.max &&
                    scale.max <= 65536)
            << scale.min << ".." << scale.max << " at " << scale.value;
    }
}

TEST(SliderRules, BarTexts) {
    const std::tuple<qint64, const char16_t*, const char16_t*> grouped[] = {
        {999, u",", u"999"},
        {1000, u",", u"1,000"},
        {1234567, u",", u"1,234,567"},
        {-4608, u",", u"-4,608"},
        {std::numeric_limits<qint64>::min(), u",", u"-9,223,372,036,854,775,808"},
        {1234567, u"\u202F", u"1\u202F234\u202F567"},
        {4608, u"", u"4608"},
    };
    for (const auto& [value, separator, expected] : grouped)
        EXPECT_EQ(sliders::FormatThousands(value, QString::fromUtf16(separator)),
                  QString::fromUtf16(expected))
            << value;
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::English, QLocale::UnitedStates)),
              "4,608");
    EXPECT_EQ(sliders::SoundQueueText(65536, QLocale(QLocale::German, QLocale::Germany)), "65.536");
    // Always grouped, even where the locale would leave a four-digit number alone.
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::Spanish, QLocale::Spain)), "4.608");
    EXPECT_EQ(sliders::PlainText(4608), "4608");
}

} // namespace
