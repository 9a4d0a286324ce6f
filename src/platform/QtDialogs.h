#pragma once

#include "platform/Dialogs.h"

// The real dialogs: QMessageBox, QFileDialog and QColorDialog.
class QtDialogs final : public Dialogs {
public:
    MsgResult MsgBox(QWidget* owner, const QString& text, MsgButtons buttons, MsgIcon icon,
                     const QString& title) override;
    QString ShowOpen(QWidget* owner, const FileDialogRequest& request) override;
    QString ShowSave(QWidget* owner, const FileDialogRequest& request) override;
    QString ShowFolder(QWidget* owner, const QString& title, const QString& initialFolder) override;
    std::optional<quint32> ShowColor(QWidget* owner, const QString& title,
                                     quint32 initialColour) override;
};
