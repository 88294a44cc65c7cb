#include "MusicManagment/database/intake/ReadAhead.h"

#include <exception>

using namespace Qt::StringLiterals;

namespace {

SongReading ReadWhatever(const QString& path, const ReadOptions& options) {
    try {
        return ReadSong(path, options);
    } catch (const std::exception& error) {
        SongReading failed;
        failed.Error =
            u"Unerwarteter Fehler beim Lesen von "_s + path + u": "_s + QString::fromUtf8(error.what());
        return failed;
    }
}

}  // namespace

ReadAhead::ReadAhead(QStringList paths, const ReadOptions& options,
                     std::function<bool(const QString& path)> isKnown)
    : paths_(std::move(paths)),
      work_(static_cast<std::size_t>(paths_.size()), kReadingThreads,
            [this, &options, isKnown = std::move(isKnown)](
                std::size_t number, WorkAhead<SongReading>::When when) -> WorkAhead<SongReading>::Work {
                const QString& path = paths_[static_cast<qsizetype>(number)];
                // On its turn a known song has left the collection since it was found there.
                if (when == WorkAhead<SongReading>::When::Ahead && isKnown(path)) return {};
                return [path, options = options] { return ReadWhatever(path, options); };
            }) {}

const QString& ReadAhead::Next() {
    work_.Next();
    return paths_[++current_];
}

std::optional<SongReading> ReadAhead::Take(const std::function<bool()>& goOn) {
    return work_.Take(goOn);
}
