// The settings window's three slider bars: the keyboard paddle sensitivity, the phosphor
// effect and the size of the sound queue, with the sound queue's movable scale and menu.
// The arithmetic lives in SliderRules; dragging a bar edits its option through the
// binding, and the handlers here edit the option for the bars' other commands.

#include "settings/SliderRules.h"
#include "settings/frmSettingsUi.h"
#include "ui/Twips.h"
#include "ui/vbalProgressBar.h"

#include <QAction>
#include <QCursor>
#include <QMenu>

vbalProgressBar* frmSettings::createSliderBar(const char* name, int min, int max) {
    auto* bar = new vbalProgressBar;
    bar->setObjectName(QLatin1String(name));
    bar->setMinimumHeight(twips::toPixelsY(300));
    bar->setMin(min);
    bar->setMax(max);
    bar->setShowText(true);
    bar->setInteractive(true);
    return bar;
}

void frmSettings::createSoundQueueMenu() {
    // The blanks line up the keys at the right of the two captions.
    QMenu* menu = m_ui->mnuSQPopup = new QMenu(this);
    menu->setObjectName(QStringLiteral("mnuSQPopup"));
    const auto item = [menu](const char* name, const QString& caption) {
        QAction* action = menu->addAction(caption);
        action->setObjectName(QLatin1String(name));
        return action;
    };
    QAction* up = item("mnuSQShiftUp", QStringLiteral("Shift Scale Up") + QString(22, u' ') +
                                           QStringLiteral("(+)"));
    QAction* down = item("mnuSQShiftDown", QStringLiteral("Shift Scale Down") + QString(18, u' ') +
                                               QStringLiteral("(-)"));
    menu->addSeparator()->setObjectName(QStringLiteral("mnuSQBar"));
    QAction* reset = item("mnuSQReset", QStringLiteral("Reset to Default Value (Double Click)"));
    connect(up, &QAction::triggered, this,
            [this] { BarColorSoundQueue_KeyPress(sliders::kKeyShiftUp); });
    connect(down, &QAction::triggered, this,
            [this] { BarColorSoundQueue_KeyPress(sliders::kKeyShiftDown); });
    connect(reset, &QAction::triggered, this, &frmSettings::BarColorSoundQueue_DblClick);
}

void frmSettings::BarColorPhos_DblClick() {
    m_options.phosphor = kPhosphorDefault;
    optionEdited();
}

void frmSettings::BarColorSoundQueue_DblClick() {
    const sliders::Scale scale = sliders::SoundQueueDefault();
    m_ui->BarColorSoundQueue->setMin(scale.min);
    m_ui->BarColorSoundQueue->setMax(scale.max);
    m_options.soundQueue = scale.value;
    optionEdited();
}

void frmSettings::BarColorSoundQueue_KeyPress(int KeyAscii) {
    vbalProgressBar* bar = m_ui->BarColorSoundQueue;
    const sliders::Scale after =
        sliders::ShiftSoundQueue({bar->Min(), bar->Max(), bar->Value()}, KeyAscii);
    bar->setMin(after.min);
    bar->setMax(after.max);
    m_options.soundQueue = after.value;
    optionEdited();
}

void frmSettings::BarColorSoundQueue_RightClick() {
    // Not modal: the chosen item runs its own handler when the menu closes.
    m_ui->mnuSQPopup->popup(QCursor::pos());
}

void frmSettings::setBarLook(const BarLook& look) {
    for (vbalProgressBar* bar :
         {m_ui->BarColorPaddle, m_ui->BarColorSoundQueue, m_ui->BarColorPhos}) {
        bar->setPicture(look.picture);
        bar->setBarPicture(look.barPicture);
        bar->setBarForeColor(look.barForeColor);
        bar->setBarColor(look.barColor);
    }
}
