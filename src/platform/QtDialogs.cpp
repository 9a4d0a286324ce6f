#include "platform/QtDialogs.h"

#include <QColorDialog>
#include <QDir>
#include <QFileDialog>
#include <QMessageBox>

namespace {

QMessageBox::Icon qtIcon(MsgIcon icon) {
    switch (icon) {
    case MsgIcon::Critical:
        return QMessageBox::Critical;
    case MsgIcon::Question:
        return QMessageBox::Question;
    case MsgIcon::Exclamation:
        return QMessageBox::Warning;
    case MsgIcon::Information:
        return QMessageBox::Information;
    case MsgIcon::None:
        break;
    }
    return QMessageBox::NoIcon;
}

QMessageBox::StandardButtons qtButtons(MsgButtons buttons) {
    switch (buttons) {
    case MsgButtons::Ok:
        return QMessageBox::Ok;
    case MsgButtons::OkCancel:
        return QMessageBox::Ok | QMessageBox::Cancel;
    case MsgButtons::YesNo:
        return QMessageBox::Yes | QMessageBox::No;
    case MsgButtons::YesNoCancel:
        return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    }
    return QMessageBox::Ok;
}

QString runFileDialog(QWidget* owner, const FileDialogRequest& request,
                      QFileDialog::AcceptMode mode) {
    QFileDialog dialog(owner, request.title, request.initialFolder, qtFileFilter(request.filter));
    dialog.setAcceptMode(mode);
    const QString selected = qtSelectedFilter(request.filter, request.filterIndex);
    if (!selected.isEmpty())
        dialog.selectNameFilter(selected);
    if (!request.fileName.isEmpty())
        dialog.selectFile(request.fileName);
    if (mode == QFileDialog::AcceptOpen)
        dialog.setFileMode(QFileDialog::ExistingFile);
    else
        dialog.setFileMode(QFileDialog::AnyFile);
    dialog.setOption(QFileDialog::DontConfirmOverwrite,
                     (request.flags & kFlagOverwritePrompt) == 0);
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return QString();
    return dialog.selectedFiles().constFirst();
}

} // namespace

MsgResult QtDialogs::MsgBox(QWidget* owner, const QString& text, MsgButtons buttons, MsgIcon icon,
                            const QString& title) {
    QMessageBox box(qtIcon(icon), title, text, qtButtons(buttons), owner);
    // Texts quote file names, server lines and system errors: never read them as markup.
    box.setTextFormat(Qt::PlainText);
    switch (box.exec()) {
    case QMessageBox::Ok:
        return MsgResult::Ok;
    case QMessageBox::Yes:
        return MsgResult::Yes;
    case QMessageBox::No:
        return MsgResult::No;
    default:
        // Closing a box without a Cancel button counts as its only answer.
        return buttons == MsgButtons::Ok      ? MsgResult::Ok
               : buttons == MsgButtons::YesNo ? MsgResult::No
                                              : MsgResult::Cancel;
    }
}

QString QtDialogs::ShowOpen(QWidget* owner, const FileDialogRequest& request) {
    return runFileDialog(owner, request, QFileDialog::AcceptOpen);
}

QString QtDialogs::ShowSave(QWidget* owner, const FileDialogRequest& request) {
    return runFileDialog(owner, request, QFileDialog::AcceptSave);
}

QString QtDialogs::ShowFolder(QWidget* owner, const QString& title, const QString& initialFolder) {
    return QFileDialog::getExistingDirectory(owner, title, initialFolder);
}

std::optional<quint32> QtDialogs::ShowColor(QWidget* owner, const QString& title,
                                            quint32 initialColour) {
    const QColor initial(initialColour & 0xFF, (initialColour >> 8) & 0xFF,
                         (initialColour >> 16) & 0xFF);
    const QColor chosen = QColorDialog::getColor(initial, owner, title);
    if (!chosen.isValid())
        return std::nullopt;
    return static_cast<quint32>(chosen.red()) | (static_cast<quint32>(chosen.green()) << 8) |
           (static_cast<quint32>(chosen.blue()) << 16);
}
