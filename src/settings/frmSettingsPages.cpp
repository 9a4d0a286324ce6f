// The settings window's pages: their controls, captions, grouping and initial states.
// What the option controls do is wired elsewhere; the Default Paths page's behaviour is in
// frmSettings.cpp.

#include "settings/frmSettings.h"

#include "settings/OptionLists.h"
#include "ui/Twips.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QRadioButton>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace {

template <class T> T* named(T* widget, const char* name) {
    widget->setObjectName(QLatin1String(name));
    return widget;
}

QGroupBox* frame(const char* name, const char* title) {
    return named(new QGroupBox(QString::fromUtf8(title)), name);
}

QCheckBox* check(const char* name, const char* caption) {
    return named(new QCheckBox(QString::fromUtf8(caption)), name);
}

QRadioButton* option(const char* name, const char* caption) {
    return named(new QRadioButton(QString::fromUtf8(caption)), name);
}

QLabel* label(const char* name, const char* caption) {
    return named(new QLabel(QString::fromUtf8(caption)), name);
}

// The numeric option fields are short: a few digits.
QLineEdit* numberField(const char* name, const char* text) {
    auto* field = named(new QLineEdit(QString::fromUtf8(text)), name);
    field->setFixedWidth(twips::toPixelsX(750));
    return field;
}

// A balloon tip's anchor: a text box that is never shown, only pointed at.
QLineEdit* balloonAnchor(const char* name, QWidget* parent) {
    auto* anchor = named(new QLineEdit(parent), name);
    anchor->hide();
    return anchor;
}

// Layouts of the pages are tight: the tab control has a fixed size.
template <class L> L* tight(L* layout, int spacing = 4) {
    layout->setContentsMargins(6, 2, 6, 4);
    layout->setSpacing(spacing);
    return layout;
}

QVBoxLayout* pageLayout(QWidget* page) {
    auto* layout = new QVBoxLayout(page);
    layout->setContentsMargins(6, 6, 6, 6);
    layout->setSpacing(4);
    return layout;
}

QHBoxLayout* row(std::initializer_list<QWidget*> widgets, bool bStretch = true) {
    auto* layout = new QHBoxLayout;
    layout->setSpacing(8);
    for (QWidget* widget : widgets)
        layout->addWidget(widget);
    if (bStretch)
        layout->addStretch(1);
    return layout;
}

} // namespace

void frmSettings::createSettingsPage() {
    auto* page = pageLayout(picSettings);

    fraConfig = frame("fraConfig", "Save/Load settings");
    cmdSaveDat = named(new QPushButton(QStringLiteral("&Save")), "cmdSaveDat");
    cmdLoadDat = named(new QPushButton(QStringLiteral("&Load")), "cmdLoadDat");
    lblConfig = named(new QLabel, "lblConfig");
    lblConfig->setWordWrap(true);
    auto* config = tight(new QHBoxLayout(fraConfig), 8);
    config->addWidget(cmdSaveDat);
    config->addWidget(cmdLoadDat);
    config->addWidget(lblConfig, 1);
    page->addWidget(fraConfig);

    fraVideoMode = frame("fraVideoMode", "Start game in Video Mode...");
    comboVideoMode = named(new QComboBox, "comboVideoMode");
    optVMWindow = option("optVMWindow", "Window");
    optVMFull = option("optVMFull", "Fullscreen");
    optVMDefault = option("optVMDefault", "Default");
    optVMDefault->setChecked(true);
    txtVidModeBalloon = balloonAnchor("txtVidModeBalloon", fraVideoMode);
    auto* video = tight(new QVBoxLayout(fraVideoMode));
    video->addWidget(comboVideoMode);
    video->addLayout(row({optVMWindow, optVMFull, optVMDefault}));

    fraScreenCapture = frame("fraScreenCapture", "Screen Capture to...");
    optSCPCX = option("optSCPCX", "PCX file");
    optSCBMP = option("optSCBMP", "BMP file");
    optSCBMP->setToolTip(QStringLiteral("Works with phosphorescent games."));
    optSCPCX->setChecked(true);
    auto* capture = tight(new QVBoxLayout(fraScreenCapture), 0);
    capture->addWidget(optSCPCX);
    capture->addWidget(optSCBMP);
    capture->addStretch(1);

    auto* middle = new QHBoxLayout;
    middle->addWidget(fraVideoMode, 1);
    middle->addWidget(fraScreenCapture);
    page->addLayout(middle);

    fraDSP = frame("fraDSP", "DSP processing level");
    optDSPLow = option("optDSPLow", "Low");
    optDSPHigh = option("optDSPHigh", "High");
    optDSPDefault = option("optDSPDefault", "Default");
    optDSPDefault->setChecked(true);
    auto* dsp = tight(new QVBoxLayout(fraDSP), 0);
    dsp->addWidget(optDSPLow);
    dsp->addWidget(optDSPHigh);
    dsp->addWidget(optDSPDefault);

    fraStart = frame("fraStart", "Start game with...");
    chkP0Hard = check("chkP0Hard", "Player 0 hard");
    chkP1Hard = check("chkP1Hard", "Player 1 hard");
    chkBW = check("chkBW", "Black and white");
    auto* start = tight(new QVBoxLayout(fraStart), 0);
    start->addWidget(chkP0Hard);
    start->addWidget(chkP1Hard);
    start->addWidget(chkBW);

    auto* bottom = new QHBoxLayout;
    bottom->addWidget(fraDSP, 1);
    bottom->addWidget(fraStart, 1);
    page->addLayout(bottom);
    page->addStretch(1);
}

void frmSettings::createControlsPage() {
    auto* page = pageLayout(picControls);

    fraLeftController = frame("fraLeftController", "Select Controller On Left Port");
    comboLeftController = named(new QComboBox, "comboLeftController");
    tight(new QVBoxLayout(fraLeftController))->addWidget(comboLeftController);
    fraRightController = frame("fraRightController", "Select Controller On Right Port");
    comboRightController = named(new QComboBox, "comboRightController");
    tight(new QVBoxLayout(fraRightController))->addWidget(comboRightController);
    // Until the controller lists set them, the buttons name the layout of "AutoDetect".
    cmdLeftControlPic =
        named(new QPushButton(QStringLiteral("Standard Control Layout")), "cmdLeftControlPic");
    cmdRightControlPic =
        named(new QPushButton(QStringLiteral("Standard Control Layout")), "cmdRightControlPic");

    auto* ports = new QGridLayout;
    ports->setVerticalSpacing(2);
    ports->addWidget(fraLeftController, 0, 0);
    ports->addWidget(fraRightController, 0, 1);
    ports->addWidget(cmdLeftControlPic, 1, 0);
    ports->addWidget(cmdRightControlPic, 1, 1);
    page->addLayout(ports);

    fraInactiveControll = frame("fraInactiveControll", "Inactivate PC-controller");
    chkIPCStella = check("chkIPCStella", "Stelladaptor");
    chkIPCJoystick = check("chkIPCJoystick", "Joystick");
    chkIPCMouse = check("chkIPCMouse", "Mouse");
    chkIPCKeyboard = check("chkIPCKeyboard", "Keyboard");
    txtIPC4Balloon = balloonAnchor("txtIPC4Balloon", fraInactiveControll);
    tight(new QVBoxLayout(fraInactiveControll))
        ->addLayout(row({chkIPCStella, chkIPCJoystick, chkIPCMouse, chkIPCKeyboard}));
    page->addWidget(fraInactiveControll);

    fraPaddleSens = frame("fraPaddleSens", "Keyboard Paddle Sensitivity");
    BarColorPaddle = createBarColorPaddle();
    tight(new QVBoxLayout(fraPaddleSens))->addWidget(BarColorPaddle);

    // Shown only while a port holds a light gun.
    fraLightgun = frame("fraLightgun", "LightGun");
    lblLightGunAdjust = label("lblLightGunAdjust", "Adjust by...");
    txtLightGunCycles = numberField("txtLightGunCycles", "0");
    lblLightGunCycles = label("lblLightGunCycles", "Cycles");
    txtLightGunScan = numberField("txtLightGunScan", "0");
    lblLightGunScan = label("lblLightGunScan", "Scanlines");
    auto* lightgun = tight(new QHBoxLayout(fraLightgun));
    for (QWidget* widget :
         {static_cast<QWidget*>(lblLightGunAdjust), static_cast<QWidget*>(txtLightGunCycles),
          static_cast<QWidget*>(lblLightGunCycles), static_cast<QWidget*>(txtLightGunScan),
          static_cast<QWidget*>(lblLightGunScan)})
        lightgun->addWidget(widget);
    lightgun->addStretch(1);
    fraLightgun->setEnabled(false);
    fraLightgun->hide();

    auto* middle = new QHBoxLayout;
    middle->addWidget(fraPaddleSens, 1);
    middle->addWidget(fraLightgun, 1);
    page->addLayout(middle);

    chkSwapControl = check("chkSwapControl", "Swap Atari Controller Ports");
    chkSwapControl->setToolTip(QStringLiteral("For All Controller Types"));
    page->addWidget(chkSwapControl);
    page->addStretch(1);
}

void frmSettings::createPaddlesAudioPage() {
    auto* page = pageLayout(picPaddlesAudio);

    fraLowerSens = frame("fraLowerSens", "Lower Sesitivity");
    lblLowerSens = label("lblLowerSens", "Lower sesitivity for PC Joysticks / Stelladaptor in "
                                         "Paddle Emulation, and delay the paddle read-bit "
                                         "flipping by...");
    lblLowerSens->setWordWrap(true);
    chkLowerSens = check("chkLowerSens", "Enable");
    txtLowerSens = numberField("txtLowerSens", "1");
    txtLowerSens->setEnabled(false);
    lblLowerSensScan = label("lblLowerSensScan", "Scanlines");
    auto* lower = tight(new QVBoxLayout(fraLowerSens), 2);
    lower->addWidget(lblLowerSens);
    lower->addLayout(row({chkLowerSens, txtLowerSens, lblLowerSensScan}));
    page->addWidget(fraLowerSens);

    fraSoundQueue = frame("fraSoundQueue", "Size of Sound Queue");
    BarColorSoundQueue = createBarColorSoundQueue();
    tight(new QVBoxLayout(fraSoundQueue))->addWidget(BarColorSoundQueue);
    page->addWidget(fraSoundQueue);

    // Two groups in one frame: the first mouse's paddle and the second's.
    fraPaddleMouse = frame("fraPaddleMouse", "Paddles to Emulate with Mouse");
    auto* paddles = tight(new QGridLayout(fraPaddleMouse), 0);
    paddles->setHorizontalSpacing(8);
    const auto makeGroup = [&](std::array<QRadioButton*, 4>& buttons, QRadioButton*& none,
                               const char* prefix, int gridRow) {
        auto* group = new QButtonGroup(this);
        for (int i = 0; i < 4; ++i) {
            const QByteArray name = QByteArray(prefix) + '_' + QByteArray::number(i);
            buttons[i] = option(name.constData(), ("Paddle " + QByteArray::number(i)).constData());
            group->addButton(buttons[i], i);
            paddles->addWidget(buttons[i], gridRow, i);
        }
        none = option((QByteArray(prefix) + "None").constData(), "None");
        group->addButton(none, 4);
        paddles->addWidget(none, gridRow, 4);
        none->setChecked(true);
        return group;
    };
    m_groupPaddleM1 = makeGroup(optPaddleM1, optPaddleM1None, "optPaddleM1", 0);
    m_groupPaddleM2 = makeGroup(optPaddleM2, optPaddleM2None, "optPaddleM2", 1);
    paddles->setColumnStretch(5, 1);
    page->addWidget(fraPaddleMouse);

    chkQuiet = check("chkQuiet", "Quiet... Disable Sound");
    page->addWidget(chkQuiet);
    page->addStretch(1);
}

void frmSettings::createVideoPage() {
    auto* page = pageLayout(picVideo);

    fraScanLines = frame("fraScanLines", "Scanlines");
    chkScanLines = check("chkScanLines", "Enabled");
    txtScanLines = numberField("txtScanLines", "0");
    txtScanLines->setEnabled(false);
    lblScanLines = label("lblScanLines", "Set the maximum number of scanlines to render (Height)");
    lblScanLines->setWordWrap(true);
    auto* scan = tight(new QHBoxLayout(fraScanLines), 8);
    scan->addWidget(chkScanLines);
    scan->addWidget(txtScanLines);
    scan->addWidget(lblScanLines, 1);
    page->addWidget(fraScanLines);

    fraFrameRate = frame("fraFrameRate", "Frame Rate");
    optFPScustom = option("optFPScustom", "Custom FPS");
    txtFPScustom = numberField("txtFPScustom", "");
    txtFPScustom->setEnabled(false);
    optFPSmonitor = option("optFPSmonitor", "Monitor Speed");
    optFPSDefault = option("optFPSDefault", "Default");
    optFPSDefault->setChecked(true);
    tight(new QVBoxLayout(fraFrameRate))
        ->addLayout(row({optFPScustom, txtFPScustom, optFPSmonitor, optFPSDefault}));

    fraNarrow = frame("fraNarrow", "Narrow Video Modes");
    optNarrowNot = option("optNarrowNot", "Not Enabled");
    optNarrow1 = option("optNarrow1", "Mode 1");
    optNarrow2 = option("optNarrow2", "Mode 2");
    optNarrowNot->setChecked(true);
    tight(new QVBoxLayout(fraNarrow))->addLayout(row({optNarrowNot, optNarrow1, optNarrow2}));

    auto* rateNarrow = new QHBoxLayout;
    rateNarrow->addWidget(fraFrameRate, 1);
    rateNarrow->addWidget(fraNarrow);
    page->addLayout(rateNarrow);

    fraColorPalette = frame("fraColorPalette", "Color Palette");
    optCPNTSC = option("optCPNTSC", "NTSC");
    optCPPAL = option("optCPPAL", "PAL");
    optCPSECAM = option("optCPSECAM", "SECAM");
    optCPDefault = option("optCPDefault", "Default");
    optCPDefault->setChecked(true);
    tight(new QVBoxLayout(fraColorPalette))
        ->addLayout(row({optCPNTSC, optCPPAL, optCPSECAM, optCPDefault}));

    fraPhos = frame("fraPhos", "Phosphorescent Effect");
    BarColorPhos = createBarColorPhos();
    tight(new QVBoxLayout(fraPhos))->addWidget(BarColorPhos);

    auto* palettePhos = new QHBoxLayout;
    palettePhos->addWidget(fraColorPalette);
    palettePhos->addWidget(fraPhos, 1);
    page->addLayout(palettePhos);

    chkPALColorLoss = check("chkPALColorLoss", "Simulate PAL color loss");
    chkSyncWSound = check("chkSyncWSound", "Synchronize with sound instead of display");
    chkInterlaced = check("chkInterlaced", "Run interlaced games");
    auto* boxes = new QGridLayout;
    boxes->setVerticalSpacing(0);
    boxes->addWidget(chkPALColorLoss, 0, 0);
    boxes->addWidget(chkSyncWSound, 0, 1);
    boxes->addWidget(chkInterlaced, 1, 0);
    boxes->setColumnStretch(1, 1);
    page->addLayout(boxes);
    page->addStretch(1);
}

void frmSettings::createDebugPage() {
    auto* page = pageLayout(picDebug);
    page->setSpacing(2);

    fraLineScan = frame("fraLineScan", "Start Scanning Game at Line...");
    chkLineScan = check("chkLineScan", "Enabled");
    txtLineScan = numberField("txtLineScan", "0");
    txtLineScan->setEnabled(false);
    tight(new QVBoxLayout(fraLineScan))->addLayout(row({chkLineScan, txtLineScan}));

    fraGameType = frame("fraGameType", "Override Game Type");
    comboGT = named(new QComboBox, "comboGT");
    tight(new QVBoxLayout(fraGameType))->addWidget(comboGT);

    auto* top = new QHBoxLayout;
    top->addWidget(fraLineScan);
    top->addWidget(fraGameType, 1);
    page->addLayout(top);

    chkMouseCapture = check("chkMouseCapture", "Enable mouse capture in a window");
    chkMouseCapture->setChecked(true);
    chkAllow4 =
        check("chkAllow4", "Allow all 4 directions on the joystick to be pressed simultaneously");
    chkFastCopy = check("chkFastCopy", "Disable the fast copy routines");
    chkPrintChecksum = check("chkPrintChecksum", "Print checksum of cartridge");
    chkCodeTrace = check("chkCodeTrace", "Write code trace to z26.log");
    chkShowScanline = check("chkShowScanline", "Show scanline count and FPS on game display");
    for (QCheckBox* box :
         {chkMouseCapture, chkAllow4, chkFastCopy, chkPrintChecksum, chkCodeTrace, chkShowScanline})
        page->addWidget(box);

    fraDOSOutput = frame("fraDOSOutput", "DOS Command Switches Outputed");
    chkDOSSwitch = check("chkDOSSwitch", "Edit Switches");
    lblDOSSwitchInstruction = label("lblDOSSwitchInstruction", "Press Enter to Execute Game");
    lblDOSSwitchInstruction->hide();
    lblDOSOutput = named(new QLabel, "lblDOSOutput");
    lblDOSOutput->setTextInteractionFlags(Qt::TextSelectableByMouse);
    lblDOSOutput->setMinimumHeight(twips::toPixelsY(315));
    txtDOSOutput = named(new QLineEdit, "txtDOSOutput");
    txtDOSOutput->hide();
    auto* dos = tight(new QGridLayout(fraDOSOutput), 2);
    dos->setHorizontalSpacing(8);
    dos->addWidget(chkDOSSwitch, 0, 0);
    // The preview label and the edit box take turns in the same place, so the frame
    // keeps its height in both modes.
    dos->addWidget(lblDOSOutput, 0, 1);
    dos->addWidget(txtDOSOutput, 0, 1);
    dos->addWidget(lblDOSSwitchInstruction, 0, 2);
    dos->setColumnStretch(1, 1);
    page->addWidget(fraDOSOutput);
    page->addStretch(1);
}

void frmSettings::createDefaultPathsPage() {
    auto* page = pageLayout(picDefPaths);

    fraDefPathFilter = frame("fraDefPathFilter", "ROM Filter");
    txtDefPathFilter = named(new QLineEdit, "txtDefPathFilter");
    tight(new QVBoxLayout(fraDefPathFilter))->addWidget(txtDefPathFilter);
    page->addWidget(fraDefPathFilter);

    fraDefPathz26 = frame("fraDefPathz26", "Drag && Drop z26 Path Here...");
    txtDefPathz26 = named(new QLineEdit, "txtDefPathz26");
    // Changed only through the chooser or a drop, which check the path first.
    txtDefPathz26->setReadOnly(true);
    txtDefPathz26->setAcceptDrops(true);
    cmdAddZ26Path = named(new QPushButton(QStringLiteral("...")), "cmdAddZ26Path");
    cmdAddZ26Path->setFixedWidth(twips::toPixelsX(495));
    auto* z26 = tight(new QHBoxLayout(fraDefPathz26));
    z26->addWidget(txtDefPathz26, 1);
    z26->addWidget(cmdAddZ26Path);
    page->addWidget(fraDefPathz26);

    fraDefPathRom = frame("fraDefPathRom", "Drag && Drop ROM's Paths Here...");
    vbalListDefPaths = named(new QTreeWidget, "vbalListDefPaths");
    vbalListDefPaths->setRootIsDecorated(false);
    vbalListDefPaths->setUniformRowHeights(true);
    vbalListDefPaths->setAllColumnsShowFocus(true);
    vbalListDefPaths->setSelectionMode(QAbstractItemView::SingleSelection);
    vbalListDefPaths->setContextMenuPolicy(Qt::CustomContextMenu);
    vbalListDefPaths->setAcceptDrops(true);
    vbalListDefPaths->viewport()->setAcceptDrops(true);
    tight(new QVBoxLayout(fraDefPathRom))->addWidget(vbalListDefPaths);
    page->addWidget(fraDefPathRom, 1);

    mnuROMSPopup = named(new QMenu(QStringLiteral("ROMSPopup"), this), "mnuROMSPopup");
    mnuROMSRemove = named(mnuROMSPopup->addAction(QStringLiteral("Remove")), "mnuROMSRemove");
    mnuROMSRefresh = named(mnuROMSPopup->addAction(QStringLiteral("Refresh")), "mnuROMSRefresh");
    mnuROMSAdd = named(mnuROMSPopup->addAction(QStringLiteral("Add Path")), "mnuROMSAdd");
}

void frmSettings::createGraveyard() {
    // Retired controls. Loading a configuration file still sets some of them, and switch
    // builders nobody calls read them; the user never sees them.
    picGraveyard = named(new QWidget(this), "picGraveyard");
    picGraveyard->hide();
    auto* layout = new QVBoxLayout(picGraveyard);

    cmdStandard = named(new QPushButton(QStringLiteral("Joystick Controlls")), "cmdStandard");
    cmdDriving = named(new QPushButton(QStringLiteral("Driving Controls")), "cmdDriving");
    cmdKeyboard = named(new QPushButton(QStringLiteral("Keyboard Controlls")), "cmdKeyboard");
    cmdMindlink = named(new QPushButton(QStringLiteral("See Pic")), "cmdMindlink");
    for (QPushButton* button : {cmdStandard, cmdDriving, cmdKeyboard, cmdMindlink})
        layout->addWidget(button);

    const auto pair = [&](QGroupBox*& box, const char* name, const char* title, QCheckBox*& left,
                          const char* leftName, QCheckBox*& right, const char* rightName) {
        box = frame(name, title);
        left = check(leftName, "Left");
        right = check(rightName, "Right");
        auto* inner = new QHBoxLayout(box);
        inner->addWidget(left);
        inner->addWidget(right);
        layout->addWidget(box);
    };
    pair(fraKeyCont, "fraKeyCont", "Emulate Keyboard Controler", chkKeyLeft, "chkKeyLeft",
         chkKeyRight, "chkKeyRight");
    pair(fraDriveCont, "fraDriveCont", "Emulate Driving Controler", chkDriveLeft, "chkDriveLeft",
         chkDriveRight, "chkDriveRight");
    pair(fraMindlink, "fraMindlink", "Enable Mindlink Controller", chkMindlinkLeft,
         "chkMindlinkLeft", chkMindlinkRight, "chkMindlinkRight");

    fraPaddleKey = frame("fraPaddleKey", "Paddle to Emulate with Keyboard");
    auto* paddleKey = new QHBoxLayout(fraPaddleKey);
    for (int i = 0; i < 4; ++i) {
        const QByteArray name = QByteArrayLiteral("optPaddleKey_") + QByteArray::number(i);
        optPaddleKey[i] = option(name.constData(), ("Paddle " + QByteArray::number(i)).constData());
        paddleKey->addWidget(optPaddleKey[i]);
    }
    optPaddleKeyNone = option("optPaddleKeyNone", "None");
    optPaddleKeyNone->setChecked(true);
    paddleKey->addWidget(optPaddleKeyNone);
    layout->addWidget(fraPaddleKey);

    fraJoyOptions = frame("fraJoyOptions", "Joystick Options");
    optJoyDefault = option("optJoyDefault", "Default");
    optJoyKey = option("optJoyKey", "Keyboard Only");
    optJoyRev = option("optJoyRev", "Reverse Keyboard");
    optJoyDefault->setChecked(true);
    auto* joy = new QHBoxLayout(fraJoyOptions);
    joy->addWidget(optJoyDefault);
    joy->addWidget(optJoyKey);
    joy->addWidget(optJoyRev);
    layout->addWidget(fraJoyOptions);

    chkLightGun = check("chkLightGun", "Emulate Light Gun");
    layout->addWidget(chkLightGun);
}

void frmSettings::fillComboLists() {
    const auto fill = [](QComboBox* combo, const auto& entries) {
        for (const char* entry : entries)
            combo->addItem(QString::fromUtf8(entry));
        combo->setCurrentIndex(0);
    };
    fill(comboGT, kGameTypeEntries);
    fill(comboVideoMode, kVideoModeEntries);
    fill(comboLeftController, kControllerEntries);
    fill(comboRightController, kControllerEntries);
}
