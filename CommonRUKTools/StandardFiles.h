#pragma once

#include <QString>

// The files that the program keeps by itself, all in one folder.
struct StandardFiles {
    QString Folder;  // without a trailing separator

    QString Database() const;
    QString BannList() const;
    QString PlayList() const;
    QString Journal() const;

    // Makes the folder where it is missing. Throws EStreamError when that is not possible.
    void MakeFolder() const;
};

// They lie beside the program when that folder is writable and already holds one of them (portable use), else
// in the data folder.
StandardFiles LocateStandardFiles(const QString& programFolder, const QString& dataFolder);
// The same for this program and this user.
StandardFiles LocateStandardFiles();
