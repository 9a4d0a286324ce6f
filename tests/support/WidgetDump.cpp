#include "support/WidgetDump.h"

#include "support/Widgets.h"

#include <QDir>
#include <QFileInfo>

#include <gtest/gtest.h>

namespace {

QString quoted(const QString& text) {
    QString escaped = text;
    escaped.replace(u'\\', QStringLiteral("\\\\"))
        .replace(u'\r', QStringLiteral("\\r"))
        .replace(u'\n', QStringLiteral("\\n"));
    return u'"' + escaped + u'"';
}

QString listed(const QStringList& items, int current) {
    return u'[' + items.join(QStringLiteral(" | ")) + QStringLiteral("] current ") +
           QString::number(current);
}

void add(QString& line, bool bOn, const char* word) {
    if (bOn)
        line += u' ' + QLatin1String(word);
}

void dumpAction(const QAction& action, int depth, QStringList& lines) {
    if (action.objectName().isEmpty())
        return;
    QString line = QString(depth * 2, u' ') + QStringLiteral("QAction ") + action.objectName() +
                   u' ' +
                   (action.isSeparator() ? QStringLiteral("separator") : quoted(action.text()));
    add(line, action.isCheckable(), action.isChecked() ? "checked" : "unchecked");
    add(line, !action.icon().isNull(), "icon");
    add(line, !action.isEnabled(), "disabled");
    add(line, !action.isVisible(), "hidden");
    lines << line;
    // A menu's items follow the action that opens it.
    if (const QMenu* menu = action.menu())
        for (const QAction* item : menu->actions())
            dumpAction(*item, depth + 1, lines);
}

QString describe(const QWidget& w) {
    QString line = QString::fromLatin1(w.metaObject()->className()) + u' ' + w.objectName();
    if (w.isWindow() && !w.windowTitle().isEmpty())
        line += QStringLiteral(" title ") + quoted(w.windowTitle());
    if (const auto* box = qobject_cast<const QGroupBox*>(&w)) {
        line += u' ' + quoted(box->title());
    } else if (const auto* button = qobject_cast<const QAbstractButton*>(&w)) {
        line += u' ' + quoted(button->text());
        add(line, button->isCheckable(), button->isChecked() ? "checked" : "unchecked");
    } else if (const auto* label = qobject_cast<const QLabel*>(&w)) {
        if (!label->text().isEmpty())
            line += u' ' + quoted(label->text());
    } else if (const auto* edit = qobject_cast<const QLineEdit*>(&w)) {
        line += u' ' + quoted(edit->text());
    } else if (const auto* combo = qobject_cast<const QComboBox*>(&w)) {
        QStringList items;
        for (int i = 0; i < combo->count(); ++i)
            items << combo->itemText(i);
        line += u' ' + listed(items, combo->currentIndex());
    } else if (const auto* tabs = qobject_cast<const QTabWidget*>(&w)) {
        QStringList captions;
        for (int i = 0; i < tabs->count(); ++i)
            captions << tabs->tabText(i);
        line += QStringLiteral(" tabs ") + listed(captions, tabs->currentIndex());
    } else if (const auto* view = qobject_cast<const QAbstractItemView*>(&w);
               view && view->model()) {
        // Column headers with their tool tips.
        const QAbstractItemModel& model = *view->model();
        QStringList headers;
        for (int i = 0; i < model.columnCount(); ++i)
            headers << model.headerData(i, Qt::Horizontal).toString() + u'/' +
                           model.headerData(i, Qt::Horizontal, Qt::ToolTipRole).toString();
        line += QStringLiteral(" columns [%1]").arg(headers.join(QStringLiteral(" | ")));
    }
    if (!w.toolTip().isEmpty())
        line += QStringLiteral(" tip ") + quoted(w.toolTip());
    add(line, w.testAttribute(Qt::WA_ForceDisabled), "disabled");
    add(line, w.isHidden() && !w.isWindow(), "hidden");
    return line;
}

void dumpWidget(const QWidget& w, int depth, QStringList& lines) {
    if (const auto* menu = qobject_cast<const QMenu*>(&w)) {
        // A menu placed in a menu bar or another menu is dumped with the action that opens
        // it; a pop-up menu on its own. Unnamed ones are Qt's (a menu bar's overflow).
        if (menu->objectName().isEmpty() || !menu->menuAction()->associatedObjects().isEmpty())
            return;
        lines << QString(depth * 2, u' ') + QStringLiteral("QMenu ") + menu->objectName() + u' ' +
                     quoted(menu->title());
        for (const QAction* action : menu->actions())
            dumpAction(*action, depth + 1, lines);
        return;
    }
    // A tab bar's own scroll buttons depend on the style, not on the window.
    if (qobject_cast<const QTabBar*>(&w))
        return;
    const bool bNamed = !w.objectName().isEmpty() && !w.objectName().startsWith(u"qt_");
    if (bNamed)
        lines << QString(depth * 2, u' ') + describe(w);
    const int inner = bNamed ? depth + 1 : depth;
    for (const QAction* action : w.actions())
        dumpAction(*action, inner, lines);
    for (const QObject* child : w.children())
        if (const auto* widget = qobject_cast<const QWidget*>(child))
            dumpWidget(*widget, inner, lines);
}

} // namespace

QString dumpWidgetTree(const QWidget& window) {
    QStringList lines;
    dumpWidget(window, 0, lines);
    return lines.join(u'\n') + u'\n';
}

QObject* findControl(const QObject& window, const QString& name, const char* className) {
    for (QObject* object : window.findChildren<QObject*>(name))
        if (object->inherits(className))
            return object;
    // A missing control would only crash the test further on; say which one and stop.
    qFatal("no %s %s in %s", className, qPrintable(name), qPrintable(window.objectName()));
}

QString sourcePath(const QString& relative) {
    const QByteArray source = qgetenv("LUM_SOURCE_DIR");
    // Run by hand, outside ctest: the tree this file lies in.
    const QString root = !source.isEmpty() ? QString::fromLocal8Bit(source)
                                           : QFileInfo(QStringLiteral(__FILE__)).absolutePath() +
                                                 QStringLiteral("/../..");
    return QDir::cleanPath(root + u'/' + relative);
}

void expectGolden(const QString& name, const QString& dump) {
    const QString path =
        sourcePath(QStringLiteral("tests/golden/") + name + QStringLiteral(".txt"));
    if (!qgetenv("LUM_UPDATE_GOLDEN").isEmpty()) {
        QFile out(path);
        ASSERT_TRUE(out.open(QIODevice::WriteOnly | QIODevice::Truncate)) << path.toStdString();
        out.write(dump.toUtf8());
        return;
    }
    QFile in(path);
    ASSERT_TRUE(in.open(QIODevice::ReadOnly))
        << path.toStdString() << " is missing: run the test with LUM_UPDATE_GOLDEN=1";
    EXPECT_EQ(QString::fromUtf8(in.readAll()).toStdString(), dump.toStdString())
        << path.toStdString() << " is out of date: run the test with LUM_UPDATE_GOLDEN=1";
}
