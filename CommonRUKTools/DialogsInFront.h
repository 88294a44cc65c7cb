#pragma once

#include "CommonRUKTools/Dialogs.h"

// Stands in front of the dialogs in use for as long as it exists, and leaves to them what it does not do
// itself.
class DialogsInFront : public Dialogs {
 public:
    ~DialogsInFront() override { SetUserDialogs(&behind_); }
    DialogsInFront(const DialogsInFront&) = delete;
    DialogsInFront& operator=(const DialogsInFront&) = delete;

    void ShowMessage(MessageKind kind, const QString& text) override { behind_.ShowMessage(kind, text); }
    int Ask(const Question& question) override { return behind_.Ask(question); }
    void ShowReport(const Report& report) override { behind_.ShowReport(report); }
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override {
        return behind_.Input(caption, prompt, choices, preset);
    }
    std::optional<QString> ChooseVolume(const QString& caption, const QString& prompt,
                                        const QString& preset) override {
        return behind_.ChooseVolume(caption, prompt, preset);
    }
    std::optional<QString> OpenFile(const FileDialogOptions& options) override {
        return behind_.OpenFile(options);
    }
    QStringList OpenFiles(const FileDialogOptions& options) override { return behind_.OpenFiles(options); }
    std::optional<QString> SaveFile(const FileDialogOptions& options) override {
        return behind_.SaveFile(options);
    }
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override {
        return behind_.ChooseFolder(caption, startFolder);
    }

 protected:
    DialogsInFront() : behind_(UserDialogs()) { SetUserDialogs(this); }

 private:
    Dialogs& behind_;
};
