#pragma once

#include <QString>
#include <QtGlobal>

#include <optional>

class QWidget;

enum class MsgButtons { Ok, OkCancel, YesNo, YesNoCancel };
enum class MsgIcon { None, Critical, Question, Exclamation, Information };
enum class MsgResult { Ok, Cancel, Yes, No };

// What a file chooser is opened with. The filter is "desc|pattern|desc|pattern" with the
// patterns of one entry separated by ';'; the filter index counts from 1.
struct FileDialogRequest {
    QString title;
    QString initialFolder;
    QString fileName;
    QString filter;
    int filterIndex = 1;
    // The chooser's flags as the program states them: 0x2 asks before overwriting,
    // 0x1800 requires the path and the file to exist.
    unsigned flags = 0;
};

inline constexpr unsigned kFlagOverwritePrompt = 0x2;
inline constexpr unsigned kFlagPathMustExist = 0x800;
inline constexpr unsigned kFlagFileMustExist = 0x1000;

// Modal dialogs: message boxes and the file, folder and colour choosers. Every dialog is
// centred over its owner.
class Dialogs {
public:
    virtual ~Dialogs() = default;

    virtual MsgResult MsgBox(QWidget* owner, const QString& text, MsgButtons buttons, MsgIcon icon,
                             const QString& title = QStringLiteral("lum")) = 0;
    // The chosen full path, or the empty text when the user cancelled.
    virtual QString ShowOpen(QWidget* owner, const FileDialogRequest& request) = 0;
    virtual QString ShowSave(QWidget* owner, const FileDialogRequest& request) = 0;
    virtual QString ShowFolder(QWidget* owner, const QString& title,
                               const QString& initialFolder) = 0;
    // The chosen OLE colour (0x00BBGGRR), or nothing when the user cancelled.
    virtual std::optional<quint32> ShowColor(QWidget* owner, const QString& title,
                                             quint32 initialColour) = 0;
};

// "Image Files|*.jpg;*.png|All Files (*.*)|*.*" in the form Qt's file dialogs take:
// "Image Files (*.jpg *.png);;All Files (*)". Each entry shows its patterns once: a label
// that ends in a pattern list has it replaced by the entry's own. Entries keep their order.
QString qtFileFilter(const QString& filter);
// The 1-based filter index's entry in qtFileFilter's form, or empty when out of range.
QString qtSelectedFilter(const QString& filter, int filterIndex);
