#pragma once

#include "MusicManagment/database/backup/BackupMatching.h"

// What the user decides about the files of a backup medium, and what comes of it.

struct BackupDecision {
    enum class Kind {
        Skip,    // nothing happens with the file
        Tie,     // the song lies there from now on; all else that is known of it stays
        TakeIn,  // a song of its own
    };
    Kind What = Kind::Skip;
    SongHandle Song{};  // that is tied

    bool operator==(const BackupDecision&) const = default;
};

// What is proposed, file by file: the best song that no better file has, where at least much agrees and the
// song has no file of its own on the disk; else nothing. A file that is like no song is taken in.
std::vector<BackupDecision> ProposeDecisions(const std::vector<BackupCandidates>& candidates);

struct BackupResult {
    int Tied = 0;
    int Added = 0;
    QStringList Failed{};  // files, each with the reason
};

// Carries out a decision for each file. The medium is catalogued under `name`. Songs that are tied get the
// path on the medium; no file is touched, and one that they had stays known as theirs. One step that can be
// taken back; saves where AutoSave says so. Throws EAbort, after telling the user, when another operation
// runs, and what FileBatch throws.
BackupResult TakeBackup(TMusicDatabase& database, const BackupMedium& medium, const QString& name,
                        const std::vector<BackupFile>& files, const std::vector<BackupDecision>& decisions);

// "12 Songs verknüpft, 3 Songs neu aufgenommen.", and what did not go.
void ReportBackup(const BackupResult& result, const QStringList& unreadable);
