#pragma once

#include <QHash>
#include <QObject>
#include <QStringList>
#include <QThreadPool>
#include <atomic>
#include <functional>

// Whether files are there, found out in a thread of its own: a disk that sleeps and a network that is gone
// take their time, and no view waits for them.
class FilePresence : public QObject {
 public:
    explicit FilePresence(QObject* parent = nullptr);
    ~FilePresence() override;

    // True when the file was not there the last time that somebody looked; what is not known is not missing.
    bool IsMissing(const QString& path) const;
    // Has those looked for of which nothing is known, or nothing new.
    void LookFor(const QStringList& paths);
    // In the thread of this object, when it has found out something new.
    std::function<void()> OnChange;

 private:
    struct Finding {
        bool Missing = false;
        bool Asked = false;  // the thread is at it
        qint64 Time = 0;     // ticks of the clock
    };
    using Answers = QList<std::pair<QString, bool>>;  // path, whether it is missing

    void Look(const QStringList& paths);
    void Take(const Answers& answers);

    QHash<QString, Finding> findings_;
    std::atomic<bool> ending_ = false;
    QThreadPool thread_;
};
