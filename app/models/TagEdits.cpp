#include "app/models/TagEdits.h"

#include <algorithm>
#include <limits>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kMostTracks = std::numeric_limits<quint8>::max();
constexpr int kMostTotal = 9999;

// What all of the songs give; nothing when they differ or there are none.
template <typename Value, typename Songs, typename Of>
std::optional<Value> InCommon(const Songs& songs, Of valueOf) {
    std::optional<Value> common;
    for (const auto& song : songs) {
        const std::optional<Value> value = valueOf(song);
        if (!value || (common && *common != *value)) return std::nullopt;
        common = value;
    }
    return common;
}

// 0 is no total.
std::optional<int> TotalFrom(const QString& text) {
    const QString trimmed = text.trimmed();
    if (trimmed.isEmpty()) return 0;
    bool isNumber = false;
    const int total = trimmed.toInt(&isNumber);
    return isNumber && total >= 0 && total <= kMostTotal ? std::optional(total) : std::nullopt;
}

QString FaultText(QStringView field, QStringView accepts) {
    return u"Das Feld „%1“ erwartet %2."_s.arg(field, accepts);
}

}  // namespace

bool AreSameSongs(std::vector<SongHandle> some, std::vector<SongHandle> others) {
    if (some.size() != others.size()) return false;
    std::ranges::sort(some, {}, &SongHandle::Slot);
    std::ranges::sort(others, {}, &SongHandle::Slot);
    return some == others;
}

// --- Songs ---

void TagEdits::SetSongs(const std::vector<SongHandle>& songs) {
    songs_.clear();
    for (const SongHandle song : songs)
        songs_.push_back({song});
    Discard();
    Refresh();
}

std::vector<SongHandle> TagEdits::Songs() const {
    std::vector<SongHandle> songs;
    songs.reserve(songs_.size());
    for (const Held& held : songs_)
        songs.push_back(held.Song);
    return songs;
}

void TagEdits::Reorder(const std::vector<SongHandle>& order) {
    if (!AreSameSongs(order, Songs())) return;
    std::map<quint32, std::size_t> places;
    for (const SongHandle song : order)
        places.emplace(song.Slot, places.size());
    std::ranges::sort(songs_, {}, [&](const Held& held) { return places[held.Song.Slot]; });
}

const TID3Tag* TagEdits::First() const {
    return songs_.empty() ? nullptr : database_.Songs().Find(songs_.front().Song);
}

bool TagEdits::Refresh() {
    const auto hasGone = [this](const Held& held) { return database_.Songs().Find(held.Song) == nullptr; };
    const bool someHaveGone = std::erase_if(songs_, hasGone) > 0;
    common_.clear();
    if (songs_.empty())
        Discard();
    else
        ForgetEditsThatChangeNothing();
    return someHaveGone;
}

void TagEdits::ForgetEditsThatChangeNothing() {
    std::erase_if(edits_, [this](const auto& edit) { return Common(edit.first) == edit.second; });
    for (const quint32 bit : {sfBurned, sfDamaged, sfLengthCorrect, sfRemixed})
        if (FlagTouched(bit)) SetFlag(bit, (flags_ & bit) != 0);
}

QStringList TagEdits::Paths() const {
    QStringList paths;
    for (const Held& held : songs_) {
        const TID3Tag* record = database_.Songs().Find(held.Song);
        if (record == nullptr) continue;
        const QString file = FileWithinReach(database_, record->FileName);
        paths << (file.isEmpty() ? record->FileName : file);
    }
    return paths;
}

// --- Fields ---

std::optional<QString> TagEdits::Common(SongFieldId field) const {
    const auto known = common_.find(field);
    if (known != common_.end()) return known->second;
    const auto text = [&](const Held& held) -> std::optional<QString> {
        const TID3Tag* record = database_.Songs().Find(held.Song);
        if (record == nullptr) return std::nullopt;
        return EditText(FieldOf(field), *record);
    };
    return common_[field] = InCommon<QString>(songs_, text);
}

std::optional<QString> TagEdits::Shown(SongFieldId field) const {
    const auto edit = edits_.find(field);
    return edit != edits_.end() ? edit->second : Common(field);
}

void TagEdits::Edit(SongFieldId field, const QString& text) {
    Restore(field);
    if (Common(field) != text) edits_[field] = text;
}

void TagEdits::Restore(SongFieldId field) {
    edits_.erase(field);
    if (field == SongFieldId::Track) numbered_ = false;
}

bool TagEdits::Touched(SongFieldId field) const {
    return edits_.contains(field) || (field == SongFieldId::Track && numbered_);
}

// --- Flags ---

std::optional<bool> TagEdits::Flag(quint32 bit) const {
    if (FlagTouched(bit)) return (flags_ & bit) != 0;
    return InCommon<bool>(songs_, [&](const Held& held) -> std::optional<bool> {
        const TID3Tag* record = database_.Songs().Find(held.Song);
        if (record == nullptr) return std::nullopt;
        return (record->Flags & bit) != 0;
    });
}

void TagEdits::SetFlag(quint32 bit, bool on) {
    RestoreFlag(bit);
    if (Flag(bit) == on) return;
    touchedFlags_ |= bit;
    flags_ = on ? flags_ | bit : flags_ & ~bit;
}

// --- Track total ---

void TagEdits::TakeFileTags(const FileTags& tags) {
    if (tags.TrackTotals.size() != songs_.size()) return;  // songs have gone since
    for (std::size_t i = 0; i < songs_.size(); ++i)
        songs_[i].Total = tags.TrackTotals[i];
    if (total_ && CommonTotal() == total_) RestoreTotal();
}

std::optional<QString> TagEdits::CommonTotal() const {
    const auto total = InCommon<int>(songs_, [](const Held& held) { return held.Total; });
    if (!total) return std::nullopt;
    return *total == 0 ? QString() : QString::number(*total);
}

std::optional<QString> TagEdits::ShownTotal() const {
    return total_ ? total_ : CommonTotal();
}

void TagEdits::EditTotal(const QString& text) {
    if (CommonTotal() == text)
        RestoreTotal();
    else
        total_ = text;
}

std::optional<int> TagEdits::TotalOf(SongHandle song) const {
    if (songs_.size() > kMostFilesRead) return std::nullopt;
    const auto found = std::ranges::find(songs_, song, &Held::Song);
    return found != songs_.end() ? found->Total : std::nullopt;
}

std::optional<int> TagEdits::EditedTotal() const {
    return total_ ? TotalFrom(*total_) : std::nullopt;
}

void TagEdits::Number() {
    if (songs_.size() > kMostTracks)
        throw ERukException(u"Es lassen sich höchstens %1 Songs auf einmal nummerieren."_s.arg(kMostTracks));
    Restore(SongFieldId::Track);
    numbered_ = !songs_.empty();
    if (numbered_) EditTotal(QString::number(songs_.size()));
}

// --- All of it ---

bool TagEdits::Touched() const {
    return !edits_.empty() || touchedFlags_ != 0 || total_ || cover_ || numbered_;
}

void TagEdits::Discard() {
    edits_.clear();
    touchedFlags_ = 0;
    total_.reset();
    cover_.reset();
    numbered_ = false;
}

bool TagEdits::Faulty(SongFieldId field) const {
    const auto edit = edits_.find(field);
    TID3Tag nobody;
    return edit != edits_.end() && !FieldOf(field).Set(nobody, edit->second);
}

bool TagEdits::TotalFaulty() const {
    return total_ && !TotalFrom(*total_);
}

std::optional<QString> TagEdits::Fault() const {
    for (const auto& [field, text] : edits_)
        if (Faulty(field)) return FaultText(FieldOf(field).Caption, FieldOf(field).Accepts);
    if (TotalFaulty()) return FaultText(u"von", u"eine Zahl von 0 bis 9999");
    return std::nullopt;
}

TID3Tag TagEdits::Edited(const TID3Tag& record, std::size_t place) const {
    TID3Tag edited = record;
    for (const auto& [id, text] : edits_) {
        const SongField& field = FieldOf(id);
        if (EditText(field, record) != text) field.Set(edited, text);
    }
    edited.Flags = (edited.Flags & ~touchedFlags_) | (flags_ & touchedFlags_);
    if (numbered_) edited.Track = static_cast<quint8>(place + 1);
    return edited;
}

std::vector<SongUpdate> TagEdits::Updates() const {
    std::vector<SongUpdate> updates;
    const auto total = EditedTotal();
    std::size_t place = 0;  // among those that are still there
    for (const Held& held : songs_) {
        const TID3Tag* record = database_.Songs().Find(held.Song);
        if (record == nullptr) continue;
        SongUpdate update{
            .Song = held.Song, .Basis = *record, .Record = Edited(*record, place++), .Cover = cover_};
        if (total && total != held.Total) update.TrackTotal = total;
        if (update.Record != *record || update.TrackTotal || update.Cover)
            updates.push_back(std::move(update));
    }
    return updates;
}
