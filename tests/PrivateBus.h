#pragma once

#include <QDBusConnection>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <stdexcept>

// A message bus of the test's own, for its lifetime.
class PrivateBus {
 public:
    PrivateBus() {
        const QString configuration = folder_.filePath(QStringLiteral("bus.conf"));
        QFile file(configuration);
        if (!file.open(QIODevice::WriteOnly)) throw std::runtime_error("cannot write bus.conf");
        file.write(
            R"(<busconfig><type>session</type><listen>unix:tmpdir=/tmp</listen><policy context="default">
<allow send_destination="*" eavesdrop="true"/><allow eavesdrop="true"/><allow own="*"/></policy></busconfig>)");
        file.close();
        daemon_.start(QStringLiteral("dbus-daemon"),
                      {QStringLiteral("--nofork"), QStringLiteral("--print-address"),
                       QStringLiteral("--config-file=") + configuration});
        if (!daemon_.waitForReadyRead(10000)) throw std::runtime_error("dbus-daemon does not start");
        address_ = QString::fromLatin1(daemon_.readLine()).trimmed();
    }
    ~PrivateBus() {
        daemon_.kill();
        daemon_.waitForFinished();
    }

    const QString& Address() const { return address_; }
    QDBusConnection Connect(const QString& name) const {
        return QDBusConnection::connectToBus(address_, name);
    }

 private:
    QTemporaryDir folder_;
    QProcess daemon_;
    QString address_;
};
