#pragma once

#include <deque>
#include <functional>

#include "CommonRUKTools/Dialogs.h"

// Answers as a test has laid down, and keeps what was asked. Without an answer left every question is
// cancelled.
class ScriptedDialogs : public Dialogs {
 public:
    ScriptedDialogs() { SetUserDialogs(this); }
    ~ScriptedDialogs() override { SetUserDialogs(nullptr); }

    QStringList Messages;
    QStringList Questions;
    std::deque<int> Answers;      // buttons of the questions to come
    std::optional<QString> File;  // what every file and folder dialog gives
    std::optional<QString> Text;  // what every input gives

    void ShowMessage(MessageKind, const QString& text) override { Messages << text; }
    int Ask(const QString& text, const QStringList&, int cancelButton) override {
        Questions << text;
        if (Answers.empty()) return cancelButton;
        const int answer = Answers.front();
        Answers.pop_front();
        return answer;
    }
    std::optional<QString> Input(const QString&, const QString&, const QStringList&,
                                 const QString&) override {
        return Text;
    }
    std::optional<QString> OpenFile(const FileDialogOptions&) override { return File; }
    QStringList OpenFiles(const FileDialogOptions&) override {
        return File ? QStringList(*File) : QStringList();
    }
    std::optional<QString> SaveFile(const FileDialogOptions&) override { return File; }
    std::optional<QString> ChooseFolder(const QString&, const QString&) override { return File; }
};
