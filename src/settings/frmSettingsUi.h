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

    QPushButton* cmdLeftControlPic = nullptr;
    QPushButton* cmdRightControlPic = nullptr;
    QGroupBox* fraPaddleSens = nullptr;
    // chkIPCKeyboard, chkIPCMouse, chkIPCJoystick, chkIPCStella, by PcDevice.
    std::array<QCheckBox*, 4> ipc{};
    QLineEdit* txtIPC4Balloon = nullptr;
    QGroupBox* fraLightgun = nullptr;

    // The number fields, and the boxes or button that switch the first four on.
    QLineEdit* txtScanLines = nullptr;
    QLineEdit* txtLineScan = nullptr;
    QLineEdit* txtLowerSens = nullptr;
    QLineEdit* txtFPScustom = nullptr;
    QLineEdit* txtLightGunCycles = nullptr;
    QLineEdit* txtLightGunScan = nullptr;
    QCheckBox* chkScanLines = nullptr;
    QCheckBox* chkLineScan = nullptr;
    QCheckBox* chkLowerSens = nullptr;
    QRadioButton* optFPScustom = nullptr;
    QRadioButton* optFPSmonitor = nullptr;

    vbalProgressBar* BarColorPaddle = nullptr;
    vbalProgressBar* BarColorPhos = nullptr;
    vbalProgressBar* BarColorSoundQueue = nullptr;
    QMenu* mnuSQPopup = nullptr;

    QCheckBox* chkDOSSwitch = nullptr;
    QLabel* lblDOSSwitchInstruction = nullptr;
    QLabel* lblDOSOutput = nullptr;
    QLineEdit* txtDOSOutput = nullptr;

    QLineEdit* txtDefPathFilter = nullptr;
    QLineEdit* txtDefPathz26 = nullptr;
    QTreeWidget* vbalListDefPaths = nullptr;
    QMenu* mnuROMSPopup = nullptr;
    QAction* mnuROMSRemove = nullptr;

    std::unique_ptr<OptionBinding> binding;
};
