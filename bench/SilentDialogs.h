#pragma once

#include "platform/Dialogs.h"

#include <cstdio>

namespace bench {

// Counts boxes instead of showing them; a benchmark run must show none.
class SilentDialogs final : public Dialogs {
public:
    MsgResult MsgBox(QWidget*, const QString& text, MsgButtons, MsgIcon,
                     const QString& title) override {
        std::fprintf(stderr, "unexpected box %s: %s\n", qPrintable(title), qPrintable(text));
        ++boxes;
        return MsgResult::Ok;
    }
    QString ShowOpen(QWidget*, const FileDialogRequest&) override { return {}; }
    QString ShowSave(QWidget*, const FileDialogRequest&) override { return {}; }
    QString ShowFolder(QWidget*, const QString&, const QString&) override { return {}; }
    std::optional<quint32> ShowColor(QWidget*, const QString&, quint32) override { return {}; }
    int boxes = 0;
};

} // namespace bench
