#pragma once

#include <QWidget>

struct Platform;
class QLabel;
class QLineEdit;
class QGroupBox;
class QPushButton;
class QTabWidget;

// The settings window: created hidden by the main window's load and kept until the
// program ends. Its close box only hides it.
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

    // Controls other windows reach by name.
    QWidget* picSideText = nullptr;
    QTabWidget* vbalDTabControl1 = nullptr;
    QWidget* picSettings = nullptr;
    QWidget* picControls = nullptr;
    QWidget* picPaddlesAudio = nullptr;
    QWidget* picVideo = nullptr;
    QWidget* picDebug = nullptr;
    QWidget* picDefPaths = nullptr;
    QGroupBox* fraConfig = nullptr;
    QPushButton* cmdSaveDat = nullptr;
    QPushButton* cmdLoadDat = nullptr;
    QLabel* lblConfig = nullptr;
    QGroupBox* fraDefPathFilter = nullptr;
    QLineEdit* txtDefPathFilter = nullptr;

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    void Form_Load();
    void Form_Unload();

    Platform& m_platform;
    bool m_bUnloading = false;
};
