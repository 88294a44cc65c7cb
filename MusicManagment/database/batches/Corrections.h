#pragma once

#include <QHash>
#include <QStringView>

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// Replacements for misspelt artists and titles, from a text file:
//
//     # a comment
//     [Artist]
//     Beatels = The Beatles
//     [Titel]
//     Yesterdey = Yesterday
//
// A text is replaced where it is the whole of the field, in capital or small letters.
class Corrections {
 public:
    // Throws ERukException, which names the line, for a text that is no such file.
    static Corrections FromText(QStringView text);

    // The song as it is to be; nothing where it stays. A corrected song needs no further correction.
    std::optional<TID3Tag> Corrected(const TID3Tag& song) const;

 private:
    struct Replacement {
        QString Right;
        int Line = 0;
    };
    using Replacements = QHash<QString, Replacement>;  // by the wrong text, folded

    static void Add(Replacements& replacements, QStringView line, int number);
    static void FollowChains(Replacements& replacements);

    Replacements artists_;
    Replacements titles_;
};

// Throws ERukException, with a message that names the file.
Corrections ReadCorrections(const QString& path);

// What of the songs would change, before anything happens.
std::vector<SongUpdate> PlanCorrections(const TMusicDatabase& database, const BatchSongs& songs,
                                        const Corrections& corrections);
BatchResult ApplyCorrections(TMusicDatabase& database, const BatchSongs& songs,
                             const Corrections& corrections);
