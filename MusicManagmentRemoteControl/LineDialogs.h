#pragma once

#include "CommonRUKTools/Dialogs.h"

// For its lifetime messages to the user are lines for a place that needs no answer: nobody may sit in front
// of a program that another one drives, and that one waits. Questions are asked as ever.
class LineDialogs : public Dialogs {
 public:
    explicit LineDialogs(const std::function<void(const QString&)>& tell)
        : former_(UserDialogs()), tell_(tell) {
        SetUserDialogs(this);
    }
    ~LineDialogs() override { SetUserDialogs(&former_); }
    LineDialogs(const LineDialogs&) = delete;
    LineDialogs& operator=(const LineDialogs&) = delete;

    void ShowMessage(MessageKind, const QString& text) override { tell_(text); }
    int Ask(const Question& question) override { return former_.Ask(question); }
    void ShowReport(const Report& report) override { former_.ShowReport(report); }
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override {
        return former_.Input(caption, prompt, choices, preset);
    }
    std::optional<QString> ChooseVolume(const QString& caption, const QString& prompt,
                                        const QString& preset) override {
        return former_.ChooseVolume(caption, prompt, preset);
    }
    std::optional<QString> OpenFile(const FileDialogOptions& options) override {
        return former_.OpenFile(options);
    }
    QStringList OpenFiles(const FileDialogOptions& options) override { return former_.OpenFiles(options); }
    std::optional<QString> SaveFile(const FileDialogOptions& options) override {
        return former_.SaveFile(options);
    }
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override {
        return former_.ChooseFolder(caption, startFolder);
    }

 private:
    Dialogs& former_;
    const std::function<void(const QString&)>& tell_;
};
