#pragma once

#include <QString>
#include <QtGlobal>

#include <optional>

// The per-user store of text values addressed by section and key (the application is
// always lum). Key and section names are compared without regard to case.
class SettingsStore {
public:
    virtual ~SettingsStore() = default;

    // The stored text, or `def` when the key is missing.
    virtual QString GetSetting(const QString& section, const QString& key,
                               const QString& def = QString()) const = 0;
    // Stores the value; false when it could not be written to disk.
    virtual bool SaveSetting(const QString& section, const QString& key, const QString& value) = 0;
    virtual bool DeleteSetting(const QString& section, const QString& key) = 0;
    // Why writes fail when the store knows better than "the disk": empty otherwise.
    virtual QString failureReason() const { return {}; }
};

// Stored texts as typed values: text that does not convert gives `def`. (The keys and their
// defaults are in StoredSettings.h.)
std::optional<qint64> tryParseLong(const QString& text);
double parseSingle(const QString& text, double def);
bool parseBool(const QString& text, bool def);
// An OLE colour (0x00BBGGRR, or a system colour with the top bit set) as stored in decimal.
quint32 parseColour(const QString& text, quint32 def);

// Texts in the forms the store uses.
QString boolText(bool value);
QString singleText(double value);
