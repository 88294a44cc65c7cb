#include "MusicManagment/conversion/ConvertSongs.h"

#include "CommonRUKTools/FileWork.h"
#include "MusicManagment/conversion/ConversionRun.h"
#include "MusicManagment/conversion/ConversionTargets.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/media/CachePlace.h"
#include "MusicManagment/database/songfiles/SongFinder.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kPartsOfASong = 100;  // in the progress

// A song of the collection on its way.
struct Way {
    SongHandle Song{};
    TID3Tag Record{};  // when it was begun
    ConversionJob Job{};
    ConversionOutcome Outcome{};

    bool IsCopyOfMedium(ConversionPlace place) const {
        return IsCdPath(Record.FileName) && place != ConversionPlace::Folder;
    }
};

class SongConversion {
 public:
    SongConversion(TMusicDatabase& database, const ConversionOrder& order)
        : database_(database), order_(order), targets_(order.Format) {}

    ConversionResult Run(const BatchSongs& songs) {
        {
            const ProgressRun run(database_, u"Konvertiere nach "_s + NameOf(order_.Format));
            Find(songs);
            Convert();
        }
        NoteCopies();
        if (order_.Place == ConversionPlace::InPlace) Replace();
        return std::move(result_);
    }

 private:
    void Find(const BatchSongs& songs) {
        SongFinder finder(database_);
        for (const SongHandle song : songs.Songs) {
            const TID3Tag* found = database_.Songs().Find(song);
            if (found == nullptr) continue;
            Way way{.Song = song, .Record = *found};  // a question lets time pass
            way.Job.Source = finder.Find(way.Record.FileName);
            if (way.Job.Source.isEmpty()) {
                result_.Missing << way.Record.FileName;
                continue;
            }
            way.Job.Format = order_.Format;
            way.Job.Record = way.Record;
            way.Job.Profile = database_.AudioReadOptions().Profile;
            way.Job.Target = TargetOf(way);
            ways_.push_back(std::move(way));
        }
    }

    QString TargetOf(const Way& way) {
        if (way.IsCopyOfMedium(order_.Place)) return targets_.Instead(CachePlace(database_, way.Record));
        return targets_.For(way.Job.Source,
                            order_.Place == ConversionPlace::Folder ? order_.Folder : QString());
    }

    void Convert() {
        std::vector<ConversionJob> jobs;
        jobs.reserve(ways_.size());
        for (const Way& way : ways_)
            jobs.push_back(way.Job);
        auto outcomes = RunConversions(jobs, ReadEncoderSettings(database_.Conversion()),
                                       [this](const ConversionState& state) { return GoOn(state); });
        for (std::size_t i = 0; i < ways_.size(); ++i) {
            ways_[i].Outcome = std::move(outcomes[i]);
            const ConversionOutcome& outcome = ways_[i].Outcome;
            if (outcome.Done) ++result_.Done;
            if (!outcome.Error.isEmpty())
                result_.Failed << ways_[i].Record.FileName + u": "_s + outcome.Error;
        }
    }

    bool GoOn(const ConversionState& state) {
        const QString& source = ways_[state.Song].Job.Source;
        result_.Stopped =
            database_.Progress({.Cur = static_cast<qint64>(state.Part * static_cast<double>(ways_.size())),
                                .Max = static_cast<qint64>(ways_.size()),
                                .CurSub = static_cast<qint64>(state.SongPart * kPartsOfASong),
                                .MaxSub = kPartsOfASong,
                                .Type = ptOther,
                                .Description = source.mid(source.lastIndexOf(u'/') + 1)});
        return !result_.Stopped;
    }

    // So that they are found, no songs of their own, and go when the copies are dropped.
    void NoteCopies() {
        bool noted = false;
        for (const Way& way : ways_) {
            if (!way.Outcome.Done || !way.IsCopyOfMedium(order_.Place)) continue;
            database_.Side().Add(kCacheSection, {way.Record.FileName, way.Job.Target});
            noted = true;
        }
        if (!noted) return;
        database_.Side().Save();
        database_.Events().MediaChanged.Tell();
    }

    void Replace() {
        std::vector<SongSubstitute> substitutes;
        for (Way& way : ways_) {
            if (!way.Outcome.Done || IsCdPath(way.Record.FileName)) continue;
            substitutes.push_back({way.Song, way.Record.FileName, way.Job.Target, way.Outcome.Record});
        }
        if (substitutes.empty()) return;
        const BatchResult done =
            SubstituteFiles(database_, SongCountText(substitutes.size()) + u" konvertieren"_s, substitutes);
        result_.Replaced = done.Changed;
        result_.Failed << done.Failed;
        result_.Stopped = result_.Stopped || done.Stopped;
    }

    TMusicDatabase& database_;
    const ConversionOrder order_;
    ConversionTargets targets_;
    std::vector<Way> ways_;
    ConversionResult result_;
};

}  // namespace

ConversionResult ConvertSongs(TMusicDatabase& database, const BatchSongs& songs,
                              const ConversionOrder& order) {
    if (songs.IsEmpty()) return {};
    return SongConversion(database, order).Run(songs);
}
