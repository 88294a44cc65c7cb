#include "HTTPRetrieval/HTTPGet.h"

#include <QMutex>
#include <QMutexLocker>
#include <QRegularExpression>
#include <QThread>
#include <utility>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/CommandRunner.h"
#include "HTTPRetrieval/HTTPWorker.h"
#include "HTTPRetrieval/WebAddress.h"

using namespace Qt::StringLiterals;

namespace {

// ms. A worker ends at once, unless the system is just looking for its proxy; nobody waits longer for that.
constexpr unsigned long kPatience = 300;

// The way from the worker's thread to an object that may be gone by then.
class Mailbox {
 public:
    explicit Mailbox(QObject& receiver) : receiver_(&receiver) {}

    void Post(std::function<void()> letter) {
        const QMutexLocker lock(&mutex_);
        if (receiver_ != nullptr)
            QMetaObject::invokeMethod(receiver_, std::move(letter), Qt::QueuedConnection);
    }
    void Close() {
        const QMutexLocker lock(&mutex_);
        receiver_ = nullptr;
    }

 private:
    QMutex mutex_;
    QObject* receiver_;
};

// A "%" that begins no escape would make Qt escape every "%" of the address once more.
QUrl UrlOf(QString address) {
    static const QRegularExpression loose(u"%(?![0-9A-Fa-f]{2})"_s);
    return QUrl(address.replace(loose, u"%25"_s));
}

}  // namespace

// The thread of a component with its worker.
class HTTPThread {
 public:
    explicit HTTPThread(QObject& receiver)
        : mailbox_(std::make_shared<Mailbox>(receiver)), worker_(new HTTPWorker), thread_(new QThread) {
        worker_->moveToThread(thread_);
        QObject::connect(thread_, &QThread::finished, worker_, &QObject::deleteLater);
        thread_->start();
    }
    ~HTTPThread() {
        mailbox_->Close();
        QObject::connect(thread_, &QThread::finished, thread_, &QObject::deleteLater);
        thread_->quit();
        if (thread_->wait(QDeadlineTimer(kPatience))) delete thread_;  // else it goes when it has ended
    }
    HTTPThread(const HTTPThread&) = delete;
    HTTPThread& operator=(const HTTPThread&) = delete;

    // `take` is called in the thread of the receiver.
    void Start(const HTTPRequest& request, std::function<void(const HTTPAnswer&)> take) {
        const auto tell = [mailbox = mailbox_, take = std::move(take)](const HTTPAnswer& answer) {
            mailbox->Post([take, answer] { take(answer); });
        };
        QMetaObject::invokeMethod(worker_,
                                  [worker = worker_, request, tell] { worker->Start(request, tell); });
    }
    void Drop() {
        QMetaObject::invokeMethod(worker_, [worker = worker_] { worker->Drop(); });
    }

 private:
    std::shared_ptr<Mailbox> mailbox_;
    HTTPWorker* worker_;  // lives in the thread and ends with it
    QThread* thread_;
};

THTTPGet::THTTPGet() = default;
THTTPGet::~THTTPGet() = default;

void THTTPGet::GetString() {
    Start(Wanted::Text, {.Url = UrlOf(url_), .Agent = agent_, .Limits = limits_});
}

void THTTPGet::GetBytes() {
    Start(Wanted::Bytes, {.Url = UrlOf(url_), .Agent = agent_, .Limits = limits_});
}

void THTTPGet::PostString(const QByteArray& body, const QString& type) {
    Start(Wanted::Text,
          {.Url = UrlOf(url_), .Agent = agent_, .Limits = limits_, .Body = body, .BodyType = type});
}

void THTTPGet::Cancel() {
    if (!running_) return;
    running_ = false;
    ++run_;
    if (thread_) thread_->Drop();
}

void THTTPGet::Start(Wanted wanted, const HTTPRequest& request) {
    wanted_ = wanted;
    running_ = true;
    const quint64 run = ++run_;
    if (!IsWebAddress(request.Url)) {
        if (thread_) thread_->Drop();
        // Told from the event loop, as every other outcome.
        const HTTPAnswer failure{{}, u"\"%1\" ist keine Adresse im Internet."_s.arg(url_)};
        QMetaObject::invokeMethod(
            this, [this, run, failure] { Take(run, failure); }, Qt::QueuedConnection);
        return;
    }
    if (!thread_) thread_ = std::make_unique<HTTPThread>(*this);
    thread_->Start(request, [this, run](const HTTPAnswer& answer) { Take(run, answer); });
}

void THTTPGet::Take(quint64 run, const HTTPAnswer& answer) {
    if (run != run_) return;
    running_ = false;
    RunCommand([this, &answer] { Tell(answer); });
}

// The handler is copied: it may destroy this object, and itself with it.
void THTTPGet::Tell(const HTTPAnswer& answer) {
    if (!answer.Failure.isEmpty()) {
        if (const auto tell = OnError) tell(answer.Failure);
    } else if (wanted_ == Wanted::Bytes) {
        if (const auto tell = OnDoneBytes) tell(answer.Body);
    } else if (const auto tell = OnDoneString) {
        tell(CodePage::FromSystem(AsBytes(answer.Body.toStdString())));
    }
}
