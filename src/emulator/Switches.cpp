#include "emulator/Switches.h"

#include "emulator/LeadingNumber.h"
#include "emulator/OptionRules.h"

#include <iterator>

namespace switches {

namespace {

QString flag(Check check, const char* switchText) {
    return isOn(check) ? QLatin1String(switchText) : QString();
}

QString controller(int index, const char* mark) {
    const Controller* entry = controllerAt(index);
    if (entry == nullptr || *entry->code == '\0')
        return QString();
    return QLatin1String(" -") + QLatin1String(mark) + QLatin1String(entry->code);
}

// One switch of a group of option buttons, by the button selected ("" for none).
template <class E, std::size_t N>
QString choice(E selected, const std::array<const char*, N>& texts) {
    return QLatin1String(texts[static_cast<std::size_t>(selected)]);
}

int paddleDigit(::Paddle paddle) {
    return paddle == ::Paddle::None ? -1 : static_cast<int>(paddle);
}

} // namespace

QString LeftController(const EmulatorOptions& o) {
    return controller(o.leftController, ")");
}

QString RightController(const EmulatorOptions& o) {
    return controller(o.rightController, "(");
}

QString Interlaced(const EmulatorOptions& o) {
    return flag(o.interlaced, " -!");
}

QString P0Hard(const EmulatorOptions& o) {
    return flag(o.player0Hard, " -0");
}

QString P1Hard(const EmulatorOptions& o) {
    return flag(o.player1Hard, " -1");
}

QString All4(const EmulatorOptions& o) {
    return flag(o.allow4Directions, " -4");
}

QString StartBW(const EmulatorOptions& o) {
    return flag(o.blackAndWhite, " -b");
}

QString ScreenCapture(const EmulatorOptions& o) {
    return choice(o.screenCapture, std::array{"", " -B"});
}

QString ColorPalette(const EmulatorOptions& o) {
    return choice(o.palette, std::array{"", " -c0", " -c1", " -c2"});
}

QString DSP(const EmulatorOptions& o) {
    return choice(o.dsp, std::array{"", " -d1", " -d2"});
}

QString Narrow(const EmulatorOptions& o) {
    return choice(o.narrow, std::array{"", " -e1", " -e2"});
}

QString Phos(const EmulatorOptions& o) {
    return o.phosphor == kPhosphorDefault ? QString()
                                          : QStringLiteral(" -f") + QString::number(o.phosphor);
}

QString GameType(const EmulatorOptions& o) {
    return o.gameType == 0 ? QString() : QStringLiteral(" -g") + QString::number(o.gameType);
}

QString ScanLines(const EmulatorOptions& o) {
    return isOn(o.scanLineLimit) ? QStringLiteral(" -h") + normalisedNumberText(o.scanLines)
                                 : QString();
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

QString ShowScanline(const EmulatorOptions& o) {
    return flag(o.showScanline, " -n");
}

QString PALColorLoss(const EmulatorOptions& o) {
    return flag(o.palColorLoss, " -o");
}

QString Quiet(const EmulatorOptions& o) {
    return flag(o.quiet, " -q");
}

QString SoundQueue(const EmulatorOptions& o) {
    return o.soundQueue == kSoundQueueDefault
               ? QString()
               : QStringLiteral(" -s") + QString::number(o.soundQueue);
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

QString LineScan(const EmulatorOptions& o) {
    return isOn(o.startLineEnabled) ? QStringLiteral(" -u") + normalisedNumberText(o.startLine)
                                    : QString();
}

QString CodeTrace(const EmulatorOptions& o) {
    return flag(o.codeTrace, " -t");
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

QString PrintChecksum(const EmulatorOptions& o) {
    return flag(o.printChecksum, " -x");
}

QString FastCopy(const EmulatorOptions& o) {
    return flag(o.noFastCopy, " -z");
}

QString SyncWSound(const EmulatorOptions& o) {
    return flag(o.syncWithSound, " -R");
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

QString launchSwitches(const EmulatorOptions& options) {
    // The emulator reads its switches in any order; this one is what users have always
    // seen, so the preview and saved habits stay familiar.
    namespace s = switches;
    static constexpr QString (*kOrder[])(const EmulatorOptions&) = {
        s::LeftController,
        s::RightController,
        s::Interlaced,
        s::P0Hard,
        s::P1Hard,
        s::All4,
        s::StartBW,
        s::ScreenCapture,
        s::ColorPalette,
        s::DSP,
        s::Narrow,
        s::Phos,
        s::GameType,
        s::ScanLines,
        s::IPC,
        s::PaddleSens,
        s::LowerSens,
        s::Paddle,
        s::MouseCapture,
        s::LightGun,
        s::ShowScanline,
        s::PALColorLoss,
        s::Quiet,
        s::SoundQueue,
        s::FPS,
        s::LineScan,
        s::CodeTrace,
        s::VideoMode,
        s::SwapControl,
        s::PrintChecksum,
        s::FastCopy,
        s::SyncWSound,
    };
    static_assert(std::size(kOrder) == 32);
    QString text;
    for (const auto builder : kOrder)
        text += builder(options);
    return text;
}
