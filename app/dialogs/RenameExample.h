#pragma once

#include <QString>
#include <QStringList>

#include "ReadMPEGHeader/ID3Tag.h"

class TMusicDatabase;

// The path with places where a line may be broken behind its separators, so that it does not make a window
// wider.
QString Breakable(const QString& path);

// How files are to be named and placed when they are renamed, as a dialog has it.
struct NamingChoice {
    QString Pattern;
    QString RootFolder;
    bool ByGenre = false;
    QStringList GenreFolders{};  // one for each main genre
    bool InPlace = true;         // in their own folder where no genre folder is their place
};

// Shows what becomes of one song's file.
class RenameExample {
 public:
    // Of an invented song.
    RenameExample();
    // Of a song of the collection that no genre folder takes, where it has one; else of any, else invented.
    explicit RenameExample(const TMusicDatabase& database);

    // "Beispiel: Aus ... wird ..."; paths may be broken behind their separators.
    QString Text(const NamingChoice& choice) const;

 private:
    TID3Tag song_;
};
