#include "library/Search.h"

#include <gtest/gtest.h>

#include <random>

namespace {

struct Case {
    const char* search;
    const char* name;
    bool matches;
};

// Each row is a search text, a file name and whether the name is kept.
const Case kCases[] = {
    // A single term is a substring matched without regard to case.
    {"pac", "Pac-Man (1982).bin", true},
    {"PAC", "pac-man.bin", true},
    {"kong", "Pac-Man.bin", false},
    // Operators count only in capitals; otherwise the whole text is one term.
    {"pac AND man", "Pac-Man.bin", true},
    {"pac AND man", "Pacific.bin", false},
    {"pac and man", "Pac-Man.bin", false},
    {"pac and man", "pac and man.bin", true},
    {"PAC AND MAN", "Pac-Man.bin", true},
    // XOR keeps names with exactly one of the terms.
    {"pac XOR man", "Pac-Man.bin", false},
    {"pac XOR man", "Pacific.bin", true},
    {"pac XOR man", "Pitfall.bin", false},
    {"pit OR kong", "Pitfall.bin", true},
    {"pit OR kong", "Pac-Man.bin", false},
    // NOT on either side, or both.
    {"asteroids AND NOT [pal]", "Asteroids.bin", true},
    {"asteroids AND NOT [pal]", "Asteroids [PAL].bin", false},
    {"NOT pac AND man", "Batman.bin", true},
    {"NOT pac AND man", "Pac-Man.bin", false},
    {"NOT a OR NOT b", "ab.bin", false},
    {"NOT a OR NOT b", "a.rom", true},
    {"NOT x XOR NOT y", "x.rom", true},
    {"NOT x XOR NOT y", "xy.rom", false},
    // Whatever stands before NOT in a term is dropped; only the first NOT counts.
    {"junk NOT pal AND x", "x.bin", true},
    {"pal NOT", "pal NOT.bin", true}, // no operator: NOT is plain text
    // The character before AND/XOR goes with the operator, even when it is no blank.
    {"pacAND man", "pa man.bin", true},
    {"pacAND man", "Pac-Man.bin", true},
    {"pacXOR xyz", "pa.bin", true},
    // AND is found first, so "a OR b AND c" splits at AND with a literal left term.
    {"a OR b AND c", "a OR b c.bin", true},
    {"a OR b AND c", "a.c", false},
    // AND inside a word in capitals is an operator: A is empty (in every name).
    {"ANDROMEDA", "romeda.bin", true},
    {"ANDROMEDA", "Pitfall.bin", false},
    // An empty right term is in every name.
    {"x AND", "x.bin", true},
    {"x AND", "y.bin", false},
    {"AND", "y.bin", true},
    // Capital words that merely contain the letters are still operators.
    {"CORE", "c.bin", true}, // "C" OR "E"
    {"CORE", "x.bin", false},
};

} // namespace

TEST(MatchesSearch, ExpressionTable) {
    for (const Case& c : kCases)
        EXPECT_EQ(MatchesSearch(QString::fromUtf8(c.search), QString::fromUtf8(c.name)), c.matches)
            << '"' << c.search << "\" on \"" << c.name << '"';
}

// Plain ASCII terms and names are compared by a quicker path than Qt's; it must agree with
// Qt's case-insensitive search, and names that are not ASCII (including letters that fold
// to ASCII ones, such as the Kelvin sign) must still go by Qt's folding.
TEST(MatchesSearch, TheAsciiPathAgreesWithQtsCaseFolding) {
    const QString alphabet = QStringLiteral("aAbBcC1 .-_é\u212A");
    std::mt19937 random(11);
    const auto text = [&](int longest) {
        QString s;
        for (int n = static_cast<int>(random() % (longest + 1)); n > 0; --n)
            s += alphabet[static_cast<qsizetype>(random() % alphabet.size())];
        return s;
    };
    for (int i = 0; i < 5000; ++i) {
        const QString term = text(3).trimmed(); // no capitals that spell an operator
        const QString name = text(10);
        const bool expected =
            term.isEmpty() ? !name.isEmpty() : name.contains(term, Qt::CaseInsensitive);
        ASSERT_EQ(MatchesSearch(term, name), expected)
            << term.toStdString() << " in " << name.toStdString();
    }
    EXPECT_TRUE(MatchesSearch(QStringLiteral("k"), QStringLiteral("\u212A.bin")));
}
