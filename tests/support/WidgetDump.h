#pragma once

#include <QString>

class QObject;
class QWidget;

// A window's texts and start states as plain text, one named widget or action a line,
// indented by nesting: class, objectName, caption, tool tip, items, and the states that
// differ from a widget's usual ones (checked, disabled, hidden). Geometry is left out, as
// it follows the platform's fonts.
QString dumpWidgetTree(const QWidget& window);

// The control of a window with that objectName, of that type. A missing one stops the test
// program with its name, so a renamed control shows at once.
QObject* findControl(const QObject& window, const QString& name, const char* className);
template <class T> T* control(const QObject& window, const QString& name) {
    return static_cast<T*>(findControl(window, name, T::staticMetaObject.className()));
}

// A file of the source tree, by its path from the tree's top.
QString sourcePath(const QString& relative);

// Compares `dump` with tests/golden/<name>.txt. With LUM_UPDATE_GOLDEN=1 in the
// environment the file is written instead; commit it after reading its diff.
void expectGolden(const QString& name, const QString& dump);
