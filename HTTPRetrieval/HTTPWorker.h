#pragma once

#include <QByteArray>
#include <QDeadlineTimer>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QString>
#include <QTimer>
#include <QUrl>
#include <functional>
#include <memory>
#include <optional>

#include "HTTPRetrieval/HTTPGet.h"

struct HTTPRequest {
    QUrl Url;
    QString Agent;
    HTTPLimits Limits;
    std::optional<QByteArray> Body{};  // posted where there is one
    QString BodyType{};
};

struct HTTPAnswer {
    QByteArray Body;
    QString Failure;  // German, for the user; empty when there is an answer
};

// Carries out one request at a time, in the thread in which it lives.
class HTTPWorker : public QObject {
 public:
    using Done = std::function<void(const HTTPAnswer& answer)>;

    HTTPWorker();
    ~HTTPWorker() override;

    // Ends a request that is under way, whose `done` is never called then.
    void Start(const HTTPRequest& request, Done done);
    void Drop();

 private:
    struct Deleter {
        void operator()(QNetworkReply* reply) const { reply->deleteLater(); }
    };

    void TakeHead();
    void TakeBytes();
    // Ends the request with a reason of our own.
    void Fail(const QString& reason);
    void Finish();
    QString FailureOf(const QNetworkReply& reply) const;

    QNetworkAccessManager manager_;
    QTimer timer_;
    HTTPLimits limits_;
    std::unique_ptr<QNetworkReply, Deleter> reply_;
    Done done_;
    HTTPAnswer answer_;
};
