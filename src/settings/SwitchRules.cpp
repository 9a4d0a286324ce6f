#include "settings/SwitchRules.h"

#include "emulator/LeadingNumber.h"

namespace switches {

const Controller* controllerAt(int index) {
    if (index < 0 || index >= static_cast<int>(kControllers.size()))
        return nullptr;
    return &kControllers[static_cast<size_t>(index)];
}

bool controllerUsesDevice(int index, const QString& device) {
    const Controller* controller = controllerAt(index);
    if (controller == nullptr)
        return false;
    if (device == QLatin1String("k"))
        return controller->keyboard;
    if (device == QLatin1String("m"))
        return controller->mouse;
    if (device == QLatin1String("j"))
        return controller->joystick;
    if (device == QLatin1String("s"))
        return controller->stelladaptor;
    return false;
}

QString numberText(double value) {
    return shortestDecimalText(value);
}

QString normalisedNumberText(QStringView text) {
    return numberText(leadingNumber(text));
}

QString mousePaddleSwitch(int mouse1, int mouse2) {
    const bool bFirst = mouse1 >= 0;
    const bool bSecond = mouse2 >= 0;
    if (bFirst && bSecond)
        return QStringLiteral(" -m1%1%2").arg(mouse1).arg(mouse2);
    if (bFirst)
        return QStringLiteral(" -m%1").arg(mouse1);
    if (bSecond)
        return QStringLiteral(" -m%1").arg(mouse2);
    return QString();
}

QString controllerPairSwitch(QChar letter, std::int16_t left, std::int16_t right) {
    // Bitwise on the 16-bit states, so a grayed box (2) combines with a checked one (1)
    // the way the emulator's front ends always have.
    QString result;
    const auto form = [letter](int n) {
        return QStringLiteral(" -") + letter + QString::number(n);
    };
    if ((~right & left) != 0)
        result = form(1);
    if ((~left & right) != 0)
        result = form(2);
    if ((left & right) != 0)
        result = form(3);
    return result;
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
