#include "app/desktop/StayAwake.h"

#include <gtest/gtest.h>

#include <QDBusMessage>
#include <QDBusVirtualObject>
#include <QTest>

#include "tests/PrintQt.h"
#include "tests/PrivateBus.h"

using namespace Qt::StringLiterals;

namespace {

// Grants everything, when the test lets it.
class Portal : public QDBusVirtualObject {
 public:
    explicit Portal(QDBusConnection bus) : bus_(std::move(bus)) {
        bus_.registerVirtualObject(u"/"_s, this, QDBusConnection::SubPath);
        bus_.registerService(u"org.freedesktop.portal.Desktop"_s);
    }

    QStringList Calls;
    bool Waits = false;

    void Answer() { bus_.send(asked_.createReply(QVariant::fromValue(QDBusObjectPath(u"/request/1"_s)))); }
    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection&) override {
        if (message.member() == u"Close"_s) Calls << u"Close "_s + message.path();
        if (message.member() != u"Inhibit"_s) return true;
        Calls << u"Inhibit "_s + message.arguments().value(1).toString();
        asked_ = message;
        if (!Waits) Answer();
        return true;
    }

 private:
    QDBusConnection bus_;
    QDBusMessage asked_;
};

class StayAwakeTest : public testing::Test {
 protected:
    ~StayAwakeTest() override {
        QDBusConnection::disconnectFromBus(u"portal"_s);
        QDBusConnection::disconnectFromBus(u"program"_s);
    }
    bool Heard(const QStringList& calls) {
        return QTest::qWaitFor([&] { return portal_.Calls == calls; });
    }

    PrivateBus bus_;
    Portal portal_{bus_.Connect(u"portal"_s)};
    QDBusConnection program_ = bus_.Connect(u"program"_s);
    StayAwake awake_{program_};
};

TEST_F(StayAwakeTest, HoldsOnlyWhileASongPlays) {
    awake_.SetPlaying(true);
    awake_.SetPlaying(true);
    EXPECT_TRUE(Heard({u"Inhibit 4"_s}));
    awake_.SetPlaying(false);
    EXPECT_TRUE(Heard({u"Inhibit 4"_s, u"Close /request/1"_s}));
    awake_.SetPlaying(true);
    EXPECT_TRUE(Heard({u"Inhibit 4"_s, u"Close /request/1"_s, u"Inhibit 4"_s}));
}

TEST_F(StayAwakeTest, AnAnswerThatComesTooLateIsGivenBack) {
    portal_.Waits = true;
    awake_.SetPlaying(true);
    EXPECT_TRUE(Heard({u"Inhibit 4"_s}));
    awake_.SetPlaying(false);
    portal_.Answer();
    EXPECT_TRUE(Heard({u"Inhibit 4"_s, u"Close /request/1"_s}));
}

TEST(StayAwakeWithoutBusTest, NobodyIsAsked) {
    StayAwake awake{QDBusConnection(u"none"_s)};
    awake.SetPlaying(true);
    awake.SetPlaying(false);
}

}  // namespace
