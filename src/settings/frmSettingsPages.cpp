// The settings window's pages: their controls, captions and grouping. What the option
// controls show and do comes from the options (frmSettingsOptions.cpp); the Default Paths
// page's behaviour is in frmSettings.cpp.

#include "settings/frmSettingsUi.h"

#include "emulator/EmulatorOptions.h"
#include "settings/SliderRules.h"
#include "ui/PictureBox.h"
#include "ui/Twips.h"
#include "ui/vbalProgressBar.h"

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
QLineEdit* numberField(const char* name) {
    auto* field = named(new QLineEdit, name);
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

QComboBox* list(const char* name, const auto& entries) {
    auto* combo = named(new QComboBox, name);
    for (const char* entry : entries)
        combo->addItem(QString::fromUtf8(entry));
    return combo;
}

} // namespace

void frmSettings::createSettingsPage() {
    auto* page = pageLayout(m_ui->pages[0]);

    auto* fraConfig = frame("fraConfig", "Save/Load settings");
    auto* cmdSaveDat = named(new QPushButton(QStringLiteral("&Save")), "cmdSaveDat");
    auto* cmdLoadDat = named(new QPushButton(QStringLiteral("&Load")), "cmdLoadDat");
    connect(cmdSaveDat, &QPushButton::clicked, this, &frmSettings::cmdSaveDat_Click);
    connect(cmdLoadDat, &QPushButton::clicked, this, &frmSettings::cmdLoadDat_Click);
    m_ui->lblConfig = named(new QLabel, "lblConfig");
    m_ui->lblConfig->setWordWrap(true);
    // It names files, which show as they are called, never as markup.
    m_ui->lblConfig->setTextFormat(Qt::PlainText);
    auto* config = tight(new QHBoxLayout(fraConfig), 8);
    config->addWidget(cmdSaveDat);
    config->addWidget(cmdLoadDat);
    config->addWidget(m_ui->lblConfig, 1);
    page->addWidget(fraConfig);

    auto* fraVideoMode = frame("fraVideoMode", "Start game in Video Mode...");
    m_ui->comboVideoMode = list("comboVideoMode", kVideoModeEntries);
    m_ui->txtVidModeBalloon = balloonAnchor("txtVidModeBalloon", fraVideoMode);
    auto* video = tight(new QVBoxLayout(fraVideoMode));
    video->addWidget(m_ui->comboVideoMode);
    video->addLayout(row({option("optVMWindow", "Window"), option("optVMFull", "Fullscreen"),
                          option("optVMDefault", "Default")}));

    auto* fraScreenCapture = frame("fraScreenCapture", "Screen Capture to...");
    auto* optSCBMP = option("optSCBMP", "BMP file");
    optSCBMP->setToolTip(QStringLiteral("Works with phosphorescent games."));
    auto* capture = tight(new QVBoxLayout(fraScreenCapture), 0);
    capture->addWidget(option("optSCPCX", "PCX file"));
    capture->addWidget(optSCBMP);
    capture->addStretch(1);

    auto* middle = new QHBoxLayout;
    middle->addWidget(fraVideoMode, 1);
    middle->addWidget(fraScreenCapture);
    page->addLayout(middle);

    auto* fraDSP = frame("fraDSP", "DSP processing level");
    auto* dsp = tight(new QVBoxLayout(fraDSP), 0);
    dsp->addWidget(option("optDSPLow", "Low"));
    dsp->addWidget(option("optDSPHigh", "High"));
    dsp->addWidget(option("optDSPDefault", "Default"));

    auto* fraStart = frame("fraStart", "Start game with...");
    auto* start = tight(new QVBoxLayout(fraStart), 0);
    start->addWidget(check("chkP0Hard", "Player 0 hard"));
    start->addWidget(check("chkP1Hard", "Player 1 hard"));
    start->addWidget(check("chkBW", "Black and white"));

    auto* bottom = new QHBoxLayout;
    bottom->addWidget(fraDSP, 1);
    bottom->addWidget(fraStart, 1);
    page->addLayout(bottom);
    page->addStretch(1);
}

void frmSettings::createControlsPage() {
    auto* page = pageLayout(m_ui->pages[1]);

    auto* fraLeftController = frame("fraLeftController", "Select Controller On Left Port");
    tight(new QVBoxLayout(fraLeftController))
        ->addWidget(list("comboLeftController", kControllerEntries));
    auto* fraRightController = frame("fraRightController", "Select Controller On Right Port");
    tight(new QVBoxLayout(fraRightController))
        ->addWidget(list("comboRightController", kControllerEntries));
    auto& pictures = m_ui->pictureButtons;
    pictures = {named(new QPushButton, "cmdLeftControlPic"),
                named(new QPushButton, "cmdRightControlPic")};
    connect(pictures[0], &QPushButton::clicked, this, [this] { showControlPic(true); });
    connect(pictures[1], &QPushButton::clicked, this, [this] { showControlPic(false); });

    auto* ports = new QGridLayout;
    ports->setVerticalSpacing(2);
    ports->addWidget(fraLeftController, 0, 0);
    ports->addWidget(fraRightController, 0, 1);
    ports->addWidget(pictures[0], 1, 0);
    ports->addWidget(pictures[1], 1, 1);
    page->addLayout(ports);

    auto* fraInactiveControll = frame("fraInactiveControll", "Inactivate PC-controller");
    auto& ipc = m_ui->ipc;
    ipc = {check("chkIPCKeyboard", "Keyboard"), check("chkIPCMouse", "Mouse"),
           check("chkIPCJoystick", "Joystick"), check("chkIPCStella", "Stelladaptor")};
    m_ui->txtIPC4Balloon = balloonAnchor("txtIPC4Balloon", fraInactiveControll);
    tight(new QVBoxLayout(fraInactiveControll))->addLayout(row({ipc[3], ipc[2], ipc[1], ipc[0]}));
    page->addWidget(fraInactiveControll);

    m_ui->fraPaddleSens = frame("fraPaddleSens", "Keyboard Paddle Sensitivity");
    m_ui->BarColorPaddle =
        createSliderBar("BarColorPaddle", sliders::kPaddleMin, sliders::kPaddleMax);
    tight(new QVBoxLayout(m_ui->fraPaddleSens))->addWidget(m_ui->BarColorPaddle);

    // Shown only while a port holds a light gun.
    m_ui->fraLightgun = frame("fraLightgun", "LightGun");
    m_ui->lightGunFields = {numberField("txtLightGunCycles"), numberField("txtLightGunScan")};
    auto* lightgun = tight(new QHBoxLayout(m_ui->fraLightgun));
    for (QWidget* widget : std::initializer_list<QWidget*>{
             label("lblLightGunAdjust", "Adjust by..."), m_ui->lightGunFields[0],
             label("lblLightGunCycles", "Cycles"), m_ui->lightGunFields[1],
             label("lblLightGunScan", "Scanlines")})
        lightgun->addWidget(widget);
    lightgun->addStretch(1);

    auto* middle = new QHBoxLayout;
    middle->addWidget(m_ui->fraPaddleSens, 1);
    middle->addWidget(m_ui->fraLightgun, 1);
    page->addLayout(middle);

    auto* chkSwapControl = check("chkSwapControl", "Swap Atari Controller Ports");
    chkSwapControl->setToolTip(QStringLiteral("For All Controller Types"));
    page->addWidget(chkSwapControl);
    page->addStretch(1);
}

void frmSettings::createPaddlesAudioPage() {
    auto* page = pageLayout(m_ui->pages[2]);

    auto* fraLowerSens = frame("fraLowerSens", "Lower Sesitivity");
    auto* lblLowerSens = label("lblLowerSens", "Lower sesitivity for PC Joysticks / Stelladaptor "
                                               "in Paddle Emulation, and delay the paddle "
                                               "read-bit flipping by...");
    lblLowerSens->setWordWrap(true);
    auto* chkLowerSens = check("chkLowerSens", "Enable");
    m_ui->txtLowerSens = numberField("txtLowerSens");
    auto* lower = tight(new QVBoxLayout(fraLowerSens), 2);
    lower->addWidget(lblLowerSens);
    lower->addLayout(
        row({chkLowerSens, m_ui->txtLowerSens, label("lblLowerSensScan", "Scanlines")}));
    page->addWidget(fraLowerSens);

    auto* fraSoundQueue = frame("fraSoundQueue", "Size of Sound Queue");
    const sliders::Scale start = sliders::SoundQueueDefault();
    m_ui->BarColorSoundQueue = createSliderBar("BarColorSoundQueue", start.min, start.max);
    m_ui->BarColorSoundQueue->setToolTip(
        QStringLiteral("Double click to reset value to the default"));
    tight(new QVBoxLayout(fraSoundQueue))->addWidget(m_ui->BarColorSoundQueue);
    page->addWidget(fraSoundQueue);

    // Two groups in one frame: the first mouse's paddle and the second's.
    auto* fraPaddleMouse = frame("fraPaddleMouse", "Paddles to Emulate with Mouse");
    auto* paddles = tight(new QGridLayout(fraPaddleMouse), 0);
    paddles->setHorizontalSpacing(8);
    const auto makeGroup = [&](const char* prefix, int gridRow) {
        auto* group = new QButtonGroup(this);
        for (int i = 0; i <= 4; ++i) {
            const QByteArray name =
                i < 4 ? prefix + ('_' + QByteArray::number(i)) : QByteArray(prefix) + "None";
            const QByteArray caption = i < 4 ? "Paddle " + QByteArray::number(i) : "None";
            QRadioButton* button = option(name.constData(), caption.constData());
            group->addButton(button, i);
            paddles->addWidget(button, gridRow, i);
        }
    };
    makeGroup("optPaddleM1", 0);
    makeGroup("optPaddleM2", 1);
    paddles->setColumnStretch(5, 1);
    page->addWidget(fraPaddleMouse);

    page->addWidget(check("chkQuiet", "Quiet... Disable Sound"));
    page->addStretch(1);
}

void frmSettings::createVideoPage() {
    auto* page = pageLayout(m_ui->pages[3]);

    auto* fraScanLines = frame("fraScanLines", "Scanlines");
    auto* chkScanLines = check("chkScanLines", "Enabled");
    m_ui->txtScanLines = numberField("txtScanLines");
    auto* lblScanLines =
        label("lblScanLines", "Set the maximum number of scanlines to render (Height)");
    lblScanLines->setWordWrap(true);
    auto* scan = tight(new QHBoxLayout(fraScanLines), 8);
    scan->addWidget(chkScanLines);
    scan->addWidget(m_ui->txtScanLines);
    scan->addWidget(lblScanLines, 1);
    page->addWidget(fraScanLines);

    auto* fraFrameRate = frame("fraFrameRate", "Frame Rate");
    auto* optFPScustom = option("optFPScustom", "Custom FPS");
    m_ui->txtFPScustom = numberField("txtFPScustom");
    auto* optFPSmonitor = option("optFPSmonitor", "Monitor Speed");
    tight(new QVBoxLayout(fraFrameRate))
        ->addLayout(row(
            {optFPScustom, m_ui->txtFPScustom, optFPSmonitor, option("optFPSDefault", "Default")}));

    auto* fraNarrow = frame("fraNarrow", "Narrow Video Modes");
    tight(new QVBoxLayout(fraNarrow))
        ->addLayout(row({option("optNarrowNot", "Not Enabled"), option("optNarrow1", "Mode 1"),
                         option("optNarrow2", "Mode 2")}));

    auto* rateNarrow = new QHBoxLayout;
    rateNarrow->addWidget(fraFrameRate, 1);
    rateNarrow->addWidget(fraNarrow);
    page->addLayout(rateNarrow);

    auto* fraColorPalette = frame("fraColorPalette", "Color Palette");
    tight(new QVBoxLayout(fraColorPalette))
        ->addLayout(row({option("optCPNTSC", "NTSC"), option("optCPPAL", "PAL"),
                         option("optCPSECAM", "SECAM"), option("optCPDefault", "Default")}));

    auto* fraPhos = frame("fraPhos", "Phosphorescent Effect");
    m_ui->BarColorPhos = createSliderBar("BarColorPhos", sliders::kPhosMin, sliders::kPhosMax);
    tight(new QVBoxLayout(fraPhos))->addWidget(m_ui->BarColorPhos);

    auto* palettePhos = new QHBoxLayout;
    palettePhos->addWidget(fraColorPalette);
    palettePhos->addWidget(fraPhos, 1);
    page->addLayout(palettePhos);

    auto* boxes = new QGridLayout;
    boxes->setVerticalSpacing(0);
    boxes->addWidget(check("chkPALColorLoss", "Simulate PAL color loss"), 0, 0);
    boxes->addWidget(check("chkSyncWSound", "Synchronize with sound instead of display"), 0, 1);
    boxes->addWidget(check("chkInterlaced", "Run interlaced games"), 1, 0);
    boxes->setColumnStretch(1, 1);
    page->addLayout(boxes);
    page->addStretch(1);
}

void frmSettings::createDebugPage() {
    auto* page = pageLayout(m_ui->pages[4]);
    page->setSpacing(2);

    auto* fraLineScan = frame("fraLineScan", "Start Scanning Game at Line...");
    auto* chkLineScan = check("chkLineScan", "Enabled");
    m_ui->txtLineScan = numberField("txtLineScan");
    tight(new QVBoxLayout(fraLineScan))->addLayout(row({chkLineScan, m_ui->txtLineScan}));

    auto* fraGameType = frame("fraGameType", "Override Game Type");
    tight(new QVBoxLayout(fraGameType))->addWidget(list("comboGT", kGameTypeEntries));

    auto* top = new QHBoxLayout;
    top->addWidget(fraLineScan);
    top->addWidget(fraGameType, 1);
    page->addLayout(top);

    for (QCheckBox* box :
         {check("chkMouseCapture", "Enable mouse capture in a window"),
          check("chkAllow4", "Allow all 4 directions on the joystick to be pressed simultaneously"),
          check("chkFastCopy", "Disable the fast copy routines"),
          check("chkPrintChecksum", "Print checksum of cartridge"),
          check("chkCodeTrace", "Write code trace to z26.log"),
          check("chkShowScanline", "Show scanline count and FPS on game display")})
        page->addWidget(box);

    auto* fraDOSOutput = frame("fraDOSOutput", "DOS Command Switches Outputed");
    m_ui->chkDOSSwitch = check("chkDOSSwitch", "Edit Switches");
    m_ui->lblDOSSwitchInstruction = label("lblDOSSwitchInstruction", "Press Enter to Execute Game");
    m_ui->lblDOSSwitchInstruction->hide();
    m_ui->lblDOSOutput = named(new QLabel, "lblDOSOutput");
    // The preview shows switches, never markup, whatever was pasted into a field.
    m_ui->lblDOSOutput->setTextFormat(Qt::PlainText);
    m_ui->lblDOSOutput->setTextInteractionFlags(Qt::TextSelectableByMouse);
    m_ui->lblDOSOutput->setMinimumHeight(twips::toPixelsY(315));
    m_ui->txtDOSOutput = named(new QLineEdit, "txtDOSOutput");
    m_ui->txtDOSOutput->hide();
    auto* dos = tight(new QGridLayout(fraDOSOutput), 2);
    dos->setHorizontalSpacing(8);
    dos->addWidget(m_ui->chkDOSSwitch, 0, 0);
    // The preview label and the edit box take turns in the same place, so the frame
    // keeps its height in both modes.
    dos->addWidget(m_ui->lblDOSOutput, 0, 1);
    dos->addWidget(m_ui->txtDOSOutput, 0, 1);
    dos->addWidget(m_ui->lblDOSSwitchInstruction, 0, 2);
    dos->setColumnStretch(1, 1);
    page->addWidget(fraDOSOutput);
    page->addStretch(1);
}

void frmSettings::createDefaultPathsPage() {
    auto* page = pageLayout(m_ui->pages[5]);

    auto* fraDefPathFilter = frame("fraDefPathFilter", "ROM Filter");
    m_ui->txtDefPathFilter = named(new QLineEdit, "txtDefPathFilter");
    tight(new QVBoxLayout(fraDefPathFilter))->addWidget(m_ui->txtDefPathFilter);
    page->addWidget(fraDefPathFilter);

    auto* fraDefPathz26 = frame("fraDefPathz26", "Drag && Drop z26 Path Here...");
    m_ui->txtDefPathz26 = named(new QLineEdit, "txtDefPathz26");
    // Changed only through the chooser or a drop, which check the path first.
    m_ui->txtDefPathz26->setReadOnly(true);
    m_ui->txtDefPathz26->setAcceptDrops(true);
    auto* cmdAddZ26Path = named(new QPushButton(QStringLiteral("...")), "cmdAddZ26Path");
    cmdAddZ26Path->setFixedWidth(twips::toPixelsX(495));
    connect(cmdAddZ26Path, &QPushButton::clicked, this, &frmSettings::cmdAddZ26Path_Click);
    auto* z26 = tight(new QHBoxLayout(fraDefPathz26));
    z26->addWidget(m_ui->txtDefPathz26, 1);
    z26->addWidget(cmdAddZ26Path);
    page->addWidget(fraDefPathz26);

    auto* fraDefPathRom = frame("fraDefPathRom", "Drag && Drop ROM's Paths Here...");
    QTreeWidget* paths = m_ui->vbalListDefPaths = named(new QTreeWidget, "vbalListDefPaths");
    paths->setRootIsDecorated(false);
    paths->setUniformRowHeights(true);
    paths->setAllColumnsShowFocus(true);
    paths->setSelectionMode(QAbstractItemView::SingleSelection);
    paths->setContextMenuPolicy(Qt::CustomContextMenu);
    paths->setAcceptDrops(true);
    paths->viewport()->setAcceptDrops(true);
    m_ui->chkROMSubfolders = check("chkROMSubfolders", "Include sub-folders");
    connect(m_ui->chkROMSubfolders, &QCheckBox::clicked, this,
            &frmSettings::chkROMSubfolders_Click);
    auto* rom = tight(new QVBoxLayout(fraDefPathRom));
    rom->addWidget(paths);
    rom->addWidget(m_ui->chkROMSubfolders);
    page->addWidget(fraDefPathRom, 1);

    QMenu* popup = m_ui->mnuROMSPopup =
        named(new QMenu(QStringLiteral("ROMSPopup"), this), "mnuROMSPopup");
    m_ui->mnuROMSRemove = named(popup->addAction(QStringLiteral("Remove")), "mnuROMSRemove");
    QAction* refresh = named(popup->addAction(QStringLiteral("Refresh")), "mnuROMSRefresh");
    QAction* add = named(popup->addAction(QStringLiteral("Add Path")), "mnuROMSAdd");
    connect(m_ui->mnuROMSRemove, &QAction::triggered, this, &frmSettings::mnuROMSRemove_Click);
    connect(refresh, &QAction::triggered, this, &frmSettings::mnuROMSRefresh_Click);
    connect(add, &QAction::triggered, this, &frmSettings::mnuROMSAdd_Click);
}
