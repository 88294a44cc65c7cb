#pragma once

#include <QString>
#include <functional>
#include <vector>

#include "CommonRUKTools/ByteReader.h"
#include "MusicManagment/playlist/ListRecognition.h"
#include "MusicManagment/playlist/PlayListTypes.h"

// What there is to know of a list beside its bytes.
struct ListOrigin {
    QString FileName{};
    // What the collection has of a song; nullptr for nothing. Empty: there is no collection.
    std::function<const TID3Tag*(const QString& name)> Known{};
};

// How lists are understood. Two sets of rules stand side by side.
struct ListRules {
    // Throws EPlayListException when the list is damaged or too large.
    std::vector<PlayListEntry> (*Parse)(ByteSpan file, const ListOrigin& origin);
    // The format in which a file of this name is written.
    PlayListFormat (*FormatOfName)(const QString& fileName);
    // Whether a file of this name is taken for a playlist.
    bool (*IsListName)(const QString& fileName);
    // For dialogs: pairs "caption|patterns".
    QString (*DialogFilter)();
};

// The program's original rules: the first nine bytes say what a list is, and of a plain one they are lost;
// relative names are those of the current folder; titles are not read.
extern const ListRules kClassicLists;
// Lists as other programs write them: any line ends, M3U without its head, PLS without a count, names
// relative to the list itself; titles and lengths are shown until the collection knows better.
extern const ListRules kModernLists;
