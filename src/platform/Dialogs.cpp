#include "platform/Dialogs.h"

#include <QStringList>

namespace {

QStringList qtFilterEntries(const QString& filter) {
    const QStringList parts = filter.split(u'|');
    QStringList entries;
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2) {
        QStringList patterns = parts[i + 1].split(u';', Qt::SkipEmptyParts);
        for (QString& p : patterns) {
            p = p.trimmed();
            // "*.*" means every file on Windows; on Linux names need not have a dot.
            if (p == QLatin1String("*.*"))
                p = QStringLiteral("*");
        }
        entries << parts[i] + QLatin1String(" (") + patterns.join(u' ') + u')';
    }
    return entries;
}

} // namespace

QString qtFileFilter(const QString& filter) {
    return qtFilterEntries(filter).join(QLatin1String(";;"));
}

QString qtSelectedFilter(const QString& filter, int filterIndex) {
    const QStringList entries = qtFilterEntries(filter);
    if (filterIndex < 1 || filterIndex > entries.size())
        return QString();
    return entries[filterIndex - 1];
}
