#pragma once

#include <QPointer>
#include <QWidget>

#include "CommonRUKTools/Dialogs.h"
#include "app/dialogs/ReportDisplay.h"

class QFileDialog;

// Asks the user with windows. They belong to the window that is active, else to the main window.
class QtDialogs : public Dialogs {
 public:
    void SetMainWindow(QWidget* window) { mainWindow_ = window; }

    void ShowMessage(MessageKind kind, const QString& text) override;
    int Ask(const Question& question) override;
    void ShowReport(const Report& report) override { reports_.Show(report, mainWindow_); }
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override;
    // The choice follows what is plugged in while it stands.
    std::optional<QString> ChooseVolume(const QString& caption, const QString& prompt,
                                        const QString& preset) override;
    std::optional<QString> OpenFile(const FileDialogOptions& options) override;
    QStringList OpenFiles(const FileDialogOptions& options) override;
    std::optional<QString> SaveFile(const FileDialogOptions& options) override;
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override;

 private:
    QWidget* Parent() const;
    void ApplyOptions(QFileDialog& dialog, const FileDialogOptions& options) const;
    // What was chosen; empty on cancel.
    QStringList Choose(QFileDialog& dialog);

    QPointer<QWidget> mainWindow_;
    ReportDisplay reports_;
    QString folder_;  // where the last choice was made
};
