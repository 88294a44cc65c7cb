#include "MusicManagmentRemoteControl/RemoteControl.h"

#include <gtest/gtest.h>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"
#include "tests/remote/RemoteRig.h"

using namespace Qt::StringLiterals;

namespace {

constexpr quint32 kWindow = 5;  // the only one that has registered

// The other programs, without a way between.
class ScriptedChannel : public RemoteChannel {
 public:
    struct Copied {
        quint32 Code;
        QByteArray Bytes;
        bool operator==(const Copied&) const = default;
    };

    void Open(RemoteReceiver& receiver) override { Receiver = &receiver; }
    void Close() override { Receiver = nullptr; }
    bool SendCopyData(quint32 window, quint32 code, const QByteArray& bytes) override {
        if (window == kWindow) Sent.push_back({code, bytes});
        return window == kWindow;
    }
    void AnswerWaiting(qint32 answer) override { Late = answer; }

    RemoteReceiver* Receiver = nullptr;
    std::vector<Copied> Sent;
    std::optional<qint32> Late;
};

struct Rig : PlayingProgram {
    Rig() {
        Remote.OnCloseProgram = [this] { Closed = true; };
        Remote.OnTell = [this](const QString& text) { Told << text; };
        List.SetPlayOrder(poUpwards);
    }
    void Wire() {
        Remote.SetMusicDatabase(&Database);
        Remote.SetPlayList(&List);
        Remote.SetPlaySound(&Player);
    }
    std::optional<qint32> Send(quint32 message, quint32 p = 0, quint32 l = 0) {
        return Channel->Receiver->Receive(message, p, l);
    }
    qint32 Copy(quint32 code, const QByteArray& bytes) {
        return Channel->Receiver->ReceiveCopyData(code, bytes);
    }
    std::vector<ScriptedChannel::Copied> Take() { return std::exchange(Channel->Sent, {}); }

    ScriptedChannel* Channel = new ScriptedChannel;
    TRemoteControl Remote{std::unique_ptr<RemoteChannel>(Channel)};
    bool Closed = false;
    QStringList Told;
};

struct Case {
    quint32 Message;
    quint32 P;
    qint32 There;
    qint32 Missing = 0;
    bool (*Effect)(Rig&) = nullptr;  // of a message that changes something
};

constexpr Case kCases[] = {
    {rmClose, 0, 0, 0, [](Rig& rig) { return rig.Closed; }},
    {rmCopyData, 0, 0},
    {rmVersion, 0, 6, 6},
    {rmPlay, 0, 1, 0, [](Rig& rig) { return rig.Player.GetStatus() == psPlaying; }},
    {rmStop, 0, 1, 0, [](Rig& rig) { return rig.Song.Status == psStopped; }},
    {rmPauseResume, 0, 1, 0, [](Rig& rig) { return rig.Song.Status == psPlaying; }},
    {rmSetPosition, 77, 1, 0, [](Rig& rig) { return rig.Song.Position == 77; }},
    {rmPosition, 0, 10'000, -1},
    {rmLength, 0, 240'000, -1},
    {rmStatus, 0, psPaused, -1},
    {rmForward, 500, 0, 0, [](Rig& rig) { return rig.Song.Position == 10'500; }},
    {rmBack, 500, 0, 0, [](Rig& rig) { return rig.Song.Position == 9'500; }},
    {rmBack, 10'001, 0, 0, [](Rig& rig) { return rig.Song.Position == 0xFFFF'FFFF; }},
    {rmUseMCI, 0, 1, 0, [](Rig& rig) { return !rig.Player.Engines().UseMCI; }},
    {rmUseEldoS, 0, 1, 0, [](Rig& rig) { return !rig.Player.Engines().UseEldoS; }},
    {rmUseWinAmp, 0, 1, 0, [](Rig& rig) { return !rig.Player.Engines().UseWinAmp; }},
    {rmOpen, 0, 1, 0, [](Rig& rig) { return rig.Song.Status == psStopped; }},
    {rmClosePlayer, 0, 1, 0, [](Rig& rig) { return rig.Song.Status == psClosed; }},
    {rmFileName, kWindow, 1, 0, [](Rig& rig) { return rig.Take().size() == 1; }},
    {rmFileName, kWindow + 1, 0},
    {rmNext, 0, 0, 0, [](Rig& rig) { return rig.List.CurrentSong() == rig.Path(u"b.wav"_s); }},
    {rmPlayOrder, 0, poUpwards},
    {rmSetPlayOrder, poStopAfterPlay, 0, 0, [](Rig& rig) { return rig.List.PlayOrder() == poStopAfterPlay; }},
    {rmSetPlayOrder, poStopAfterPlay + 1, 0},
    {rmRepeatAll, 0, 0},
    {rmSetRepeatAll, 1, 0, 0, [](Rig& rig) { return rig.List.RepeatAll() && rig.Send(rmRepeatAll) == 1; }},
    {rmScan, 0, 0},
    {rmSetScan, 1, 0, 0, [](Rig& rig) { return rig.List.Scan() && rig.Send(rmScan) == 1; }},
    {rmScanTime, 0, 10'000, -1},
    {rmSetScanTime, 5000, 1, 0, [](Rig& rig) { return rig.List.ScanTime() == 5000; }},
    {rmWaitForEnd + 100'000, 0, 0},
};

TEST(RemoteControl, AnswersEachMessageWithAndWithoutTheComponentsAndNoneWhileItIsOff) {
    for (const Case& test : kCases) {
        SCOPED_TRACE(testing::Message() << test.Message << " " << test.P);
        Rig rig;
        if (test.Message != rmStop) rig.Player.PauseResume();
        EXPECT_EQ(rig.Send(test.Message, test.P), test.Missing);
        rig.Closed = false;
        rig.Wire();
        rig.Remote.SetEnabled(false);
        EXPECT_EQ(rig.Copy(kRemoteOpenFile, "x"), 0);
        EXPECT_EQ(test.Message == rmClose ? 0 : rig.Send(test.Message, test.P), 0);
        EXPECT_FALSE(test.Effect && test.Effect(rig));
        rig.Remote.SetEnabled(true);
        EXPECT_EQ(rig.Send(test.Message, test.P), test.There);
        EXPECT_TRUE(!test.Effect || test.Effect(rig));
        EXPECT_EQ(rig.Told, QStringList());
    }
}

TEST(RemoteControl, PreviousGoesBackAndFilesAreOpenedByName) {
    Rig rig;
    EXPECT_EQ(rig.Copy(kRemoteOpenFile, rig.Path(u"b.wav"_s).toUtf8()), 0);
    rig.Wire();
    rig.Send(rmNext);
    rig.Send(rmPrevious);
    EXPECT_EQ(rig.Song.File, rig.Path(u"a.wav"_s));
    EXPECT_EQ(rig.Copy(kRemoteOpenFile + 1, rig.Path(u"b.wav"_s).toUtf8()), 0);
    EXPECT_EQ(rig.Player.FileName(), rig.Path(u"a.wav"_s));
    const QString umlauts = rig.Folder.Add(u"Käse.wav"_s);
    EXPECT_EQ(rig.Copy(kRemoteOpenFile, umlauts.toUtf8() + '\0'), 1);
    EXPECT_EQ(rig.Song.File, umlauts);
    rig.Player.SetFileName({});
    EXPECT_EQ(rig.Copy(kRemoteOpenFile, umlauts.toLatin1()), 1);
    EXPECT_EQ(rig.Song.File, umlauts);
    EXPECT_EQ(rig.Copy(kRemoteOpenFile, rig.Folder.Add(u"a.xyz"_s).toUtf8()), 0);
    EXPECT_EQ(rig.Copy(kRemoteOpenFile, "/missing.wav"), 0);
    EXPECT_EQ(rig.Told.size(), 2);
    rig.List.Clear();
    rig.Send(rmNext);
    EXPECT_EQ(rig.Told.size(), 3);
    EXPECT_EQ(rig.Dialogs.Messages, QStringList());
}

TEST(RemoteControl, SendsWhatIsKnownOfASongToWhoAsks) {
    Rig rig;
    rig.Send(rmSongTitle, 0, kWindow);
    EXPECT_TRUE(rig.Take().empty());
    rig.Wire();
    const auto ask = [&](quint32 message, int index, quint32 window = kWindow) {
        EXPECT_EQ(rig.Send(message, static_cast<quint32>(index), window), 0);
        const auto sent = rig.Take();
        return sent.size() == 1 ? sent.front() : ScriptedChannel::Copied{};
    };
    using Copied = ScriptedChannel::Copied;
    const QByteArray second = rig.Database.Song(1).FileName.toUtf8();
    EXPECT_EQ(ask(rmSongFileName, 1), Copied(rmSongFileName, second));
    EXPECT_EQ(ask(rmSongTitle, 1), Copied(rmSongTitle, "T\xE4?"));
    EXPECT_EQ(ask(rmSongTitle, 1, kWindow | kUtf8Window),
              Copied(rmSongTitle + kUtf8Code, "T\xC3\xA4\xD0\x96"));
    EXPECT_EQ(ask(rmSongArtist, 1), Copied(rmSongArtist, "Band"));
    EXPECT_EQ(ask(rmSongAlbum, 1), Copied(rmSongAlbum, "Platte"));
    EXPECT_EQ(ask(rmSongComment, 1), Copied(rmSongComment, "Text"));
    const auto packed = PackedRecord(rig.Database.Song(1));
    EXPECT_EQ(ask(rmSongRecord, 1),
              Copied(rmSongRecord, QByteArray(reinterpret_cast<const char*>(packed.data()), 39)));
    EXPECT_EQ(ask(rmSongFileName, -1).Bytes, rig.Path(u"a.wav"_s).toUtf8());
    for (const int index : {2, -2, 0x7FFF'FFFF})
        EXPECT_EQ(ask(rmSongTitle, index).Bytes, QByteArray());
    EXPECT_EQ(ask(rmSongTitle, 0, kWindow + 1).Bytes, QByteArray());
    rig.Player.SetFileName(rig.Folder.Add(u"elsewhere.wav"_s));
    EXPECT_EQ(ask(rmSongFileName, -1).Bytes, QByteArray());
}

TEST(RemoteControl, TellsWhoWaitsThatTheSongIsOver) {
    const std::function<void(Rig&)> ends[] = {
        [](Rig& rig) { rig.Player.Stop(); }, [](Rig& rig) { rig.Send(rmClosePlayer); },
        [](Rig& rig) { rig.List.PlayNext(); }, [](Rig& rig) { rig.Player.SetFileName({}); },
        [](Rig& rig) { rig.Player.HandleEndOfSong(); }};
    Rig rig;
    EXPECT_EQ(rig.Send(rmWaitForEnd), 0);
    rig.Wire();
    for (const auto& end : ends) {
        rig.List.PlayEntry(0);
        rig.Channel->Late.reset();
        EXPECT_EQ(rig.Send(rmWaitForEnd), std::nullopt);
        rig.Player.PauseResume();
        EXPECT_EQ(rig.Channel->Late, std::nullopt);
        end(rig);
        EXPECT_EQ(rig.Channel->Late, 1);
    }
    rig.Player.SetFileName({});
    EXPECT_EQ(rig.Send(rmWaitForEnd), 1);
    rig.List.PlayEntry(0);
    rig.Send(rmWaitForEnd);
    rig.Remote.SetPlaySound(nullptr);
    EXPECT_EQ(rig.Channel->Late, 0);
}

TEST(RemoteControl, CloseMessagesEndItselfButForTheOneThatClosesTheProgram) {
    Rig enabled;
    enabled.Send(rmEndRemote);
    EXPECT_EQ(enabled.Channel->Receiver, nullptr);
    EXPECT_FALSE(enabled.Closed);
    Rig disabled;
    TRWReg settings(u"\\Test"_s, disabled.Path(u"test.conf"_s));
    settings.WriteBool(u"RCEnabled"_s, false);
    disabled.Remote.LoadSettings(settings);
    disabled.Send(rmEndRemote);
    EXPECT_NE(disabled.Channel->Receiver, nullptr);
    disabled.Send(rmClose);
    EXPECT_EQ(disabled.Channel->Receiver, nullptr);
    EXPECT_FALSE(disabled.Closed);
}

}  // namespace
