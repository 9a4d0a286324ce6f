#pragma once

#include "platform/SettingsStore.h"

#include <QString>

#include <vector>

// The settings store kept in an INI file: one group per section. The whole file is
// rewritten through a temporary file and renamed into place on every change, so a
// failed or interrupted write never leaves half a file behind. A file that is there but
// could not be read is never written over: the session's values stay in memory and every
// write reports failure until that file is gone.
class IniSettingsStore final : public SettingsStore {
public:
    explicit IniSettingsStore(QString filePath);

    // The file of the real program: lum/lum.ini in the user's configuration folder.
    static QString defaultFilePath();

    QString GetSetting(const QString& section, const QString& key,
                       const QString& def = QString()) const override;
    bool SaveSetting(const QString& section, const QString& key, const QString& value) override;
    bool DeleteSetting(const QString& section, const QString& key) override;
    QString failureReason() const override;

    const QString& filePath() const { return m_filePath; }

    // The INI text of a set of sections, and its reading; exposed for the tests.
    struct Entry {
        QString key;
        QString value;
    };
    struct Section {
        QString name;
        std::vector<Entry> entries;
    };
    static std::vector<Section> parse(const QByteArray& text);
    static QByteArray format(const std::vector<Section>& sections);

private:
    Section* findSection(const QString& name);
    const Section* findSection(const QString& name) const;
    bool write() const;

    QString m_filePath;
    std::vector<Section> m_sections;
    // The file existed at start but its settings could not be read: why, or empty.
    QString m_unreadReason;
};
