#include <gtest/gtest.h>

#include <QFileInfo>
#include <QSemaphore>
#include <QTemporaryDir>

#include "MusicManagment/playback/extern/ChannelServer.h"
#include "MusicManagment/playback/extern/LocalExternalPlayer.h"
#include "MusicManagment/playback/winamp/Waiting.h"
#include "tests/PrintQt.h"
#include "tests/playback/engines/OtherProgram.h"
#include "tests/playback/engines/Patience.h"

using namespace Qt::StringLiterals;

namespace {

TEST(FrameTest, AFrameComesOutAsItWentIn) {
    const Frame frames[] = {
        {.Kind = FrameKind::Command, .Id = 0xFFFFFFFF, .Code = -2, .Number = -5'000'000'000},
        {.Kind = FrameKind::Text, .Id = 7, .Code = 17, .Text = u"/Musik/Ärger 🎵.mp3"_s},
        {.Kind = FrameKind::Answer, .Id = 7, .Number = 1},
    };
    QByteArray stream;
    for (const Frame& frame : frames)
        stream += Encode(frame);
    // However the bytes come in.
    for (const qsizetype step : {qsizetype{1}, qsizetype{3}, stream.size()}) {
        FrameReader reader;
        std::vector<Frame> read;
        for (qsizetype at = 0; at < stream.size(); at += step) {
            reader.Append(stream.mid(at, step));
            while (const auto frame = reader.Next())
                read.push_back(*frame);
        }
        ASSERT_EQ(read.size(), std::size(frames));
        EXPECT_TRUE(std::ranges::equal(read, frames));
        EXPECT_FALSE(reader.Broken());
    }
}

TEST(FrameTest, WhatIsNoFrameBreaksTheStream) {
    QByteArray unknownKind = Encode({.Kind = FrameKind::Answer});
    unknownKind[4] = 7;
    const QByteArray broken[] = {
        unknownKind,
        QByteArray::fromHex("10000000"),  // shorter than any frame
        QByteArray::fromHex("12000100"),  // longer than the longest text
        QByteArray::fromHex("FFFFFFFF"),
        "GET / HTTP/1.1\r\n\r\n",
    };
    for (const QByteArray& bytes : broken) {
        FrameReader reader;
        reader.Append(bytes);
        EXPECT_EQ(reader.Next(), std::nullopt);
        EXPECT_TRUE(reader.Broken()) << bytes.toHex().toStdString();
        reader.Append(Encode({}));
        EXPECT_EQ(reader.Next(), std::nullopt);
    }
}

TEST(FrameTest, ALongTextIsCutBetweenCharacters) {
    FrameReader reader;
    reader.Append(Encode({.Kind = FrameKind::Text, .Text = u'x' + QString(kLongestText, u'ä')}));
    const auto frame = reader.Next();
    ASSERT_TRUE(frame);
    EXPECT_EQ(frame->Text, u'x' + QString(kLongestText / 2 - 1, u'ä'));
}

// A player program that only notes what it is told.
struct Listener {
    Listener(const QString& path, qint64 number) : server(number) {
        listens = server.Listen(path);
        server.OnAsked = [this](ChannelPeer& peer, const Frame& frame) { return Answer(peer, frame); };
        server.OnPeerGone = [this](ChannelPeer&) { ++gone; };
    }
    qint64 Answer(ChannelPeer& peer, const Frame& frame) {
        asked << u"%1 %2 %3"_s.arg(frame.Code).arg(frame.Number).arg(frame.Text);
        for (int code = 1; code <= feedback; ++code)
            peer.Post({.Kind = FrameKind::Feedback, .Code = code, .Number = 10 * code});
        if (feedback > 0)
            peer.Post({.Kind = FrameKind::FeedbackText, .Code = fbFileName, .Text = u"lied.mp3"_s});
        if (asksBack)
            return peer.Ask({.Kind = FrameKind::Question, .Code = fbCrossoverQuery}, kPatience).value_or(-1);
        for (int i = 0; i < chatter; ++i)
            peer.Post({.Kind = FrameKind::FeedbackText, .Text = QString(kLongestText, u'x')});
        if (hangs) goOn.acquire();
        return frame.Number + 1;
    }

    ChannelServer server;
    bool listens = false;
    QStringList asked;
    int gone = 0;
    int feedback = 0;
    bool asksBack = false;
    int chatter = 0;  // long texts that nobody wants
    bool hangs = false;
    QSemaphore goOn;
};

struct Receiver : FeedbackReceiver {
    qint64 HandleFeedback(int code, quint32 parameter) override {
        told << u"%1 %2"_s.arg(code).arg(parameter);
        return code == fbCrossoverQuery ? 3 : 0;
    }
    void HandleFeedbackText(int code, const QString& text) override {
        told << u"%1 %2"_s.arg(code).arg(text);
    }
    QStringList told;
};

class ChannelTest : public testing::Test {
 protected:
    QTemporaryDir folder_;
    const QString path_ = folder_.filePath(u"kanal"_s);
    Receiver receiver_;
};

TEST_F(ChannelTest, CommandsAndTextsAreAnsweredAtOnce) {
    LocalExternalPlayer player(path_);
    EXPECT_EQ(player.Find(), std::nullopt);
    EXPECT_EQ(player.SendCommand(ecGetPosition, 4), 0);
    OtherProgram<Listener> other(path_, qint64{77});
    EXPECT_EQ(player.Find(), 77);
    EXPECT_EQ(player.SendCommand(ecSetPosition, 4'000'000'000), 4'000'000'001);
    EXPECT_EQ(player.SendText(ecOpenFile, u"/Ä.mp3"_s), 1);
    const auto handle = player.CreateFeedback(receiver_);
    ASSERT_TRUE(handle);
    other.Do([&](Listener& listener) {
        EXPECT_EQ(listener.asked, (QStringList{u"2 4000000000 "_s, u"17 0 /Ä.mp3"_s}));
        EXPECT_NE(listener.server.FindPeer(*handle), nullptr);
        EXPECT_EQ(listener.server.FindPeer(*handle + 1), nullptr);
    });
}

TEST_F(ChannelTest, FeedbackComesLaterAndInOrder) {
    OtherProgram<Listener> other(path_, qint64{77});
    other.Do([](Listener& listener) { listener.feedback = 3; });
    LocalExternalPlayer player(path_);
    player.CreateFeedback(receiver_);
    ASSERT_TRUE(player.Find());
    player.SendCommand(ecPlay, 0);
    player.SendCommand(ecPauseResume, 0);
    EXPECT_EQ(receiver_.told, QStringList());
    const QStringList once{u"1 10"_s, u"2 20"_s, u"3 30"_s, u"11 lied.mp3"_s};
    EXPECT_TRUE(WaitUntil([&] { return receiver_.told.size() >= 8; }, kPatience));
    EXPECT_EQ(receiver_.told, once + once);
}

TEST_F(ChannelTest, WhoWaitsForAnAnswerStillAnswers) {
    OtherProgram<Listener> other(path_, qint64{77});
    other.Do([](Listener& listener) { listener.asksBack = true; });
    LocalExternalPlayer player(path_);
    player.CreateFeedback(receiver_);
    ASSERT_TRUE(player.Find());
    EXPECT_EQ(player.SendCommand(ecPlay, 0), 3);
    EXPECT_EQ(receiver_.told, QStringList{u"12 0"_s});
}

TEST_F(ChannelTest, APlayerThatGoesIsNoticedAndItsHeirIsAnotherOne) {
    LocalExternalPlayer player(path_);
    {
        OtherProgram<Listener> other(path_, qint64{77});
        EXPECT_EQ(player.Find(), 77);
    }
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 0);
    EXPECT_EQ(player.Find(), std::nullopt);
    OtherProgram<Listener> heir(path_, qint64{78});
    EXPECT_EQ(player.Find(), 78);
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 6);
}

TEST_F(ChannelTest, APlayerThatHangsCostsItsTimeOnce) {
    OtherProgram<Listener> other(path_, qint64{77});
    QSemaphore* goOn = nullptr;
    other.Do([&](Listener& listener) {
        listener.hangs = true;
        goOn = &listener.goOn;
    });
    LocalExternalPlayer player(path_, 20);
    ASSERT_TRUE(player.Find());
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 0);
    // It is not asked any more, nor waited for, nor is a second one started beside it.
    EXPECT_EQ(player.Find(), std::nullopt);
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 0);
    EXPECT_FALSE(player.Start(u"/bin/true"_s, {}));
    goOn->release(1000);
    EXPECT_TRUE(WaitUntil([&] { return player.Find() == 77; }, kPatience));
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 6);
    other.Do([](Listener& listener) { EXPECT_EQ(listener.asked.size(), 2); });
}

TEST_F(ChannelTest, WhoSaysTooMuchOrDoesNotListenLosesTheConnection) {
    OtherProgram<Listener> other(path_, qint64{77});
    other.Do([](Listener& listener) { listener.chatter = 100; });
    LocalExternalPlayer player(path_);
    player.CreateFeedback(receiver_);
    ASSERT_TRUE(player.Find());
    EXPECT_EQ(player.SendCommand(ecPlay, 0), 0);
    other.Do([](Listener& listener) { listener.chatter = 0; });
    EXPECT_EQ(player.Find(), 77);
    EXPECT_EQ(player.SendCommand(ecPlay, 0), 1);

    QLocalSocket deaf;
    deaf.setReadBufferSize(1);
    deaf.connectToServer(path_);
    ASSERT_TRUE(deaf.waitForConnected(kPatience));
    const QByteArray questions = Encode({.Kind = FrameKind::Command, .Code = ecGetPosition}).repeated(1000);
    EXPECT_TRUE(WaitUntil(
        [&] {
            if (deaf.bytesToWrite() < questions.size()) deaf.write(questions);
            return deaf.state() == QLocalSocket::UnconnectedState;
        },
        kPatience));
}

TEST_F(ChannelTest, GarbageEndsOnlyItsOwnConnection) {
    OtherProgram<Listener> other(path_, qint64{77});
    LocalExternalPlayer player(path_);
    ASSERT_TRUE(player.Find());
    for (const QByteArray& garbage :
         {QByteArray(100000, '\xFF'), QByteArray("\0\0\0\0", 4), QByteArray("hello, anybody there?")}) {
        QLocalSocket stranger;
        stranger.connectToServer(path_);
        ASSERT_TRUE(stranger.waitForConnected(kPatience));
        stranger.write(garbage);
        stranger.flush();
        EXPECT_TRUE(WaitUntil([&] { return stranger.state() == QLocalSocket::UnconnectedState; }, kPatience));
    }
    EXPECT_EQ(player.SendCommand(ecGetPosition, 5), 6);
    other.Do([](Listener& listener) { EXPECT_EQ(listener.gone, 3); });
}

TEST_F(ChannelTest, OneListensAndOnlyItsUserComesIn) {
    OtherProgram<Listener> other(path_, qint64{77});
    const QFile::Permissions others = QFile::ReadGroup | QFile::WriteGroup | QFile::ExeGroup |
                                      QFile::ReadOther | QFile::WriteOther | QFile::ExeOther;
    EXPECT_EQ(QFileInfo(path_).permissions() & others, QFile::Permissions());
    ChannelServer second(1);
    EXPECT_FALSE(second.Listen(path_));
    EXPECT_FALSE(second.Listen(QString()));
    // What a crash has left is no obstacle.
    const QString left = folder_.filePath(u"rest"_s);
    QFile file(left);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    EXPECT_TRUE(second.Listen(left));
}

}  // namespace
