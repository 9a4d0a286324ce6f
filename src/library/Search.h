#pragma once

#include <QString>
#include <QStringView>

// Whether a file name matches a search expression: one or two terms joined by AND, XOR
// or OR (capitals only, the first of them found in that order decides), each term
// optionally preceded by NOT. Terms are substrings matched without regard to case.
bool MatchesSearch(const QString& searchText, QStringView fileName);

// The same expression read once, for matching many names.
class SearchExpression {
public:
    explicit SearchExpression(const QString& searchText);
    bool matches(QStringView fileName) const;

    struct Term {
        QString text;
        bool negated = false;
        // The text in lower case when it is plain ASCII, for the quick comparison.
        QString asciiLower;
        bool contains(QStringView fileName) const;
    };

private:
    enum class Op { Single, And, Xor, Or } m_op = Op::Single;
    Term m_a, m_b;
};
