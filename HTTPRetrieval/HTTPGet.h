#pragma once

#include <QByteArray>
#include <QObject>
#include <QString>
#include <functional>
#include <memory>

class HTTPThread;
struct HTTPAnswer;
struct HTTPRequest;

// What one request may cost.
struct HTTPLimits {
    int Time = 30'000;              // ms from its start to its end
    qint64 Size = 8 * 1024 * 1024;  // bytes of the answer
    int Redirects = 5;
};

// Asks a server, one request at a time. The work is done in a thread of its own; the events are raised in the
// thread of this object, from its event loop. Certificates are checked, the system's proxy is used, nothing
// is kept of an answer (neither cookies nor a cache). An answer that is cut off is an error, but for one in
// chunks: Qt 6.4 now and then takes its last chunk for whole.
class THTTPGet : public QObject {
 public:
    THTTPGet();
    // Ends a request that is under way.
    ~THTTPGet() override;

    // How this program calls itself.
    const QString& Agent() const { return agent_; }
    void SetAgent(const QString& agent) { agent_ = agent; }
    // An address of HTTP or HTTPS.
    const QString& URL() const { return url_; }
    void SetURL(const QString& url) { url_ = url; }
    const HTTPLimits& Limits() const { return limits_; }
    void SetLimits(const HTTPLimits& limits) { limits_ = limits; }

    // Each takes the place of a request that is still under way.
    void GetString();
    void GetBytes();
    // `type` is that of the body, as "application/x-www-form-urlencoded".
    void PostString(const QByteArray& body, const QString& type);

    // The request that is under way raises no event any more.
    void Cancel();
    bool IsRunning() const { return running_; }

    // Exactly one of these is raised for each request that is not cancelled. All may start the next request
    // or destroy this object.
    std::function<void(const QString& text)> OnDoneString;
    std::function<void(const QByteArray& bytes)> OnDoneBytes;
    std::function<void(const QString& reason)> OnError;  // German, for the user

 private:
    enum class Wanted { Text, Bytes };

    void Start(Wanted wanted, const HTTPRequest& request);
    void Take(quint64 run, const HTTPAnswer& answer);
    void Tell(const HTTPAnswer& answer);

    QString agent_;
    QString url_;
    HTTPLimits limits_;
    std::unique_ptr<HTTPThread> thread_;  // since the first request
    Wanted wanted_ = Wanted::Text;
    quint64 run_ = 0;  // number of the last request
    bool running_ = false;
};
