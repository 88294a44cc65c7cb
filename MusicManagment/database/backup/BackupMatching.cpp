#include "MusicManagment/database/backup/BackupMatching.h"

#include <QFileInfo>
#include <algorithm>
#include <cstdlib>
#include <numeric>
#include <tuple>

#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/duplicates/PairSearch.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

// Readers count the last frames differently, and an encoder adds some silence.
constexpr int kLengthSlack = 5;  // seconds, of songs that may be the same
constexpr int kSameLength = 1;   // seconds, of songs whose lengths agree
constexpr qint64 kPairsAPoint = 64;

bool KnowsLengths(const TID3Tag& a, const TID3Tag& b) {
    return a.Length > 0 && b.Length > 0;
}

int LengthDifference(const TID3Tag& a, const TID3Tag& b) {
    return std::abs(int{a.Length} - int{b.Length});
}

// Counts what agrees, and what could be compared at all.
class Comparison {
 public:
    void Take(bool agrees) {
        agreeing_ += agrees ? 1 : 0;
        ++compared_;
    }
    // One thing alone proves nothing.
    BackupRating Rating() const {
        if (agreeing_ == compared_ && agreeing_ > 1) return BackupRating::All;
        return agreeing_ > 0 ? BackupRating::Much : BackupRating::Some;
    }

 private:
    int agreeing_ = 0;
    int compared_ = 0;
};

BackupCandidate Rated(SongHandle handle, const TID3Tag& song, const BackupFile& file, double percent) {
    BackupCandidate candidate{.Song = handle, .Percent = percent};
    Comparison comparison;
    comparison.Take(percent == 100);
    if (KnowsLengths(song, file.Tag)) comparison.Take(LengthDifference(song, file.Tag) <= kSameLength);
    if (!IsCdPath(song.FileName))
        if (const QFileInfo own(song.FileName); own.isFile()) {
            candidate.HasOwnFile = true;
            comparison.Take(own.size() == file.Size);
        }
    candidate.Rating = comparison.Rating();
    return candidate;
}

class Matcher {
 public:
    Matcher(TMusicDatabase& database, const std::vector<BackupFile>& files)
        : database_(database), files_(files) {
        for (const BackupFile& file : files)
            texts_.Add(ArtistAndTitle(file.Tag));
        for (const auto& song : database.Songs()) {
            texts_.Add(ArtistAndTitle(*song));
            songs_.push_back(database.Songs().HandleOf(*song));
        }
        texts_.Classify();
    }

    std::vector<BackupCandidates> Run() {
        PairQuery query{.Texts = &texts_, .Percent = kAlikePercent};
        query.References.resize(files_.size());
        std::iota(query.References.begin(), query.References.end(), 0);
        std::vector<BackupCandidates> candidates(files_.size());
        const auto found = [&](std::uint32_t file, std::span<const TextBlocks::Match> matches) {
            for (const TextBlocks::Match& match : matches)
                if (match.Number >= files_.size()) Take(file, match, candidates[file]);
            Order(files_[file], candidates[file]);
            return ++done_ % kPairsAPoint != 0 || GoOn();
        };
        if (!SearchPairs(query, found, [this] { return GoOn(); })) return {};
        return candidates;
    }

 private:
    bool GoOn() { return !database_.Progress({.Cur = done_, .Max = static_cast<qint64>(files_.size())}); }

    void Take(std::uint32_t number, const TextBlocks::Match& match, BackupCandidates& candidates) const {
        const BackupFile& file = files_[number];
        const SongHandle handle = songs_[match.Number - files_.size()];
        const TID3Tag* song = database_.Songs().Find(handle);
        if (song == nullptr) return;
        if (KnowsLengths(*song, file.Tag) && LengthDifference(*song, file.Tag) > kLengthSlack) return;
        const auto longer = std::max(texts_.Length(number), texts_.Length(match.Number));
        candidates.push_back(Rated(handle, *song, file, Similarity(match.Distance, longer)));
    }

    // The nearest lengths first among those that are equally good.
    void Order(const BackupFile& file, BackupCandidates& candidates) const {
        const auto rank = [&](const BackupCandidate& candidate) {
            const TID3Tag& song = *database_.Songs().Find(candidate.Song);
            return std::tuple(-static_cast<int>(candidate.Rating), -candidate.Percent,
                              LengthDifference(song, file.Tag));
        };
        std::ranges::stable_sort(candidates, {}, rank);
        if (candidates.size() > kMostCandidates) candidates.resize(kMostCandidates);
    }

    TMusicDatabase& database_;
    const std::vector<BackupFile>& files_;
    ComparedTexts texts_;  // of the files, then of the songs
    std::vector<SongHandle> songs_;
    qint64 done_ = 0;
};

}  // namespace

QString RatingText(BackupRating rating) {
    return u'(' + QString(static_cast<int>(rating), u'*') + u')';
}

QString CandidateText(const BackupCandidate& candidate, const TID3Tag& song) {
    // Below a hundred there is a difference, however small.
    const int percent = static_cast<int>(candidate.Percent);
    return QString::asprintf("%.3d%%: ", percent) + ArtistAndTitle(song) + u' ' +
           RatingText(candidate.Rating);
}

std::vector<BackupCandidates> MatchBackup(TMusicDatabase& database, const std::vector<BackupFile>& files) {
    const ProgressRun run(database, u"Vergleiche mit den Songs der Sammlung"_s);
    return Matcher(database, files).Run();
}
