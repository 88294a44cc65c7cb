#pragma once

#include <deque>
#include <utility>

#include "CommonRUKTools/Dialogs.h"

// Plays the user: gives the answers that a test has put ready and writes down what was said. Installed for
// its own lifetime. What nothing is put ready for is cancelled.
class ScriptedDialogs : public Dialogs {
 public:
    ScriptedDialogs() { SetUserDialogs(this); }
    ~ScriptedDialogs() override { SetUserDialogs(nullptr); }

    // Each is given once.
    std::deque<int> Answers;  // places of buttons
    std::deque<QString> Inputs;
    std::deque<QStringList> Files;  // a dialog for one file takes the first
    std::deque<QString> Folders;

    // What was said and asked.
    QStringList Messages;
    std::vector<MessageKind> MessageKinds;
    QStringList Questions;
    std::vector<Question> Asked;  // the same with their buttons
    std::vector<Report> Reports;
    std::function<void()> OnReport;
    QStringList Prompts;
    std::vector<FileDialogOptions> FileDialogs;
    QStringList FolderCaptions;
    QStringList StartFolders;

    void ShowMessage(MessageKind kind, const QString& text) override {
        Messages << text;
        MessageKinds.push_back(kind);
    }
    int Ask(const Question& question) override {
        Questions << question.Text;
        Asked.push_back(question);
        return Next(Answers).value_or(question.Cancel);
    }
    void ShowReport(const Report& report) override {
        Reports.push_back(report);
        if (OnReport) OnReport();
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
