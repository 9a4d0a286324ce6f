#include "app/frmMain.h"

#include "about/frmAbout.h"
#include "app/MenuIcons.h"
#include "emulator/OptionFile.h"
#include "library/CCRC32.h"
#include "library/GameDatabase.h"
#include "library/RomListModel.h"
#include "library/Search.h"
#include "platform/Dialogs.h"
#include "platform/FileSystem.h"
#include "platform/Platform.h"
#include "platform/Shell.h"
#include "platform/StoredSettings.h"
#include "platform/WebAddresses.h"
#include "settings/DefaultPaths.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/OleColor.h"
#include "ui/PictureFile.h"
#include "ui/ScreenPlace.h"
#include "ui/Twips.h"
#include "ui/cTextBoxXP.h"
#include "ui/vbalProgressBar.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDir>
#include <QFileInfo>
#include <QGroupBox>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QTemporaryDir>
#include <QTimer>

#include <climits>
#include <cmath>

frmMain::frmMain(Platform& platform) : m_platform(platform) {
    // First, so that the listing has the whole building of the window to run in: a large
    // collection takes longer to list than the window to build and show.
    const SettingsStore& store = m_platform.store;
    const QStringList folders = enabledRomFolders(store);
    if (!folders.isEmpty() && !read(store, stored::z26Path).isEmpty())
        m_catalogue.prefetch(folders, read(store, stored::romFilter),
                             read(store, stored::romSubfolders));
    setObjectName(QStringLiteral("frmMain"));
    setWindowTitle(QStringLiteral("lum"));
    createControls();
    createMenus();
}

frmMain::~frmMain() {
    // The settings window outlives the members a command-line run's filter reads.
    if (m_settings)
        m_settings->removeEventFilter(this);
}

void frmMain::createControls() {
    auto* central = new QWidget(this);
    central->setObjectName(QStringLiteral("centralWidget"));
    setCentralWidget(central);

    fraSelectRom = new QGroupBox(QStringLiteral("Double Click on ROM to load it..."), central);
    fraSelectRom->setObjectName(QStringLiteral("fraSelectRom"));
    vbalListViewCtl1 = new ListView(fraSelectRom);
    vbalListViewCtl1->setObjectName(QStringLiteral("vbalListViewCtl1"));
    m_listModel = new RomListModel(this);
    vbalListViewCtl1->setModel(m_listModel);

    fraSearch = new QGroupBox(QStringLiteral("Only show filenames containing..."), central);
    fraSearch->setObjectName(QStringLiteral("fraSearch"));
    txtSearch = new QLineEdit(fraSearch);
    txtSearch->setObjectName(QStringLiteral("txtSearch"));
    vbalProgressBar1 = new vbalProgressBar(fraSearch);
    vbalProgressBar1->setObjectName(QStringLiteral("vbalProgressBar1"));
    vbalProgressBar1->setShowText(true);
    vbalProgressBar1->hide();

    txtSearch->installEventFilter(this);
    tmrSearch = new QTimer(this);
    tmrSearch->setObjectName(QStringLiteral("tmrSearch"));
    tmrSearch->setSingleShot(true);
    tmrSearch->setInterval(20);
    connect(tmrSearch, &QTimer::timeout, this, &frmMain::tmrSearch_Timer);
    // Also the operators that Ctrl+A, Ctrl+O and Ctrl+N insert.
    connect(txtSearch, &QLineEdit::textChanged, this, &frmMain::txtSearch_Change);
    connect(vbalListViewCtl1, &ListView::keyDown, this, &frmMain::vbalListViewCtl1_KeyDown);
    connect(vbalListViewCtl1, &ListView::mouseDown, this, &frmMain::vbalListViewCtl1_MouseDown);
    connect(vbalListViewCtl1, &ListView::popupKey, this, &frmMain::showRowPopup);
    connect(vbalListViewCtl1, &ListView::itemDoubleClicked, this, [this] { LoadROM(false); });
    connect(vbalListViewCtl1, &ListView::fileDropped, this,
            [this](const QString& path) { launchRom(path, false); });

    picBack = new QLabel(central);
    picBack->setObjectName(QStringLiteral("picBack"));
    picBack->hide();
    m_backdrop = loadPictureFile(m_platform.programFolder + QStringLiteral("/backdrop.png"));
    picBack->setPixmap(QPixmap::fromImage(m_backdrop));
}

frmSettings& frmMain::settingsWindow() {
    if (!m_settings)
        createSettingsWindow();
    return *m_settings;
}

void frmMain::createSettingsWindow() {
    // Built when first needed: its pages cost more than the whole main window, and
    // nothing of them shows at start-up.
    m_settings = std::make_unique<frmSettings>(m_platform);
    connect(m_settings.get(), &frmSettings::launchRequested, this, &frmMain::LoadROM);
    if (m_startOptions) {
        m_settings->setOptions(*m_startOptions);
        m_startOptions.reset();
    }
    if (m_configCaption) {
        m_settings->showConfigStatus(m_configCaption->first, m_configCaption->second);
        m_configCaption.reset();
    }
    ApplyBackground();
}

void frmMain::showConfigCaption(const QString& text, const QString& tip) {
    if (m_settings)
        m_settings->showConfigStatus(text, tip);
    else
        m_configCaption.emplace(text, tip);
}

void frmMain::createMenus() {
    auto item = [](QMenu* menu, const char* name, const char* caption) {
        QAction* action = menu->addAction(QString::fromUtf8(caption));
        action->setObjectName(QLatin1String(name));
        return action;
    };
    auto menu = [](QMenu* m, const char* name) {
        m->setObjectName(QLatin1String(name));
        m->menuAction()->setObjectName(QLatin1String(name));
        return m;
    };
    auto separator = [](QMenu* m, const char* name) {
        m->addSeparator()->setObjectName(QLatin1String(name));
    };

    mnuFile = menu(menuBar()->addMenu(QStringLiteral("&File")), "mnuFile");
    mnuFileLoadSettings = item(mnuFile, "mnuFileLoadSettings", "&Load Settings");
    mnuFileSaveSettings = item(mnuFile, "mnuFileSaveSettings", "&Save Settings");
    mnuFileRecent = menu(mnuFile->addMenu(QStringLiteral("&Recent ROMs")), "mnuFileRecent");
    mnuFileRecent->setToolTipsVisible(true);
    connect(mnuFileRecent, &QMenu::aboutToShow, this, [this] { fillRecentMenu(true); });
    // Whether each file is still there is asked when the menu opens: a ROM on a slow or
    // unplugged disk must not hold up the start.
    fillRecentMenu(false);
    separator(mnuFile, "mnuBar3");
    mnuFileExit = item(mnuFile, "mnuFileExit", "E&xit");

    mnuSettings = menu(menuBar()->addMenu(QStringLiteral("&Settings")), "mnuSettings");
    mnuSettingsConfiguration = item(mnuSettings, "mnuSettingsConfiguration", "&Configuration");
    separator(mnuSettings, "mnuBar1");
    mnuTextColor = item(mnuSettings, "mnuTextColor", "&Text Color");
    mnuBackImg = menu(mnuSettings->addMenu(QStringLiteral("&Background")), "mnuBackImg");
    mnuBackImgChange = item(mnuBackImg, "mnuBackImgChange", "Change Background &Image");
    mnuBackColorChange = item(mnuBackImg, "mnuBackColorChange", "Change Background &Color");
    separator(mnuBackImg, "mnuBar2");
    mnuBackImgEnabled = item(mnuBackImg, "mnuBackImgEnabled", "Background Image &Enabled");
    mnuBackImgEnabled->setCheckable(true);
    separator(mnuSettings, "mnuBar5");
    mnuSearchAsYouType = item(mnuSettings, "mnuSearchAsYouType", "Search &As You Type");
    mnuSearchAsYouType->setCheckable(true);
    mnuFavouritesOnly = item(mnuSettings, "mnuFavouritesOnly", "&Favourites Only");
    mnuFavouritesOnly->setCheckable(true);

    mnuAbout = menu(menuBar()->addMenu(QStringLiteral("&About")), "mnuAbout");
    mnuAboutz26Readme = item(mnuAbout, "mnuAboutz26Readme", "z26 &Readme");
    mnuAboutCopying = item(mnuAbout, "mnuAboutCopying", "&Copying");
    mnuAboutz26HomePage = item(mnuAbout, "mnuAboutz26HomePage", "&z26 HomePage");
    separator(mnuAbout, "mnuBar4");
    mnuAboutlumAbout = item(mnuAbout, "mnuAboutlumAbout", "&About lum");
    mnuAboutlumHomePage = item(mnuAbout, "mnuAboutlumHomePage", "&lum HomePage");

    mnuMainPopup = new QMenu(QStringLiteral("MainPopup"), this);
    mnuMainPopup->setObjectName(QStringLiteral("mnuMainPopup"));
    mnuMainRefresh = item(mnuMainPopup, "mnuMainRefresh", "Refresh");
    mnuMainGameInfo = item(mnuMainPopup, "mnuMainGameInfo", "Game Info");
    mnuMainGameInfo->setVisible(false);
    mnuMainFavourite = item(mnuMainPopup, "mnuMainFavourite", "Add to Favourites");
    mnuMainFavourite->setVisible(false);

    connect(mnuFileExit, &QAction::triggered, this, &frmMain::mnuFileExit_Click);
    connect(mnuSettingsConfiguration, &QAction::triggered, this,
            &frmMain::mnuSettingsConfiguration_Click);
    connect(mnuMainRefresh, &QAction::triggered, this, &frmMain::mnuMainRefresh_Click);
    connect(mnuMainGameInfo, &QAction::triggered, this, &frmMain::mnuMainGameInfo_Click);
    connect(mnuMainFavourite, &QAction::triggered, this, &frmMain::mnuMainFavourite_Click);
    connect(mnuFavouritesOnly, &QAction::triggered, this, &frmMain::mnuFavouritesOnly_Click);
    connect(mnuBackColorChange, &QAction::triggered, this, &frmMain::mnuBackColorChange_Click);
    connect(mnuTextColor, &QAction::triggered, this, &frmMain::mnuTextColor_Click);
    connect(mnuBackImgChange, &QAction::triggered, this, &frmMain::mnuBackImgChange_Click);
    connect(mnuBackImgEnabled, &QAction::triggered, this, &frmMain::mnuBackImgEnabled_Click);
    connect(mnuSearchAsYouType, &QAction::triggered, this, &frmMain::mnuSearchAsYouType_Click);
    connect(mnuAboutz26Readme, &QAction::triggered, this, &frmMain::mnuAboutz26Readme_Click);
    connect(mnuAboutCopying, &QAction::triggered, this, &frmMain::mnuAboutCopying_Click);
    connect(mnuAboutz26HomePage, &QAction::triggered, this, &frmMain::mnuAboutz26HomePage_Click);
    connect(mnuAboutlumHomePage, &QAction::triggered, this, &frmMain::mnuAboutlumHomePage_Click);
    connect(mnuAboutlumAbout, &QAction::triggered, this, &frmMain::mnuAboutlumAbout_Click);
    connect(mnuFileLoadSettings, &QAction::triggered, this,
            [this] { settingsWindow().loadOptionSetFromMenu(); });
    connect(mnuFileSaveSettings, &QAction::triggered, this,
            [this] { settingsWindow().saveOptionSetFromMenu(); });
}

void frmMain::fillRecentMenu(bool bCheckFiles) {
    // Not clear(): an item of this menu may be the one whose click runs this.
    for (QAction* old : mnuFileRecent->actions()) {
        mnuFileRecent->removeAction(old);
        old->setParent(nullptr);
        old->deleteLater();
    }
    const QStringList roms = readRecentRoms(m_platform.store);
    for (int n = 0; n < roms.size(); ++n) {
        const QFileInfo rom(roms[n]);
        QAction* action =
            mnuFileRecent->addAction(rom.fileName().replace(u'&', QStringLiteral("&&")));
        action->setObjectName(QStringLiteral("mnuFileRecentROM") + QString::number(n + 1));
        // No status bar to show a status tip: the folder shows as the item's tip too.
        action->setStatusTip(QDir::toNativeSeparators(rom.absolutePath()));
        action->setToolTip(action->statusTip());
        action->setEnabled(!bCheckFiles || rom.isFile());
        const QString path = roms[n];
        connect(action, &QAction::triggered, this, [this, path] { launchRom(path, false); });
    }
    mnuFileRecent->addSeparator()->setObjectName(QStringLiteral("mnuFileRecentBar"));
    QAction* clear = mnuFileRecent->addAction(QStringLiteral("&Clear List"));
    clear->setObjectName(QStringLiteral("mnuFileRecentClear"));
    clear->setEnabled(!roms.isEmpty());
    connect(clear, &QAction::triggered, this, [this] {
        writeRecentRoms(m_platform.store, {});
        fillRecentMenu(true);
    });
}

void frmMain::assignMenuIcons() {
    // The icons are made when a menu first opens: nothing of them is needed for the
    // window's first paint.
    for (QMenu* menu : {mnuFile, mnuSettings, mnuAbout}) {
        connect(menu, &QMenu::aboutToShow, this, [this] {
            if (!m_menuIconsAssigned)
                assignMenuIconsNow();
        });
    }
}

void frmMain::assignMenuIconsNow() {
    m_menuIconsAssigned = true;
    const std::pair<QAction*, int> icons[] = {
        {mnuFileExit, 3},          {mnuFileLoadSettings, 9},
        {mnuFileSaveSettings, 10}, {mnuSettingsConfiguration, 0},
        {mnuTextColor, 4},         {mnuBackImg->menuAction(), 1},
        {mnuBackImgChange, 1},     {mnuAboutz26Readme, 5},
        {mnuAboutz26HomePage, 7},  {mnuAboutlumAbout, 5},
        {mnuAboutlumHomePage, 8},
    };
    for (const auto& [action, index] : icons)
        action->setIcon(menuIcon(index));
}

void frmMain::Form_Load() {
    assignMenuIcons();
    mcrc32 = std::make_unique<CCRC32>(m_platform.dialogs);
    // The window keeps painting while a ROM on a slow disk is identified.
    connect(mcrc32.get(), &CCRC32::Progress, this,
            [] { QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents); });

    loadStartOptions();

    const SettingsStore& store = m_platform.store;
    const WindowPlace place = read(store, stored::mainWindow);
    m_place = placeOnScreen(*this, {twips::toPixelsX(place.left), twips::toPixelsY(place.top),
                                    twips::toPixelsX(place.width), twips::toPixelsY(place.height)});
    if (read(store, stored::mainWindowMaximized))
        setWindowState(windowState() | Qt::WindowMaximized);

    vbalListViewCtl1->setBackColor(read(store, stored::backColor));
    mnuBackImgEnabled->setChecked(read(store, stored::backImgEnabled));
    vbalListViewCtl1->setPicture(mnuBackImgEnabled->isChecked() ? read(store, stored::backImg)
                                                                : QString());
    vbalListViewCtl1->setForeColor(read(store, stored::textColor));
    ApplyBackground();
    mnuSearchAsYouType->setChecked(read(store, stored::searchAsYouType));
    mnuFavouritesOnly->setChecked(read(store, stored::favouritesOnly));
    const QStringList favourites = readFavourites(store);
    m_favourites = QSet<QString>(favourites.begin(), favourites.end());

    const QString z26Path = storedOrFoundZ26Path();
    const bool bRomPath = !readRomFolders(store).empty();

    if (!z26Path.isEmpty() && bRomPath) {
        addListColumns();

        show();
        QCoreApplication::processEvents();
        m_bInitialLoad = true;
        RefreshMainList();
        m_bInitialLoad = false;
        return;
    }
    m_catalogue.dropPrefetch(); // nothing to fill without both paths

    if (z26Path.isEmpty())
        m_platform.dialogs.MsgBox(
            this, QStringLiteral("You need to select you z26 path before you continue."),
            MsgButtons::Ok, MsgIcon::None, QStringLiteral("Choose z26 Path"));
    else
        m_platform.dialogs.MsgBox(
            this, QStringLiteral("You need to select you ROM's path before you continue."),
            MsgButtons::Ok, MsgIcon::None, QStringLiteral("Choose ROM's Path"));
    settingsWindow().selectPage(QStringLiteral("DefaultPaths"));
    settingsWindow().show();
}

void frmMain::loadStartOptions() {
    // The user's own start options first; the set that ships beside the program else.
    QString defaultFile = m_platform.userFolder + QStringLiteral("/Default.lum");
    if (!QFileInfo(defaultFile).isFile())
        defaultFile = m_platform.programFolder + QStringLiteral("/Default.lum");
    if (QFileInfo(defaultFile).isFile()) {
        // A sound option set waits for the settings window; a corrupt one is reported now.
        const OptionSetRead optionSet =
            readOptionFile(defaultFile, m_settings ? m_settings->options() : EmulatorOptions());
        const bool loaded = optionSet.ok();
        if (m_settings || !loaded)
            settingsWindow().LoadSettings(optionSet);
        else
            m_startOptions = optionSet.options;
        showConfigCaption(loaded ? QStringLiteral("Default.lum was succesfully loaded")
                                 : QStringLiteral("Default.lum is corrupt.  Please verify "
                                                  "settings and re-save to correct the problem."),
                          QString());
    } else {
        showConfigCaption(QStringLiteral("Default.lum couldn't be loaded"),
                          QStringLiteral("Default.lum need's to be in the same folder as lum"));
    }
}

QString frmMain::storedOrFoundZ26Path() {
    QString z26Path = read(m_platform.store, stored::z26Path);
    if (z26Path.isEmpty()) {
        // A z26 installed the usual way needs no first-run question.
        z26Path = findProgramOnPath(z26FileName());
        if (!z26Path.isEmpty())
            write(m_platform.store, stored::z26Path, z26Path);
    }
    return z26Path;
}

void frmMain::addListColumns() {
    m_listModel->addColumn(
        {QStringLiteral("Name"), QStringLiteral("Name"), QStringLiteral("ROM Name")});
    m_listModel->addColumn(
        {QStringLiteral("Path"), QStringLiteral("Path"), QStringLiteral("ROM Path")});
    // The name takes what the folder leaves, at any width of the window; a long folder
    // keeps both its ends.
    QHeaderView* header = vbalListViewCtl1->header();
    header->setSectionResizeMode(0, QHeaderView::Stretch);
    header->resizeSection(1, twips::toPixelsX(1000));
    vbalListViewCtl1->setColumnElideMode(1, Qt::ElideMiddle);
}

void frmMain::RefreshMainList() {
    // A list first filled after the paths were chosen on a first run still needs its
    // columns, or its rows would not show until the next start.
    if (m_listModel->columnCount() == 0)
        addListColumns();
    const SettingsStore& store = m_platform.store;
    const QString search = txtSearch->text().trimmed();
    tmrSearch->stop(); // the refresh applies the same search

    // The first load's listing is already under way on another core, so its caption is
    // painted while that listing finishes rather than after it.
    if (m_bInitialLoad) {
        fraSearch->setTitle(QStringLiteral("Loading ROM's List..."));
        show();
        QCoreApplication::processEvents();
    }

    // The caption and the bar show before any folder is read.
    if (!m_bInitialLoad)
        fraSearch->setTitle(QStringLiteral("Finding ROM's..."));
    txtSearch->hide();
    vbalProgressBar1->setMin(0);
    vbalProgressBar1->setValue(0);
    vbalProgressBar1->show();
    bool bListed = false;
    const auto progress = [&](qint64 done, qint64 total) {
        if (!bListed) {
            bListed = true;
            if (total > 0)
                vbalProgressBar1->setMax(static_cast<int>(std::min<qint64>(total, INT_MAX)));
            m_listModel->clear();
        }
        const int value = static_cast<int>(std::min<qint64>(done, INT_MAX));
        vbalProgressBar1->setValue(value);
        vbalProgressBar1->setText(
            QString::number(std::llround(vbalProgressBar1->PercentAt(value))) + u'%');
    };
    // Painted while the folders are read, but no key or click starts anything meanwhile.
    const auto paint = [] { QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents); };
    RomRows rows = m_catalogue.refresh(enabledRomFolders(store), read(store, stored::romFilter),
                                       read(store, stored::romSubfolders), listFilter(search),
                                       progress, paint);
    m_shownSearch = search;
    showRows(std::move(rows), m_bInitialLoad);

    fraSearch->setTitle(QStringLiteral("Only show filenames containing..."));
    vbalProgressBar1->hide();
    txtSearch->show();
    txtSearch->setFocus();
}

void frmMain::resizeEvent(QResizeEvent* event) {
    QMainWindow::resizeEvent(event);
    Form_Resize();
}

void frmMain::Form_Resize() {
    if (isMinimized())
        return;
    const int minWidth = twips::toPixelsX(2700);
    const int minHeight = twips::toPixelsY(2700);
    if (height() < minHeight || width() < minWidth) {
        resize(std::max(width(), minWidth), std::max(height(), minHeight));
        return; // the resize comes back here with the corrected size
    }
    const double w = twips::fromPixelsX(width());
    // Margins of 120 all round: Qt's sizes leave out the title bar and borders that the
    // Windows sizes these come from included.
    const double frameWidth = w - 240;
    const double frameHeight = twips::fromPixelsY(centralWidget()->height()) - 1020;
    fraSelectRom->setGeometry(twips::toPixelsX(120), twips::toPixelsY(120),
                              twips::toPixelsX(frameWidth), twips::toPixelsY(frameHeight));
    vbalListViewCtl1->setGeometry(twips::toPixelsX(120), twips::toPixelsY(240),
                                  twips::toPixelsX(frameWidth - 240),
                                  twips::toPixelsY(frameHeight - 345));
    fraSearch->setGeometry(twips::toPixelsX(120), twips::toPixelsY(frameHeight + 225),
                           twips::toPixelsX(frameWidth), twips::toPixelsY(675));
    txtSearch->setGeometry(twips::toPixelsX(120), twips::toPixelsY(270),
                           twips::toPixelsX(frameWidth - 240), twips::toPixelsY(315));
    vbalProgressBar1->setGeometry(txtSearch->geometry());
}

void frmMain::closeEvent(QCloseEvent* event) {
    Form_Unload();
    event->accept();
}

void frmMain::Form_Unload() {
    SettingsStore& store = m_platform.store;
    if (!isMinimized()) {
        write(store, stored::mainWindowMaximized, isMaximized());
        if (!isMaximized() && placeChangedByUser(*this, m_place))
            write(store, stored::mainWindow,
                  {twips::fromPixelsY(y()), twips::fromPixelsX(x()), twips::fromPixelsX(width()),
                   twips::fromPixelsY(height())});
    }
    // Every other window goes with the main one, the settings window saving its state.
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (window != this && window != m_settings.get() && window->isWindow() &&
            window->isVisible())
            window->close();
    }
    if (m_settings)
        m_settings->Unload();
}

void frmMain::mnuFileExit_Click() {
    close();
}

void frmMain::mnuSettingsConfiguration_Click() {
    frmSettings& settings = settingsWindow();
    settings.show();
    settings.raise();
    settings.activateWindow();
}

void frmMain::mnuMainRefresh_Click() {
    RefreshMainList();
}

bool frmMain::eventFilter(QObject* watched, QEvent* event) {
    // Closed, not minimised: a command-line run waiting for its switches ends.
    if (watched == m_settings.get() && event->type() == QEvent::Hide && !event->spontaneous() &&
        !m_commandLineRom.isEmpty())
        emit commandLineDone(1);
    if (watched == txtSearch) {
        if (event->type() == QEvent::KeyPress) {
            const auto* key = static_cast<QKeyEvent*>(event);
            if (txtSearch_KeyPress(key->key(), key->modifiers()))
                return true;
        } else if (event->type() == QEvent::MouseButtonDblClick) {
            txtSearch_DblClick();
            return true;
        }
    }
    return QMainWindow::eventFilter(watched, event);
}

bool frmMain::txtSearch_KeyPress(int key, Qt::KeyboardModifiers modifiers) {
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
        RefreshMainList();
        return true;
    }
    if ((modifiers & Qt::ControlModifier) == 0 ||
        (modifiers & (Qt::AltModifier | Qt::ShiftModifier)))
        return false;
    QString insert;
    if (key == Qt::Key_A)
        insert = QStringLiteral(" AND ");
    else if (key == Qt::Key_O)
        insert = QStringLiteral(" OR ");
    else if (key == Qt::Key_N)
        insert = QStringLiteral(" NOT ");
    else
        return false;
    const int caret = txtSearch->cursorPosition();
    const QString text = txtSearch->text();
    txtSearch->setText(text.left(caret) + insert + text.mid(caret));
    txtSearch->setCursorPosition(caret + static_cast<int>(insert.size()));
    return true;
}

void frmMain::txtSearch_DblClick() {
    cTextBoxXP tip;
    tip.setTextBox(txtSearch);
    tip.setBalloonTipIcon(1);
    tip.setBalloonTipTitle(QStringLiteral("Advanced Search"));
    tip.setBalloonTipText(
        QStringLiteral("You can use the following logic operations in your search: AND, OR, XOR, "
                       "NOT\r\nBut the Operations must be capitalized.\r\nfor example...  pac "
                       "AND man... asteroids AND NOT [pal]."));
    tip.ShowBalloonTip();
}

void frmMain::txtSearch_Change() {
    if (mnuSearchAsYouType->isChecked())
        tmrSearch->start();
}

void frmMain::tmrSearch_Timer() {
    showNarrowed(txtSearch->text().trimmed());
}

void frmMain::showNarrowed(const QString& search) {
    std::optional<RomRows> rows = m_catalogue.narrow(listFilter(search));
    if (!rows)
        return; // nothing listed yet
    m_shownSearch = search;
    showRows(std::move(*rows), false);
}

void frmMain::showRows(RomRows rows, bool bFirstLoad) {
    const qint64 listed = rows.listed;
    m_listModel->setRows(std::move(rows.folders), std::move(rows.names), std::move(rows.rowFolders),
                         std::move(rows.favourite));
    setWindowTitle(refreshCaption(bFirstLoad, m_listModel->rowCount(), listed));
}

RowFilter frmMain::listFilter(const QString& search) const {
    return {search, m_favourites, mnuFavouritesOnly->isChecked()};
}

void frmMain::vbalListViewCtl1_KeyDown(int key) {
    if (key == Qt::Key_F5)
        RefreshMainList();
    else if (key == Qt::Key_Return || key == Qt::Key_Enter)
        LoadROM(false);
}

void frmMain::vbalListViewCtl1_MouseDown(Qt::MouseButton button, QPoint globalPos) {
    if (button == Qt::RightButton)
        showRowPopup(globalPos);
}

void frmMain::showRowPopup(QPoint globalPos) {
    const QString path = selectedRowPath();
    mnuMainGameInfo->setVisible(false);
    if (!path.isEmpty() && LookupSoftwareID(path) != 0)
        mnuMainGameInfo->setVisible(true);
    mnuMainFavourite->setVisible(!path.isEmpty());
    mnuMainFavourite->setText(m_favourites.contains(path) ? QStringLiteral("Remove from Favourites")
                                                          : QStringLiteral("Add to Favourites"));
    mnuMainPopup->popup(globalPos);
}

void frmMain::mnuMainFavourite_Click() {
    const int row = vbalListViewCtl1->selectedRow();
    const QString path = m_listModel->rowPath(row);
    if (path.isEmpty())
        return;
    const bool bFavourite = !m_favourites.contains(path);
    if (bFavourite)
        m_favourites.insert(path);
    else
        m_favourites.remove(path);
    QStringList roms(m_favourites.begin(), m_favourites.end());
    roms.sort();
    writeFavourites(m_platform.store, roms);
    if (!bFavourite && mnuFavouritesOnly->isChecked())
        showNarrowed(m_shownSearch); // the row leaves the list
    else
        m_listModel->setFavourite(row, bFavourite);
}

void frmMain::mnuFavouritesOnly_Click() {
    // The action has already flipped its check mark when it is triggered from the menu.
    write(m_platform.store, stored::favouritesOnly, mnuFavouritesOnly->isChecked());
    showNarrowed(m_shownSearch);
}

void frmMain::mnuMainGameInfo_Click() {
    const QString path = selectedRowPath();
    if (path.isEmpty())
        return;
    const qint16 id = LookupSoftwareID(path);
    m_platform.shell.OpenUrl(QString(web::kGameInfoSite) +
                             QStringLiteral("/software_page.html?SoftwareID=") +
                             QString::number(id));
}

qint16 frmMain::LookupSoftwareID(const QString& path) {
    QString rom = path;
    if (isRomArchiveName(path) && (rom = unpackArchive(path).path).isEmpty())
        return 0;
    return ::LookupSoftwareID(*mcrc32, m_platform.programFolder + QStringLiteral("/CRCID.dat"),
                              rom);
}

QString frmMain::selectedRowPath() const {
    return m_listModel->rowPath(vbalListViewCtl1->selectedRow());
}

void frmMain::mnuBackColorChange_Click() {
    const std::optional<quint32> chosen = m_platform.dialogs.ShowColor(
        this, QStringLiteral("Choose a Color"), vbalListViewCtl1->BackColor());
    if (!chosen)
        return;
    const quint32 colour = *chosen & 0xFFFFFF;
    SettingsStore& store = m_platform.store;
    write(store, stored::backColor, colour);
    vbalListViewCtl1->setBackColor(colour);
    const quint32 text = 16777215 - colour;
    write(store, stored::textColor, text);
    vbalListViewCtl1->setForeColor(text);
    mnuBackImgEnabled->setChecked(false);
    vbalListViewCtl1->setPicture(QString());
    write(store, stored::backImgEnabled, false);
    ApplyBackground();
}

void frmMain::mnuTextColor_Click() {
    const std::optional<quint32> chosen = m_platform.dialogs.ShowColor(
        this, QStringLiteral("Choose a Color"), vbalListViewCtl1->ForeColor());
    if (!chosen)
        return;
    const quint32 colour = *chosen & 0xFFFFFF;
    write(m_platform.store, stored::textColor, colour);
    vbalListViewCtl1->setForeColor(colour);
    ApplyBackground();
}

void frmMain::mnuBackImgChange_Click() {
    FileDialogRequest request;
    request.title = QStringLiteral("Choose Image File");
    request.flags = kFlagPathMustExist | kFlagFileMustExist;
    request.initialFolder = m_platform.programFolder + QStringLiteral("/Backgrounds");
    request.filter = QStringLiteral("Image Files (*.jpg,*.bmp,*gif,*png)|*.jpg;*.bmp;*.gif;*.png|"
                                    "All Files (*.*)|*.*");
    request.filterIndex = 1;
    SettingsStore& store = m_platform.store;
    const QString chosen = m_platform.dialogs.ShowOpen(this, request);
    if (!chosen.isEmpty())
        write(store, stored::backImg, chosen);
    // Chosen or cancelled, the picture is switched on with the stored file.
    mnuBackImgEnabled->setChecked(true);
    vbalListViewCtl1->setPicture(read(store, stored::backImg));
    write(store, stored::backImgEnabled, true);
    ApplyBackground();
}

void frmMain::mnuBackImgEnabled_Click() {
    // The action has already flipped its check mark when it is triggered from the menu.
    SettingsStore& store = m_platform.store;
    vbalListViewCtl1->setPicture(mnuBackImgEnabled->isChecked() ? read(store, stored::backImg)
                                                                : QString());
    write(store, stored::backImgEnabled, mnuBackImgEnabled->isChecked());
    ApplyBackground();
}

void frmMain::mnuSearchAsYouType_Click() {
    write(m_platform.store, stored::searchAsYouType, mnuSearchAsYouType->isChecked());
    if (!mnuSearchAsYouType->isChecked())
        tmrSearch->stop();
}

void frmMain::ApplyBackground() {
    BarLook look;
    if (mnuBackImgEnabled->isChecked()) {
        look.picture = m_backdrop;
        look.barPicture = loadPictureFile(read(m_platform.store, stored::backImg));
    }
    look.barColor = vbalListViewCtl1->BackColor();
    look.barForeColor = vbalListViewCtl1->ForeColor();
    vbalProgressBar1->setPicture(look.picture);
    vbalProgressBar1->setBarPicture(look.barPicture);
    vbalProgressBar1->setBarForeColor(look.barForeColor);
    vbalProgressBar1->setBarColor(look.barColor);
    if (m_settings)
        m_settings->setBarLook(look);
}

void frmMain::showEmulatorDocument(const QString& fileName) {
    QString folder = read(m_platform.store, stored::z26Path);
    // A stored path of the emulator itself names its folder's documents; a folder that
    // merely has the emulator's name is kept.
    const QString suffix = u'/' + QStringLiteral("z26");
    if (folder.endsWith(suffix, Qt::CaseInsensitive) && !QFileInfo(folder).isDir())
        folder.chop(suffix.size());
    QString path = folder + u'/' + fileName;
    if (!folder.isEmpty() && !QFileInfo(path).isFile()) {
        // Documents unpacked on Linux often carry lower-case names.
        for (const QString& name : QDir(folder).entryList(QDir::Files))
            if (name.compare(fileName, Qt::CaseInsensitive) == 0)
                path = folder + u'/' + name;
    }
    if (folder.isEmpty() || !QFileInfo(path).isFile() || !m_platform.shell.OpenTextFile(path))
        m_platform.dialogs.MsgBox(this, QStringLiteral("Error loading ") + fileName, MsgButtons::Ok,
                                  MsgIcon::Exclamation, QStringLiteral("Error"));
}

void frmMain::mnuAboutz26Readme_Click() {
    showEmulatorDocument(QStringLiteral("README.TXT"));
}

void frmMain::mnuAboutCopying_Click() {
    showEmulatorDocument(QStringLiteral("COPYING.TXT"));
}

void frmMain::mnuAboutz26HomePage_Click() {
    m_platform.shell.OpenUrl(QString(web::kZ26HomePage));
}

void frmMain::mnuAboutlumHomePage_Click() {
    m_platform.shell.OpenUrl(QString(web::kLumHomePage));
}

void frmMain::mnuAboutlumAbout_Click() {
    if (m_about) {
        m_about->show();
        m_about->raise();
        m_about->activateWindow();
        return;
    }
    auto* about = new frmAbout(m_platform, this);
    m_about = about;
    // The update check may start an installer and end the program at once, without any
    // window saving its state.
    connect(about, &frmAbout::endProgramRequested, qApp, [] { QCoreApplication::exit(0); });
    about->show();
}
