#pragma once

#include "CommonRUKTools/WorkAhead.h"
#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongFinder.h"

// What a batch reads from the files of its songs: by threads, some files ahead of their turn, and handed out
// in the order of the songs.
template <typename Result>
class FilesAhead {
 public:
    // Runs in several threads at a time.
    using Reader = std::function<Result(const QString& path)>;

    // Database and songs must live as long.
    FilesAhead(TMusicDatabase& database, const BatchSongs& songs, Reader read)
        : database_(database),
          songs_(songs),
          read_(std::move(read)),
          work_(songs.Songs.size(), kReadingThreads,
                [this](std::size_t number, auto) { return WorkOf(number); }) {}

    // What was read for the next song that is still in the collection; there must be one. Lets the interface
    // work while it is not there yet; nothing when the user stopped meanwhile. Throws what the reader threw.
    std::optional<Result> Next() {
        do
            work_.Next();
        while (database_.Songs().Find(songs_.Songs[next_++]) == nullptr);
        const auto goOn = [this] { return !database_.Progress(database_.LastProgress(), false, false); };
        return work_.Take(goOn);
    }

 private:
    // Of a medium that is not put in the reader gets the stored path, of which it says what it is.
    std::function<Result()> WorkOf(std::size_t number) {
        const TID3Tag* song = database_.Songs().Find(songs_.Songs[number]);
        if (song == nullptr) return {};
        const QString stored = song->FileName;  // a question lets time pass
        const QString found = finder_.Find(stored);
        return [read = read_, path = found.isEmpty() ? stored : found] { return read(path); };
    }

    TMusicDatabase& database_;
    const BatchSongs& songs_;
    Reader read_;
    SongFinder finder_{database_};
    std::size_t next_ = 0;
    WorkAhead<Result> work_;
};
