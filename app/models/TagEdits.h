#pragma once

#include <QString>
#include <map>
#include <optional>
#include <vector>

#include "MusicManagment/database/SongFields.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "app/models/FileTags.h"

// In whatever order.
bool AreSameSongs(std::vector<SongHandle> some, std::vector<SongHandle> others);

// What the tag editor has of the songs that it works on: what they have in common, what the user made of it,
// and what each of them is to become. A field that nobody touched stays as it is in every song, whatever
// happens to that song meanwhile. Songs are held by their handles; one that has gone is left out.
class TagEdits {
 public:
    explicit TagEdits(const TMusicDatabase& database) : database_(database) {}

    // Takes other songs, in the order in which they are numbered, and forgets what was edited.
    void SetSongs(const std::vector<SongHandle>& songs);
    // Those that were still there when the records were last looked at.
    std::vector<SongHandle> Songs() const;
    std::size_t Count() const { return songs_.size(); }
    // The record of the first song; nullptr when there is none.
    const TID3Tag* First() const;
    // Puts the songs into this order; does nothing when these are not the same songs.
    void Reorder(const std::vector<SongHandle>& order);
    // Looks at the records again. True when songs have gone.
    bool Refresh();
    QStringList Paths() const;

    // --- The fields that have a Set, but the flags ---
    // What all songs hold; nothing when they differ.
    std::optional<QString> Common(SongFieldId field) const;
    // What the user made of it, else the same.
    std::optional<QString> Shown(SongFieldId field) const;
    void Edit(SongFieldId field, const QString& text);
    void Restore(SongFieldId field);
    bool Touched(SongFieldId field) const;

    // --- Flags, each for itself ---
    std::optional<bool> Flag(quint32 bit) const;
    bool FlagTouched(quint32 bit) const { return (touchedFlags_ & bit) != 0; }
    void SetFlag(quint32 bit, bool on);
    void RestoreFlag(quint32 bit) { touchedFlags_ &= ~bit; }

    // --- What only the files hold ---
    // Of the songs as they stood in Paths().
    void TakeFileTags(const FileTags& tags);
    // Nothing when the totals differ or have not been read.
    std::optional<QString> CommonTotal() const;
    std::optional<QString> ShownTotal() const;
    void EditTotal(const QString& text);
    void RestoreTotal() { total_.reset(); }
    bool TotalTouched() const { return total_.has_value(); }
    void SetCover(std::optional<CoverChange> change) { cover_ = std::move(change); }
    const std::optional<CoverChange>& Cover() const { return cover_; }

    // Gives each song its place as its track, and all of them their number as the total. Throws ERukException
    // for more songs than there are track numbers.
    void Number();
    // Until somebody edits the track.
    bool Numbered() const { return numbered_; }

    // --- All of it ---
    bool Touched() const;
    void Discard();
    // What the user entered and a field cannot hold, as a sentence; nothing when all is well.
    std::optional<QString> Fault() const;
    bool Faulty(SongFieldId field) const;
    bool TotalFaulty() const;
    // One for each song that changes. Nothing may be faulty.
    std::vector<SongUpdate> Updates() const;
    // The total in the file of a song; nothing when it has not been read.
    std::optional<int> TotalOf(SongHandle song) const;

 private:
    struct Held {
        SongHandle Song;
        std::optional<int> Total{};  // in its file, once it has been read
    };

    void ForgetEditsThatChangeNothing();
    TID3Tag Edited(const TID3Tag& record, std::size_t place) const;
    std::optional<int> EditedTotal() const;

    const TMusicDatabase& database_;
    std::vector<Held> songs_;
    // Looking through thousands of songs at each question would be felt.
    mutable std::map<SongFieldId, std::optional<QString>> common_;
    std::map<SongFieldId, QString> edits_;
    quint32 touchedFlags_ = 0;
    quint32 flags_ = 0;  // as they are to be, where touched
    std::optional<QString> total_;
    std::optional<CoverChange> cover_;
    bool numbered_ = false;
};
