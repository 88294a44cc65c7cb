#pragma once

#include <QAbstractTableModel>
#include <QHash>
#include <QTimer>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <unordered_set>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/duplicates/DuplicateSearch.h"
#include "MusicManagment/database/search/SongFilter.h"
#include "app/models/RowSorting.h"

// Which of the pairs are shown.
struct DuplicateChoice {
    int LeastPercent = kAlikePercent;
    SongFilter Filter{};         // that one of the two songs passes
    bool InGroups = false;       // pairs whose songs hang together come one after the other
    bool WithKeptPairs = false;  // also those of which the user wants to keep both
};

// The pairs that a search finds, a row each; rows appear while it goes on. Texts are made when they are
// shown, choosing and sorting go on in slices beside the work of the interface, also over millions of rows;
// of what is chosen the first kMostShown rows are shown. Rows follow their songs: they go with them, and
// come back when a song comes back under its path.
class DuplicateListModel : public QAbstractTableModel {
 public:
    enum Column { Percent, Title1, Length1, Title2, Length2, Group, ColumnCount };
    static constexpr std::size_t kMostShown = 250'000;

    explicit DuplicateListModel(TMusicDatabase& database, QObject* parent = nullptr);
    ~DuplicateListModel() override;

    // Begins anew, with the rows that a search is to fill.
    DuplicateRows& Begin(bool sameArtistOnly);
    void TakeNewRows();
    // What comes late in a sorted list takes its place now.
    void EndSearch();

    void SetChoice(DuplicateChoice choice);
    const DuplicateChoice& Choice() const { return choice_; }
    // Does at once what is to be done in slices.
    void FinishWork();
    bool Works() const { return sorting_ != nullptr; }
    // Told when rows have come or gone.
    std::function<void()> OnChanged;

    std::size_t Found() const { return rows_->Count(); }
    std::size_t Chosen() const { return order_.size(); }
    std::optional<DuplicatePair> PairAt(int row) const;
    // The shown pairs.
    std::vector<DuplicatePair> ShownPairs() const;
    // What names a row as long as there is no new search, and where it stands now: -1 nowhere.
    std::uint32_t NumberAt(int row) const { return order_[static_cast<std::size_t>(row)]; }
    int RowOf(std::uint32_t number) const;

    bool IsKeptPair(int row) const;
    // Pairs were kept or forgotten.
    void NotePairs();

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    // Column -1: in the order in which they were found.
    void sort(int column, Qt::SortOrder order = Qt::AscendingOrder) override;

 private:
    const TID3Tag* SongOf(std::uint32_t number) const;
    const TID3Tag* SongAt(const QModelIndex& index) const;
    QString Text(const QModelIndex& index) const;
    QString GroupText(int row) const;
    std::uint32_t GroupAt(int row) const;
    void Follow();
    void SongRemoved(const TID3Tag& record);
    void SongInserted(SongIndex place);
    void SongsRenamed(const QHash<QString, QString>& changes);
    void IndexPaths(const TID3Tag& removed);
    void Forget();
    void DropGoneRows();
    void BeginSongs();
    void FindKeptPairs();
    bool Passes(std::uint32_t row) const;
    std::function<std::uint32_t(std::uint32_t row)> KeyOfOrder() const;
    void RankNames();
    bool NeedsRanks() const { return sortColumn_ == Title1 || sortColumn_ == Title2; }
    void Arrange();
    void Work();
    void TakeOver();
    void CountGroups();
    void Changed() const {
        if (OnChanged) OnChanged();
    }

    TMusicDatabase& database_;
    std::unique_ptr<DuplicateRows> rows_ = std::make_unique<DuplicateRows>();
    bool sameArtistOnly_ = false;
    DuplicateChoice choice_;
    int sortColumn_ = -1;
    Qt::SortOrder sortOrder_ = Qt::AscendingOrder;

    std::size_t taken_ = 0;             // of the rows
    std::vector<std::uint32_t> order_;  // the chosen rows; the first of them are shown
    std::vector<std::uint32_t> groupOfSong_;
    std::vector<std::uint32_t> songsInGroup_;
    std::unique_ptr<RowSorting> sorting_;
    QTimer work_;
    QTimer gone_;

    // Of the songs, by number.
    std::vector<char> isGone_;
    std::vector<char> passesFilter_;
    std::vector<std::uint32_t> ranks_;
    std::future<std::vector<std::uint32_t>> ranking_;
    QHash<QString, std::uint32_t> numberOfPath_;  // from the first song on that goes
    std::unordered_set<std::uint64_t> keptPairs_;
    Subscriptions subscriptions_;
};
