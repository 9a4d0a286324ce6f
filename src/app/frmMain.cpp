#include "app/frmMain.h"

#include "about/frmAbout.h"
#include "app/MenuIcons.h"
#include "emulator/ConfigRecord.h"
#include "library/CCRC32.h"
#include "library/GameDatabase.h"
#include "library/RomListModel.h"
#include "library/Search.h"
#include "platform/Dialogs.h"
#include "platform/FileSystem.h"
#include "platform/Platform.h"
#include "platform/SettingsStore.h"
#include "platform/Shell.h"
#include "platform/WebAddresses.h"
#include "settings/DefaultPaths.h"
#include "settings/frmSettings.h"
#include "ui/ListView.h"
#include "ui/OleColor.h"
#include "ui/PictureFile.h"
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

#include <cmath>

namespace {

const QString kSettings = QStringLiteral("Settings");
const QString kWinpos = QStringLiteral("winpos");

// The store's keys of ROM folder n: ROMPath, ROM2Path, ROM3Path, ...
QString folderKey(int n, const char* suffix) {
    return QStringLiteral("ROM") + (n == 1 ? QString() : QString::number(n)) +
           QLatin1String(suffix);
}

} // namespace

frmMain::frmMain(Platform& platform) : m_platform(platform) {
    // First, so that the listing has the whole building of the window to run in.
    startFirstListing();
    setObjectName(QStringLiteral("frmMain"));
    setWindowTitle(QStringLiteral("lum"));
    createControls();
    createMenus();
}

frmMain::~frmMain() = default;

QStringList frmMain::enabledRomFolders() const {
    const SettingsStore& store = m_platform.store;
    QStringList folders;
    for (int n = 1;; ++n) {
        const QString path = store.GetSetting(kSettings, folderKey(n, "Path"));
        if (path.isEmpty())
            break;
        if (readBool(store, kSettings, folderKey(n, "Checked"), false))
            folders.push_back(path);
    }
    return folders;
}

void frmMain::startFirstListing() {
    // Listing a large collection takes longer than building and showing the window, so it
    // runs on another core meanwhile; the load's refresh takes the result over.
    m_firstListingFolders = enabledRomFolders();
    m_firstListingPattern = storedRomFilter(m_platform.store);
    if (m_firstListingFolders.isEmpty() ||
        m_platform.store.GetSetting(kSettings, QStringLiteral("Z26Path")).isEmpty())
        return;
    m_firstListing = std::async(
        std::launch::async, [folders = m_firstListingFolders, pattern = m_firstListingPattern] {
            const FilePattern filePattern(pattern);
            std::vector<RomFolderListing> listings;
            for (const QString& folder : folders)
                listings.push_back({folder, listMatchingFiles(folder, filePattern)});
            return listings;
        });
}

std::vector<frmMain::RomFolderListing> frmMain::takeFirstListing(const QStringList& folders,
                                                                 const QString& pattern) {
    if (!m_firstListing.valid())
        return {};
    std::vector<RomFolderListing> listings = m_firstListing.get();
    // Folders or a pattern changed since the start are listed again.
    if (folders != m_firstListingFolders || pattern != m_firstListingPattern)
        return {};
    return listings;
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
    connect(vbalListViewCtl1, &ListView::keyDown, this, &frmMain::vbalListViewCtl1_KeyDown);
    connect(vbalListViewCtl1, &ListView::mouseDown, this, &frmMain::vbalListViewCtl1_MouseDown);
    connect(vbalListViewCtl1, &ListView::itemDoubleClicked, this, [this] { LoadROM(false); });

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
    m_settings->setLoadRomHandler([this](bool ForceLoad) { LoadROM(ForceLoad); });
    if (m_defaultOptionSet) {
        m_settings->LoadSettings(*m_defaultOptionSet);
        m_defaultOptionSet.reset();
    }
    if (m_configCaption) {
        showConfigCaption(m_configCaption->first, m_configCaption->second);
        m_configCaption.reset();
    }
    const std::vector<vbalProgressBar*> bars = {
        m_settings->BarColorPaddle, m_settings->BarColorSoundQueue, m_settings->BarColorPhos};
    for (vbalProgressBar* bar : bars)
        bar->setForeColor(0);
    applyBackgroundTo(bars);
}

void frmMain::showConfigCaption(const QString& text, const QString& tip) {
    if (!m_settings) {
        m_configCaption.emplace(text, tip);
        return;
    }
    m_settings->lblConfig->setText(text);
    m_settings->lblConfig->setToolTip(tip);
}

void frmMain::createMenus() {
    auto item = [this](QMenu* menu, const char* name, const char* caption) {
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

    connect(mnuFileExit, &QAction::triggered, this, &frmMain::mnuFileExit_Click);
    connect(mnuSettingsConfiguration, &QAction::triggered, this,
            &frmMain::mnuSettingsConfiguration_Click);
    connect(mnuMainRefresh, &QAction::triggered, this, &frmMain::mnuMainRefresh_Click);
    connect(mnuMainGameInfo, &QAction::triggered, this, &frmMain::mnuMainGameInfo_Click);
    connect(mnuBackColorChange, &QAction::triggered, this, &frmMain::mnuBackColorChange_Click);
    connect(mnuTextColor, &QAction::triggered, this, &frmMain::mnuTextColor_Click);
    connect(mnuBackImgChange, &QAction::triggered, this, &frmMain::mnuBackImgChange_Click);
    connect(mnuBackImgEnabled, &QAction::triggered, this, &frmMain::mnuBackImgEnabled_Click);
    connect(mnuAboutz26Readme, &QAction::triggered, this, &frmMain::mnuAboutz26Readme_Click);
    connect(mnuAboutCopying, &QAction::triggered, this, &frmMain::mnuAboutCopying_Click);
    connect(mnuAboutz26HomePage, &QAction::triggered, this, &frmMain::mnuAboutz26HomePage_Click);
    connect(mnuAboutlumHomePage, &QAction::triggered, this, &frmMain::mnuAboutlumHomePage_Click);
    connect(mnuAboutlumAbout, &QAction::triggered, this, &frmMain::mnuAboutlumAbout_Click);
    connect(mnuFileLoadSettings, &QAction::triggered, this,
            [this] { settingsWindow().cmdLoadDat_Click(); });
    connect(mnuFileSaveSettings, &QAction::triggered, this,
            [this] { settingsWindow().cmdSaveDat_Click(); });
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

    const QString defaultFile = m_platform.programFolder + QStringLiteral("/Default.lum");
    if (FileExist(defaultFile)) {
        // A sound option set waits for the settings window; a corrupt one is reported now.
        ConfigDecode optionSet = frmSettings::readOptionSet(defaultFile);
        const bool loaded = optionSet.ok();
        if (m_settings || !loaded)
            settingsWindow().LoadSettings(optionSet);
        else
            m_defaultOptionSet = std::make_unique<ConfigDecode>(std::move(optionSet));
        showConfigCaption(loaded ? QStringLiteral("Default.lum was succesfully loaded")
                                 : QStringLiteral("Default.lum is corrupt.  Please verify "
                                                  "settings and re-save to correct the problem."),
                          QString());
    } else {
        showConfigCaption(QStringLiteral("Default.lum couldn't be loaded"),
                          QStringLiteral("Default.lum need's to be in the same folder as lum.exe"));
    }

    SettingsStore& store = m_platform.store;
    File1.setPattern(
        store.GetSetting(kSettings, QStringLiteral("ROMFilter"), QStringLiteral("*.*")));

    const double height = readSingle(store, kWinpos, QStringLiteral("height"), 6570);
    const double width = readSingle(store, kWinpos, QStringLiteral("width"), 4905);
    const double top = readSingle(store, kWinpos, QStringLiteral("top"), 500);
    const double left = readSingle(store, kWinpos, QStringLiteral("left"), 500);
    resize(twips::toPixelsX(width), twips::toPixelsY(height));
    move(twips::toPixelsX(left), twips::toPixelsY(top));
    if (readBool(store, kWinpos, QStringLiteral("max"), false))
        setWindowState(windowState() | Qt::WindowMaximized);

    vbalListViewCtl1->setBackColor(
        readColour(store, kSettings, QStringLiteral("BackColor"), kOleWhite));
    mnuBackImgEnabled->setChecked(
        readBool(store, kSettings, QStringLiteral("BackImgEnabled"), true));
    vbalListViewCtl1->setPicture(mnuBackImgEnabled->isChecked()
                                     ? store.GetSetting(kSettings, QStringLiteral("BackImg"))
                                     : QString());
    vbalListViewCtl1->setForeColor(readColour(store, kSettings, QStringLiteral("TextColor"), 0));

    for (vbalProgressBar* bar : progressBars()) {
        bar->setForeColor(0);
        bar->setBarColor(vbalListViewCtl1->BackColor());
        bar->setBarForeColor(vbalListViewCtl1->ForeColor());
    }
    ApplyBackground();

    const QString romPath = store.GetSetting(kSettings, QStringLiteral("ROMPath"));
    m_sZ26Path = store.GetSetting(kSettings, QStringLiteral("Z26Path"));

    if (!m_sZ26Path.isEmpty() && !romPath.isEmpty()) {
        addListColumns();

        show();
        QCoreApplication::processEvents();
        m_bInitialLoad = true;
        RefreshMainList();
        m_bInitialLoad = false;
        return;
    }
    m_firstListing = {}; // nothing to fill without both paths

    if (m_sZ26Path.isEmpty())
        m_platform.dialogs.MsgBox(
            this, QStringLiteral("You need to select you z26 path before you continue."),
            MsgButtons::Ok, MsgIcon::None, QStringLiteral("Choose z26 Path"));
    else
        m_platform.dialogs.MsgBox(
            this, QStringLiteral("You need to select you ROM's path before you continue."),
            MsgButtons::Ok, MsgIcon::None, QStringLiteral("Choose ROM's Path"));
    settingsWindow().SelectTab(QStringLiteral("DefaultPaths"));
    settingsWindow().show();
}

void frmMain::addListColumns() {
    const int listWidth = vbalListViewCtl1->width();
    m_listModel->addColumn(
        {QStringLiteral("Name"), QStringLiteral("Name"), QStringLiteral("ROM Name")});
    m_listModel->addColumn(
        {QStringLiteral("Path"), QStringLiteral("Path"), QStringLiteral("ROM Path")});
    QHeaderView* header = vbalListViewCtl1->header();
    header->resizeSection(0, listWidth + twips::toPixelsX(1000));
    header->resizeSection(1, twips::toPixelsX(1000));
}

void frmMain::RefreshMainList() {
    SettingsStore& store = m_platform.store;
    // A list first filled after the paths were chosen on a first run still needs its
    // columns, or its rows would not show until the next start.
    if (m_listModel->columnCount() == 0)
        addListColumns();
    File1.setPattern(m_settings ? m_settings->txtDefPathFilter->text() : storedRomFilter(store));
    const QString search = txtSearch->text().trimmed();

    // The first load's listing is already under way on another core, so its caption is
    // painted while that listing finishes rather than after it.
    if (m_bInitialLoad) {
        fraSearch->setTitle(QStringLiteral("Loading ROM's List..."));
        show();
        QCoreApplication::processEvents();
    }

    // Counting pass. Each enabled folder is listed once; the scanning pass below reuses
    // the listing, so both passes see the same files.
    const QStringList folderPaths = enabledRomFolders();
    std::vector<RomFolderListing> listings;
    if (m_bInitialLoad)
        listings = takeFirstListing(folderPaths, File1.pattern());
    if (listings.empty()) {
        for (const QString& path : folderPaths) {
            File1.setPath(path);
            listings.push_back({path, File1.takeNames()});
        }
    }
    double total = 0;
    for (const RomFolderListing& listing : listings)
        total += static_cast<double>(listing.names.size());

    if (!m_bInitialLoad) {
        fraSearch->setTitle(QStringLiteral("Finding ROM's..."));
        QCoreApplication::processEvents();
    }

    txtSearch->hide();
    vbalProgressBar1->setMin(0);
    if (total > 0)
        vbalProgressBar1->setMax(static_cast<int>(std::nearbyint(total)));
    vbalProgressBar1->setValue(0);
    vbalProgressBar1->show();

    m_listModel->clear();

    // Scanning pass: the rows are gathered first and handed to the list in one batch.
    QStringList folders;
    NameList names;
    std::vector<int> rowFolders;
    const SearchExpression expression(search);
    int done = 0;
    long long shownPercent = -1;
    int shownUntil = -1; // the last value known to give the percent shown
    const auto advance = [&](int value) {
        vbalProgressBar1->setValue(value);
        // The percent text only changes when its rounded value does. Values only grow
        // here, so where the next change comes is worked out once per percent.
        if (value <= shownUntil)
            return;
        const auto percentAt = [&](int v) { return std::llround(vbalProgressBar1->PercentAt(v)); };
        const long long percent = percentAt(value);
        if (percent != shownPercent) {
            shownPercent = percent;
            vbalProgressBar1->setText(QString::number(percent) + u'%');
        }
        shownUntil = progressbar::runEnd(value, +1, [&](int v) { return percentAt(v) == percent; });
    };
    for (RomFolderListing& listing : listings) {
        const int folderIndex = static_cast<int>(folders.size());
        folders.push_back(listing.folder);
        const int count = static_cast<int>(listing.names.size());
        for (int i = 0; i < count; ++i) {
            advance(i + done);
            const QStringView name = listing.names.at(i);
            if (!search.isEmpty() && expression.matches(name)) {
                names.append(name);
                rowFolders.push_back(folderIndex);
            }
        }
        advance(count + done);
        done += count;
        // Without a search every name is a row, so the folder's names are taken whole.
        if (search.isEmpty()) {
            rowFolders.insert(rowFolders.end(), static_cast<size_t>(count), folderIndex);
            names.append(std::move(listing.names));
        }
    }
    m_listModel->setRows(std::move(folders), std::move(names), std::move(rowFolders));

    const int k = m_listModel->rowCount();
    QString mark = k == 1 ? QString() : QStringLiteral("'s");
    if (m_bInitialLoad) {
        setWindowTitle(QStringLiteral("lum - %1 ROM%2 Found").arg(k).arg(mark));
    } else {
        if (!mark.isEmpty())
            mark = QStringLiteral("es");
        setWindowTitle(QStringLiteral("lum - %1 Match%2 out of %3")
                           .arg(k)
                           .arg(mark)
                           .arg(static_cast<qint64>(total)));
    }

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
    const double h = twips::fromPixelsY(height());
    const double frameWidth = w - 330;
    const double frameHeight = h - 1755;
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
        if (isMaximized()) {
            store.SaveSetting(kWinpos, QStringLiteral("max"), boolText(true));
        } else {
            store.SaveSetting(kWinpos, QStringLiteral("max"), boolText(false));
            store.SaveSetting(kWinpos, QStringLiteral("top"), singleText(twips::fromPixelsY(y())));
            store.SaveSetting(kWinpos, QStringLiteral("left"), singleText(twips::fromPixelsX(x())));
            store.SaveSetting(kWinpos, QStringLiteral("height"),
                              singleText(twips::fromPixelsY(height())));
            store.SaveSetting(kWinpos, QStringLiteral("width"),
                              singleText(twips::fromPixelsX(width())));
        }
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

void frmMain::vbalListViewCtl1_KeyDown(int key) {
    if (key == Qt::Key_F5)
        RefreshMainList();
    else if (key == Qt::Key_Return || key == Qt::Key_Enter)
        LoadROM(false);
}

void frmMain::vbalListViewCtl1_MouseDown(Qt::MouseButton button, QPoint globalPos) {
    if (button != Qt::RightButton)
        return;
    mnuMainGameInfo->setVisible(false);
    if (const QString path = selectedRowPath(); !path.isEmpty() && LookupSoftwareID(path) != 0)
        mnuMainGameInfo->setVisible(true);
    mnuMainPopup->popup(globalPos);
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
    return ::LookupSoftwareID(*mcrc32, m_platform.programFolder + QStringLiteral("/CRCID.dat"),
                              path);
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
    store.SaveSetting(kSettings, QStringLiteral("BackColor"), QString::number(colour));
    vbalListViewCtl1->setBackColor(colour);
    const quint32 text = 16777215 - colour;
    store.SaveSetting(kSettings, QStringLiteral("TextColor"), QString::number(text));
    vbalListViewCtl1->setForeColor(text);
    mnuBackImgEnabled->setChecked(false);
    vbalListViewCtl1->setPicture(QString());
    store.SaveSetting(kSettings, QStringLiteral("BackImgEnabled"), boolText(false));
    ApplyBackground();
}

void frmMain::mnuTextColor_Click() {
    const std::optional<quint32> chosen = m_platform.dialogs.ShowColor(
        this, QStringLiteral("Choose a Color"), vbalListViewCtl1->ForeColor());
    if (!chosen)
        return;
    const quint32 colour = *chosen & 0xFFFFFF;
    m_platform.store.SaveSetting(kSettings, QStringLiteral("TextColor"), QString::number(colour));
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
        store.SaveSetting(kSettings, QStringLiteral("BackImg"), chosen);
    // Chosen or cancelled, the picture is switched on with the stored file.
    mnuBackImgEnabled->setChecked(true);
    vbalListViewCtl1->setPicture(store.GetSetting(kSettings, QStringLiteral("BackImg")));
    store.SaveSetting(kSettings, QStringLiteral("BackImgEnabled"), boolText(true));
    ApplyBackground();
}

void frmMain::mnuBackImgEnabled_Click() {
    // The action has already flipped its check mark when it is triggered from the menu.
    SettingsStore& store = m_platform.store;
    vbalListViewCtl1->setPicture(mnuBackImgEnabled->isChecked()
                                     ? store.GetSetting(kSettings, QStringLiteral("BackImg"))
                                     : QString());
    store.SaveSetting(kSettings, QStringLiteral("BackImgEnabled"),
                      boolText(mnuBackImgEnabled->isChecked()));
    ApplyBackground();
}

std::vector<vbalProgressBar*> frmMain::progressBars() const {
    if (!m_settings)
        return {vbalProgressBar1};
    return {vbalProgressBar1, m_settings->BarColorPaddle, m_settings->BarColorSoundQueue,
            m_settings->BarColorPhos};
}

void frmMain::ApplyBackground() {
    applyBackgroundTo(progressBars());
}

void frmMain::applyBackgroundTo(const std::vector<vbalProgressBar*>& bars) {
    QImage picture;
    QImage barPicture;
    if (mnuBackImgEnabled->isChecked()) {
        picture = m_backdrop;
        barPicture =
            loadPictureFile(m_platform.store.GetSetting(kSettings, QStringLiteral("BackImg")));
    }
    for (vbalProgressBar* bar : bars) {
        bar->setPicture(picture);
        bar->setBarPicture(barPicture);
        bar->setBarForeColor(vbalListViewCtl1->ForeColor());
        bar->setBarColor(vbalListViewCtl1->BackColor());
    }
}

void frmMain::showEmulatorDocument(const QString& fileName) {
    m_sZ26Path = m_platform.store.GetSetting(kSettings, QStringLiteral("Z26Path"));
    QString folder = m_sZ26Path;
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
    auto* about = new frmAbout(m_platform, this);
    // The update check may start an installer and end the program at once, without any
    // window saving its state.
    connect(about, &frmAbout::endProgramRequested, qApp, [] { QCoreApplication::exit(0); });
    about->show();
}
