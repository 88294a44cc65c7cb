#pragma once

#include <QString>

#include "CommonRUKTools/StandardFiles.h"

class Installation;

// What goes when the program is removed.
struct RemovalChoice {
    bool Program = false;  // its entry in the menu and its file types; else nothing at all
    bool Database = false;
    bool Lists = false;  // ban list and playlist
    bool Settings = false;
};

// Installing and removing as the user sees them: what is asked before and said after.
class InstallationSteps {
 public:
    // Without an installation the system has none, and the user is told so.
    InstallationSteps(Installation* installation, StandardFiles files, QString settingsFile)
        : installation_(installation), files_(std::move(files)), settingsFile_(std::move(settingsFile)) {}

    // `linkFolder`, of the program's shortcuts, may be empty. Throws EStreamError.
    void Install(const QString& linkFolder);
    // Renews an installation of an earlier version. Throws EStreamError.
    void Refresh();
    // Files that hold the user's work go to the recycle bin. Throws EStreamError.
    void Uninstall(const QString& linkFolder);
    // What Uninstall() has removed, also when it could not do all of it.
    const RemovalChoice& Removed() const { return removed_; }

 private:
    RemovalChoice AskWhatGoes() const;
    bool IsPossible() const;

    Installation* installation_;
    StandardFiles files_;
    QString settingsFile_;
    RemovalChoice removed_;
};
