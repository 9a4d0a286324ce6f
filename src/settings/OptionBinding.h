#pragma once

#include "emulator/EmulatorOptions.h"

#include <QObject>

#include <vector>

class QWidget;

// Ties the option controls of a window to one EmulatorOptions value through optionTable():
// each row's controls are found by their objectName. A user's change of a control writes
// its row into the value and reports it; showing a value sets only the controls that show
// something else, without reporting that as a change.
class OptionBinding : public QObject {
    Q_OBJECT
public:
    // Every control the table names must be under `window`.
    OptionBinding(QWidget& window, EmulatorOptions& options);

    // Shows the value. With bRescaleSoundQueue the sound queue's bar is re-centred on its
    // value, as loading an option set does; otherwise its scale is left as the user set it.
    void show(const EmulatorOptions& options, bool bRescaleSoundQueue);

signals:
    void edited();

private:
    void bind(const OptionRow& row);
    void showRow(const OptionRow& row, const EmulatorOptions& options, bool bRescaleSoundQueue);

    EmulatorOptions& m_options;
    // Each row's controls, in the order of its slots (null for a slot with no control).
    std::vector<std::vector<QWidget*>> m_controls;
};
