#pragma once

// The settings window's controls that its behaviour works with, known to its own files
// only. The option controls that merely show an option are found by OptionBinding.

#include "settings/OptionBinding.h"
#include "settings/frmSettings.h"

#include <array>
#include <memory>

class PictureBox;
class QAction;
class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QMenu;
class QPushButton;
class QRadioButton;
class QTabWidget;
class QTreeWidget;
class vbalProgressBar;

struct frmSettings::Ui {
    PictureBox* picSideText = nullptr;
    QTabWidget* vbalDTabControl1 = nullptr;
    std::array<QWidget*, 6> pages{};

    QLabel* lblConfig = nullptr;
    QComboBox* comboVideoMode = nullptr;
    QLineEdit* txtVidModeBalloon = nullptr;

    // The layout-picture buttons: left port, right port.
    std::array<QPushButton*, 2> pictureButtons{};
    QGroupBox* fraPaddleSens = nullptr;
    // chkIPCKeyboard, chkIPCMouse, chkIPCJoystick, chkIPCStella, by PcDevice.
    std::array<QCheckBox*, 4> ipc{};
    QLineEdit* txtIPC4Balloon = nullptr;
    QGroupBox* fraLightgun = nullptr;

    // The number fields that a box or button switches on, and the light gun's.
    QLineEdit* txtScanLines = nullptr;
    QLineEdit* txtLineScan = nullptr;
    QLineEdit* txtLowerSens = nullptr;
    QLineEdit* txtFPScustom = nullptr;
    std::array<QLineEdit*, 2> lightGunFields{};

    vbalProgressBar* BarColorPaddle = nullptr;
    vbalProgressBar* BarColorPhos = nullptr;
    vbalProgressBar* BarColorSoundQueue = nullptr;
    QMenu* mnuSQPopup = nullptr;

    // "Edit Switches" and the switches' preview.
    QCheckBox* chkDOSSwitch = nullptr;
    QLabel* lblDOSSwitchInstruction = nullptr;
    QLabel* lblDOSOutput = nullptr;
    QLineEdit* txtDOSOutput = nullptr;

    // Default Paths page.
    QLineEdit* txtDefPathFilter = nullptr;
    QLineEdit* txtDefPathz26 = nullptr;
    QTreeWidget* vbalListDefPaths = nullptr;
    QCheckBox* chkROMSubfolders = nullptr;
    QMenu* mnuROMSPopup = nullptr;
    QAction* mnuROMSRemove = nullptr;

    std::unique_ptr<OptionBinding> binding;
};
