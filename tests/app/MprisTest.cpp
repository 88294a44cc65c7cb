#include "app/desktop/Mpris.h"

#include <gtest/gtest.h>

#include <QDBusArgument>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusReply>
#include <QDBusVariant>
#include <QTest>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "tests/PrintQt.h"
#include "tests/PrivateBus.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/app/ScriptedBackend.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

const QString kPlayer = u"org.mpris.MediaPlayer2.Player"_s;
const QString kRoot = u"org.mpris.MediaPlayer2"_s;

// A bus of the test's own with the player on one connection and the desktop on another.
class MprisTest : public testing::Test {
 protected:
    void SetUp() override {
        ASSERT_TRUE(mpris_.Register(bus_.Connect(u"player"_s)));
        player_.SetPlayList(&list_);
        for (const int id : {plPlay, plPause, plStop, plPrevious, plNext})
            handlers_ += player_.Commands().Handle(id, {.Run = [this, id] { commands_ << id; }});
        for (const QString& name : {u"a"_s, u"b"_s}) {
            TID3Tag record;
            record.Title = name.toUpper();
            record.Artist = u"Band"_s;
            record.Album = u"Platte"_s;
            list_.Insert(list_.Count(), {.Name = folder_.Add(name + u".mp3"_s), .Record = record});
        }
    }
    void TearDown() override {
        QDBusConnection::disconnectFromBus(u"player"_s);
        QDBusConnection::disconnectFromBus(u"desktop"_s);
    }

    // The answer of an interface to the playlist.
    QDBusMessage AskList(const QString& interface, const QString& method, const QVariantList& arguments) {
        return Ask(kRoot + interface, method, arguments);
    }
    QList<QDBusObjectPath> Tracks() {
        return qdbus_cast<QList<QDBusObjectPath>>(Property(u"Tracks"_s, kRoot + u".TrackList"_s));
    }

    // The player answers in this thread, so the desktop may not block.
    QDBusMessage Ask(const QString& interface, const QString& method, const QVariantList& arguments = {}) {
        QDBusMessage call = QDBusMessage::createMethodCall(u"org.mpris.MediaPlayer2.tunestead"_s,
                                                           u"/org/mpris/MediaPlayer2"_s, interface, method);
        call.setArguments(arguments);
        const QDBusPendingCall pending = desktop_.asyncCall(call);
        EXPECT_TRUE(QTest::qWaitFor([&] { return pending.isFinished(); }));
        return pending.reply();
    }
    QVariant Property(const QString& name, const QString& interface = kPlayer) {
        const QDBusMessage reply = Ask(u"org.freedesktop.DBus.Properties"_s, u"Get"_s, {interface, name});
        return reply.arguments().value(0).value<QDBusVariant>().variant();
    }
    QVariantMap Metadata() { return qdbus_cast<QVariantMap>(Property(u"Metadata"_s)); }

    SongFolder folder_;
    PrivateBus bus_;
    QDBusConnection desktop_ = bus_.Connect(u"desktop"_s);
    ScriptedSong song_;
    TPlayList list_;
    TPlaySound player_{ScriptedEngines(song_)};
    QList<int> commands_;
    Subscriptions handlers_;
    QString opened_;
    int raised_ = 0;
    double volume_ = 0.75;
    Mpris mpris_{player_,
                 list_,
                 {.OpenFile = [this](const QString& path) { opened_ = path; },
                  .Raise = [this] { ++raised_; },
                  .Quit = [] {},
                  .Volume = [this] { return volume_; },
                  .SetVolume = [this](double volume) { volume_ = volume; }}};
};

TEST_F(MprisTest, TellsWhatPlays) {
    EXPECT_EQ(Property(u"PlaybackStatus"_s), u"Stopped"_s);
    ASSERT_TRUE(list_.PlayEntry(1));
    mpris_.Update();
    QApplication::processEvents();
    EXPECT_EQ(Property(u"PlaybackStatus"_s), u"Playing"_s);
    const QVariantMap data = Metadata();
    EXPECT_EQ(data.value(u"xesam:title"_s), u"B"_s);
    EXPECT_EQ(data.value(u"xesam:artist"_s).toStringList(), QStringList(u"Band"_s));
    EXPECT_EQ(data.value(u"xesam:album"_s), u"Platte"_s);
    EXPECT_EQ(data.value(u"mpris:length"_s).toLongLong(), 240'000'000);
    song_.Position = 1500;
    EXPECT_EQ(Property(u"Position"_s).toLongLong(), 1'500'000);
    player_.PauseResume();
    EXPECT_EQ(Property(u"PlaybackStatus"_s), u"Paused"_s);
    EXPECT_EQ(Property(u"Identity"_s, kRoot), u"Tunestead"_s);
}

TEST_F(MprisTest, MediaKeysBecomeCommandsOfThePlayer) {
    for (const QString& method : {u"PlayPause"_s, u"Next"_s, u"Previous"_s, u"Stop"_s, u"Pause"_s})
        Ask(kPlayer, method);
    EXPECT_EQ(commands_, QList<int>({plPlay, plNext, plPrevious, plStop}));
    commands_.clear();
    ASSERT_TRUE(list_.PlayEntry(0));
    Ask(kPlayer, u"PlayPause"_s);
    Ask(kPlayer, u"Pause"_s);
    player_.PauseResume();
    Ask(kPlayer, u"Pause"_s);
    Ask(kPlayer, u"Play"_s);
    EXPECT_EQ(commands_, QList<int>({plPause, plPause, plPause}));
    Ask(kRoot, u"Raise"_s);
    EXPECT_EQ(raised_, 1);
    Ask(kPlayer, u"OpenUri"_s, {u"file://localhost/Musik/a%20b.mp3"_s});
    EXPECT_EQ(Ask(kPlayer, u"OpenUri"_s, {u"http://a/b.mp3"_s}).errorMessage(),
              u"Nur Dateien können geöffnet werden: http://a/b.mp3"_s);
    EXPECT_EQ(opened_, u"/Musik/a b.mp3"_s);
    EXPECT_EQ(Ask(kPlayer, u"Dance"_s).type(), QDBusMessage::ErrorMessage);
}

TEST_F(MprisTest, SeeksWithinTheSongThatIsMeant) {
    ASSERT_TRUE(list_.PlayEntry(0));
    mpris_.Update();
    QApplication::processEvents();
    song_.Position = 10'000;
    Ask(kPlayer, u"Seek"_s, {qint64{-4'000'000}});
    EXPECT_EQ(song_.Position, 6'000u);
    Ask(kPlayer, u"Seek"_s, {qint64{-40'000'000}});
    EXPECT_EQ(song_.Position, 0u);
    Ask(kPlayer, u"Seek"_s, {qint64{300'000'000}});
    EXPECT_EQ(commands_, QList<int>{plNext});

    const QVariant track = Metadata().value(u"mpris:trackid"_s);
    Ask(kPlayer, u"SetPosition"_s, {track, qint64{90'000'000}});
    EXPECT_EQ(song_.Position, 90'000u);
    Ask(kPlayer, u"SetPosition"_s, {track, qint64{241'000'000}});
    Ask(kPlayer, u"SetPosition"_s, {QVariant::fromValue(QDBusObjectPath(u"/other"_s)), qint64{1'000'000}});
    EXPECT_EQ(song_.Position, 90'000u);
}

TEST_F(MprisTest, OrderAndRepeatAreSetFromOutside) {
    const QString properties = u"org.freedesktop.DBus.Properties"_s;
    const auto set = [&](const QString& name, const QVariant& value) {
        return Ask(properties, u"Set"_s, {kPlayer, name, QVariant::fromValue(QDBusVariant(value))}).type();
    };
    EXPECT_EQ(set(u"Shuffle"_s, true), QDBusMessage::ReplyMessage);
    EXPECT_EQ(set(u"LoopStatus"_s, u"Playlist"_s), QDBusMessage::ReplyMessage);
    EXPECT_EQ(list_.PlayOrder(), poRandom);
    EXPECT_TRUE(list_.RepeatAll());
    EXPECT_EQ(set(u"Volume"_s, 0.5), QDBusMessage::ReplyMessage);
    EXPECT_EQ(Property(u"Volume"_s).toDouble(), 0.5);
    set(u"Volume"_s, 7.0);
    EXPECT_EQ(volume_, 1);
    EXPECT_EQ(set(u"Volume"_s, u"leise"_s), QDBusMessage::ErrorMessage);
    EXPECT_EQ(volume_, 1);
    EXPECT_EQ(set(u"CanPlay"_s, true), QDBusMessage::ErrorMessage);
    EXPECT_EQ(set(u"Nonsense"_s, true), QDBusMessage::ErrorMessage);
}

TEST_F(MprisTest, TheTrackListIsServedAndEdited) {
    const QString trackList = u".TrackList"_s;
    const QList<QDBusObjectPath> tracks = Tracks();
    ASSERT_EQ(tracks.size(), 2);
    QList<QDBusObjectPath> asked = tracks;
    asked << QDBusObjectPath(u"/tunestead/entry/99"_s) << tracks;
    const QDBusMessage known = AskList(trackList, u"GetTracksMetadata"_s, {QVariant::fromValue(asked)});
    EXPECT_EQ(known.signature(), u"aa{sv}"_s);
    const auto data = qdbus_cast<QList<QVariantMap>>(known.arguments().value(0));
    ASSERT_EQ(data.size(), 2);
    EXPECT_EQ(data[1].value(u"xesam:title"_s), u"B"_s);

    AskList(trackList, u"GoTo"_s, {QVariant::fromValue(tracks[1])});
    EXPECT_EQ(song_.Status, psPlaying);
    QApplication::processEvents();
    EXPECT_EQ(Metadata().value(u"mpris:trackid"_s).value<QDBusObjectPath>(), tracks[1]);
    AskList(trackList, u"RemoveTrack"_s, {QVariant::fromValue(tracks[0])});
    EXPECT_EQ(Tracks(), QList{tracks[1]});
    const QString url = u"file://"_s + folder_.Path(u"a.mp3"_s);
    AskList(trackList, u"AddTrack"_s, {url, QVariant::fromValue(tracks[1]), false});
    AskList(trackList, u"AddTrack"_s, {u"http://a/b.mp3"_s, QVariant::fromValue(tracks[1]), true});
    EXPECT_EQ(list_.Count(), 2);
    EXPECT_EQ(list_.Entry(1).Name, folder_.Path(u"a.mp3"_s));
}

TEST_F(MprisTest, TellsWhichTracksHaveComeAndGone) {
    MprisTrackList tracks(player_, list_);
    const auto told = [&tracks] {
        QStringList names;
        tracks.TellChanges([&](const QString& name, const QVariantList&) { names << name; });
        return names;
    };
    EXPECT_EQ(told(), QStringList());
    list_.Insert(1, {.Name = u"/new.mp3"_s});
    EXPECT_EQ(told(), QStringList(u"TrackAdded"_s));
    list_.RefreshRecord(0);
    EXPECT_EQ(told(), QStringList(u"TrackMetadataChanged"_s));
    list_.Remove(2);
    EXPECT_EQ(told(), QStringList(u"TrackRemoved"_s));
    list_.Move({1}, 0);
    EXPECT_EQ(told(), QStringList(u"TrackListReplaced"_s));
    for (int i = 0; i < 400; ++i)
        list_.Insert(list_.Count(), {.Name = u"/%1.mp3"_s.arg(i)});
    EXPECT_EQ(told(), QStringList(u"TrackListReplaced"_s));
    EXPECT_EQ(Tracks().size(), MprisTrackList::kMost);
    list_.Remove(300);  // out of sight
    EXPECT_EQ(told(), QStringList());
}

TEST_F(MprisTest, PlaylistsBesideTheOpenOneAreOffered) {
    for (const QString& name : {u"b.m3u"_s, u"A.rukpl"_s, u"c.pls"_s})
        list_.Save(folder_.Path(name));
    list_.SetPlayListFileName(folder_.Path(u"b.m3u"_s));
    const QString playlists = u".Playlists"_s;
    EXPECT_EQ(Property(u"PlaylistCount"_s, kRoot + playlists), 3u);
    EXPECT_EQ(Property(u"ActivePlaylist"_s, kRoot + playlists).value<QDBusArgument>().currentSignature(),
              u"(b(oss))"_s);
    const QDBusMessage listed = AskList(playlists, u"GetPlaylists"_s, {0u, 1u, u"Alphabetical"_s, false});
    EXPECT_EQ(listed.signature(), u"a(oss)"_s);
    const auto first = listed.arguments().value(0).value<QDBusArgument>();
    QDBusObjectPath id;
    first.beginArray();
    first.beginStructure();
    first >> id;
    AskList(playlists, u"ActivatePlaylist"_s, {QVariant::fromValue(id)});
    EXPECT_EQ(opened_, folder_.Path(u"A.rukpl"_s));
}

TEST_F(MprisTest, TheCoverOfTheSongIsAFileWhileItPlays) {
    auto tag = TitledTag("Lied", "Band");
    tag.Frame("APIC", std::string("\0image/jpeg\0\3\0\xff\xd8\xff picture", 25));
    list_.Insert(0, {.Name = folder_.Put(u"c.mp3"_s, tag.Build())});
    ASSERT_TRUE(list_.PlayEntry(0));
    mpris_.Update();
    const auto picture = [this] {
        return QUrl(Metadata().value(u"mpris:artUrl"_s).toString()).toLocalFile();
    };
    ASSERT_TRUE(QTest::qWaitFor([&] { return !picture().isEmpty(); }));
    QFile file(picture());
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll(), "\xff\xd8\xff picture");
    ASSERT_TRUE(list_.PlayEntry(1));
    mpris_.Update();
    QApplication::processEvents();
    EXPECT_EQ(picture(), QString());
    EXPECT_FALSE(file.exists());
}

TEST_F(MprisTest, ASecondProgramTakesANameOfItsOwn) {
    Mpris second(player_, list_, {});
    EXPECT_TRUE(second.Register(bus_.Connect(u"second"_s)));
    EXPECT_TRUE(second.ServiceName().startsWith(u"org.mpris.MediaPlayer2.tunestead.instance"_s));
    QDBusConnection::disconnectFromBus(u"second"_s);
}

}  // namespace
