#include "library/Search.h"

#include "library/Ascii.h"

#include <algorithm>

namespace {

// Characters [start, start + count) of s with 0-based start; counts below zero are
// zero and a range past the end is cut, as the old string functions did.
QString mid(const QString& s, qsizetype start, qsizetype count) {
    if (count <= 0 || start >= s.size())
        return QString();
    start = std::max<qsizetype>(start, 0);
    return s.mid(start, count);
}

using Term = SearchExpression::Term;

Term makeTerm(QString text, bool negated) {
    QString lower = isAscii(text) ? text.toLower() : QString();
    return {std::move(text), negated, std::move(lower)};
}

Term readTerm(QString t) {
    t = t.trimmed();
    const qsizetype q = t.indexOf(QLatin1String("NOT")); // 0-based; 1-based is q + 1
    if (q < 0)
        return makeTerm(t, false);
    // length(T) - q1 - 2 characters from 1-based q1 + 3, i.e. everything after NOT.
    const qsizetype q1 = q + 1;
    return makeTerm(mid(t, q1 + 2, t.size() - q1 - 2).trimmed(), true);
}

} // namespace

SearchExpression::SearchExpression(const QString& searchText) {
    const QString& s = searchText;
    const qsizetype length = s.size();
    QString left, right;

    // Positions below are 1-based, as the expression's rules state them.
    if (const qsizetype i = s.indexOf(QLatin1String("AND")); i >= 0) {
        const qsizetype p = i + 1;
        m_op = Op::And;
        left = mid(s, 0, p - 2);
        right = mid(s, p + 2, length - p - 2);
    } else if (const qsizetype j = s.indexOf(QLatin1String("XOR")); j >= 0) {
        const qsizetype p = j + 1;
        m_op = Op::Xor;
        left = mid(s, 0, p - 2);
        right = mid(s, p + 2, length - p - 2);
    } else if (const qsizetype k = s.indexOf(QLatin1String("OR")); k >= 0) {
        const qsizetype p = k + 1;
        m_op = Op::Or;
        left = mid(s, 0, p - 1);
        right = mid(s, p + 1, length - p - 1);
    } else {
        m_op = Op::Single;
        m_a = makeTerm(s, false);
        return;
    }
    m_a = readTerm(left);
    m_b = readTerm(right);
}

bool SearchExpression::matches(QStringView fileName) const {
    const bool inA = m_a.contains(fileName) != m_a.negated;
    const auto inB = [&] { return m_b.contains(fileName) != m_b.negated; };
    switch (m_op) {
    case Op::Single:
        return inA;
    case Op::And:
        return inA && inB();
    case Op::Xor:
        return inA != inB();
    case Op::Or:
        return inA || inB();
    }
    return false;
}

bool SearchExpression::Term::contains(QStringView fileName) const {
    if (text.isEmpty())
        return !fileName.isEmpty();
    // Where both sides are plain ASCII, ignoring case is lower-casing the letters, which is
    // all Qt's folding does there; anything else goes to Qt.
    if (asciiLower.isEmpty() || !isAscii(fileName))
        return fileName.contains(text, Qt::CaseInsensitive);
    const char16_t* name = fileName.utf16();
    const char16_t* term = QStringView(asciiLower).utf16();
    const qsizetype m = asciiLower.size();
    for (qsizetype at = 0; at + m <= fileName.size(); ++at) {
        qsizetype k = 0;
        while (k < m) {
            char16_t c = name[at + k];
            if (c >= u'A' && c <= u'Z')
                c = static_cast<char16_t>(c + 32);
            if (c != term[k])
                break;
            ++k;
        }
        if (k == m)
            return true;
    }
    return false;
}

bool MatchesSearch(const QString& searchText, QStringView fileName) {
    return SearchExpression(searchText).matches(fileName);
}
