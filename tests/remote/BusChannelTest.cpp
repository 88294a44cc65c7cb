#include "MusicManagmentRemoteControl/bus/BusChannel.h"

#include <gtest/gtest.h>

#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QTest>

#include "MusicManagmentRemoteControl/RemoteControl.h"
#include "MusicManagmentRemoteControl/bus/CopyDataReceiver.h"
#include "MusicManagmentRemoteControl/bus/RemoteNames.h"
#include "tests/PrivateBus.h"
#include "tests/remote/RemoteRig.h"

using namespace Qt::StringLiterals;

namespace {

// The program and two others on a bus of the test's own.
class BusChannelTest : public testing::Test {
 protected:
    BusChannelTest() {
        remote_.SetMusicDatabase(&program_.Database);
        remote_.SetPlaySound(&program_.Player);
    }
    ~BusChannelTest() override {
        for (const QString& name : {u"program"_s, u"client"_s, u"other"_s})
            QDBusConnection::disconnectFromBus(name);
    }

    // All of them live in this thread, so nobody may block.
    static QDBusPendingCall Begin(const QDBusConnection& from, const QString& method,
                                  const QVariantList& arguments = {}) {
        QDBusMessage call =
            QDBusMessage::createMethodCall(kRemoteService, kRemotePath, kRemoteInterface, method);
        call.setArguments(arguments);
        return from.asyncCall(call);
    }
    static QDBusMessage End(const QDBusPendingCall& call) {
        EXPECT_TRUE(QTest::qWaitFor([&] { return call.isFinished(); }));
        return call.reply();
    }
    QVariant Ask(const QString& method, const QVariantList& arguments = {}) {
        return End(Begin(client_, method, arguments)).arguments().value(0);
    }
    QDBusError::ErrorType ErrorOf(const QString& method, const QVariantList& arguments) {
        return QDBusError(End(Begin(client_, method, arguments))).type();
    }

    PrivateBus bus_;
    PlayingProgram program_;
    QDBusConnection client_ = bus_.Connect(u"client"_s);
    TRemoteControl remote_{std::make_unique<BusChannel>(bus_.Connect(u"program"_s))};
};

TEST_F(BusChannelTest, CarriesMessagesAnswersAndCopiedData) {
    EXPECT_EQ(Ask(u"Send"_s, {2126u, 0, 0}), 10'000);
    EXPECT_EQ(Ask(u"Send"_s, {2130, qint64{0xFFFF'FFFF}, 0u}), 0);  // other kinds of numbers
    EXPECT_EQ(program_.Song.Position, 10'001u);
    for (const QVariantList& wrong : {QVariantList{2126u}, {2126u, 0, u"x"_s}, {2126u, qint64{1} << 32, 0}})
        EXPECT_EQ(ErrorOf(u"Send"_s, wrong), QDBusError::InvalidArgs);
    EXPECT_EQ(ErrorOf(u"SendCopyData"_s, {0u, 1025u, u"x"_s}), QDBusError::InvalidArgs);
    EXPECT_EQ(ErrorOf(u"Dance"_s, {}), QDBusError::UnknownMethod);
    EXPECT_EQ(Ask(u"SendCopyData"_s, {0u, 1025u, program_.Path(u"b.wav"_s).toUtf8()}), 1);
    EXPECT_EQ(program_.Song.File, program_.Path(u"b.wav"_s));

    CopyDataReceiver mine(client_);
    CopyDataReceiver others(bus_.Connect(u"other"_s));
    const int window = Ask(u"Register"_s).toInt();
    EXPECT_EQ(Ask(u"Register"_s), window);
    Ask(u"Send"_s, {3026u, -1, window});
    EXPECT_EQ(mine.Take(3026), program_.Path(u"b.wav"_s).toUtf8());
    EXPECT_EQ(others.Take(3026), std::nullopt);
    EXPECT_EQ(Ask(u"Send"_s, {2327u, window + 1, 1}), 0);
}

TEST_F(BusChannelTest, WaitsForTheEndOfTheSongWithoutKeepingOthersWaiting) {
    const QDBusPendingCall end = Begin(client_, u"Send"_s, {2225u, 0, 0});
    EXPECT_EQ(Ask(u"Send"_s, {2128u, 0, 0}), psPlaying);
    EXPECT_FALSE(end.isFinished());
    program_.Player.Stop();
    EXPECT_EQ(End(end).arguments(), QVariantList{1});
}

TEST_F(BusChannelTest, ForgetsProgramsThatHaveGone) {
    QDBusConnection gone = bus_.Connect(u"other"_s);
    const int window = End(Begin(gone, u"Register"_s)).arguments().value(0).toInt();
    EXPECT_EQ(Ask(u"Send"_s, {2327u, window, 1}), 1);
    gone = QDBusConnection(u"none"_s);
    QDBusConnection::disconnectFromBus(u"other"_s);
    EXPECT_TRUE(QTest::qWaitFor([&] { return Ask(u"Send"_s, {2327u, window, 1}) == 0; }));
}

TEST_F(BusChannelTest, ASecondProgramTakesThePlaceOfOneThatIsClosed) {
    TRemoteControl second(std::make_unique<BusChannel>(bus_.Connect(u"other"_s)));
    EXPECT_EQ(Ask(u"Send"_s, {2126u, 0, 0}), 10'000);
    EXPECT_EQ(Ask(u"Send"_s, {1026u, 0, 0}), 0);
    EXPECT_EQ(Ask(u"Send"_s, {2126u, 0, 0}), -1);  // it has no player
    EXPECT_EQ(Ask(u"Send"_s, {1026u, 0, 0}), 0);
    EXPECT_EQ(ErrorOf(u"Send"_s, {1025u, 0, 0}), QDBusError::ServiceUnknown);
}

TEST(CallQueue, TakesNoMoreThanAProgramCanDoWith) {
    using Put = CallQueue::Put;
    const auto call = [](const QVariantList& arguments) {
        QDBusMessage message = QDBusMessage::createMethodCall({}, {}, {}, {});
        message.setArguments(arguments);
        return message;
    };
    CallQueue many;
    EXPECT_EQ(many.Add(call({1})), Put::First);
    for (int i = 1; i < CallQueue::kMostOfOne; ++i)
        EXPECT_EQ(many.Add(call({1})), Put::Behind);
    EXPECT_EQ(many.Add(call({1})), Put::Refused);
    many.Take();
    EXPECT_EQ(many.Add(call({1})), Put::Behind);

    CallQueue large;
    EXPECT_EQ(large.Add(call({QByteArray(CallQueue::kLargest + 1, 'x')})), Put::Refused);
    EXPECT_EQ(large.Add(call({QByteArray(CallQueue::kLargest, 'x')})), Put::First);
    EXPECT_EQ(large.Add(call({QStringList{u"x"_s}})), Put::Refused);  // nobody knows how long the list is
    large.Take();
    EXPECT_EQ(large.Add(call({QStringList{u"x"_s}})), Put::First);
}

}  // namespace
