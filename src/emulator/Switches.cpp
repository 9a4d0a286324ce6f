#include "emulator/Switches.h"

#include "emulator/LeadingNumber.h"
#include "emulator/OptionRules.h"

namespace switches {

namespace {

QString controller(int index, const char* mark) {
    const Controller* entry = controllerAt(index);
    if (entry == nullptr || *entry->code == '\0')
        return QString();
    return QLatin1String(" -") + QLatin1String(mark) + QLatin1String(entry->code);
}

int paddleDigit(::Paddle paddle) {
    return paddle == ::Paddle::None ? -1 : static_cast<int>(paddle);
}

} // namespace

QString FieldSwitch::operator()(const EmulatorOptions& o) const {
    return isOn(o.*box) ? QLatin1String(text) + normalisedNumberText(o.*field) : QString();
}

QString LeftController(const EmulatorOptions& o) {
    return controller(o.leftController, ")");
}

QString RightController(const EmulatorOptions& o) {
    return controller(o.rightController, "(");
}

QString IPC(const EmulatorOptions& o) {
    // A box no selected controller can use is disabled and never counts.
    const OptionStates states = optionStates(o);
    const std::pair<PcDevice, char> devices[] = {{PcDevice::Keyboard, 'K'},
                                                 {PcDevice::Mouse, 'M'},
                                                 {PcDevice::Joystick, 'J'},
                                                 {PcDevice::Stelladaptor, 'S'}};
    QString letters;
    for (const auto& [device, letter] : devices)
        if (inactivation(o, device) == Check::On &&
            states.pcDevices[static_cast<std::size_t>(device)])
            letters += QLatin1Char(letter);
    return letters.isEmpty() ? QString() : QStringLiteral(" -i") + letters;
}

QString PaddleSens(const EmulatorOptions& o) {
    return optionStates(o).keyboardPaddle
               ? QStringLiteral(" -p") + QString::number(o.paddleSensitivity)
               : QString();
}

QString LowerSens(const EmulatorOptions& o) {
    if (o.lowerSensitivity != Check::On || o.lowerSensitivityBy.isEmpty())
        return QString();
    // Only pasted text can hold more than digits; its leading number is what counts.
    return QStringLiteral(" -P") + normalisedNumberText(o.lowerSensitivityBy);
}

QString Paddle(const EmulatorOptions& o) {
    const int first = paddleDigit(o.mousePaddle1);
    const int second = paddleDigit(o.mousePaddle2);
    if (first >= 0 && second >= 0)
        return QStringLiteral(" -m1%1%2").arg(first).arg(second);
    if (first >= 0 || second >= 0)
        return QStringLiteral(" -m%1").arg(std::max(first, second));
    return QString();
}

QString MouseCapture(const EmulatorOptions& o) {
    return isOn(o.mouseCapture) ? QStringLiteral(" -M1") : QStringLiteral(" -M0");
}

QString LightGun(const EmulatorOptions& o) {
    if (!optionStates(o).lightGun)
        return QString();
    // Tidied, the scanlines are never empty, so an enabled light gun always gives both.
    return QStringLiteral(" -l") + normalisedNumberText(o.lightGunCycles) + QStringLiteral(" -a") +
           normalisedNumberText(o.lightGunScanlines);
}

QString FPS(const EmulatorOptions& o) {
    switch (o.frameRate) {
    case FrameRate::Monitor:
        return QStringLiteral(" -r");
    case FrameRate::Custom:
        // As typed: the emulator checks the rate itself.
        return QStringLiteral(" -r") + o.customFrameRate.trimmed();
    case FrameRate::Default:
        break;
    }
    return QString();
}

QString VideoMode(const EmulatorOptions& o) {
    const QString mode = QString::number(o.videoMode);
    switch (o.videoStart) {
    case VideoStart::Fullscreen:
        return QStringLiteral(" -v") + mode;
    case VideoStart::Window:
        return QStringLiteral(" -v1") + mode;
    case VideoStart::Default:
        break;
    }
    return QString();
}

QString SwapControl(const EmulatorOptions& o) {
    return o.swapPorts == Check::On ? QStringLiteral(" -w") : QString();
}

QString withoutLeadingBlank(const QString& switchText) {
    return switchText.startsWith(u' ') ? switchText.mid(1) : switchText;
}

QStringList emulatorArguments(const QString& romPath, const QString& switchText) {
    QStringList arguments{romPath};
    // Any white space separates, so a tab pasted into the edited switches does too.
    qsizetype start = -1;
    for (qsizetype i = 0; i <= switchText.size(); ++i) {
        const bool bSeparator = i == switchText.size() || switchText[i].isSpace();
        if (bSeparator && start >= 0) {
            arguments << switchText.mid(start, i - start);
            start = -1;
        } else if (!bSeparator && start < 0) {
            start = i;
        }
    }
    return arguments;
}

} // namespace switches

QString launchSwitches(const EmulatorOptions& o) {
    // The emulator reads its switches in any order; this one is what users have always
    // seen, so the preview and saved habits stay familiar.
    namespace s = switches;
    return s::LeftController(o) + s::RightController(o) + s::Interlaced(o) + s::P0Hard(o) +
           s::P1Hard(o) + s::All4(o) + s::StartBW(o) + s::ScreenCapture(o) + s::ColorPalette(o) +
           s::DSP(o) + s::Narrow(o) + s::Phos(o) + s::GameType(o) + s::ScanLines(o) + s::IPC(o) +
           s::PaddleSens(o) + s::LowerSens(o) + s::Paddle(o) + s::MouseCapture(o) + s::LightGun(o) +
           s::ShowScanline(o) + s::PALColorLoss(o) + s::Quiet(o) + s::SoundQueue(o) + s::FPS(o) +
           s::LineScan(o) + s::CodeTrace(o) + s::VideoMode(o) + s::SwapControl(o) +
           s::PrintChecksum(o) + s::FastCopy(o) + s::SyncWSound(o);
}
