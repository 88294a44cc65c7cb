#pragma once

#include <QStringList>
#include <functional>

#include "app/desktop/MimeTypes.h"

class CollectionCommands;
class InstallationSteps;
class TMusicDatabase;

// What the program does once its main window stands: opens its standard files and acts on the command line.
// Nothing that goes wrong with a file keeps it from going on with the next.
class Startup {
 public:
    Startup(TMusicDatabase& database, CollectionCommands& commands, InstallationSteps& installation)
        : database_(database), commands_(commands), installation_(installation) {}

    // All of these are to be set before the start.
    // Opens the playlist of the last run.
    std::function<void()> OpenStandardPlayList;
    // Makes it the playlist's file.
    std::function<void(const QString& path)> OpenPlayList;
    // Makes it the player's current file.
    std::function<void(const QString& path)> OpenSong;
    // Puts the windows where a desktop file says.
    std::function<void(const QString& path)> OpenArrangement;

    // Folder of the program's shortcuts; may be empty.
    QString LinkFolder;

    // `arguments` without the program's name. False when the program is to end.
    bool Run(const QStringList& arguments);
    // What a later start of the program was given; paths are absolute. False when the program is to end.
    bool ActOn(const QStringList& arguments);

 private:
    bool OpenStandardDatabase();
    bool ReadStandardDatabase();
    void OpenStandardLists();
    bool Uninstall();
    void OpenFiles(const QStringList& arguments);
    void OpenFile(FileKind kind, const QString& path);
    void OfferDatabase(const QString& path);

    TMusicDatabase& database_;
    CollectionCommands& commands_;
    InstallationSteps& installation_;
};
