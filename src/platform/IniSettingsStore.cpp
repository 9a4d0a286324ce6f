#include "platform/IniSettingsStore.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QHash>
#include <QSaveFile>
#include <QStandardPaths>

#include <algorithm>
#include <optional>

namespace {

bool sameName(const QString& a, const QString& b) {
    return a.compare(b, Qt::CaseInsensitive) == 0;
}

// A name folded code point by code point, as the comparison above folds it: two names are
// the same exactly when their keys are equal. Lets a big file be read in linear time.
QString nameKey(QStringView name) {
    QString key;
    key.reserve(name.size());
    for (const char32_t c : name.toUcs4())
        key += QChar::fromUcs4(QChar::toCaseFolded(c));
    return key;
}

// Values may hold any text; line breaks and backslashes are escaped so that one line
// always holds one key.
QString escape(const QString& value) {
    QString out;
    out.reserve(value.size());
    for (const QChar c : value) {
        if (c == u'\\')
            out += QLatin1String("\\\\");
        else if (c == u'\n')
            out += QLatin1String("\\n");
        else if (c == u'\r')
            out += QLatin1String("\\r");
        else
            out += c;
    }
    return out;
}

QString unescape(const QString& value) {
    QString out;
    out.reserve(value.size());
    for (qsizetype i = 0; i < value.size(); ++i) {
        const QChar c = value[i];
        if (c != u'\\' || i + 1 == value.size()) {
            out += c;
            continue;
        }
        const QChar next = value[++i];
        if (next == u'n')
            out += u'\n';
        else if (next == u'r')
            out += u'\r';
        else
            out += next;
    }
    return out;
}

} // namespace

IniSettingsStore::IniSettingsStore(QString filePath) : m_filePath(std::move(filePath)) {
    const QFileInfo info(m_filePath);
    if (!info.exists())
        return;
    // An unreadable file is an empty store; so is a file bigger than any store we would
    // write, and anything but a regular file (a pipe would block the start). Each is kept
    // for the user to look at, not replaced.
    constexpr qint64 maxSize = 16 * 1024 * 1024;
    if (!info.isFile()) {
        m_unreadReason = QStringLiteral("That is not a regular file, so lum did not read it.");
        return;
    }
    if (info.size() > maxSize) {
        m_unreadReason = QStringLiteral("That file is larger than 16 MiB, far more than lum "
                                        "ever writes, so lum did not read it.");
        return;
    }
    QFile file(m_filePath);
    if (file.open(QIODevice::ReadOnly)) {
        const QByteArray text = file.readAll();
        if (file.error() == QFileDevice::NoError) {
            m_sections = parse(text);
            return;
        }
    }
    m_unreadReason = QStringLiteral("That file could not be read (") + file.errorString() +
                     QStringLiteral("), so lum did not read it.");
}

QString IniSettingsStore::failureReason() const {
    if (m_unreadReason.isEmpty() || !QFileInfo::exists(m_filePath))
        return {};
    return m_unreadReason +
           QStringLiteral(" It is kept as it is: move it aside to start with fresh settings.");
}

QString IniSettingsStore::defaultFilePath() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
           QStringLiteral("/lum/lum.ini");
}

std::vector<IniSettingsStore::Section> IniSettingsStore::parse(const QByteArray& text) {
    std::vector<Section> sections;
    // Where each section and key already read lies, by name key.
    QHash<QString, std::size_t> sectionAt;
    std::vector<QHash<QString, std::size_t>> entryAt;
    std::optional<std::size_t> current;
    const QString all = QString::fromUtf8(text);
    for (QStringView line : QStringView(all).split(u'\n')) {
        if (line.endsWith(u'\r'))
            line.chop(1);
        const QStringView trimmed = line.trimmed();
        if (trimmed.isEmpty() || trimmed.startsWith(u';') || trimmed.startsWith(u'#'))
            continue;
        if (trimmed.startsWith(u'[') && trimmed.endsWith(u']')) {
            const QString name = trimmed.mid(1, trimmed.size() - 2).trimmed().toString();
            const QString k = nameKey(name);
            auto at = sectionAt.constFind(k);
            if (at == sectionAt.constEnd()) {
                at = sectionAt.insert(k, sections.size());
                sections.push_back({name, {}});
                entryAt.emplace_back();
            }
            current = *at;
            continue;
        }
        const qsizetype eq = line.indexOf(u'=');
        if (!current || eq <= 0)
            continue;
        const QString key = line.left(eq).trimmed().toString();
        if (key.isEmpty())
            continue;
        QString value = unescape(line.mid(eq + 1).toString());
        std::vector<Entry>& entries = sections[*current].entries;
        QHash<QString, std::size_t>& index = entryAt[*current];
        const QString k = nameKey(key);
        // The last of two spellings wins, as on a rewrite.
        if (const auto at = index.constFind(k); at != index.constEnd()) {
            entries[*at].value = std::move(value);
        } else {
            index.insert(k, entries.size());
            entries.push_back({key, std::move(value)});
        }
    }
    return sections;
}

QByteArray IniSettingsStore::format(const std::vector<Section>& sections) {
    QString out;
    for (const Section& section : sections) {
        if (section.entries.empty())
            continue;
        if (!out.isEmpty())
            out += u'\n';
        out += u'[' + section.name + QLatin1String("]\n");
        for (const Entry& entry : section.entries)
            out += entry.key + u'=' + escape(entry.value) + u'\n';
    }
    return out.toUtf8();
}

IniSettingsStore::Section* IniSettingsStore::findSection(const QString& name) {
    auto it = std::find_if(m_sections.begin(), m_sections.end(),
                           [&](const Section& s) { return sameName(s.name, name); });
    return it == m_sections.end() ? nullptr : &*it;
}

const IniSettingsStore::Section* IniSettingsStore::findSection(const QString& name) const {
    return const_cast<IniSettingsStore*>(this)->findSection(name);
}

QString IniSettingsStore::GetSetting(const QString& section, const QString& key,
                                     const QString& def) const {
    const Section* s = findSection(section);
    if (s == nullptr)
        return def;
    for (const Entry& e : s->entries)
        if (sameName(e.key, key))
            return e.value;
    return def;
}

bool IniSettingsStore::SaveSetting(const QString& section, const QString& key,
                                   const QString& value) {
    Section* s = findSection(section);
    if (s == nullptr) {
        m_sections.push_back({section, {}});
        s = &m_sections.back();
    }
    auto it = std::find_if(s->entries.begin(), s->entries.end(),
                           [&](const Entry& e) { return sameName(e.key, key); });
    if (it == s->entries.end()) {
        s->entries.push_back({key, value});
    } else {
        if (it->value == value)
            return true;
        it->value = value;
    }
    return write();
}

bool IniSettingsStore::DeleteSetting(const QString& section, const QString& key) {
    Section* s = findSection(section);
    if (s == nullptr)
        return true;
    const auto before = s->entries.size();
    std::erase_if(s->entries, [&](const Entry& e) { return sameName(e.key, key); });
    return before == s->entries.size() ? true : write();
}

bool IniSettingsStore::write() const {
    // Writing would put this session's few values in place of everything the file holds.
    if (!m_unreadReason.isEmpty() && QFileInfo::exists(m_filePath))
        return false;
    QDir().mkpath(QFileInfo(m_filePath).absolutePath());
    QSaveFile file(m_filePath);
    // Unbuffered, so that a short write (a full disk) shows here: commit() flushes a
    // buffered one without noticing the failure and would put a cut-off file in place.
    if (!file.open(QIODevice::WriteOnly | QIODevice::Unbuffered))
        return false;
    const QByteArray text = format(m_sections);
    if (file.write(text) != text.size()) {
        file.cancelWriting();
        return false;
    }
    return file.commit();
}
