#include "MusicManagment/database/songfiles/RenamePlan.h"

#include <QSet>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/songfiles/RenameTarget.h"

using namespace Qt::StringLiterals;

std::vector<PlannedRename> PlanRenames(const TMusicDatabase& database, const std::vector<SongHandle>& songs,
                                       const QString& pattern) {
    std::vector<PlannedRename> plans;
    QSet<QString> targets;
    for (const SongHandle song : songs) {
        const TID3Tag* record = database.Songs().Find(song);
        if (record == nullptr) continue;
        const QString target = RenameTargetByPattern(database, pattern, record->FileName, *record);
        if (target.compare(record->FileName, Qt::CaseInsensitive) == 0) continue;
        PlannedRename plan{.Move = {.Song = song, .Target = target}, .From = record->FileName};
        if (targets.contains(target))
            plan.Problem = u"Ein anderer Song bekommt diesen Namen"_s;
        else if (FileSource::Exists(target))
            plan.Problem = u"Die Datei existiert bereits"_s;
        else if (!FileSource::Exists(record->FileName))
            plan.Problem = u"Die Datei ist nicht da"_s;
        targets.insert(target);
        plans.push_back(std::move(plan));
    }
    return plans;
}

std::vector<SongMove> PossibleMoves(const std::vector<PlannedRename>& plans) {
    std::vector<SongMove> moves;
    for (const PlannedRename& plan : plans)
        if (plan.Problem.isEmpty()) moves.push_back(plan.Move);
    return moves;
}
