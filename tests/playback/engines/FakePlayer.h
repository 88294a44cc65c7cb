#pragma once

#include <QDBusConnection>
#include <QDBusVirtualObject>
#include <QFile>
#include <QStringList>
#include <QTimer>

// A player on the bus, as obedient as the test wants it.
class FakePlayer : public QDBusVirtualObject {
 public:
    // Its connection to the bus, and the last part of its name there.
    FakePlayer(const QDBusConnection& bus, const QString& name);
    ~FakePlayer() override;

    // Switches.
    bool HasOpenUri = true;
    bool OpensNothing = false;  // takes files and does nothing with them
    bool StatusLags = false;    // calls itself stopped until its first pause
    bool SeekFails = false;
    bool HasTrackId = true;
    bool Answers = true;
    QStringList Schemes{QStringLiteral("file")};

    // What it does.
    QString File;
    QString Status = QStringLiteral("Stopped");
    qint64 Position = 0;                // microseconds
    qint64 Length = 180 * 1000 * 1000;  // microseconds
    QStringList Calls;                  // of the player's own interface
    int StatesTold = 0;
    double Volume = 0.8;

    void Appear();
    void Vanish();
    void Load(const QString& path);

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override;

 private:
    QDBusMessage Answer(const QDBusMessage& message);
    QDBusMessage AnswerPlayer(const QDBusMessage& message);
    QVariantMap State() const;

    QDBusConnection bus_;
    QString name_;
};

// The program of a player that is started with a file: a script that writes down its argument. Whoever
// watches for starts is told of each.
class PlayerScript {
 public:
    PlayerScript(const QString& path, std::function<void(const QString& file)> started);
    const QString& Path() const { return path_; }

 private:
    void Look();

    QString path_;
    std::function<void(const QString&)> started_;
    QTimer timer_;
    qsizetype seen_ = 0;  // bytes
};
