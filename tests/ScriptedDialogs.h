#pragma once

#include <deque>
#include <utility>
#include <vector>

#include "CommonRUKTools/Dialogs.h"

// Plays the user: gives the answers that a test has put ready and writes down what was said. Installed for
// its own lifetime. What nothing is put ready for is cancelled.
class ScriptedDialogs : public Dialogs {
 public:
    struct Question {
        QString Text;
        QStringList Buttons;
    };

    ScriptedDialogs() { SetUserDialogs(this); }
    ~ScriptedDialogs() override { SetUserDialogs(nullptr); }

    // Answers, each given once.
    std::deque<int> Buttons;
    std::deque<QString> Inputs;
    std::deque<QStringList>
        Files;  // for every dialog that asks for a file; one that takes one takes the first
    std::deque<QString> Folders;

    // What was said and asked.
    std::vector<std::pair<MessageKind, QString>> Messages;
    std::vector<Question> Questions;
    QStringList Prompts;
    std::vector<FileDialogOptions> FileDialogs;
    QStringList FolderCaptions;
    QStringList StartFolders;

    void ShowMessage(MessageKind kind, const QString& text) override { Messages.emplace_back(kind, text); }
    int Ask(const QString& text, const QStringList& buttons, int cancelButton) override {
        Questions.push_back({text, buttons});
        return Next(Buttons).value_or(cancelButton);
    }
    std::optional<QString> Input(const QString&, const QString& prompt, const QStringList&,
                                 const QString&) override {
        Prompts << prompt;
        return Next(Inputs);
    }
    std::optional<QString> OpenFile(const FileDialogOptions& options) override { return OneFile(options); }
    QStringList OpenFiles(const FileDialogOptions& options) override {
        FileDialogs.push_back(options);
        return Next(Files).value_or(QStringList());
    }
    std::optional<QString> SaveFile(const FileDialogOptions& options) override { return OneFile(options); }
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override {
        FolderCaptions << caption;
        StartFolders << startFolder;
        return Next(Folders);
    }

 private:
    template <typename T>
    static std::optional<T> Next(std::deque<T>& answers) {
        if (answers.empty()) return std::nullopt;
        T answer = std::move(answers.front());
        answers.pop_front();
        return answer;
    }
    std::optional<QString> OneFile(const FileDialogOptions& options) {
        const QStringList files = OpenFiles(options);
        return files.isEmpty() ? std::nullopt : std::optional(files.first());
    }
};
