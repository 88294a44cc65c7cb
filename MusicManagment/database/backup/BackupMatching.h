#pragma once

#include "MusicManagment/database/backup/BackupFiles.h"

// Which songs of the collection the files of a backup medium may be.

// How much agrees of what can be compared: name, length, and the size of the song's own file.
enum class BackupRating { Some = 1, Much = 2, All = 3 };
// "(*)" to "(***)".
QString RatingText(BackupRating rating);

struct BackupCandidate {
    SongHandle Song{};
    double Percent = 0;  // of the names, as CompStr has it
    BackupRating Rating = BackupRating::Some;
    bool HasOwnFile = false;  // its file is on the disk
};

// "097%: Artist - Titel (**)"; the song must be there.
QString CandidateText(const BackupCandidate& candidate, const TID3Tag& song);

// For each file the songs whose names are alike by 60 percent and whose lengths, where both are known, are
// about the same; the best first, kMostCandidates at most. A long operation. Empty when the user stopped.
// Throws EAbort, after telling the user, when another one runs.
inline constexpr std::size_t kMostCandidates = 20;
using BackupCandidates = std::vector<BackupCandidate>;
std::vector<BackupCandidates> MatchBackup(TMusicDatabase& database, const std::vector<BackupFile>& files);
