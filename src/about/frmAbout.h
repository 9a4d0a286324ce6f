#pragma once

#include <QDialog>
#include <QPixmap>

struct Platform;
class QFrame;
class QLabel;
class QPushButton;

// The About window: product name, version, the freeware note and the support address on
// a tiled background, with buttons for system information, the update check, the forum,
// the web page and the donation page. Non-modal; it deletes itself when closed.
class frmAbout : public QDialog {
    Q_OBJECT
public:
    // `updateServer` serves the update description file and the forum (scheme and host,
    // no trailing slash). Empty: $LUM_UPDATE_URL when set (a mirror, a packager's own
    // server), else the maker's server.
    explicit frmAbout(Platform& platform, QWidget* parent = nullptr, QString updateServer = {});
    ~frmAbout() override;

    void StartSysInfo();
    bool GetKeyValue(quint32 KeyRoot, const QString& KeyName, const QString& SubKeyRef,
                     QString& KeyVal);
    bool DownloadFile(const QString& URL, const QString& LocalFilename);

    void cmdOK_Click();
    void cmdSysInfo_Click();
    void cmdUpdate_Click();
    void cmdForum_Click();
    void cmdWeb_Click();
    void cmdDonate_Click();
    void lblEmail_Click();
    void lblEmail_MouseMove();

    QLabel* lblProgram = nullptr;
    QLabel* lblVersion = nullptr;
    QLabel* lblCorwen = nullptr;
    QLabel* lblMain = nullptr;
    QLabel* lblEmail = nullptr;
    QLabel* Picture1 = nullptr;
    QFrame* Line1[2] = {nullptr, nullptr};
    QPushButton* cmdOK = nullptr;
    QPushButton* cmdSysInfo = nullptr;
    QPushButton* cmdUpdate = nullptr;
    QPushButton* cmdForum = nullptr;
    QPushButton* cmdWeb = nullptr;
    QPushButton* cmdDonate = nullptr;
    // The background picture, painted as tiles over the whole window.
    QPixmap Image1;

    QString m_sVersion;
    bool m_bForumRequest = false;

signals:
    // The update's installer has been started: the program must end at once, without
    // any window saving its state.
    void endProgramRequested();

protected:
    void paintEvent(QPaintEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void createControls();
    void Form_Load();
    void Form_Paint();
    void Form_MouseMove(const QPoint& position);
    void runUpdateCheck();

    Platform& m_platform;
    QString m_updateServer;
    // True while an update check runs: its downloads wait in a nested event loop, which
    // must not close the window under it.
    bool m_bChecking = false;
};
