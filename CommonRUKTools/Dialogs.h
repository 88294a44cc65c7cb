#pragma once

#include <QString>
#include <QStringList>
#include <optional>

// The engine's way to the user. The desktop program answers with windows, the command line at the terminal, a
// test with a script.

enum class MessageKind { Information, Warning, Error };

struct FileDialogOptions {
    QString Title;
    QString DefaultExtension;  // without a dot
    QString Filter;  // pairs "caption|patterns", joined by "|": "Musik|*.mp3;*.wav|Alle Dateien|*.*"
    QString Preset;  // file or folder shown first
    bool ConfirmOverwrite = false;
};

class Dialogs {
 public:
    virtual ~Dialogs() = default;

    virtual void ShowMessage(MessageKind kind, const QString& text) = 0;
    // The index of the chosen button; `cancelButton` when the dialog is closed in another way.
    virtual int Ask(const QString& text, const QStringList& buttons, int cancelButton) = 0;
    // The text entered or chosen; nothing on cancel. With choices the text is one of them.
    virtual std::optional<QString> Input(const QString& caption, const QString& prompt,
                                         const QStringList& choices, const QString& preset) = 0;
    // Nothing (or an empty list) on cancel.
    virtual std::optional<QString> OpenFile(const FileDialogOptions& options) = 0;
    virtual QStringList OpenFiles(const FileDialogOptions& options) = 0;
    virtual std::optional<QString> SaveFile(const FileDialogOptions& options) = 0;
    // `startFolder` is shown first; without one it is up to the dialog.
    virtual std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder = {}) = 0;
};

// The dialogs in use. Before any are set, messages go to standard error and every question is cancelled.
Dialogs& UserDialogs();
// The caller keeps ownership; nullptr restores the start state.
void SetUserDialogs(Dialogs* dialogs);
