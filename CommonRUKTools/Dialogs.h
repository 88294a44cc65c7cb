#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <optional>
#include <vector>

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

// Buttons are named by their place. Captions are plain: letters to reach them by are the dialog's business.
struct Question {
    QString Text;
    QStringList Buttons;
    int Cancel = 0;  // the answer when the dialog is closed in another way
    // The answer of the Return key; Cancel unless another is named. Never one that destroys something.
    std::optional<int> Default{};

    int DefaultButton() const { return Default.value_or(Cancel); }
};

// The answer of the Return key where there are two. Never Agrees to what destroys something.
enum class ReturnKey { Declines, Agrees };

// One kind of thing that a report tells of: the songs that are new, the files that could not be read.
struct ReportSection {
    QString Caption;
    QStringList Lines;
    bool Complaint = false;  // something that did not go as the user wished
};

// What came of a command that handled many things.
struct Report {
    QString Message;  // the sum of it in a sentence
    std::vector<ReportSection> Sections;
    // Opens the report as a text; may be called long after the command has ended.
    std::function<void()> OpenAsText;

    bool HasComplaints() const;
};

class Dialogs {
 public:
    virtual ~Dialogs() = default;

    virtual void ShowMessage(MessageKind kind, const QString& text) = 0;
    // The place of the chosen button.
    virtual int Ask(const Question& question) = 0;
    // Whether the user chooses what the button `action` says, and not "Abbrechen".
    bool Confirm(const QString& question, const QString& action, ReturnKey returnKey = ReturnKey::Declines);
    // "Ja" or "Nein".
    bool AskYesNo(const QString& question, ReturnKey returnKey = ReturnKey::Declines);
    // Unless dialogs know better, the message with a button that opens the text.
    virtual void ShowReport(const Report& report);
    // The text entered or chosen; nothing on cancel. With choices the text is one of them.
    virtual std::optional<QString> Input(const QString& caption, const QString& prompt,
                                         const QStringList& choices, const QString& preset) = 0;
    // Where a medium is: the mount point of a volume, empty while none is chosen; nothing on cancel. Unless
    // dialogs know better, a choice of what is mounted at this moment.
    virtual std::optional<QString> ChooseVolume(const QString& caption, const QString& prompt,
                                                const QString& preset);
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
