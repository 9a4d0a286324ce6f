#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <QtGlobal>

#include <optional>

// The root key handle of the machine-wide hive.
inline constexpr quint32 kHkeyLocalMachine = 0x80000002u;

// Value types as the registry names them.
inline constexpr quint32 kRegString = 1;
inline constexpr quint32 kRegNumber = 4;

struct RegistryValue {
    quint32 type = kRegString;
    // The raw bytes as stored: a string with its terminating NUL, a number as 4 bytes
    // with the lowest byte first.
    QByteArray data;
};

// Read-only lookups of values under a root key, a key path and a value name.
class Registry {
public:
    virtual ~Registry() = default;

    // The value, or nothing when the key or the value does not exist.
    virtual std::optional<RegistryValue> QueryValue(quint32 root, const QString& keyName,
                                                    const QString& valueName) = 0;
};

// Linux has no registry. The one lookup the program makes, the path of the system
// information tool, is answered with the first such tool found on PATH; every other
// lookup finds nothing.
class ToolRegistry final : public Registry {
public:
    // The candidates, best first.
    static QStringList systemInformationTools();

    std::optional<RegistryValue> QueryValue(quint32 root, const QString& keyName,
                                            const QString& valueName) override;
};
