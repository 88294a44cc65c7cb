#pragma once

#include <optional>
#include <unordered_map>
#include <utility>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"

// What an edit has done to one song: nothing before it was added, nothing after it was removed.
struct SongEdit {
    SongHandle Song{};
    std::optional<TID3Tag> Before{};
    std::optional<TID3Tag> After{};
};

// The door through which several songs of a collection change as one: it collects what is to happen, and does
// it at once. Songs are held by their handles, so time may pass between the two; those that have gone
// meanwhile are passed over.
class CollectionEdit {
 public:
    explicit CollectionEdit(TMusicDatabase& database) : database_(database) {}

    // The record that the song is to have; with another path it is renamed in the collection.
    void Change(SongHandle song, TID3Tag record);
    void Add(TID3Tag record, AddAs as = AddAs::New);
    void Remove(SongHandle song);
    bool IsEmpty() const { return removals_.empty() && changes_.empty() && additions_.empty(); }

    // Makes all of it, in this order: removals, changes, additions. Many changed songs are placed in one
    // step. False, and nothing has happened, when the database takes no changes now.
    bool Commit();
    // What Commit has done, song by song.
    const std::vector<SongEdit>& Done() const { return done_; }
    // Collects the opposite of what another edit has done: takes it back when it is committed. Returns how
    // many of its songs have changed or gone since and are left alone.
    int TakeBack(const std::vector<SongEdit>& done);

 private:
    struct Changing {
        SongHandle Song;
        TID3Tag Record;
    };
    struct Adding {
        TID3Tag Record;
        AddAs As;
    };

    void RemoveSongs();
    void ChangeSongs();
    void ChangeMany();
    void NoteChange(SongHandle song, TID3Tag before, TID3Tag after);
    void TellRenamed();
    void AddSongs();
    void PlaceAgain(const std::vector<SongHandle>& songs);

    TMusicDatabase& database_;
    std::vector<SongHandle> removals_;
    std::vector<Changing> changes_;
    std::vector<Adding> additions_;
    std::vector<SongEdit> done_;
    std::unordered_map<quint32, std::size_t> changedAt_;   // in done_, by slot
    std::vector<std::pair<SongHandle, QString>> renamed_;  // each with the path that it had
};
