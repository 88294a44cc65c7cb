#pragma once

#include <cstdio>

#include "CommonRUKTools/Dialogs.h"

// The engine's questions at the terminal: texts go to the error stream, answers come from the input. Where
// nobody can answer (no terminal, end of input) every question is cancelled.
class TerminalDialogs : public Dialogs {
 public:
    // The caller keeps ownership of both. `answers` may be nullptr: nobody answers.
    TerminalDialogs(std::FILE* questions, std::FILE* answers) : questions_(questions), answers_(answers) {}

    void ShowMessage(MessageKind kind, const QString& text) override;
    int Ask(const Question& question) override;
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override;
    std::optional<QString> OpenFile(const FileDialogOptions& options) override;
    QStringList OpenFiles(const FileDialogOptions& options) override;
    std::optional<QString> SaveFile(const FileDialogOptions& options) override;
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override;

 private:
    void Print(const QString& text);
    // Nothing at the end of the input.
    std::optional<QString> ReadLine(const QString& prompt);
    // A number of a list that is shown from 1; an empty line takes `preset`. Nothing when the answer is none
    // of them.
    std::optional<int> Choose(const QStringList& choices, const QString& prompt,
                              std::optional<int> preset = std::nullopt);
    std::optional<QString> AskForPath(const QString& caption, const QString& preset);

    std::FILE* questions_;
    std::FILE* answers_;
};

// Installs dialogs for as long as it exists.
class InstalledDialogs {
 public:
    explicit InstalledDialogs(Dialogs& dialogs) { SetUserDialogs(&dialogs); }
    ~InstalledDialogs() { SetUserDialogs(nullptr); }
    InstalledDialogs(const InstalledDialogs&) = delete;
    InstalledDialogs& operator=(const InstalledDialogs&) = delete;
};
