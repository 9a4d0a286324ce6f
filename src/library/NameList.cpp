#include "library/NameList.h"

#include <algorithm>

void NameList::reserve(qsizetype names, qsizetype chars) {
    m_ends.reserve(static_cast<size_t>(names));
    m_chars.reserve(static_cast<size_t>(chars));
}

void NameList::append(QStringView name) {
    m_chars.insert(m_chars.end(), name.utf16(), name.utf16() + name.size());
    m_ends.push_back(m_chars.size());
}

void NameList::appendLatin1(const char* name, qsizetype size) {
    const size_t at = m_chars.size();
    m_chars.resize(at + static_cast<size_t>(size));
    std::transform(name, name + size, m_chars.begin() + static_cast<std::ptrdiff_t>(at),
                   [](char c) { return static_cast<char16_t>(static_cast<unsigned char>(c)); });
    m_ends.push_back(m_chars.size());
}

void NameList::append(NameList&& other) {
    if (isEmpty()) {
        *this = std::move(other);
        return;
    }
    const size_t shift = m_chars.size();
    m_chars.insert(m_chars.end(), other.m_chars.begin(), other.m_chars.end());
    m_ends.reserve(m_ends.size() + other.m_ends.size());
    for (const size_t end : other.m_ends)
        m_ends.push_back(shift + end);
    other = NameList();
}

QStringList NameList::toStringList() const {
    QStringList list;
    list.reserve(size());
    for (qsizetype i = 0; i < size(); ++i)
        list.push_back(at(i).toString());
    return list;
}
