#include "settings/frmSettings.h"

#include "platform/Platform.h"
#include "platform/SettingsStore.h"
#include "ui/Twips.h"

#include <QCloseEvent>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyle>
#include <QTabBar>
#include <QTabWidget>

namespace {

constexpr double kTabWidthTwips = 6495;
constexpr double kTabHeightTwips = 4095;
constexpr double kSideStripWidthTwips = 495;

struct TabInfo {
    const char* key;
    const char* caption;
    const char* page;
    QStyle::StandardPixmap icon;
};

constexpr TabInfo kTabs[] = {
    {"Settings", "Settings", "picSettings", QStyle::SP_FileDialogDetailedView},
    {"Controls", "Controls", "picControls", QStyle::SP_ComputerIcon},
    {"PaddlesAudio", "Paddles / Audio", "picPaddlesAudio", QStyle::SP_MediaVolume},
    {"Video", "Video", "picVideo", QStyle::SP_DesktopIcon},
    {"Debug", "Debugging", "picDebug", QStyle::SP_MessageBoxWarning},
    {"DefaultPaths", "Default Paths", "picDefPaths", QStyle::SP_DirIcon},
};

} // namespace

frmSettings::frmSettings(Platform& platform, QWidget* parent)
    : QWidget(parent, Qt::Window), m_platform(platform) {
    setObjectName(QStringLiteral("frmSettings"));
    setWindowTitle(QStringLiteral("Settings"));

    picSideText = new QWidget(this);
    picSideText->setObjectName(QStringLiteral("picSideText"));

    vbalDTabControl1 = new QTabWidget(this);
    vbalDTabControl1->setObjectName(QStringLiteral("vbalDTabControl1"));

    QWidget** pages[] = {&picSettings, &picControls, &picPaddlesAudio,
                         &picVideo,    &picDebug,    &picDefPaths};
    for (size_t i = 0; i < std::size(kTabs); ++i) {
        QWidget* page = new QWidget;
        page->setObjectName(QLatin1String(kTabs[i].page));
        *pages[i] = page;
    }

    fraConfig = new QGroupBox(QStringLiteral("Save/Load settings"), picSettings);
    fraConfig->setObjectName(QStringLiteral("fraConfig"));
    cmdSaveDat = new QPushButton(QStringLiteral("&Save"), fraConfig);
    cmdSaveDat->setObjectName(QStringLiteral("cmdSaveDat"));
    cmdLoadDat = new QPushButton(QStringLiteral("&Load"), fraConfig);
    cmdLoadDat->setObjectName(QStringLiteral("cmdLoadDat"));
    lblConfig = new QLabel(fraConfig);
    lblConfig->setObjectName(QStringLiteral("lblConfig"));
    lblConfig->setWordWrap(true);
    fraConfig->setGeometry(twips::toPixelsX(120), twips::toPixelsY(120), twips::toPixelsX(6135),
                           twips::toPixelsY(1095));
    cmdSaveDat->setGeometry(twips::toPixelsX(120), twips::toPixelsY(300), twips::toPixelsX(1095),
                            twips::toPixelsY(375));
    cmdLoadDat->setGeometry(twips::toPixelsX(1320), twips::toPixelsY(300),
                            twips::toPixelsX(1095), twips::toPixelsY(375));
    lblConfig->setGeometry(twips::toPixelsX(2520), twips::toPixelsY(240), twips::toPixelsX(3495),
                           twips::toPixelsY(735));

    fraDefPathFilter = new QGroupBox(QStringLiteral("ROM Filter"), picDefPaths);
    fraDefPathFilter->setObjectName(QStringLiteral("fraDefPathFilter"));
    txtDefPathFilter = new QLineEdit(fraDefPathFilter);
    txtDefPathFilter->setObjectName(QStringLiteral("txtDefPathFilter"));
    fraDefPathFilter->setGeometry(twips::toPixelsX(120), twips::toPixelsY(120),
                                  twips::toPixelsX(6135), twips::toPixelsY(675));
    txtDefPathFilter->setGeometry(twips::toPixelsX(120), twips::toPixelsY(270),
                                  twips::toPixelsX(5895), twips::toPixelsY(315));

    Form_Load();
}

frmSettings::~frmSettings() = default;

void frmSettings::Form_Load() {
    txtDefPathFilter->setText(m_platform.store.GetSetting(
        QStringLiteral("Settings"), QStringLiteral("ROMFilter"), QStringLiteral("*.bin")));

    const int stripWidth = twips::toPixelsX(kSideStripWidthTwips);
    const int tabWidth = twips::toPixelsX(kTabWidthTwips);
    const int tabHeight = twips::toPixelsY(kTabHeightTwips);
    vbalDTabControl1->setGeometry(stripWidth, 0, tabWidth, tabHeight);
    resize(stripWidth + tabWidth + twips::toPixelsX(100), tabHeight + twips::toPixelsY(500));
    picSideText->setGeometry(0, 0, stripWidth, height());

    const SettingsStore& store = m_platform.store;
    move(twips::toPixelsX(readSingle(store, QStringLiteral("setpos"), QStringLiteral("left"), 250)),
         twips::toPixelsY(readSingle(store, QStringLiteral("setpos"), QStringLiteral("top"), 250)));

    QWidget* pages[] = {picSettings, picControls, picPaddlesAudio, picVideo, picDebug, picDefPaths};
    for (size_t i = 0; i < std::size(kTabs); ++i) {
        const int index = vbalDTabControl1->addTab(pages[i], style()->standardIcon(kTabs[i].icon),
                                                   QLatin1String(kTabs[i].caption));
        vbalDTabControl1->tabBar()->setTabData(index, QLatin1String(kTabs[i].key));
    }
}

void frmSettings::SelectTab(const QString& key) {
    for (int i = 0; i < vbalDTabControl1->count(); ++i) {
        if (vbalDTabControl1->tabBar()->tabData(i).toString() == key) {
            vbalDTabControl1->setCurrentIndex(i);
            return;
        }
    }
}

QString frmSettings::SelectedTabKey() const {
    return vbalDTabControl1->tabBar()->tabData(vbalDTabControl1->currentIndex()).toString();
}

void frmSettings::Unload() {
    m_bUnloading = true;
    close();
}

void frmSettings::closeEvent(QCloseEvent* event) {
    hide();
    if (!m_bUnloading) {
        // The user's close box only hides the window; every option stays as it is.
        event->ignore();
        return;
    }
    Form_Unload();
    event->accept();
}

void frmSettings::Form_Unload() {
    SettingsStore& store = m_platform.store;
    store.SaveSetting(QStringLiteral("setpos"), QStringLiteral("top"),
                      singleText(twips::fromPixelsY(y())));
    store.SaveSetting(QStringLiteral("setpos"), QStringLiteral("left"),
                      singleText(twips::fromPixelsX(x())));
}
