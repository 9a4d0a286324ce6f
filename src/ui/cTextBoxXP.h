#pragma once

#include <QFrame>
#include <QPointer>
#include <QString>

class QWidget;

// A balloon tip: a small popup with an icon, a bold title and lines of text, anchored
// under a control. It closes when clicked or after a few seconds.
class BalloonTip : public QFrame {
    Q_OBJECT
public:
    // Icon: 0 none, 1 information, 2 warning, 3 error.
    BalloonTip(QWidget* anchor, int icon, const QString& title, const QString& text);

    QString title() const { return m_title; }
    QString text() const { return m_text; }
    int icon() const { return m_icon; }

protected:
    void mousePressEvent(QMouseEvent* event) override;

private:
    QString m_title;
    QString m_text;
    int m_icon;
};

// Attaches to a text box and shows balloon tips and a cue banner on it.
class cTextBoxXP {
public:
    void setTextBox(QWidget* box) { m_box = box; }

    QString CueBanner() const { return m_cueBanner; }
    // A line edit shows the cue banner as its placeholder text.
    void setCueBanner(const QString& text);

    QString BalloonTipTitle() const { return m_title; }
    void setBalloonTipTitle(const QString& title) { m_title = title; }
    // Lines may be separated by CR LF.
    QString BalloonTipText() const { return m_text; }
    void setBalloonTipText(const QString& text) { m_text = text; }
    int BalloonTipIcon() const { return m_icon; }
    void setBalloonTipIcon(int icon) { m_icon = icon; }

    // Shows the tip on the attached control, replacing one already shown there.
    void ShowBalloonTip();
    void HideBalloonTip();

    // The tip shown on a control, or null.
    static BalloonTip* shownOn(QWidget* box);

private:
    QPointer<QWidget> m_box;
    QString m_cueBanner;
    QString m_title;
    QString m_text;
    int m_icon = 0;
};
