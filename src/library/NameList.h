#pragma once

#include <QString>
#include <QStringList>
#include <QStringView>

#include <vector>

// File names kept end to end in one buffer: a folder of 100,000 names costs a few
// allocations rather than one per name, and half the memory.
class NameList {
public:
    qsizetype size() const { return static_cast<qsizetype>(m_ends.size()); }
    bool isEmpty() const { return m_ends.empty(); }
    // The i-th name; valid until the list changes.
    QStringView at(qsizetype i) const {
        const size_t end = m_ends[static_cast<size_t>(i)];
        const size_t start = i == 0 ? 0 : m_ends[static_cast<size_t>(i - 1)];
        return QStringView(m_chars.data() + start, static_cast<qsizetype>(end - start));
    }

    void reserve(qsizetype names, qsizetype chars);
    void append(QStringView name);
    // A name in Latin-1, which for plain ASCII is its bytes.
    void appendLatin1(const char* name, qsizetype size);
    // Every name of `other`, after this list's own.
    void append(NameList&& other);

    QStringList toStringList() const;

    bool operator==(const NameList&) const = default;

private:
    std::vector<char16_t> m_chars;
    std::vector<size_t> m_ends;
};
