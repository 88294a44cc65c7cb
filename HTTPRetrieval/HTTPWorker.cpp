#include "HTTPRetrieval/HTTPWorker.h"

#include <QNetworkProxy>
#include <QNetworkRequest>

using namespace Qt::StringLiterals;

namespace {

// Bytes that may wait here before the server has to: what is read is counted at once.
constexpr qint64 kReadBuffer = 64 * 1024;
constexpr int kFirstBadStatus = 400;

// The system's proxy for the requests of one manager; to set it for the whole program would concern others.
class SystemProxies : public QNetworkProxyFactory {
 public:
    QList<QNetworkProxy> queryProxy(const QNetworkProxyQuery& query) override {
        return systemProxyForQuery(query);
    }
};

QNetworkRequest RequestOf(const HTTPRequest& asked) {
    QNetworkRequest request(asked.Url);
    if (!asked.Agent.isEmpty()) request.setHeader(QNetworkRequest::UserAgentHeader, asked.Agent);
    // Packed answers would be unpacked before their size is known.
    request.setRawHeader("Accept-Encoding", "identity");
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute, QNetworkRequest::NoLessSafeRedirectPolicy);
    request.setMaximumRedirectsAllowed(asked.Limits.Redirects);
    if (asked.Body) request.setHeader(QNetworkRequest::ContentTypeHeader, asked.BodyType);
    return request;
}

QString ReasonOf(QNetworkReply::NetworkError error) {
    switch (error) {
        case QNetworkReply::ConnectionRefusedError:
        case QNetworkReply::ProxyConnectionRefusedError:
            return u"Der Server %1 nimmt keine Verbindung an."_s;
        case QNetworkReply::HostNotFoundError:
            return u"Der Server %1 wurde nicht gefunden."_s;
        case QNetworkReply::SslHandshakeFailedError:
            return u"Die Verbindung zum Server %1 ist nicht sicher: Sein Zertifikat wurde nicht anerkannt."_s;
        case QNetworkReply::TooManyRedirectsError:
            return u"Der Server %1 leitet immer weiter um."_s;
        case QNetworkReply::InsecureRedirectError:
        case QNetworkReply::ProtocolUnknownError:
            return u"Der Server %1 leitet an eine Adresse um, die nicht erlaubt ist."_s;
        default:
            return u"Die Verbindung zum Server %1 ist abgebrochen."_s;
    }
}

// What the head says of the length of the body; negative when it says nothing.
qint64 AnnouncedLength(const QNetworkReply& reply) {
    bool isNumber = false;
    const qint64 length = reply.header(QNetworkRequest::ContentLengthHeader).toLongLong(&isNumber);
    return isNumber ? length : -1;
}

}  // namespace

HTTPWorker::HTTPWorker() : manager_(this), timer_(this) {
    manager_.setProxyFactory(new SystemProxies);  // which the manager owns
    timer_.setSingleShot(true);
    connect(&timer_, &QTimer::timeout, this, [this] {
        if (reply_) Fail(u"Der Server %1 hat nicht rechtzeitig geantwortet."_s.arg(reply_->url().host()));
    });
}

HTTPWorker::~HTTPWorker() {
    Drop();
}

void HTTPWorker::Start(const HTTPRequest& request, Done done) {
    Drop();
    limits_ = request.Limits;
    done_ = std::move(done);
    answer_ = {};
    const QNetworkRequest asked = RequestOf(request);
    reply_.reset(request.Body ? manager_.post(asked, *request.Body) : manager_.get(asked));
    reply_->setReadBufferSize(kReadBuffer);
    connect(reply_.get(), &QNetworkReply::metaDataChanged, this, [this] { TakeHead(); });
    connect(reply_.get(), &QNetworkReply::readyRead, this, [this] { TakeBytes(); });
    connect(reply_.get(), &QNetworkReply::finished, this, [this] { Finish(); });
    timer_.start(limits_.Time);
}

void HTTPWorker::Drop() {
    timer_.stop();
    if (!reply_) return;
    reply_->disconnect(this);
    reply_->abort();
    reply_.reset();
}

void HTTPWorker::TakeHead() {
    if (reply_ && AnnouncedLength(*reply_) > limits_.Size) Fail(u"Die Antwort des Servers ist zu groß."_s);
}

void HTTPWorker::TakeBytes() {
    if (!reply_ || !answer_.Failure.isEmpty()) return;
    answer_.Body += reply_->readAll();
    if (answer_.Body.size() > limits_.Size) Fail(u"Die Antwort des Servers ist zu groß."_s);
}

void HTTPWorker::Fail(const QString& reason) {
    if (!answer_.Failure.isEmpty()) return;
    answer_.Failure = reason;
    reply_->abort();  // which finishes it
}

void HTTPWorker::Finish() {
    if (!reply_) return;
    TakeBytes();
    if (!reply_) return;  // what was taken last was too much
    timer_.stop();
    if (answer_.Failure.isEmpty()) answer_.Failure = FailureOf(*reply_);
    if (!answer_.Failure.isEmpty()) answer_.Body.clear();
    reply_.reset();
    std::exchange(done_, {})(std::exchange(answer_, {}));
}

QString HTTPWorker::FailureOf(const QNetworkReply& reply) const {
    const QString host = reply.url().host();
    const int status = reply.attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    if (status >= kFirstBadStatus)
        return u"Der Server %1 meldet einen Fehler (HTTP %2)."_s.arg(host).arg(status);
    if (reply.error() != QNetworkReply::NoError) return ReasonOf(reply.error()).arg(host);
    const qint64 announced = AnnouncedLength(reply);
    if (announced >= 0 && announced != answer_.Body.size())
        return u"Die Antwort des Servers %1 ist unvollständig."_s.arg(host);
    return {};
}
