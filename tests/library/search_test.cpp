#include "library/Search.h"

#include <gtest/gtest.h>

#include <tuple>

namespace {

// A search text, a name it keeps and a name it drops (either may be absent).
const std::tuple<const char*, const char*, const char*> kCases[] = {
    // A single term is a substring matched without regard to case.
    {"pac", "Pac-Man (1982).bin", "Kong.bin"},
    {"PAC", "pac-man.bin", nullptr},
    // Operators count only in capitals; otherwise the whole text is one term.
    {"pac AND man", "Pac-Man.bin", "Pacific.bin"},
    {"PAC AND MAN", "Pac-Man.bin", "Pacific.bin"},
    {"pac and man", "pac and man.bin", "Pac-Man.bin"},
    // XOR keeps names with exactly one of the terms.
    {"pac XOR man", "Pacific.bin", "Pac-Man.bin"},
    {"pac XOR man", nullptr, "Pitfall.bin"},
    {"pit OR kong", "Pitfall.bin", "Pac-Man.bin"},
    // NOT on either side, or both.
    {"asteroids AND NOT [pal]", "Asteroids.bin", "Asteroids [PAL].bin"},
    {"NOT pac AND man", "Batman.bin", "Pac-Man.bin"},
    {"NOT a OR NOT b", "a.rom", "ab.bin"},
    {"NOT x XOR NOT y", "x.rom", "xy.rom"},
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
    // Plain ASCII is compared by a quicker path than the rest, which Qt folds: a term at the
    // end, one that starts over inside a near match, letters that fold to ASCII ones.
    {"BIN", "x.bin", "x.bi"},
    {"aab", "AAAB.bin", "aba.bin"},
    {"k", "\u212A.bin", nullptr}, // the Kelvin sign
    {"\u00e9mul\u00e9", "\u00c9MUL\u00c9.bin", "emule.bin"},
};

} // namespace

TEST(MatchesSearch, ExpressionTable) {
    for (const auto& [search, kept, dropped] : kCases) {
        SCOPED_TRACE(search);
        if (kept) {
            EXPECT_TRUE(MatchesSearch(QString::fromUtf8(search), QString::fromUtf8(kept))) << kept;
        }
        if (dropped) {
            EXPECT_FALSE(MatchesSearch(QString::fromUtf8(search), QString::fromUtf8(dropped)))
                << dropped;
        }
    }
}
