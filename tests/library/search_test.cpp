#include "library/Search.h"

#include <gtest/gtest.h>

// A search text, a name it keeps and a name it drops (either may be absent).
TEST(SearchExpression, ExpressionTable) {
    const std::tuple<const char*, const char*, const char*> cases[] = {
        {"pac", "Pac-Man (1982).bin", "Kong.bin"},
        // A term is a substring matched without case; operators count only in capitals.
        {"pac AND man", "Pac-Man.bin", "Pacific.bin"},
        {"pac and man", "pac and man.bin", "Pac-Man.bin"},
        {"pac XOR man", "Pacific.bin", "Pac-Man.bin"},
        {"pac XOR man", nullptr, "Pitfall.bin"},
        {"pit OR kong", "Pitfall.bin", "Pac-Man.bin"},
        {"asteroids AND NOT [pal]", "Asteroids.bin", "Asteroids [PAL].bin"},
        {"NOT pac AND man", "Batman.bin", "Pac-Man.bin"},
        {"NOT a OR NOT b", "a.rom", "ab.bin"},
        // Whatever stands before NOT in a term is dropped; without an operator NOT is plain text.
        {"junk NOT pal AND x", "x.bin", "pal x.bin"},
        {"pal NOT", "pal NOT.bin", "pal.bin"},
        // The character before AND/XOR goes with the operator, even when it is no blank.
        {"pacAND man", "pa man.bin", "pac.bin"},
        {"pacXOR xyz", "pa.bin", "pa xyz.bin"},
        // AND is found first, so "a OR b AND c" splits at AND with a literal left term.
        {"a OR b AND c", "a OR b c.bin", "a.c"},
        // Capitals inside a word are an operator; an empty term is in every name but an empty one.
        {"ANDROMEDA", "romeda.bin", "Pitfall.bin"},
        {"CORE", "c.bin", "x.bin"}, // "C" OR "E"
        {"x AND", "x.bin", "y.bin"},
        {"AND", "y.bin", ""},
        // Plain ASCII takes a quicker path than the rest, which Qt folds.
        {"BIN", "x.bin", "x.bi"},
        {"aab", "AAAB.bin", "aba.bin"},
        {"k", "\u212A.bin", nullptr}, // the Kelvin sign
        {"\u00e9mul\u00e9", "\u00c9MUL\u00c9.bin", "emule.bin"},
    };
    for (const auto& [search, kept, dropped] : cases) {
        const SearchExpression expression(QString::fromUtf8(search));
        EXPECT_TRUE(!kept || expression.matches(QString::fromUtf8(kept))) << search;
        EXPECT_FALSE(dropped && expression.matches(QString::fromUtf8(dropped))) << search;
    }
}
