#include "app/desktop/SingleInstance.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QDir>
#include <QEventLoop>
#include <QFile>
#include <QLocalSocket>
#include <QTemporaryDir>
#include <QTimer>
#include <memory>

#include "app/desktop/StartRequests.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;
using namespace std::chrono_literals;
using Role = SingleInstance::Role;

namespace {

class SingleInstanceTest : public testing::Test {
 protected:
    std::unique_ptr<SingleInstance> Program(const QString& dataFolder = u"data"_s) {
        return std::make_unique<SingleInstance>(folder_.filePath(dataFolder), folder_.path());
    }
    std::unique_ptr<SingleInstance> RunningProgram() {
        auto program = Program();
        program->OnStart = [this](const StartRequest& request) {
            received_.push_back(request);
            return true;
        };
        EXPECT_EQ(program->Start({}), Role::First);
        return program;
    }
    QString Socket() const {
        const QStringList names =
            QDir(folder_.path()).entryList({u"tunestead-*"_s}, QDir::System | QDir::Files);
        return names.size() == 1 ? folder_.filePath(names.first()) : QString();
    }
    // Says `bytes` to the running program. True when it hangs up without an answer.
    bool HangsUpOn(const QByteArray& bytes) {
        QLocalSocket socket;
        QEventLoop loop;
        QObject::connect(&socket, &QLocalSocket::disconnected, &loop, &QEventLoop::quit);
        socket.connectToServer(Socket());
        socket.write(bytes);
        loop.exec();
        return socket.readAll().isEmpty();
    }

    QTemporaryDir folder_;
    std::vector<StartRequest> received_;
};

TEST_F(SingleInstanceTest, ALaterStartHandsOverWhatItWasGiven) {
    const auto first = RunningProgram();
    const StartRequest request{{u"/Musik/Zu spät.mp3"_s, QString(200'000, u'x')}, u"token"_s};
    EXPECT_EQ(Program()->Start(request), Role::HandedOver);
    EXPECT_EQ(Program()->Start({}), Role::HandedOver);
    EXPECT_EQ(Program(u"other"_s)->Start(request), Role::First) << "with a folder of its own";
    ASSERT_EQ(received_.size(), 2U);
    EXPECT_EQ(received_[0].Arguments, request.Arguments);
    EXPECT_EQ(received_[0].ActivationToken, request.ActivationToken);
    EXPECT_TRUE(received_[1].Arguments.isEmpty());
}

TEST_F(SingleInstanceTest, TheSocketOfADeadProgramIsTakenOver) {
    auto dead = RunningProgram();
    const QString socket = Socket();
    ASSERT_TRUE(QFile::rename(socket, socket + u".kept"_s));
    dead.reset();
    ASSERT_TRUE(QFile::rename(socket + u".kept"_s, socket));

    const auto next = RunningProgram();
    EXPECT_EQ(Program()->Start({{u"/a.mp3"_s}, {}}), Role::HandedOver);
    EXPECT_EQ(received_.size(), 1U);
}

TEST_F(SingleInstanceTest, AProgramThatDoesNotAnswerIsNotJoined) {
    const auto first = RunningProgram();
    ASSERT_TRUE(QFile::remove(Socket()));
    const auto second = Program();
    EXPECT_EQ(second->Start({{u"/a.mp3"_s}, {}}, 20ms), Role::Unanswered);
    EXPECT_EQ(second->Holder(), u"Prozess "_s + QString::number(QCoreApplication::applicationPid()));
}

TEST_F(SingleInstanceTest, AProgramThatIsEndingMakesPlace) {
    auto first = RunningProgram();
    // It refuses, and is gone when the later one tries again.
    first->OnStart = [&first](const StartRequest&) {
        QTimer::singleShot(0, qApp, [&first] { first.reset(); });
        return false;
    };
    EXPECT_EQ(Program()->Start({{u"/a.mp3"_s}, {}}), Role::First);
    EXPECT_EQ(first, nullptr);
}

TEST_F(SingleInstanceTest, HangsUpOnWhatIsNoMessage) {
    const auto first = RunningProgram();
    EXPECT_TRUE(HangsUpOn("GET / HTTP/1.1\r\n"));
    EXPECT_TRUE(HangsUpOn(QByteArray("TSI1\xff\xff\xff\xff", 8)));  // longer than a message may be
    EXPECT_TRUE(HangsUpOn(QByteArray("TSI1\3\0\0\0abc", 11)));      // a text without its end
    EXPECT_TRUE(HangsUpOn(QByteArray("TSI1\0\0\0\0", 8)));
    EXPECT_TRUE(received_.empty());
    EXPECT_EQ(Program()->Start({}), Role::HandedOver);
}

TEST(StartRequestsTest, WaitUntilTheProgramCanAct) {
    bool ready = false;
    QStringList acted;
    StartRequests requests;
    requests.IsReady = [&] { return ready; };
    requests.Act = [&](const QStringList& arguments) {
        acted << arguments;
        requests.Work();  // as from the event loop of a dialog
    };
    requests.Add({u"a"_s});
    requests.Add({u"b"_s, u"c"_s});
    requests.Work();
    EXPECT_TRUE(acted.isEmpty());
    ready = true;
    requests.Work();
    EXPECT_EQ(acted, QStringList({u"a"_s, u"b"_s, u"c"_s}));
    requests.Work();
    EXPECT_EQ(acted.size(), 3);
}

}  // namespace
