#pragma once

#include <QDBusObjectPath>
#include <QList>
#include <QStringList>
#include <QVariantMap>
#include <functional>
#include <optional>

class TPlayList;

// The playlists that the desktop can choose among: the open one, those that lie beside it and those in the
// user's folder for music.
class MprisPlaylists {
 public:
    static constexpr int kMost = 500;

    // `play` opens a list and plays it; `musicFolder` may be unset.
    MprisPlaylists(const TPlayList& list, std::function<QString()> musicFolder,
                   std::function<void(const QString& path)> play);

    QVariantMap Properties() const;
    // Of the properties the one whose changes the bus is told.
    QVariant Active() const;
    // The answer to a call; nothing when there is no such method. Throws what `play` throws.
    std::optional<QVariantList> Call(const QString& method, const QVariantList& arguments);

 private:
    QStringList Files() const;
    QVariantList Listed(const QVariantList& arguments) const;
    void Activate(const QDBusObjectPath& id);

    const TPlayList& list_;
    std::function<QString()> musicFolder_;
    std::function<void(const QString& path)> play_;
};
