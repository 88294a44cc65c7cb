#pragma once

#include <QString>
#include <optional>
#include <span>
#include <variant>

#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// What a song's record holds, field by field: the one list from which columns, sheets, filter, tag form and
// JSON are made. The numbers up to Path stand in the settings as columns of the song list: fields to come get
// the next ones.
enum class SongFieldId {
    Title,
    Artist,
    Album,
    Year,
    Length,
    MainGenre,
    Genre,
    Track,
    BitRate,
    SampleRate,
    Channels,
    Format,
    PlayCount,
    Comment,
    AddTime,
    Flags,
    Path,
    Emphasis,
    HeaderFlags,
    FrameSize,
    Remix,
};

enum class FieldGroup { File, Tag, Technical, Collection };

struct SongField {
    SongFieldId Id;
    const char16_t* Caption;       // where it stands among others of its group: "Genre"
    const char16_t* ShortCaption;  // above a column; one of its own where two fields share a caption
    FieldGroup Group;
    // What is shown to the user.
    QString (*Text)(const TID3Tag& song);
    // The value of a field that is a number, for comparisons; nullptr for texts.
    qint64 (*Number)(const TID3Tag& song) = nullptr;
    std::optional<TSortType> Sort{};  // the order of the database that goes by it
    // Names that the filter understands, separated by blanks; the first is the one that is told the user.
    // Empty: the filter does not know it.
    const char16_t* FilterNames = u"";
    bool InPlainSearch = false;  // a word without a field's name is looked for here too
    const char* FormName = "";   // its name in the tag form
    // Takes what a user enters. False, and the song as it was, where the field cannot hold that. nullptr:
    // nobody edits the field.
    bool (*Set)(TID3Tag& song, const QString& text) = nullptr;
    // What is shown for editing; nullptr: Text.
    QString (*Edited)(const TID3Tag& song) = nullptr;
    const char16_t* Accepts = u"";  // what Set takes, where that is not every text: "vier Ziffern"
};

// All fields, in the order of SongFieldId.
std::span<const SongField> SongFields();
const SongField& FieldOf(SongFieldId id);

// What an editor shows of a field.
QString EditText(const SongField& field, const TID3Tag& song);

// What the filter looks through: the shown text, and for the main genre also the genre of the tag.
QString SearchedText(const SongField& field, const TID3Tag& song);

// A member of the record under its public name, with which JSON shows it.
using SongMember = std::variant<QString TID3Tag::*, bool TID3Tag::*, quint8 TID3Tag::*, quint16 TID3Tag::*,
                                quint32 TID3Tag::*, double TID3Tag::*>;
struct RecordMember {
    const char* Name;
    SongMember Member;
};

// All members of the record, in the order of its definition.
std::span<const RecordMember> RecordMembers();

// Which of two changes of the same member counts: the one that is merged, or the one that the song has had
// meanwhile.
enum class MergeConflict { TakesMerged, KeepsSong };
// A song with the members in which two records differ, as the later of them has them; all others stay.
TID3Tag MergedChange(TID3Tag song, const TID3Tag& before, const TID3Tag& after, MergeConflict conflict);
