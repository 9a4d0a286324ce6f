#pragma once

#include "emulator/EmulatorOptions.h"
#include "library/RomArchive.h"
#include "library/RomCatalogue.h"
#include "ui/ScreenPlace.h"

#include <QImage>
#include <QMainWindow>
#include <QPointer>
#include <QSet>

#include <memory>
#include <optional>
#include <utility>
#include <vector>

struct CommandLine;
struct Platform;
class frmAbout;
class frmSettings;
class ListView;
class QAction;
class QGroupBox;
class QLabel;
class QLineEdit;
class QMenu;
class QTemporaryDir;
class QTimer;
class CCRC32;
class RomListModel;
class vbalProgressBar;

// The main window: the ROM list, the search box and the menus.
class frmMain : public QMainWindow {
    Q_OBJECT
public:
    explicit frmMain(Platform& platform);
    ~frmMain() override;

    // The load handler: restores the window and either fills the list or asks for the
    // missing paths. The start-up routine runs it before showing the window.
    void Form_Load();

    // Rebuilds the ROM list from the enabled folders, the file pattern and the search box.
    void RefreshMainList();

    // Starts the emulator on the selected ROM with the settings window's options, after
    // checking the paths and the options that would spoil the game. With "Edit Switches"
    // on it hands the switches to the user instead, unless ForceLoad: then it starts with
    // the switches as the user edited them.
    void LoadROM(bool ForceLoad = false);

    enum class Launch { Started, NotStarted, EditingSwitches };
    // The launch of one ROM file, whoever asks for it: the list, a drop, the Recent ROMs
    // menu or the command line. A ROM started goes on top of the recent list.
    Launch launchRom(const QString& romPath, bool ForceLoad);

    // Runs a command line that names a ROM file, this window staying hidden: the exit
    // status once z26 is started (0) or the box saying why not is closed (1); nothing while
    // the settings window waits for the user's edited switches (commandLineDone then).
    std::optional<int> startFromCommandLine(const CommandLine& command);

    // The settings window, built on first use.
    frmSettings& settingsWindow();
    RomListModel& listModel() { return *m_listModel; }

signals:
    void commandLineDone(int exitStatus);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    // Controls, by the names the rest of the program knows them by.
    QGroupBox* fraSelectRom = nullptr;
    ListView* vbalListViewCtl1 = nullptr;
    QGroupBox* fraSearch = nullptr;
    QLineEdit* txtSearch = nullptr;
    vbalProgressBar* vbalProgressBar1 = nullptr;
    QLabel* picBack = nullptr;
    // Narrows the list a moment after the last key, so that a burst of keys costs one pass.
    QTimer* tmrSearch = nullptr;

    QMenu* mnuFile = nullptr;
    QAction* mnuFileLoadSettings = nullptr;
    QAction* mnuFileSaveSettings = nullptr;
    QMenu* mnuFileRecent = nullptr;
    QAction* mnuFileExit = nullptr;
    QMenu* mnuSettings = nullptr;
    QAction* mnuSettingsConfiguration = nullptr;
    QAction* mnuTextColor = nullptr;
    QMenu* mnuBackImg = nullptr;
    QAction* mnuBackImgChange = nullptr;
    QAction* mnuBackColorChange = nullptr;
    QAction* mnuBackImgEnabled = nullptr;
    QAction* mnuSearchAsYouType = nullptr;
    QAction* mnuFavouritesOnly = nullptr;
    QMenu* mnuAbout = nullptr;
    QAction* mnuAboutz26Readme = nullptr;
    QAction* mnuAboutCopying = nullptr;
    QAction* mnuAboutz26HomePage = nullptr;
    QAction* mnuAboutlumAbout = nullptr;
    QAction* mnuAboutlumHomePage = nullptr;
    QMenu* mnuMainPopup = nullptr;
    QAction* mnuMainRefresh = nullptr;
    QAction* mnuMainGameInfo = nullptr;
    QAction* mnuMainFavourite = nullptr;

    bool m_bInitialLoad = false;

    // The search box's handlers: Enter refreshes, Ctrl+A / Ctrl+O / Ctrl+N insert an
    // operator at the caret; a double-click shows the search help.
    bool txtSearch_KeyPress(int key, Qt::KeyboardModifiers modifiers);
    void txtSearch_DblClick();
    void txtSearch_Change();
    // Narrows the list to what the search box matches among the rows the last refresh
    // listed, without reading a folder.
    void tmrSearch_Timer();
    // The last listing again, kept by `search` and the favourites, without reading a folder.
    void showNarrowed(const QString& search);
    void showRows(RomRows rows, bool bFirstLoad);
    RowFilter listFilter(const QString& search) const;
    void vbalListViewCtl1_KeyDown(int key);
    void vbalListViewCtl1_MouseDown(Qt::MouseButton button, QPoint globalPos);
    // The row popup at a place on the screen, with Game Info when the row is known and the
    // favourite item captioned by the row's state.
    void showRowPopup(QPoint globalPos);

    void createControls();
    void createMenus();
    void addListColumns();
    void assignMenuIcons();
    void assignMenuIconsNow();
    // Default.lum's options: the user's own, else the program's.
    void loadStartOptions();
    // The stored z26 path, or a z26 on PATH, stored then.
    QString storedOrFoundZ26Path();
    // The Recent ROMs menu from the stored list; with bCheckFiles a ROM that is gone shows
    // disabled.
    void fillRecentMenu(bool bCheckFiles);
    void Form_Resize();
    void Form_Unload();
    void mnuFileExit_Click();
    void mnuSettingsConfiguration_Click();
    void mnuMainRefresh_Click();
    void mnuMainGameInfo_Click();
    // Adds the selected row to the favourites, or removes it.
    void mnuMainFavourite_Click();
    void mnuFavouritesOnly_Click();
    void mnuBackColorChange_Click();
    void mnuTextColor_Click();
    void mnuBackImgChange_Click();
    void mnuBackImgEnabled_Click();
    void mnuSearchAsYouType_Click();
    // The list's colours and picture on the bars that follow them: the refresh's progress
    // bar and the settings window's slider bars.
    void ApplyBackground();
    void createSettingsWindow();
    // The settings window's status line, kept until the window exists.
    void showConfigCaption(const QString& text, const QString& tip);
    void mnuAboutz26Readme_Click();
    void mnuAboutCopying_Click();
    void mnuAboutz26HomePage_Click();
    void mnuAboutlumHomePage_Click();
    void mnuAboutlumAbout_Click();
    // Opens one of the emulator's documents in the text editor, or says it could not.
    void showEmulatorDocument(const QString& fileName);
    // The folder z26 runs in.
    QString emulatorWorkingFolder(const QString& emulator) const;
    // The owner of the launch's boxes.
    QWidget* boxOwner();
    // Says that z26 at `emulator` could not be started, and why.
    void launchFailed(const QString& emulator, const QString& reason);
    // The software ID of a ROM file (an archive's first file) in the game database beside
    // the program, or 0.
    qint16 LookupSoftwareID(const QString& path);
    // An archive's first file extracted into this run's private folder, or why not.
    ArchiveResult unpackArchive(const QString& archive);
    // The selected row's full path, or the empty text when no row is selected.
    QString selectedRowPath() const;

    Platform& m_platform;
    std::unique_ptr<frmSettings> m_settings;
    // Default.lum as read at start-up, shown when the settings window is built.
    std::optional<EmulatorOptions> m_startOptions;
    std::optional<std::pair<QString, QString>> m_configCaption;
    RomCatalogue m_catalogue;
    // The favourite ROMs' full paths, as stored.
    QSet<QString> m_favourites;
    // The search the shown rows were kept by: the box may hold one not yet applied.
    QString m_shownSearch;
    std::unique_ptr<CCRC32> mcrc32;
    QImage m_backdrop; // picBack's built-in picture
    bool m_menuIconsAssigned = false;
    // The ROM a command line names: the launches of this run are all of it.
    QString m_commandLineRom;
    ScreenFit m_place;          // as opened: a corrected place is not saved unless changed
    QPointer<frmAbout> m_about; // one at a time
    RomListModel* m_listModel = nullptr;
    // Where archives are extracted; removed with the window, so the files live while lum runs.
    std::unique_ptr<QTemporaryDir> m_unpacked;
};
