#include "platform/Dialogs.h"

#include <QRegularExpression>
#include <QStringList>

namespace {

QStringList qtPatterns(const QString& text, const QRegularExpression& separators) {
    QStringList patterns = text.split(separators, Qt::SkipEmptyParts);
    // "*.*" means every file on Windows; on Linux names need not have a dot.
    for (QString& p : patterns)
        if (p == QLatin1String("*.*"))
            p = QStringLiteral("*");
    return patterns;
}

// Qt shows the last parenthesised group of a label as its patterns, so a label that already
// ends in its pattern list ("Pictures (*.jpg,*.png)", "z26 executable (z26)") has that list
// rewritten in Qt's form rather than a second one appended.
QString qtFilterEntry(const QString& label, const QString& patternText) {
    static const QRegularExpression patternSeparators(QStringLiteral("[;\\s]"));
    static const QRegularExpression shownSeparators(QStringLiteral("[;,\\s]"));
    const QStringList patterns = qtPatterns(patternText, patternSeparators);
    QString head = label.trimmed();
    const qsizetype open = head.lastIndexOf(u'(');
    if (open >= 0 && head.endsWith(u')')) {
        const QString shown = head.mid(open + 1, head.size() - open - 2);
        if (shown.contains(u'*') || shown.contains(u'?') ||
            qtPatterns(shown, shownSeparators) == patterns)
            head = head.left(open).trimmed();
    }
    const QString list = u'(' + patterns.join(u' ') + u')';
    return head.isEmpty() ? list : head + u' ' + list;
}

QStringList qtFilterEntries(const QString& filter) {
    const QStringList parts = filter.split(u'|');
    QStringList entries;
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2)
        entries << qtFilterEntry(parts[i], parts[i + 1]);
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
