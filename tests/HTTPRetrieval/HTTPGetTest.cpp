#include "HTTPRetrieval/HTTPGet.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QPointer>
#include <QProcess>
#include <QSslKey>
#include <QSslServer>
#include <QTemporaryDir>
#include <QThread>

#include "tests/HTTPRetrieval/LoopbackServer.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

// A component that notes what it tells.
struct Asker {
    explicit Asker(const QString& url) {
        Get->SetAgent(u"Tunestead Test"_s);
        Get->SetURL(url);
        Get->OnDoneString = [this](const QString& text) { Told(text); };
        Get->OnDoneBytes = [this](const QByteArray& bytes) { Told(QString::fromLatin1(bytes.toHex())); };
        Get->OnError = [this](const QString& reason) { Told(u"Fehler: "_s + reason); };
    }

    void Told(const QString& text) {
        EXPECT_EQ(QThread::currentThread(), qApp->thread());
        EXPECT_FALSE(Get->IsRunning());
        Texts << text;
    }
    // What the next request tells.
    QString Next() {
        const qsizetype before = Texts.size();
        return Comes([&] { return Texts.size() > before; }) ? Texts.back() : u"(nothing)"_s;
    }

    std::unique_ptr<THTTPGet> Get = std::make_unique<THTTPGet>();
    QStringList Texts;
};

// Whatever was posted to this thread has been delivered.
void DeliverAll() {
    QCoreApplication::sendPostedEvents();
    QCoreApplication::processEvents();
}

TEST(HTTPGetTest, AnAnswerComesAsTextOrAsBytes) {
    QByteArray seen;
    LoopbackServer server([&](QTcpSocket& socket, const QByteArray& request) {
        seen = request;
        SendAnswer(socket, request.startsWith("GET /latin") ? "Gr\xFC\xDF"
                                                              "e"
                                                            : "Grüße");
    });

    Asker asker(server.URL(u"/utf?a=%C3%A4+100%+b"_s));
    asker.Get->GetString();
    EXPECT_TRUE(asker.Get->IsRunning());
    EXPECT_EQ(asker.Next(), u"Grüße"_s);
    EXPECT_TRUE(seen.startsWith("GET /utf?a=%C3%A4+100%25+b HTTP/1.1\r\n")) << seen.toStdString();
    EXPECT_TRUE(seen.contains("User-Agent: Tunestead Test\r\n")) << seen.toStdString();

    asker.Get->SetURL(server.URL(u"/latin"_s));
    asker.Get->GetString();
    EXPECT_EQ(asker.Next(), u"Grüße"_s);
    asker.Get->GetBytes();
    EXPECT_EQ(asker.Next(), u"4772fcdf65"_s);

    asker.Get->PostString("a=1&b=2", u"application/x-www-form-urlencoded"_s);
    EXPECT_EQ(asker.Next(), u"Grüße"_s);
    EXPECT_TRUE(seen.startsWith("POST ")) << seen.toStdString();
    EXPECT_TRUE(seen.contains("Content-Type: application/x-www-form-urlencoded\r\n")) << seen.toStdString();
    EXPECT_TRUE(seen.endsWith("\r\n\r\na=1&b=2")) << seen.toStdString();
}

TEST(HTTPGetTest, ASlowServerIsWaitedForWithoutHoldingAnybodyUp) {
    QPointer<QTcpSocket> waiting;
    LoopbackServer server([&](QTcpSocket& socket, const QByteArray&) {
        socket.write("HTTP/1.1 200 OK\r\nContent-Length: 6\r\n\r\nhal");
        waiting = &socket;
    });
    Asker asker(server.URL(u"/"_s));
    asker.Get->GetString();
    ASSERT_TRUE(Comes([&] { return !waiting.isNull(); }));
    DeliverAll();
    EXPECT_TRUE(asker.Texts.isEmpty());
    EXPECT_TRUE(asker.Get->IsRunning());
    waiting->write("lo!");
    EXPECT_EQ(asker.Next(), u"hallo!"_s);
}

TEST(HTTPGetTest, WhatGoesWrongIsToldOnce) {
    LoopbackServer server([](QTcpSocket& socket, const QByteArray& request) {
        const QByteArray path = request.mid(5, request.indexOf(' ', 5) - 5);
        if (path == "never") return;
        if (path == "cut") socket.write("HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\nten bytes.");
        if (path == "garbage") socket.write("what is this?\r\n\r\n");
        if (path == "missing") socket.write("HTTP/1.1 404 Not Found\r\nContent-Length: 2\r\n\r\nno");
        if (path == "busy") socket.write("HTTP/1.1 503 Service Unavailable\r\nContent-Length: 0\r\n\r\n");
        if (path == "circle")
            socket.write("HTTP/1.1 302 Found\r\nLocation: /circle\r\nContent-Length: 0\r\n\r\n");
        if (path == "file") socket.write("HTTP/1.1 302 Found\r\nLocation: file:///etc/hostname\r\n\r\n");
        socket.disconnectFromHost();
    });
    QTcpServer closed;  // a port that nobody listens to
    closed.listen(QHostAddress::LocalHost);
    const QString closedUrl = u"http://127.0.0.1:%1/"_s.arg(closed.serverPort());
    closed.close();

    const QString broken = u"Die Verbindung zum Server 127.0.0.1 ist abgebrochen."_s;
    const std::pair<QString, QString> cases[] = {
        {server.URL(u"/never"_s), u"Der Server 127.0.0.1 hat nicht rechtzeitig geantwortet."_s},
        {server.URL(u"/cut"_s), broken},
        {server.URL(u"/garbage"_s), broken},
        {server.URL(u"/missing"_s), u"Der Server 127.0.0.1 meldet einen Fehler (HTTP 404)."_s},
        {server.URL(u"/busy"_s), u"Der Server 127.0.0.1 meldet einen Fehler (HTTP 503)."_s},
        {server.URL(u"/circle"_s), u"Der Server 127.0.0.1 leitet immer weiter um."_s},
        {server.URL(u"/file"_s), u"Der Server 127.0.0.1 leitet an eine Adresse um, die nicht erlaubt ist."_s},
        {closedUrl, u"Der Server 127.0.0.1 nimmt keine Verbindung an."_s},
        {u"file:///etc/hostname"_s, u"\"file:///etc/hostname\" ist keine Adresse im Internet."_s},
        {QString(), u"\"\" ist keine Adresse im Internet."_s},
    };
    for (const auto& [url, reason] : cases) {
        Asker asker(url);
        if (url.endsWith(u"never")) asker.Get->SetLimits({.Time = 30});
        asker.Get->GetString();
        EXPECT_EQ(asker.Next(), u"Fehler: "_s + reason) << url.toStdString();
        DeliverAll();
        EXPECT_EQ(asker.Texts.size(), 1) << url.toStdString();
    }
}

TEST(HTTPGetTest, AnAnswerBeyondTheLimitIsNotTaken) {
    constexpr qint64 kGibibyte = 1024 * 1024 * 1024;
    const QByteArray block(256 * 1024, 'x');
    qint64 sent = 0;
    LoopbackServer server([&](QTcpSocket& socket, const QByteArray& request) {
        const bool announces = request.startsWith("GET /announced");
        socket.write(
            "HTTP/1.1 200 OK\r\n" +
            (announces ? "Content-Length: " + QByteArray::number(kGibibyte) + "\r\n" : QByteArray()) +
            "\r\n");
        // As long as somebody takes them.
        QObject::connect(&socket, &QTcpSocket::bytesWritten, &socket, [&, &taker = socket] {
            if (taker.bytesToWrite() > 0 || sent >= kGibibyte) return;
            sent += taker.write(block);
        });
    });
    for (const QString& path : {u"/announced"_s, u"/streamed"_s}) {
        sent = 0;
        Asker asker(server.URL(path));
        const int gone = server.Gone();
        asker.Get->GetBytes();
        EXPECT_EQ(asker.Next(), u"Fehler: Die Antwort des Servers ist zu groß."_s);
        EXPECT_TRUE(Comes([&] { return server.Gone() > gone; }));
        // What was on its way in the system's buffers counts too.
        EXPECT_LT(sent, 64 * 1024 * 1024);
    }
}

TEST(HTTPGetTest, ACertificateThatNobodySignedIsRefused) {
    const QTemporaryDir folder;
    const QString key = folder.filePath(u"key.pem"_s);
    const QString certificate = folder.filePath(u"cert.pem"_s);
    ASSERT_EQ(QProcess::execute(u"openssl"_s,
                                {u"req"_s, u"-x509"_s, u"-newkey"_s, u"ec"_s, u"-pkeyopt"_s,
                                 u"ec_paramgen_curve:prime256v1"_s, u"-nodes"_s, u"-batch"_s, u"-subj"_s,
                                 u"/CN=127.0.0.1"_s, u"-keyout"_s, key, u"-out"_s, certificate}),
              0);
    QFile keyFile(key);
    ASSERT_TRUE(keyFile.open(QIODevice::ReadOnly));
    LoopbackServer<QSslServer> server(
        [](QTcpSocket& socket, const QByteArray&) { SendAnswer(socket, "secret"); });
    QSslConfiguration configuration = QSslConfiguration::defaultConfiguration();
    configuration.setLocalCertificateChain(QSslCertificate::fromPath(certificate));
    configuration.setPrivateKey(QSslKey(&keyFile, QSsl::Ec));
    server.Socket().setSslConfiguration(configuration);

    Asker asker(u"https://"_s + server.Host() + u"/"_s);
    asker.Get->GetString();
    EXPECT_EQ(asker.Next(),
              u"Fehler: Die Verbindung zum Server 127.0.0.1 ist nicht sicher: "
              "Sein Zertifikat wurde nicht anerkannt."_s);
    EXPECT_EQ(server.Requests(), 0);
}

TEST(HTTPGetTest, ARequestThatWasCancelledOrReplacedTellsNothing) {
    QPointer<QTcpSocket> held;
    LoopbackServer server([&](QTcpSocket& socket, const QByteArray& request) {
        if (request.startsWith("GET /held"))
            held = &socket;
        else
            SendAnswer(socket, "the other");
    });
    Asker asker(server.URL(u"/held"_s));
    for (const bool cancels : {true, false}) {
        asker.Get->SetURL(server.URL(u"/held"_s));
        asker.Get->GetString();
        ASSERT_TRUE(Comes([&] { return !held.isNull(); }));
        SendAnswer(*held, "too late");
        held.clear();
        if (cancels) asker.Get->Cancel();
        EXPECT_EQ(asker.Get->IsRunning(), !cancels);
        asker.Get->SetURL(server.URL(u"/"_s));
        asker.Get->GetString();
        EXPECT_EQ(asker.Next(), u"the other"_s);
    }
    DeliverAll();
    EXPECT_EQ(asker.Texts, QStringList({u"the other"_s, u"the other"_s}));
}

TEST(HTTPGetTest, ADestroyedComponentLeavesNothingBehind) {
    LoopbackServer server([](QTcpSocket& socket, const QByteArray& request) {
        if (request.startsWith("GET /answered")) SendAnswer(socket, "yes");
    });
    Asker asker(server.URL(u"/never"_s));
    asker.Get->GetString();
    ASSERT_TRUE(Comes([&] { return server.Requests() == 1; }));
    asker.Get.reset();
    EXPECT_TRUE(Comes([&] { return server.Gone() == 1; }));
    DeliverAll();
    EXPECT_TRUE(asker.Texts.isEmpty());

    // By its own event.
    auto get = std::make_unique<THTTPGet>();
    QString told;
    get->SetURL(server.URL(u"/answered"_s));
    get->OnDoneString = [&](const QString& text) {
        get.reset();
        told = text;
    };
    get->GetString();
    EXPECT_TRUE(Comes([&] { return get == nullptr; }));
    EXPECT_EQ(told, u"yes"_s);
}

}  // namespace
