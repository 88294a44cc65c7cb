#pragma once

#include "CommonRUKTools/Dialogs.h"

// As long as it exists, and when it is told to, answers every question of two buttons with the first, which
// agrees. Everything else goes to the dialogs that were in use: where there is a choice, agreeing means
// nothing.
class AgreeingDialogs : public Dialogs {
 public:
    explicit AgreeingDialogs(bool agrees) : before_(UserDialogs()) {
        if (agrees) SetUserDialogs(this);
    }
    ~AgreeingDialogs() override { SetUserDialogs(&before_); }
    AgreeingDialogs(const AgreeingDialogs&) = delete;
    AgreeingDialogs& operator=(const AgreeingDialogs&) = delete;

    void ShowMessage(MessageKind kind, const QString& text) override { before_.ShowMessage(kind, text); }
    int Ask(const Question& question) override {
        return question.Buttons.size() == 2 ? 0 : before_.Ask(question);
    }
    void ShowReport(const Report& report) override { before_.ShowReport(report); }
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override {
        return before_.Input(caption, prompt, choices, preset);
    }
    std::optional<QString> OpenFile(const FileDialogOptions& options) override {
        return before_.OpenFile(options);
    }
    QStringList OpenFiles(const FileDialogOptions& options) override { return before_.OpenFiles(options); }
    std::optional<QString> SaveFile(const FileDialogOptions& options) override {
        return before_.SaveFile(options);
    }
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override {
        return before_.ChooseFolder(caption, startFolder);
    }

 private:
    Dialogs& before_;
};
