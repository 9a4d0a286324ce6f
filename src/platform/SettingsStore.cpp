#include "platform/SettingsStore.h"

#include <QLocale>

#include <cmath>
#include <limits>

double parseSingle(const QString& text, double def) {
    bool ok = false;
    const double value = QLocale::c().toDouble(text.trimmed(), &ok);
    if (!ok || !std::isfinite(value) || std::fabs(value) > std::numeric_limits<float>::max())
        return def;
    return static_cast<float>(value);
}

std::optional<qint64> tryParseLong(const QString& text) {
    bool ok = false;
    const QString t = text.trimmed();
    const qint64 value = t.toLongLong(&ok, 10);
    if (ok)
        return value;
    // Numbers written with a fraction ("12.0") still convert, rounded half to even.
    const double d = QLocale::c().toDouble(t, &ok);
    if (!ok || !std::isfinite(d) || std::fabs(d) > 9.0e15)
        return std::nullopt;
    return static_cast<qint64>(std::nearbyint(d));
}

qint64 parseLong(const QString& text, qint64 def) {
    return tryParseLong(text).value_or(def);
}

bool parseBool(const QString& text, bool def) {
    const QString t = text.trimmed();
    if (t.compare(QLatin1String("True"), Qt::CaseInsensitive) == 0)
        return true;
    if (t.compare(QLatin1String("False"), Qt::CaseInsensitive) == 0)
        return false;
    bool ok = false;
    const double d = QLocale::c().toDouble(t, &ok);
    if (ok && std::isfinite(d))
        return d != 0.0;
    return def;
}

double readSingle(const SettingsStore& store, const QString& section, const QString& key,
                  double def) {
    return parseSingle(store.GetSetting(section, key, QString()), def);
}

qint64 readLong(const SettingsStore& store, const QString& section, const QString& key,
                qint64 def) {
    return parseLong(store.GetSetting(section, key, QString()), def);
}

bool readBool(const SettingsStore& store, const QString& section, const QString& key, bool def) {
    return parseBool(store.GetSetting(section, key, QString()), def);
}

quint32 readColour(const SettingsStore& store, const QString& section, const QString& key,
                   quint32 def) {
    return parseColour(store.GetSetting(section, key, QString()), def);
}

quint32 parseColour(const QString& text, quint32 def) {
    const std::optional<qint64> value = tryParseLong(text);
    // Colours are 32-bit; a stored value outside that range is not a colour.
    if (!value || *value < std::numeric_limits<qint32>::min() ||
        *value > std::numeric_limits<quint32>::max())
        return def;
    return static_cast<quint32>(*value);
}

QString boolText(bool value) {
    return value ? QStringLiteral("True") : QStringLiteral("False");
}

QString singleText(double value) {
    // The shortest text that reads back as the same single-precision number.
    return QString::number(static_cast<float>(value), 'g', QLocale::FloatingPointShortest);
}
