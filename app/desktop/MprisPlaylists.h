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

    struct Options {
        std::function<QString()> MusicFolder{};  // may be unset
        QString StandardList{};                  // keeps whatever is open between two runs: no list to choose
        std::function<void(const QString& path)> Play{};  // opens a list and plays it
    };

    MprisPlaylists(const TPlayList& list, Options options);

    QVariantMap Properties() const;
    // Of the properties the one whose changes the bus is told.
    QVariant Active() const;
    // The answer to a call; nothing when there is no such method. Throws what `Play` throws.
    std::optional<QVariantList> Call(const QString& method, const QVariantList& arguments);

 private:
    QString Open() const;
    const QStringList& Files() const;
    QVariantList Listed(const QVariantList& arguments) const;
    void Activate(const QDBusObjectPath& id);

    const TPlayList& list_;
    const Options options_;
    // Folders are not looked through for each question.
    mutable QStringList files_;
    mutable QString filesBeside_;              // the open list of then
    mutable std::optional<qint64> filesTime_;  // ticks of the clock
};
