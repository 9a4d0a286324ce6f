#include "settings/OptionBinding.h"

#include "emulator/OptionFile.h"
#include "settings/SliderRules.h"
#include "ui/vbalProgressBar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QRadioButton>
#include <QSignalBlocker>

#include <algorithm>

namespace {

using K = OptionKind;

// Qt's states in its own order: unchecked, partially checked (grayed), checked.
Check checkOf(Qt::CheckState state) {
    constexpr Check kChecks[] = {Check::Off, Check::Grayed, Check::On};
    return kChecks[std::clamp(static_cast<int>(state), 0, 2)];
}

QString sliderText(const OptionRow& row, int value) {
    return row.kind == K::SoundQueue ? sliders::SoundQueueText(value) : sliders::PlainText(value);
}

} // namespace

OptionBinding::OptionBinding(QWidget& window, EmulatorOptions& options) : m_options(options) {
    for (const OptionRow& row : optionTable()) {
        std::vector<QWidget*> controls;
        for (int i = 0; i < row.slotCount; ++i) {
            const char* name = row.slotList[static_cast<std::size_t>(i)].control;
            QWidget* control = name ? window.findChild<QWidget*>(QLatin1String(name)) : nullptr;
            // A control the table names but the window lacks is a mistake of the code.
            Q_ASSERT_X(control || !name, "OptionBinding", name);
            controls.push_back(control);
        }
        m_controls.push_back(std::move(controls));
        bind(row);
    }
}

void OptionBinding::bind(const OptionRow& row) {
    const std::vector<QWidget*>& controls = m_controls.back();
    if (controls.front() == nullptr && row.kind != K::Choice)
        return;
    const auto changed = [this, &row](int value) {
        row.set(m_options, value);
        emit edited();
    };
    switch (row.kind) {
    case K::List:
        connect(static_cast<QComboBox*>(controls.front()), &QComboBox::currentIndexChanged, this,
                changed);
        break;
    case K::Check: {
        auto* box = static_cast<QCheckBox*>(controls.front());
#if QT_VERSION >= QT_VERSION_CHECK(6, 7, 0)
        connect(box, &QCheckBox::checkStateChanged, this,
                [changed](Qt::CheckState state) { changed(static_cast<int>(checkOf(state))); });
#else
        connect(box, &QCheckBox::stateChanged, this, [changed](int state) {
            changed(static_cast<int>(checkOf(static_cast<Qt::CheckState>(state))));
        });
#endif
        break;
    }
    case K::Choice:
        for (std::size_t i = 0; i < controls.size(); ++i)
            if (auto* button = static_cast<QRadioButton*>(controls[i]))
                connect(button, &QRadioButton::toggled, this, [changed, i](bool bOn) {
                    if (bOn)
                        changed(static_cast<int>(i));
                });
        break;
    case K::Number:
        connect(static_cast<QLineEdit*>(controls.front()), &QLineEdit::textChanged, this,
                [this, &row](const QString& text) {
                    m_options.*row.text = text;
                    emit edited();
                });
        break;
    case K::Slider:
    case K::SoundQueue: {
        auto* bar = static_cast<vbalProgressBar*>(controls.front());
        connect(bar, &vbalProgressBar::Change, this, [bar, changed] { changed(bar->Value()); });
        break;
    }
    }
}

void OptionBinding::show(const EmulatorOptions& options, bool bRescaleSoundQueue) {
    const auto& table = optionTable();
    for (std::size_t i = 0; i < table.size(); ++i)
        showRow(table[i], options, bRescaleSoundQueue);
}

void OptionBinding::showRow(const OptionRow& row, const EmulatorOptions& options,
                            bool bRescaleSoundQueue) {
    const std::vector<QWidget*>& controls =
        m_controls[static_cast<std::size_t>(&row - optionTable().data())];
    if (row.kind == K::Choice) {
        const auto selected = static_cast<std::size_t>(row.get(options));
        if (selected < controls.size() && controls[selected]) {
            auto* button = static_cast<QRadioButton*>(controls[selected]);
            const QSignalBlocker quiet(button);
            button->setChecked(true);
        }
        return;
    }
    QWidget* control = controls.front();
    if (control == nullptr)
        return;
    const QSignalBlocker quiet(control);
    switch (row.kind) {
    case K::List:
        if (auto* list = static_cast<QComboBox*>(control); list->currentIndex() != row.get(options))
            list->setCurrentIndex(row.get(options));
        break;
    case K::Check: {
        auto* box = static_cast<QCheckBox*>(control);
        const auto state = static_cast<Check>(row.get(options));
        if (checkOf(box->checkState()) == state)
            break;
        if (state == Check::Grayed) {
            box->setCheckState(Qt::PartiallyChecked);
        } else {
            // A grayed state is one a file gives; the user's clicks go on between the two.
            box->setTristate(false);
            box->setCheckState(state == Check::On ? Qt::Checked : Qt::Unchecked);
        }
        break;
    }
    case K::Number:
        if (auto* field = static_cast<QLineEdit*>(control); field->text() != options.*row.text)
            field->setText(options.*row.text);
        break;
    case K::Slider:
    case K::SoundQueue: {
        auto* bar = static_cast<vbalProgressBar*>(control);
        const int value = row.get(options);
        if (row.kind == K::SoundQueue && bRescaleSoundQueue) {
            if (const std::optional<SliderScale> scale = soundQueueScaleFor(float(value))) {
                bar->setMin(scale->min);
                bar->setMax(scale->max);
            }
        }
        bar->setValue(value);
        bar->setText(sliderText(row, value));
        break;
    }
    case K::Choice:
        break;
    }
}
