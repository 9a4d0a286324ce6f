#include "emulator/LeadingNumber.h"
#include "emulator/OptionFile.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

TEST(LeadingNumber, TakesTheLongestDecimalPrefixAfterBlanks) {
    const std::pair<const char*, double> cases[] = {
        {"12abc", 12},   {"abc", 0},   {"", 0},       {"   42", 42}, {"\t 7 fps", 7},
        {"-3.5x", -3.5}, {"+8", 8},    {".5", 0.5},   {"5.", 5},     {"1.2.3", 1.2},
        {"12e", 12},     {"12e+", 12}, {"1e3", 1000}, {"2E-1", 0.2}, {"-", 0},
        {".", 0},        {"-.", 0},    {"- 5", 0},    {"1 2", 1},    {"0x10", 0},
        {"1e-999", 0},   {"007", 7},   {"60,5", 60},  {"inf", 0},    {"nan", 0},
    };
    for (const auto& [text, value] : cases)
        EXPECT_DOUBLE_EQ(leadingNumber(QString::fromLatin1(text)), value) << text;
    EXPECT_TRUE(std::isinf(leadingNumber(u"1e999")));
}

TEST(LeadingNumber, SinglesStayFiniteSoEveryTextCanBeSaved) {
    EXPECT_EQ(leadingSingle(u"1e999"), std::numeric_limits<float>::max());
    EXPECT_EQ(leadingSingle(u"-1e39"), std::numeric_limits<float>::lowest());
    EXPECT_EQ(leadingSingle(u"12abc"), 12.0f);
}

TEST(ShortestDecimalText, WritesTheShortestTextThatReadsBack) {
    const std::pair<float, const char*> cases[] = {
        {0.0f, "0"},     {-0.0f, "0"},       {1.5f, "1.5"},     {12.0f, "12"},    {0.1f, "0.1"},
        {-2.5f, "-2.5"}, {1e7f, "10000000"}, {0.001f, "0.001"}, {1e20f, "1e+20"}, {1e-6f, "1e-06"},
    };
    for (const auto& [value, text] : cases)
        EXPECT_EQ(shortestDecimalText(value), QLatin1String(text)) << value;
    EXPECT_EQ(shortestDecimalText(std::numeric_limits<float>::quiet_NaN()), "0");

    // What a load writes into a text field, a later save reads back unchanged.
    for (float v : {1.0f / 3, 123456.789f, -7.25e-3f, std::numeric_limits<float>::max(),
                    std::numeric_limits<float>::lowest(), std::numeric_limits<float>::denorm_min(),
                    16777217.0f})
        EXPECT_EQ(leadingSingle(shortestDecimalText(v)), v) << v;
}

TEST(LumExtension, AppendedUnlessTheLastFourCharactersAreDotLum) {
    for (const char* kept : {"/tmp/NAME.LUM", "/opt/a.Lum"})
        EXPECT_EQ(withLumExtension(QString::fromLatin1(kept)), QLatin1String(kept));
    for (const char* bare : {"name", "x.lum.bak", "a.txt", "lum", "/sets/my lum"})
        EXPECT_EQ(withLumExtension(QString::fromLatin1(bare)), QLatin1String(bare) + ".lum");
}
