// The settings window's three slider bars: the keyboard paddle sensitivity, the phosphor
// effect and the size of the sound queue, with the sound queue's movable scale and menu.
// The arithmetic lives in SliderRules; here it is wired to the bars.

#include "settings/SliderRules.h"
#include "settings/frmSettings.h"
#include "ui/Twips.h"
#include "ui/vbalProgressBar.h"

#include <QAction>
#include <QCursor>
#include <QMenu>

namespace {

vbalProgressBar* sliderBar(const char* name, int min, int max, int value, const QString& text) {
    auto* bar = new vbalProgressBar;
    bar->setObjectName(QLatin1String(name));
    bar->setMinimumHeight(twips::toPixelsY(300));
    bar->setMin(min);
    bar->setMax(max);
    bar->setValue(value);
    bar->setText(text);
    bar->setShowText(true);
    bar->setInteractive(true);
    return bar;
}

void applyScale(vbalProgressBar* bar, const sliders::Scale& scale) {
    bar->setMin(scale.min);
    bar->setMax(scale.max);
    bar->setValue(scale.value);
}

} // namespace

vbalProgressBar* frmSettings::createBarColorPaddle() {
    auto* bar = sliderBar("BarColorPaddle", sliders::kPaddleMin, sliders::kPaddleMax,
                          sliders::kPaddleStart, sliders::PlainText(sliders::kPaddleStart));
    connect(bar, &vbalProgressBar::Change, this, &frmSettings::BarColorPaddle_Change);
    return bar;
}

vbalProgressBar* frmSettings::createBarColorPhos() {
    auto* bar = sliderBar("BarColorPhos", sliders::kPhosMin, sliders::kPhosMax,
                          sliders::kPhosDefault, sliders::PlainText(sliders::kPhosDefault));
    connect(bar, &vbalProgressBar::Change, this, &frmSettings::BarColorPhos_Change);
    connect(bar, &vbalProgressBar::DblClick, this, &frmSettings::BarColorPhos_DblClick);
    return bar;
}

vbalProgressBar* frmSettings::createBarColorSoundQueue() {
    const sliders::Scale start = sliders::SoundQueueDefault();
    auto* bar = sliderBar("BarColorSoundQueue", start.min, start.max, start.value,
                          sliders::SoundQueueText(start.value));
    bar->setToolTip(QStringLiteral("Double click to reset value to the default"));
    connect(bar, &vbalProgressBar::Change, this, &frmSettings::BarColorSoundQueue_Change);
    connect(bar, &vbalProgressBar::DblClick, this, &frmSettings::BarColorSoundQueue_DblClick);
    connect(bar, &vbalProgressBar::KeyPress, this, &frmSettings::BarColorSoundQueue_KeyPress);
    connect(bar, &vbalProgressBar::RightClick, this, &frmSettings::BarColorSoundQueue_RightClick);

    // The blanks line up the keys at the right of the two captions.
    mnuSQPopup = new QMenu(this);
    mnuSQPopup->setObjectName(QStringLiteral("mnuSQPopup"));
    mnuSQShiftUp = mnuSQPopup->addAction(QStringLiteral("Shift Scale Up") + QString(22, u' ') +
                                         QStringLiteral("(+)"));
    mnuSQShiftUp->setObjectName(QStringLiteral("mnuSQShiftUp"));
    mnuSQShiftDown = mnuSQPopup->addAction(QStringLiteral("Shift Scale Down") + QString(18, u' ') +
                                           QStringLiteral("(-)"));
    mnuSQShiftDown->setObjectName(QStringLiteral("mnuSQShiftDown"));
    mnuSQBar = mnuSQPopup->addSeparator();
    mnuSQBar->setObjectName(QStringLiteral("mnuSQBar"));
    mnuSQReset = mnuSQPopup->addAction(QStringLiteral("Reset to Default Value (Double Click)"));
    mnuSQReset->setObjectName(QStringLiteral("mnuSQReset"));
    connect(mnuSQShiftUp, &QAction::triggered, this, &frmSettings::mnuSQShiftUp_Click);
    connect(mnuSQShiftDown, &QAction::triggered, this, &frmSettings::mnuSQShiftDown_Click);
    connect(mnuSQReset, &QAction::triggered, this, &frmSettings::mnuSQReset_Click);
    return bar;
}

void frmSettings::BarColorPaddle_Change() {
    BarColorPaddle->setText(sliders::PlainText(BarColorPaddle->Value()));
    RefreshOptionStates();
}

void frmSettings::BarColorPhos_Change() {
    BarColorPhos->setText(sliders::PlainText(BarColorPhos->Value()));
    RefreshOptionStates();
}

void frmSettings::BarColorPhos_DblClick() {
    BarColorPhos->setValue(sliders::kPhosDefault);
    BarColorPhos->setText(sliders::PlainText(sliders::kPhosDefault));
    RefreshOptionStates();
}

void frmSettings::BarColorSoundQueue_Change() {
    BarColorSoundQueue->setText(sliders::SoundQueueText(BarColorSoundQueue->Value()));
    RefreshOptionStates();
}

void frmSettings::BarColorSoundQueue_DblClick() {
    const sliders::Scale scale = sliders::SoundQueueDefault();
    applyScale(BarColorSoundQueue, scale);
    BarColorSoundQueue->setText(sliders::SoundQueueText(scale.value));
    RefreshOptionStates();
}

void frmSettings::BarColorSoundQueue_KeyPress(int KeyAscii) {
    const sliders::Scale before{BarColorSoundQueue->Min(), BarColorSoundQueue->Max(),
                                BarColorSoundQueue->Value()};
    const sliders::Scale after = sliders::ShiftSoundQueue(before, KeyAscii);
    applyScale(BarColorSoundQueue, after);
    // The text follows the value whenever the shift moved it, so what the bar shows is
    // always what the switch sends.
    if (after.value != before.value)
        BarColorSoundQueue->setText(sliders::SoundQueueText(after.value));
    RefreshOptionStates();
}

void frmSettings::BarColorSoundQueue_RightClick() {
    // Not modal: the chosen item runs its own handler when the menu closes.
    mnuSQPopup->popup(QCursor::pos());
    RefreshOptionStates();
}

void frmSettings::mnuSQShiftUp_Click() {
    BarColorSoundQueue_KeyPress(sliders::kKeyShiftUp);
}

void frmSettings::mnuSQShiftDown_Click() {
    BarColorSoundQueue_KeyPress(sliders::kKeyShiftDown);
}

void frmSettings::mnuSQReset_Click() {
    BarColorSoundQueue_DblClick();
}
