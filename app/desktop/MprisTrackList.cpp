#include "app/desktop/MprisTrackList.h"

#include <QDBusArgument>
#include <QDBusMetaType>
#include <algorithm>

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayList.h"
#include "app/desktop/MprisMetadata.h"

using namespace Qt::StringLiterals;

namespace {

QList<QDBusObjectPath> TracksOf(const QList<EntryId>& entries) {
    QList<QDBusObjectPath> tracks;
    for (const EntryId entry : entries)
        tracks << TrackOfEntry(entry);
    return tracks;
}

// Where `longer` has one entry more; -1 when that is not the difference.
qsizetype OneMore(const QList<EntryId>& longer, const QList<EntryId>& shorter) {
    if (longer.size() != shorter.size() + 1) return -1;
    const auto [more, same] = std::ranges::mismatch(longer, shorter);
    return std::equal(more + 1, longer.end(), same, shorter.end()) ? more - longer.begin() : -1;
}

QDBusObjectPath TrackIn(const QVariantList& arguments, qsizetype index) {
    return arguments.value(index).value<QDBusObjectPath>();
}

}  // namespace

MprisTrackList::MprisTrackList(TPlaySound& player, TPlayList& list) : player_(player), list_(list) {
    qDBusRegisterMetaType<QList<QVariantMap>>();
    told_ = Shown();
    renewing_ = list_.Events().Changed.Subscribe([this](int index) {
        if (renewed_.size() < kMost) renewed_ << list_.IdAt(index);
    });
}

QList<EntryId> MprisTrackList::Shown() const {
    const int first = std::max(list_.IndexOf() - kBefore, 0);
    const int end = std::min(first + kMost, list_.Count());
    QList<EntryId> entries;
    for (int i = first; i < end; ++i)
        entries << list_.IdAt(i);
    return entries;
}

QVariantMap MprisTrackList::Properties() const {
    return {{u"Tracks"_s, QVariant::fromValue(TracksOf(Shown()))}, {u"CanEditTracks"_s, true}};
}

std::optional<QVariantList> MprisTrackList::Call(const QString& method, const QVariantList& arguments) {
    if (method == u"GetTracksMetadata"_s) return MetadataOf(arguments.value(0));
    if (method == u"AddTrack"_s)
        Add(arguments);
    else if (const int index = list_.IndexOfId(EntryOfTrack(TrackIn(arguments, 0)));
             method == u"RemoveTrack"_s) {
        if (index >= 0) list_.Remove(index);
    } else if (method == u"GoTo"_s) {
        if (index >= 0) GoTo(index);
    } else
        return std::nullopt;
    return QVariantList();
}

// While the user is asked for a medium the list may change.
void MprisTrackList::GoTo(int index) {
    const QString name = list_.Entry(index).Name;
    if (!list_.PlayEntry(index, {.Change = player_.ChangeOnDemand()}))
        throw EPlayListException(u"Die Datei ist nicht verfügbar: "_s + name);
}

QVariantMap MprisTrackList::MetadataAt(int index) const {
    const PlayingSong song = SongNamed(list_.Entry(index).Name, list_);
    return MprisMetadata(TrackOfEntry(list_.IdAt(index)), song, song.Seconds * 1000);
}

// Of those that are shown, and of each once. A list of many others is not read to its end.
QVariantList MprisTrackList::MetadataOf(const QVariant& tracks) const {
    QList<EntryId> open = Shown();
    QList<QVariantMap> data;
    const auto paths = tracks.value<QDBusArgument>();
    if (paths.currentSignature() == u"ao"_s) {
        paths.beginArray();
        for (int i = 0; i < 2 * kMost && !open.isEmpty() && !paths.atEnd(); ++i) {
            QDBusObjectPath path;
            paths >> path;
            const EntryId entry = EntryOfTrack(path);
            if (open.removeOne(entry)) data << MetadataAt(list_.IndexOfId(entry));
        }
    }
    return {QVariant::fromValue(data)};
}

// Behind an entry, or in front of all.
void MprisTrackList::Add(const QVariantList& arguments) {
    const QString address = arguments.value(0).toString();
    const QString path = LocalPath(address);
    const int position = list_.IndexOfId(EntryOfTrack(TrackIn(arguments, 1))) + 1;
    const int added = path.isEmpty() ? 0 : list_.InsertFiles(position, {path});
    if (added == 0) throw EPlayListException(u"Das kann nicht in die PlayList: "_s + address);
    if (arguments.value(2).toBool()) list_.PlayEntry(position, {.Change = player_.ChangeOnDemand()});
}

// --- What the bus is told ---

bool MprisTrackList::TellChanges(const Signal& tell) {
    const QList<EntryId> now = Shown();
    const bool changed = now != told_;
    if (changed) TellDifference(now, tell);
    told_ = now;
    for (const EntryId entry : std::exchange(renewed_, {}))
        if (now.contains(entry))
            tell(u"TrackMetadataChanged"_s,
                 {QVariant::fromValue(TrackOfEntry(entry)), QVariant(MetadataAt(list_.IndexOfId(entry)))});
    return changed;
}

void MprisTrackList::TellDifference(const QList<EntryId>& now, const Signal& tell) const {
    if (const qsizetype added = OneMore(now, told_); added >= 0) {
        const EntryId after = added > 0 ? now[added - 1] : 0;
        return tell(u"TrackAdded"_s, {QVariant(MetadataAt(list_.IndexOfId(now[added]))),
                                      QVariant::fromValue(TrackOfEntry(after))});
    }
    if (const qsizetype removed = OneMore(told_, now); removed >= 0)
        return tell(u"TrackRemoved"_s, {QVariant::fromValue(TrackOfEntry(told_[removed]))});
    const int current = list_.IndexOf();
    tell(u"TrackListReplaced"_s, {QVariant::fromValue(TracksOf(now)),
                                  QVariant::fromValue(TrackOfEntry(current < 0 ? 0 : list_.IdAt(current)))});
}
