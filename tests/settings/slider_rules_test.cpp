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

Scale pressAll(Scale scale, const std::string& keys) {
    for (const char key : keys)
        scale = sliders::ShiftSoundQueue(scale, key);
    return scale;
}

TEST(SliderRules, SoundQueueDefaultWindow) {
    EXPECT_EQ(sliders::SoundQueueDefault(), (Scale{4500, 4700, 4608}));
}

TEST(SliderRules, SoundQueueShiftSequences) {
    constexpr int kIntMin = std::numeric_limits<int>::min();
    constexpr int kIntMax = std::numeric_limits<int>::max();
    const std::string manyUps(700, '+');
    const std::string manyDowns(700, '-');
    struct Case {
        const char* what;
        Scale start;
        std::string keys;
        Scale expected;
    };
    const Case cases[] = {
        {"up moves the window, not a value inside it", {4500, 4700, 4608}, "+", {4600, 4800, 4608}},
        {"up twice leaves the value behind", {4500, 4700, 4608}, "++", {4700, 4900, 4705}},
        {"down leaves the value above", {4500, 4700, 4608}, "-", {4400, 4600, 4595}},
        {"down twice follows the top edge", {4500, 4700, 4608}, "--", {4300, 4500, 4495}},
        {"down then up", {4500, 4700, 4608}, "-+", {4500, 4700, 4595}},
        {"other keys shift nothing", {4500, 4700, 4608}, "a0 =\r", {4500, 4700, 4608}},
        {"the top window is 197 wide", {4500, 4700, 4608}, manyUps, {65339, 65536, 65344}},
        {"the bottom window is 1..201", {4500, 4700, 4608}, manyDowns, {1, 201, 196}},
        {"up at the top keeps the value", {65339, 65536, 65400}, "+", {65339, 65536, 65400}},
        {"down at the bottom keeps the value", {1, 201, 150}, "-", {1, 201, 150}},
        {"partial step up to the top", {65300, 65500, 65310}, "+", {65339, 65536, 65344}},
        {"partial step down to the bottom", {50, 250, 240}, "-", {1, 201, 196}},
        {"any key brings a high value into the scale",
         {65339, 65536, 70000},
         "x",
         {65339, 65536, 65536}},
        {"any key brings a low value into the scale", {1, 201, -3}, "x", {1, 201, 1}},
        {"any key mends a window below the scale", {-100, 100, 0}, "x", {1, 201, 1}},
        {"any key mends a window above the scale",
         {65500, 65700, 65600},
         "x",
         {65339, 65536, 65536}},
        {"no overflow stepping up from the top of int",
         {kIntMax - 200, kIntMax, kIntMax},
         "+",
         {65339, 65536, 65536}},
        {"no overflow stepping down from the bottom of int",
         {kIntMin, kIntMin + 200, kIntMin},
         "-",
         {1, 201, 1}},
    };
    for (const Case& c : cases)
        EXPECT_EQ(pressAll(c.start, c.keys), c.expected) << c.what;
}

TEST(SliderRules, SoundQueueWindowAlwaysHoldsTheValueAfterShifts) {
    // Wander up and down across both ends: every shift leaves a window of the scale with
    // the value inside it.
    Scale scale = sliders::SoundQueueDefault();
    const std::string walk = std::string(40, '-') + std::string(300, '+') + "+-+-" +
                             std::string(700, '+') + std::string(650, '-');
    for (const char key : walk) {
        scale = sliders::ShiftSoundQueue(scale, key);
        ASSERT_GE(scale.min, 1);
        ASSERT_LE(scale.max, 65536);
        ASSERT_LE(scale.min, scale.value);
        ASSERT_LE(scale.value, scale.max);
    }
}

TEST(SliderRules, ThousandsGrouping) {
    struct Case {
        qint64 value;
        const char16_t* separator;
        const char16_t* expected;
    };
    const Case cases[] = {
        {0, u",", u"0"},
        {7, u",", u"7"},
        {999, u",", u"999"},
        {1000, u",", u"1,000"},
        {4608, u",", u"4,608"},
        {65536, u",", u"65,536"},
        {100000, u",", u"100,000"},
        {1234567, u",", u"1,234,567"},
        {-100, u",", u"-100"},
        {-4608, u",", u"-4,608"},
        {std::numeric_limits<qint64>::min(), u",", u"-9,223,372,036,854,775,808"},
        {4608, u".", u"4.608"},
        {1234567, u"\u202F", u"1\u202F234\u202F567"},
        {4608, u"", u"4608"},
    };
    for (const Case& c : cases)
        EXPECT_EQ(sliders::FormatThousands(c.value, QString::fromUtf16(c.separator)),
                  QString::fromUtf16(c.expected))
            << c.value;
}

TEST(SliderRules, BarTexts) {
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::English, QLocale::UnitedStates)),
              "4,608");
    EXPECT_EQ(sliders::SoundQueueText(65536, QLocale(QLocale::German, QLocale::Germany)), "65.536");
    // Always grouped, even where the locale would leave a four-digit number alone.
    EXPECT_EQ(sliders::SoundQueueText(4608, QLocale(QLocale::Spanish, QLocale::Spain)), "4.608");
    EXPECT_EQ(sliders::PlainText(4608), "4608");
    EXPECT_EQ(sliders::PlainText(77), "77");
}

} // namespace
