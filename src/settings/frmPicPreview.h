#pragma once

#include "ui/ScreenPlace.h"

#include <QWidget>

struct Platform;
class QLabel;

// The controller-layout preview: a modeless window that shows one picture scaled to fit
// it with its proportions kept. It opens where it was last closed (section "picpos" of the
// settings store, in twips) and deletes itself when closed, so the owner keeps a QPointer
// and makes a new one for the next picture after that.
class frmPicPreview : public QWidget {
    Q_OBJECT
public:
    // `owner` (the settings window) gives the window its icon and keeps it in front.
    explicit frmPicPreview(Platform& platform, QWidget* owner = nullptr);

    // Shows the picture file `path` under the window caption `caption` and brings the
    // window up. When the file cannot be loaded as a picture, says "Error loading pic"
    // and leaves the window as it was (closed, or showing its previous picture); false
    // then.
    bool showPicture(const QString& path, const QString& caption);

    // The path of the picture shown (Label1's caption).
    QString picturePath() const;

    // Places the image control for the window's current size, unless minimized.
    void refit();

    // PPPic holds the loaded picture at its natural size and is never shown; PPImg shows
    // it stretched; Label1 (hidden) holds the picture's path.
    QLabel* PPPic = nullptr;
    QLabel* PPImg = nullptr;
    QLabel* Label1 = nullptr;

protected:
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void takePicture(const QString& path, const QPixmap& picture);
    void saveGeometryToStore();

    Platform& m_platform;
    ScreenFit m_place; // where the stored place opened the window
};
