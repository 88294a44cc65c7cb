#pragma once

#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

#include "MusicManagment/database/SongFields.h"

// Changes of the fields of a record, as "FIELD=VALUE" names them: fields as in the JSON of a song, with
// "trackTotal" besides. Genres go by number or name, flags by number or by names with commas between them,
// the remix mark by true and false.
class TagAssignments {
 public:
    // Throws EUsageError for a field that cannot be set, and for a value that it cannot have.
    explicit TagAssignments(const QStringList& assignments);

    void Apply(TID3Tag& record) const;
    std::optional<int> TrackTotal() const { return trackTotal_; }  // 0: none

 private:
    struct Change {
        const SongField* Field;
        QString Value;
    };
    std::vector<Change> changes_;
    std::optional<int> trackTotal_;
};

// One field of a record that two versions of it do not share.
struct FieldDifference {
    const char* Name;  // as in JSON
    QString Old;
    QString New;
};
std::vector<FieldDifference> DifferencesOf(const TID3Tag& before, const TID3Tag& after);
