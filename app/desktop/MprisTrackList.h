#pragma once

#include <QDBusObjectPath>
#include <QList>
#include <QSet>
#include <QVariantMap>
#include <functional>
#include <optional>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/playlist/PlayListTypes.h"

class TPlayList;
class TPlaySound;

// The part of the playlist around the current song, as the desktop sees it: long lists are no business of the
// bus.
class MprisTrackList {
 public:
    static constexpr int kBefore = 50;  // entries in front of the current one
    static constexpr int kMost = 250;   // entries in all
    using Signal = std::function<void(const QString& name, const QVariantList& arguments)>;

    MprisTrackList(TPlaySound& player, TPlayList& list);

    QVariantMap Properties() const;
    // The answer to a call; nothing when there is no such method. Throws what the list throws.
    std::optional<QVariantList> Call(const QString& method, const QVariantList& arguments);
    // Tells what has changed since the last time. True when the tracks are others.
    bool TellChanges(const Signal& tell);

 private:
    QList<EntryId> Shown() const;
    QVariantMap MetadataAt(int index) const;
    QVariantList MetadataOf(const QVariant& tracks) const;
    void GoTo(int index);
    void Add(const QVariantList& arguments);
    void TellDifference(const QList<EntryId>& now, const Signal& tell) const;

    TPlaySound& player_;
    TPlayList& list_;
    QList<EntryId> told_;
    QSet<EntryId> renewed_;  // entries with other records
    Subscription renewing_;
};
