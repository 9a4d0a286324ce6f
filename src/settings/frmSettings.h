#pragma once

#include "library/FileLister.h"
#include "ui/cLogo.h"
#include "ui/vbalProgressBar.h"

#include <QPointer>
#include <QWidget>

#include <array>
#include <functional>

struct ConfigDecode;
struct Platform;
class PictureBox;
class QAction;
class QButtonGroup;
class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QMenu;
class QMimeData;
class QPushButton;
class QRadioButton;
class QTabWidget;
class QTreeWidget;
class QTreeWidgetItem;
class frmPicPreview;

// The settings window: created hidden by the main window when first needed and kept
// until the program ends. Its close box only hides it; its option controls are the one holder of
// the emulator options, read whether the window is shown or not.
class frmSettings : public QWidget {
    Q_OBJECT
public:
    explicit frmSettings(Platform& platform, QWidget* parent = nullptr);
    ~frmSettings() override;

    // Selects the tab with the given key ("Settings", "Controls", "PaddlesAudio", "Video",
    // "Debug", "DefaultPaths"); an unknown key changes nothing.
    void SelectTab(const QString& key);
    QString SelectedTabKey() const;

    // The program's own unload at exit: saves the window's state and really closes it.
    void Unload();

    // The side strip's logo (its caption follows the selected tab).
    const cLogo& Logo() const { return m_logo; }

    // Brings every option control that depends on another (enabled states, the preview of
    // the emulator's switches) in line with the current values. Cheap; safe to call from
    // any change handler.
    void RefreshOptionStates();

    // Whether the device named by one letter ("k" keyboard, "m" mouse, "j" joystick, "s"
    // Stelladaptor) can drive the controller selected on the left (bLeft) or right port.
    bool CheckIPC(bool bLeft, const QString& device) const;
    // The switch builders: each reads its controls as they are now and returns an empty
    // text or switches that start with a blank (" -c1"). Some tidy the number fields they
    // read and the controller ones caption the layout-picture buttons, every time.
    QString LeftController();
    QString RightController();
    QString Interlaced();
    QString P0Hard();
    QString P1Hard();
    QString All4();
    QString StartBW();
    QString ScreenCapture();
    QString ColorPalette();
    QString DSP();
    QString Narrow();
    QString Phos();
    QString GameType();
    QString ScanLines();
    QString IPC();
    QString MindlinkLeft();
    QString MindlinkRight();
    QString Joystick();
    QString PaddleSens();
    QString LowerSens();
    QString Paddle();
    QString MouseCapture();
    QString LightGun();
    QString ShowScanline();
    QString PALColorLoss();
    QString Quiet();
    QString SoundQueue();
    QString FPS();
    QString CodeTrace();
    QString LineScan();
    QString VideoMode();
    QString DrivCont();
    QString SwapControl();
    QString KeyCont();
    QString PrintChecksum();
    QString FastCopy();
    QString SyncWSound();

    // The switches a launch sends: the launch's builders concatenated in their fixed
    // order, with the leading blank of the first.
    QString LaunchSwitches();

    // Called with ForceLoad true when Enter is pressed in the edited switches; the main
    // window starts the emulator from it.
    void setLoadRomHandler(std::function<void(bool)> handler);

    // Option sets (.lum files). LoadSettings writes the file's options into the controls
    // and returns false, after saying so, when the file is corrupt; the two buttons (also
    // the main window's File menu) ask for a file and report in lblConfig.
    bool LoadSettings(const QString& path);
    // The same for an option set read earlier with readOptionSet.
    bool LoadSettings(const ConfigDecode& optionSet);
    static ConfigDecode readOptionSet(const QString& path);
    void cmdSaveDat_Click();
    void cmdLoadDat_Click();

    // The layout picture's file name for a button caption ("/lum Paddles.jpg" for one that
    // mentions "paddle"), or "" when the caption names no layout.
    QString GetPicName(const QString& cmdTxt) const;
    void cmdLeftControlPic_Click();
    void cmdRightControlPic_Click();

    // Slider bars. Every handler ends in RefreshOptionStates.
    void BarColorPaddle_Change();
    void BarColorPhos_Change();
    // Back to the default, 77.
    void BarColorPhos_DblClick();
    void BarColorSoundQueue_Change();
    // Back to the default window 4500..4700 and value 4608.
    void BarColorSoundQueue_DblClick();
    // '+' and '-' shift the scale by 100.
    void BarColorSoundQueue_KeyPress(int KeyAscii);
    // Pops up mnuSQPopup at the mouse.
    void BarColorSoundQueue_RightClick();
    void mnuSQShiftUp_Click();
    void mnuSQShiftDown_Click();
    void mnuSQReset_Click();
    QMenu* mnuSQPopup = nullptr;
    QAction* mnuSQShiftUp = nullptr;
    QAction* mnuSQShiftDown = nullptr;
    QAction* mnuSQBar = nullptr;
    QAction* mnuSQReset = nullptr;

    // Default Paths page.
    void LoadDefaultPaths();
    void SaveDefaultPaths();
    void txtDefPathFilter_Change();
    // Adds one folder; `bArchive` marks a dropped archive, which is refused.
    void AddRomFolder(const QString& path, bool bArchive);
    // Validates the emulator path (a folder is completed with the emulator's name) and
    // stores it, or says why not.
    void SetZ26Path(const QString& path);
    void cmdAddZ26Path_Click();
    void mnuROMSRemove_Click();
    void mnuROMSRefresh_Click();
    void mnuROMSAdd_Click();
    void vbalListDefPaths_KeyDown(int key);
    // Right button: pops up the list's menu at `pos` (list viewport coordinates), offering
    // "Remove" only with a selected row.
    void vbalListDefPaths_MouseDown(Qt::MouseButton button, const QPoint& pos);
    void vbalListDefPaths_OLEDragDrop(const QMimeData* data);
    void txtDefPathz26_OLEDragDrop(const QMimeData* data);

    // Frame and tabs.
    PictureBox* picSideText = nullptr;
    QTabWidget* vbalDTabControl1 = nullptr;
    QWidget* picSettings = nullptr;
    QWidget* picControls = nullptr;
    QWidget* picPaddlesAudio = nullptr;
    QWidget* picVideo = nullptr;
    QWidget* picDebug = nullptr;
    QWidget* picDefPaths = nullptr;

    // Settings page.
    QGroupBox* fraConfig = nullptr;
    QPushButton* cmdSaveDat = nullptr;
    QPushButton* cmdLoadDat = nullptr;
    QLabel* lblConfig = nullptr;
    QGroupBox* fraVideoMode = nullptr;
    QComboBox* comboVideoMode = nullptr;
    QRadioButton* optVMWindow = nullptr;
    QRadioButton* optVMFull = nullptr;
    QRadioButton* optVMDefault = nullptr;
    QLineEdit* txtVidModeBalloon = nullptr;
    QGroupBox* fraScreenCapture = nullptr;
    QRadioButton* optSCPCX = nullptr;
    QRadioButton* optSCBMP = nullptr;
    QGroupBox* fraDSP = nullptr;
    QRadioButton* optDSPLow = nullptr;
    QRadioButton* optDSPHigh = nullptr;
    QRadioButton* optDSPDefault = nullptr;
    QGroupBox* fraStart = nullptr;
    QCheckBox* chkP0Hard = nullptr;
    QCheckBox* chkP1Hard = nullptr;
    QCheckBox* chkBW = nullptr;

    // Controls page.
    QPushButton* cmdLeftControlPic = nullptr;
    QPushButton* cmdRightControlPic = nullptr;
    QGroupBox* fraPaddleSens = nullptr;
    vbalProgressBar* BarColorPaddle = nullptr;
    QGroupBox* fraInactiveControll = nullptr;
    QCheckBox* chkIPCStella = nullptr;
    QCheckBox* chkIPCJoystick = nullptr;
    QCheckBox* chkIPCMouse = nullptr;
    QCheckBox* chkIPCKeyboard = nullptr;
    QLineEdit* txtIPC4Balloon = nullptr;
    QGroupBox* fraRightController = nullptr;
    QComboBox* comboRightController = nullptr;
    QGroupBox* fraLeftController = nullptr;
    QComboBox* comboLeftController = nullptr;
    QGroupBox* fraLightgun = nullptr;
    QLabel* lblLightGunAdjust = nullptr;
    QLineEdit* txtLightGunCycles = nullptr;
    QLabel* lblLightGunCycles = nullptr;
    QLineEdit* txtLightGunScan = nullptr;
    QLabel* lblLightGunScan = nullptr;
    QCheckBox* chkSwapControl = nullptr;

    // Paddles / Audio page.
    QGroupBox* fraLowerSens = nullptr;
    QLabel* lblLowerSens = nullptr;
    QCheckBox* chkLowerSens = nullptr;
    QLineEdit* txtLowerSens = nullptr;
    QLabel* lblLowerSensScan = nullptr;
    QGroupBox* fraSoundQueue = nullptr;
    vbalProgressBar* BarColorSoundQueue = nullptr;
    QGroupBox* fraPaddleMouse = nullptr;
    // "Paddle 0" to "Paddle 3" of each mouse, plus each one's "None".
    std::array<QRadioButton*, 4> optPaddleM1{};
    QRadioButton* optPaddleM1None = nullptr;
    std::array<QRadioButton*, 4> optPaddleM2{};
    QRadioButton* optPaddleM2None = nullptr;
    QCheckBox* chkQuiet = nullptr;

    // Video page.
    QGroupBox* fraScanLines = nullptr;
    QCheckBox* chkScanLines = nullptr;
    QLineEdit* txtScanLines = nullptr;
    QLabel* lblScanLines = nullptr;
    QGroupBox* fraFrameRate = nullptr;
    QRadioButton* optFPScustom = nullptr;
    QLineEdit* txtFPScustom = nullptr;
    QRadioButton* optFPSmonitor = nullptr;
    QRadioButton* optFPSDefault = nullptr;
    QGroupBox* fraNarrow = nullptr;
    QRadioButton* optNarrowNot = nullptr;
    QRadioButton* optNarrow1 = nullptr;
    QRadioButton* optNarrow2 = nullptr;
    QGroupBox* fraPhos = nullptr;
    vbalProgressBar* BarColorPhos = nullptr;
    QGroupBox* fraColorPalette = nullptr;
    QRadioButton* optCPNTSC = nullptr;
    QRadioButton* optCPPAL = nullptr;
    QRadioButton* optCPSECAM = nullptr;
    QRadioButton* optCPDefault = nullptr;
    QCheckBox* chkPALColorLoss = nullptr;
    QCheckBox* chkSyncWSound = nullptr;
    QCheckBox* chkInterlaced = nullptr;

    // Debugging page.
    QGroupBox* fraLineScan = nullptr;
    QCheckBox* chkLineScan = nullptr;
    QLineEdit* txtLineScan = nullptr;
    QGroupBox* fraGameType = nullptr;
    QComboBox* comboGT = nullptr;
    QCheckBox* chkMouseCapture = nullptr;
    QCheckBox* chkAllow4 = nullptr;
    QCheckBox* chkFastCopy = nullptr;
    QCheckBox* chkPrintChecksum = nullptr;
    QCheckBox* chkCodeTrace = nullptr;
    QCheckBox* chkShowScanline = nullptr;
    QGroupBox* fraDOSOutput = nullptr;
    QCheckBox* chkDOSSwitch = nullptr;
    QLabel* lblDOSSwitchInstruction = nullptr;
    QLabel* lblDOSOutput = nullptr;
    QLineEdit* txtDOSOutput = nullptr;

    // Default Paths page.
    QGroupBox* fraDefPathFilter = nullptr;
    QLineEdit* txtDefPathFilter = nullptr;
    QGroupBox* fraDefPathz26 = nullptr;
    QLineEdit* txtDefPathz26 = nullptr;
    QPushButton* cmdAddZ26Path = nullptr;
    QGroupBox* fraDefPathRom = nullptr;
    QTreeWidget* vbalListDefPaths = nullptr;
    QMenu* mnuROMSPopup = nullptr;
    QAction* mnuROMSRemove = nullptr;
    QAction* mnuROMSRefresh = nullptr;
    QAction* mnuROMSAdd = nullptr;

    // Retired controls: never shown, changed only by loading a configuration file.
    QWidget* picGraveyard = nullptr;
    QPushButton* cmdStandard = nullptr;
    QPushButton* cmdDriving = nullptr;
    QPushButton* cmdKeyboard = nullptr;
    QPushButton* cmdMindlink = nullptr;
    QGroupBox* fraKeyCont = nullptr;
    QCheckBox* chkKeyLeft = nullptr;
    QCheckBox* chkKeyRight = nullptr;
    QGroupBox* fraDriveCont = nullptr;
    QCheckBox* chkDriveLeft = nullptr;
    QCheckBox* chkDriveRight = nullptr;
    QGroupBox* fraPaddleKey = nullptr;
    std::array<QRadioButton*, 4> optPaddleKey{};
    QRadioButton* optPaddleKeyNone = nullptr;
    QGroupBox* fraJoyOptions = nullptr;
    QRadioButton* optJoyDefault = nullptr;
    QRadioButton* optJoyKey = nullptr;
    QRadioButton* optJoyRev = nullptr;
    QGroupBox* fraMindlink = nullptr;
    QCheckBox* chkMindlinkLeft = nullptr;
    QCheckBox* chkMindlinkRight = nullptr;
    QCheckBox* chkLightGun = nullptr;

protected:
    void closeEvent(QCloseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void createSettingsPage();
    void createControlsPage();
    void createPaddlesAudioPage();
    void createVideoPage();
    void createDebugPage();
    void createDefaultPathsPage();
    void createGraveyard();
    // Each slider bar with its range, start value, text and handlers.
    vbalProgressBar* createBarColorPaddle();
    vbalProgressBar* createBarColorPhos();
    vbalProgressBar* createBarColorSoundQueue();
    void fillComboLists();
    void placeTabControl();

    void Form_Load();
    void Form_Unload();
    void Form_Resize();
    void vbalDTabControl1_TabClick(int index);
    void vbalDTabControl1_TabSelected(int index);
    void vbalListDefPaths_ItemChanged(QTreeWidgetItem* item, int column);

    QTreeWidgetItem* selectedRomRow() const;
    void addRomRow(const QString& path, bool bEnabled);
    // Sets every row's count from its folder with the current pattern.
    void recountRomRows();
    QString tabKey(int index) const;

    // Option behaviour: the controls' reactions, the numeric fields' filter and the
    // switch-edit mode.
    void connectOptionControls();
    bool optionControlEvent(QObject* watched, QEvent* event);
    void numberCheck_Click(QCheckBox* box, QLineEdit* field);
    void optFPS_Click();
    void comboVideoMode_Click();
    void chkDOSSwitch_Click();
    void txtDOSOutput_KeyPress();
    // Gives a number field the decimal text of its leading number.
    QString normaliseField(QLineEdit* field);

    // Option sets and the layout-picture buttons.
    void connectConfigControls();
    bool reportCorruptOptionSet();
    void showControlPic(const QPushButton* button);

    Platform& m_platform;
    cLogo m_logo;
    FileLister FileROM;
    bool m_bCountsPending = false; // the folder counts wait for the window to show
    QButtonGroup* m_groupPaddleM1 = nullptr;
    QButtonGroup* m_groupPaddleM2 = nullptr;
    bool m_bUnloading = false;
    std::function<void(bool)> m_loadRom;
    // A refresh asked for while one runs (a field it tidies reports the change) is run
    // once more after it instead of inside it.
    bool m_bRefreshing = false;
    bool m_bRefreshAgain = false;
    // Created by the first picture button click; it deletes itself when closed.
    QPointer<frmPicPreview> m_picPreview;
};
