#include "app/models/DuplicateListModel.h"

#include <QGuiApplication>
#include <QPalette>
#include <algorithm>
#include <chrono>
#include <cmath>
#include <numeric>
#include <unordered_map>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Collation.h"
#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/database/duplicates/KeptPairs.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kSlice = 15;               // milliseconds
constexpr std::size_t kStepsAtOnce = 8192;  // between two looks at the clock
constexpr int kFewRuns = 64;

std::uint64_t PairKey(std::uint32_t a, std::uint32_t b) {
    return (std::uint64_t{std::min(a, b)} << 32) | std::max(a, b);
}

// Of each name its place among all, as a reader expects them; equal names have equal ones.
std::vector<std::uint32_t> RanksOf(const QStringList& names) {
    const QCollator& collator = Collation::CaseInsensitive();
    std::vector<std::pair<QCollatorSortKey, std::uint32_t>> sorted;
    sorted.reserve(static_cast<std::size_t>(names.size()));
    for (const QString& name : names)
        sorted.emplace_back(collator.sortKey(name), static_cast<std::uint32_t>(sorted.size()));
    std::ranges::sort(sorted, [](const auto& a, const auto& b) { return a.first < b.first; });
    std::vector<std::uint32_t> ranks(sorted.size());
    std::uint32_t rank = 0;
    for (std::size_t i = 0; i < sorted.size(); ++i) {
        if (i > 0 && sorted[i - 1].first < sorted[i].first) ++rank;
        ranks[sorted[i].second] = rank;
    }
    return ranks;
}

}  // namespace

DuplicateListModel::DuplicateListModel(TMusicDatabase& database, QObject* parent)
    : QAbstractTableModel(parent), database_(database) {
    work_.setInterval(0);
    work_.callOnTimeout(this, Guarded([this] { Work(); }));
    gone_.setSingleShot(true);
    gone_.setInterval(0);
    gone_.callOnTimeout(this, Guarded([this] { DropGoneRows(); }));
    Follow();
}

DuplicateListModel::~DuplicateListModel() = default;

// --- The songs ---

void DuplicateListModel::Follow() {
    CollectionEvents& events = database_.Events();
    subscriptions_ += events.Removed.Subscribe([this](SongIndex, const TID3Tag& song) { SongRemoved(song); });
    subscriptions_ += events.Inserted.Subscribe([this](SongIndex place) { SongInserted(place); });
    subscriptions_ += events.Renamed.Subscribe([this](const PathChanges& changes) { SongsRenamed(changes); });
    subscriptions_ += events.Changed.Subscribe([this](SongIndex, const TID3Tag&, const TID3Tag&) {
        if (rowCount() > 0) Q_EMIT dataChanged(index(0, 0), index(rowCount() - 1, ColumnCount - 1));
    });
    subscriptions_ += events.Cleared.Subscribe([this] { Forget(); });
}

const TID3Tag* DuplicateListModel::SongOf(std::uint32_t number) const {
    return database_.Songs().Find(rows_->Songs()[number]);
}

// The removed song is the only one that has gone and is not known to have.
void DuplicateListModel::IndexPaths(const TID3Tag& removed) {
    for (std::uint32_t number = 0; number < isGone_.size(); ++number) {
        const TID3Tag* song = SongOf(number);
        if (song != nullptr || isGone_[number] == 0)
            numberOfPath_.insert(song != nullptr ? song->FileName : removed.FileName, number);
    }
}

void DuplicateListModel::SongRemoved(const TID3Tag& record) {
    if (isGone_.empty()) return;
    if (numberOfPath_.isEmpty()) IndexPaths(record);
    const auto found = numberOfPath_.constFind(record.FileName);
    if (found == numberOfPath_.constEnd() || SongOf(*found) != nullptr) return;
    isGone_[*found] = 1;
    gone_.start();
}

void DuplicateListModel::SongInserted(SongIndex place) {
    const auto found = numberOfPath_.constFind(database_.Song(place).FileName);
    if (found == numberOfPath_.constEnd() || isGone_[*found] == 0) return;
    rows_->PutBack(*found, database_.Songs().HandleOf(place));
    isGone_[*found] = 0;
    Arrange();
}

void DuplicateListModel::SongsRenamed(const PathChanges& changes) {
    QHash<QString, std::uint32_t> moved;
    for (auto change = changes.cbegin(); change != changes.cend(); ++change)
        if (const auto known = numberOfPath_.constFind(change.key()); known != numberOfPath_.constEnd()) {
            moved.insert(change.value(), *known);
            numberOfPath_.erase(known);
        }
    numberOfPath_.insert(moved);
}

void DuplicateListModel::BeginSongs() {
    if (isGone_.size() == rows_->Songs().size()) return;
    isGone_.assign(rows_->Songs().size(), 0);
    passesFilter_.assign(rows_->Songs().size(), 1);
    FindKeptPairs();
    if (!choice_.Filter.IsEmpty()) Arrange();
}

void DuplicateListModel::FindKeptPairs() {
    keptPairs_.clear();
    const auto pairs = KeptPairs(database_);
    if (pairs.empty()) return;
    std::unordered_map<quint32, std::uint32_t> numberOfSlot;
    for (std::uint32_t number = 0; number < isGone_.size(); ++number)
        numberOfSlot.emplace(rows_->Songs()[number].Slot, number);
    const auto numberOf = [&](const QString& path) -> std::optional<std::uint32_t> {
        const TID3Tag* song = database_.Songs().Find(path);
        if (song == nullptr) return std::nullopt;
        const auto found = numberOfSlot.find(database_.Songs().HandleOf(*song).Slot);
        return found != numberOfSlot.end() ? std::optional(found->second) : std::nullopt;
    };
    for (const auto& [first, second] : pairs) {
        const auto a = numberOf(first);
        const auto b = numberOf(second);
        if (a && b) keptPairs_.insert(PairKey(*a, *b));
    }
}

void DuplicateListModel::NotePairs() {
    FindKeptPairs();
    Arrange();
}

// --- Rows that come ---

DuplicateRows& DuplicateListModel::Begin(bool sameArtistOnly) {
    Forget();
    sameArtistOnly_ = sameArtistOnly;
    return *rows_;
}

void DuplicateListModel::Forget() {
    beginResetModel();
    sorting_.reset();
    work_.stop();
    rows_ = std::make_unique<DuplicateRows>();
    taken_ = 0;
    order_ = {};
    groupOfSong_ = {};
    songsInGroup_ = {};
    isGone_ = {};
    passesFilter_ = {};
    ranks_ = {};
    ranking_ = {};
    numberOfPath_ = {};
    keptPairs_ = {};
    endResetModel();
    Changed();
}

void DuplicateListModel::TakeNewRows() {
    BeginSongs();
    if (sorting_) return;
    const std::size_t shown = order_.size();
    std::vector<std::uint32_t> come;
    for (; taken_ < rows_->Count(); ++taken_)
        if (const auto row = static_cast<std::uint32_t>(taken_); Passes(row)) come.push_back(row);
    if (come.empty()) return Changed();
    const std::size_t last = std::min(shown + come.size(), kMostShown);
    const bool isSeen = shown < last;
    if (isSeen) beginInsertRows({}, static_cast<int>(shown), static_cast<int>(last) - 1);
    order_.insert(order_.end(), come.begin(), come.end());
    if (isSeen) endInsertRows();
    Changed();
}

void DuplicateListModel::EndSearch() {
    TakeNewRows();
    if (sorting_ || sortColumn_ >= 0 || choice_.InGroups) Arrange();
}

// --- Rows that go ---

void DuplicateListModel::DropGoneRows() {
    const auto isGone = [this](std::uint32_t row) {
        const auto pair = rows_->NumbersAt(row);
        return isGone_[pair.First] != 0 || isGone_[pair.Second] != 0;
    };
    // Rows that are not shown yet come up, and a list that is being sorted is sorted anew.
    if (sorting_ || order_.size() > kMostShown) return Arrange();
    std::vector<std::pair<int, int>> runs;
    for (int row = 0; row < rowCount(); ++row) {
        if (!isGone(order_[static_cast<std::size_t>(row)])) continue;
        if (!runs.empty() && runs.back().second == row - 1)
            runs.back().second = row;
        else
            runs.emplace_back(row, row);
    }
    if (runs.size() > kFewRuns) return Arrange();
    for (auto run = runs.rbegin(); run != runs.rend(); ++run) {
        beginRemoveRows({}, run->first, run->second);
        order_.erase(order_.begin() + run->first, order_.begin() + run->second + 1);
        endRemoveRows();
    }
    Changed();
}

// --- Choosing and sorting ---

bool DuplicateListModel::Passes(std::uint32_t row) const {
    const auto pair = rows_->NumbersAt(row);
    return pair.Percent >= choice_.LeastPercent && isGone_[pair.First] == 0 && isGone_[pair.Second] == 0 &&
           (passesFilter_[pair.First] != 0 || passesFilter_[pair.Second] != 0) &&
           (choice_.WithKeptPairs || keptPairs_.empty() ||
            !keptPairs_.contains(PairKey(pair.First, pair.Second)));
}

std::function<std::uint32_t(std::uint32_t)> DuplicateListModel::KeyOfOrder() const {
    const auto key = [this]() -> std::function<std::uint32_t(std::uint32_t)> {
        const auto lengthOf = [this](std::uint32_t number) -> std::uint32_t {
            const TID3Tag* song = SongOf(number);
            return song != nullptr ? song->Length : 0;
        };
        switch (sortColumn_) {
            case Percent:
                return [this](std::uint32_t row) {
                    constexpr double kParts = 1e6;  // of a per cent
                    return static_cast<std::uint32_t>(std::lround(rows_->NumbersAt(row).Percent * kParts));
                };
            case Title1:
                return [this](std::uint32_t row) { return ranks_[rows_->NumbersAt(row).First]; };
            case Title2:
                return [this](std::uint32_t row) { return ranks_[rows_->NumbersAt(row).Second]; };
            case Length1:
                return [this, lengthOf](std::uint32_t row) { return lengthOf(rows_->NumbersAt(row).First); };
            case Length2:
                return [this, lengthOf](std::uint32_t row) { return lengthOf(rows_->NumbersAt(row).Second); };
            default:
                return {};
        }
    }();
    if (!key || sortOrder_ == Qt::AscendingOrder) return key;
    return [key](std::uint32_t row) { return ~key(row); };
}

// On a thread of its own: a hundred thousand names take a while.
void DuplicateListModel::RankNames() {
    if (!NeedsRanks() || ranks_.size() == isGone_.size() || ranking_.valid()) return;
    QStringList names;
    names.reserve(static_cast<qsizetype>(isGone_.size()));
    for (std::uint32_t number = 0; number < isGone_.size(); ++number) {
        const TID3Tag* song = SongOf(number);
        names << (song != nullptr ? ComparedName(*song, sameArtistOnly_) : QString());
    }
    ranking_ = std::async(std::launch::async, RanksOf, std::move(names));
}

void DuplicateListModel::Arrange() {
    if (isGone_.empty()) return;
    RankNames();
    RowOrder order{.Rows = rows_->Count(),
                   .SongCount = isGone_.size(),
                   .Passes = [this](std::uint32_t row) { return Passes(row); },
                   .Key = KeyOfOrder(),
                   .Songs =
                       [this](std::uint32_t row) {
                           const auto pair = rows_->NumbersAt(row);
                           return std::pair(pair.First, pair.Second);
                       },
                   .InGroups = choice_.InGroups};
    order.Prepare = [this](std::uint32_t number) {
        const TID3Tag* song = choice_.Filter.IsEmpty() ? nullptr : SongOf(number);
        passesFilter_[number] =
            choice_.Filter.IsEmpty() || (song != nullptr && choice_.Filter.Matches(*song));
    };
    sorting_ = std::make_unique<RowSorting>(std::move(order));
    work_.start();
    Changed();
}

void DuplicateListModel::Work() {
    if (!sorting_) return work_.stop();
    if (ranking_.valid()) {
        if (ranking_.wait_for(std::chrono::milliseconds(1)) != std::future_status::ready) return;
        ranks_ = ranking_.get();
    }
    const qint64 end = CurrentClock().Ticks() + kSlice;
    while (sorting_->Work(kStepsAtOnce))
        if (CurrentClock().Ticks() >= end) return;
    TakeOver();
}

void DuplicateListModel::FinishWork() {
    if (ranking_.valid()) ranks_ = ranking_.get();
    if (sorting_) {
        while (sorting_->Work(kStepsAtOnce)) {
        }
        TakeOver();
    }
    if (gone_.isActive()) {
        gone_.stop();
        DropGoneRows();
    }
}

void DuplicateListModel::TakeOver() {
    work_.stop();
    beginResetModel();
    order_ = sorting_->TakeRows();
    groupOfSong_ = sorting_->TakeGroups();
    taken_ = sorting_->Order().Rows;
    sorting_.reset();
    CountGroups();
    endResetModel();
    TakeNewRows();
}

void DuplicateListModel::CountGroups() {
    songsInGroup_.clear();
    for (const std::uint32_t group : groupOfSong_) {
        if (group == RowSorting::kNoGroup) continue;
        if (group >= songsInGroup_.size()) songsInGroup_.resize(group + 1);
        ++songsInGroup_[group];
    }
}

void DuplicateListModel::SetChoice(DuplicateChoice choice) {
    choice_ = std::move(choice);
    Arrange();
}

void DuplicateListModel::sort(int column, Qt::SortOrder order) {
    sortColumn_ = column == Group ? -1 : column;
    sortOrder_ = order;
    Arrange();
}

// --- What the view asks ---

std::optional<DuplicatePair> DuplicateListModel::PairAt(int row) const {
    if (row < 0 || row >= rowCount()) return std::nullopt;
    return rows_->At(NumberAt(row));
}

std::vector<DuplicatePair> DuplicateListModel::ShownPairs() const {
    std::vector<DuplicatePair> pairs;
    pairs.reserve(static_cast<std::size_t>(rowCount()));
    for (int row = 0; row < rowCount(); ++row)
        pairs.push_back(rows_->At(NumberAt(row)));
    return pairs;
}

int DuplicateListModel::RowOf(std::uint32_t number) const {
    const auto end = order_.begin() + rowCount();
    const auto found = std::find(order_.begin(), end, number);
    return found != end ? static_cast<int>(found - order_.begin()) : -1;
}

bool DuplicateListModel::IsKeptPair(int row) const {
    const auto pair = rows_->NumbersAt(NumberAt(row));
    return keptPairs_.contains(PairKey(pair.First, pair.Second));
}

int DuplicateListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(std::min(order_.size(), kMostShown));
}

int DuplicateListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

const TID3Tag* DuplicateListModel::SongAt(const QModelIndex& index) const {
    const auto pair = rows_->NumbersAt(NumberAt(index.row()));
    const bool isFirst = index.column() == Title1 || index.column() == Length1;
    return SongOf(isFirst ? pair.First : pair.Second);
}

QString DuplicateListModel::Text(const QModelIndex& index) const {
    if (index.column() == Percent) return SimilarityText(rows_->NumbersAt(NumberAt(index.row())).Percent);
    if (index.column() == Group) return GroupText(index.row());
    const TID3Tag* song = SongAt(index);
    if (song == nullptr) return {};
    const bool isLength = index.column() == Length1 || index.column() == Length2;
    return isLength ? FormatLength(song->Length, false) : ComparedName(*song, sameArtistOnly_);
}

std::uint32_t DuplicateListModel::GroupAt(int row) const {
    if (groupOfSong_.empty()) return RowSorting::kNoGroup;
    return groupOfSong_[rows_->NumbersAt(NumberAt(row)).First];
}

QString DuplicateListModel::GroupText(int row) const {
    const std::uint32_t group = GroupAt(row);
    if (group == RowSorting::kNoGroup) return {};
    return u"%1 (%2)"_s.arg(group + 1).arg(SongCountText(songsInGroup_[group]));
}

QVariant DuplicateListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    switch (role) {
        case Qt::DisplayRole:
            return Text(index);
        case Qt::ToolTipRole: {
            if (index.column() == Percent || index.column() == Group) return {};
            const TID3Tag* song = SongAt(index);
            return song != nullptr ? song->FileName : QString();
        }
        case Qt::TextAlignmentRole: {
            const bool isText =
                index.column() == Title1 || index.column() == Title2 || index.column() == Group;
            return QVariant((isText ? Qt::AlignLeft : Qt::AlignRight) | Qt::AlignVCenter);
        }
        case Qt::ForegroundRole:
            if (!keptPairs_.empty() && IsKeptPair(index.row()))
                return QGuiApplication::palette().brush(QPalette::Disabled, QPalette::Text);
            return {};
        case Qt::BackgroundRole:
            if (const auto group = GroupAt(index.row()); group != RowSorting::kNoGroup && group % 2 == 1)
                return QGuiApplication::palette().brush(QPalette::AlternateBase);
            return {};
        default:
            return {};
    }
}

QVariant DuplicateListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    constexpr QStringView kCaptions[] = {u"Warsch.", u"Titel 1", u"Länge 1",
                                         u"Titel 2", u"Länge 2", u"Gruppe"};
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    return kCaptions[section].toString();
}
