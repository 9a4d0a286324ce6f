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
};

// Typed readers: a missing key, or stored text that does not convert, gives `def`.
std::optional<qint64> tryParseLong(const QString& text);
double parseSingle(const QString& text, double def);
qint64 parseLong(const QString& text, qint64 def);
bool parseBool(const QString& text, bool def);
// An OLE colour (0x00BBGGRR, or a system colour with the top bit set) as stored in decimal.
quint32 parseColour(const QString& text, quint32 def);

double readSingle(const SettingsStore& store, const QString& section, const QString& key,
                  double def);
qint64 readLong(const SettingsStore& store, const QString& section, const QString& key, qint64 def);
bool readBool(const SettingsStore& store, const QString& section, const QString& key, bool def);
// An OLE colour (0x00BBGGRR, or a system colour with the top bit set) as stored in decimal.
quint32 readColour(const SettingsStore& store, const QString& section, const QString& key,
                   quint32 def);

// Texts in the forms the store uses.
QString boolText(bool value);
QString singleText(double value);
