#pragma once

#include <QStringList>
#include <functional>

class CollectionCommands;
class TMusicDatabase;

// What the program does once its main window stands: opens the standard database and acts on the command
// line.
class Startup {
 public:
    Startup(TMusicDatabase& database, CollectionCommands& commands)
        : database_(database), commands_(commands) {}

    // The standard database is open; the other standard files are to be opened.
    std::function<void()> OnOpened;

    // `arguments` without the program's name. False when the user does not want to go on.
    bool Run(const QStringList& arguments);

 private:
    bool OpenStandardDatabase();
    bool ReadStandardDatabase();
    void ActOn(const QStringList& arguments);
    void OfferDatabase(const QString& path);

    TMusicDatabase& database_;
    CollectionCommands& commands_;
};
