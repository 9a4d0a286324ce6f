#pragma once

#include "emulator/EmulatorOptions.h"
#include "library/FileLister.h"
#include "ui/ScreenPlace.h"
#include "ui/cLogo.h"

#include <QImage>
#include <QPointer>
#include <QWidget>

#include <memory>

struct OptionSetRead;
struct Platform;
class QMimeData;
class QTreeWidgetItem;
class frmPicPreview;
class vbalProgressBar;

// The colours and pictures of a slider bar, which follow the main list's.
struct BarLook {
    quint32 barColor = 0;
    quint32 barForeColor = 0;
    QImage picture;
    QImage barPicture;
};

// The settings window: created hidden by the main window when first needed and kept until
// the program ends; its close box only hides it. It edits one EmulatorOptions value, which
// the preview of the switches, a launch and a save read, and the Default Paths page keeps
// the ROM folders and the emulator's path in the settings store. Its controls are its own;
// tests and tools find them by objectName.
class frmSettings : public QWidget {
    Q_OBJECT
public:
    explicit frmSettings(Platform& platform, QWidget* parent = nullptr);
    ~frmSettings() override;

    // The emulator options as the window shows them.
    const EmulatorOptions& options() const { return m_options; }
    // Shows other options, as loading an option set does.
    void setOptions(const EmulatorOptions& options);

    // Pages by key: "Settings", "Controls", "PaddlesAudio", "Video", "Debug",
    // "DefaultPaths". An unknown key changes nothing.
    void selectPage(const QString& key);
    QString selectedPage() const;
    // A page's caption on its tab, or the empty text for an unknown key.
    static QString pageCaption(const QString& key);
    // Brings the window up on that page.
    void showPage(const QString& key);
    // A balloon tip at one of the window's controls, named by its objectName.
    void showBalloonTip(const QString& control, int icon, const QString& title,
                        const QString& text);

    // "Edit Switches": whether it is on, and the switches as the user left them.
    bool switchEditing() const;
    QString editedSwitches() const;
    // Shows the switches a launch sends (with their leading blank) in the preview.
    void showSwitches(const QString& switchText);
    // Brings the window up with the switches in the edit box, for the user to change and
    // then start with Enter.
    void editSwitches();

    // Option sets (.lum files). LoadSettings shows the set's options and returns false,
    // after saying so, when the file is corrupt; the two buttons ask for a file and report
    // in the status line. The main window's File menu does the same, and says a failure in
    // a message box too, naming the file and why, as this window may be out of sight.
    bool LoadSettings(const QString& path);
    bool LoadSettings(const OptionSetRead& optionSet);
    void cmdSaveDat_Click();
    void cmdLoadDat_Click();
    void saveOptionSetFromMenu();
    void loadOptionSetFromMenu();
    // The status line of the Save/Load frame and its tool tip.
    void showConfigStatus(const QString& text, const QString& tip);

    // Default Paths: adds one folder (`bArchive` marks a dropped archive, which is
    // refused), and validates and stores the emulator's path (a folder is completed with
    // the emulator's name).
    void AddRomFolder(const QString& path, bool bArchive);
    void SetZ26Path(const QString& path);

    // The layout picture's file name for a button caption ("/lum Paddles.jpg" for one that
    // mentions "paddle"), or "" when the caption names no layout.
    static QString GetPicName(const QString& cmdTxt);

    void setBarLook(const BarLook& look);
    // The side strip's logo, whose caption follows the page shown.
    const cLogo& Logo() const;

    // The program's own unload at exit: saves the window's state and really closes it.
    void Unload();

signals:
    // The user changed an option.
    void optionsChanged(const EmulatorOptions& options);
    // Enter in the edited switches: start the selected ROM with them.
    void launchRequested(bool ForceLoad);

protected:
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    struct Ui;

    void createSettingsPage();
    void createControlsPage();
    void createPaddlesAudioPage();
    void createVideoPage();
    void createDebugPage();
    void createDefaultPathsPage();
    vbalProgressBar* createSliderBar(const char* name, int min, int max);
    void createSoundQueueMenu();
    void placeTabControl();

    void Form_Load();
    void Form_Unload();
    void Form_Resize();
    void vbalDTabControl1_TabClick(int index);
    void vbalDTabControl1_TabSelected(int index);
    QString tabKey(int index) const;

    // Options: each control edits the value; the value is then shown back, with the states
    // that follow from it and the preview of the switches.
    void connectOptionControls();
    void optionEdited();
    void showOptions(bool bRescaleSoundQueue);
    void RefreshOptionStates();
    bool numberFieldEvent(QObject* watched, QEvent* event);
    void comboVideoMode_Click();
    void chkDOSSwitch_Click();
    void saveOptionSet(bool bFromMenu);
    void loadOptionSet(bool bFromMenu);
    // The corrupt-set box: the fixed words, or `why` when it is given.
    bool reportCorruptOptionSet(const QString& why);
    void showControlPic(bool bLeft);

    // Slider bars.
    void BarColorPhos_DblClick();
    void BarColorSoundQueue_DblClick();
    void BarColorSoundQueue_KeyPress(int KeyAscii);
    void BarColorSoundQueue_RightClick();

    // Default Paths page.
    void LoadDefaultPaths();
    void SaveDefaultPaths();
    void txtDefPathFilter_Change();
    void chkROMSubfolders_Click();
    void cmdAddZ26Path_Click();
    void mnuROMSRemove_Click();
    void mnuROMSRefresh_Click();
    void mnuROMSAdd_Click();
    void vbalListDefPaths_KeyDown(int key);
    void vbalListDefPaths_MouseDown(Qt::MouseButton button, const QPoint& pos);
    void vbalListDefPaths_ItemChanged(QTreeWidgetItem* item, int column);
    void vbalListDefPaths_OLEDragDrop(const QMimeData* data);
    void txtDefPathz26_OLEDragDrop(const QMimeData* data);
    QTreeWidgetItem* selectedRomRow() const;
    void addRomRow(const QString& path, bool bEnabled);
    // Sets every row's count from its folder (and, when asked, the folders below it) with
    // the current pattern.
    void recountRomRows();

    Platform& m_platform;
    std::unique_ptr<Ui> m_ui;
    EmulatorOptions m_options;
    cLogo m_logo;
    FileLister FileROM;
    bool m_bCountsPending = false; // the folder counts wait for the window to show
    bool m_bUnloading = false;
    ScreenFit m_place; // where the stored place opened the window
    // Created by the first picture button click; it deletes itself when closed.
    QPointer<frmPicPreview> m_picPreview;
};
