#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <vector>

#include "app/desktop/DesktopTools.h"

// Where the program makes itself known to the desktop.
struct InstallationPlaces {
    QString Program;       // the executable, absolute
    QString DataFolder;    // of this user: $XDG_DATA_HOME
    QString ConfigFolder;  // of this user: $XDG_CONFIG_HOME

    // Those of this program and this user.
    static InstallationPlaces OfThisUser();
};

// The program's entry in the menu, its icon and its file types, for one user of a desktop that follows the
// freedesktop.org standards (Desktop Entry, Icon Theme, Shared MIME-info). Complaints of the desktop's tools
// are returned, as texts for the user: what they keep up to date is a cache.
class Installation {
 public:
    explicit Installation(InstallationPlaces places, ToolRunner run = RunDesktopTool);

    // With a folder for shortcuts one is put there too. Throws EStreamError.
    QStringList Install(const QString& linkFolder);
    // Renews what an earlier version of this program has installed; does nothing where it is not installed,
    // and where another copy that still exists is. The user's choice of programs stays. Throws EStreamError.
    QStringList Refresh();
    // Removes what Install() has written. Throws EStreamError when a file cannot be removed.
    QStringList Remove(const QString& linkFolder);

 private:
    struct File {
        QString Path;
        QByteArray Contents;
    };

    QByteArray DesktopEntry() const;
    std::vector<File> Files() const;
    QString DesktopFile() const;
    QStringList WriteFiles() const;
    QStringList UpdateCaches() const;
    void RemoveDefaults() const;

    InstallationPlaces places_;
    ToolRunner run_;
};
