#include "app/models/FilePresence.h"

#include <QFileInfo>

#include "CommonRUKTools/Clock.h"

namespace {

constexpr qint64 kTrusted = 15'000;  // milliseconds that a finding is good for

}  // namespace

FilePresence::FilePresence(QObject* parent) : QObject(parent) {
    thread_.setMaxThreadCount(1);
}

FilePresence::~FilePresence() {
    ending_ = true;
    thread_.clear();
    thread_.waitForDone();
}

bool FilePresence::IsMissing(const QString& path) const {
    return findings_.value(path).Missing;
}

void FilePresence::LookFor(const QStringList& paths) {
    const qint64 now = CurrentClock().Ticks();
    QStringList wanted;
    for (const QString& path : paths) {
        const auto known = findings_.constFind(path);
        if (known != findings_.constEnd() && (known->Asked || now - known->Time < kTrusted)) continue;
        findings_[path].Asked = true;
        wanted << path;
    }
    if (!wanted.isEmpty()) thread_.start([this, wanted] { Look(wanted); });
}

// In the thread.
void FilePresence::Look(const QStringList& paths) {
    Answers answers;
    for (const QString& path : paths) {
        if (ending_) return;
        answers.append({path, !QFileInfo::exists(path)});
    }
    QMetaObject::invokeMethod(
        this, [this, answers] { Take(answers); }, Qt::QueuedConnection);
}

void FilePresence::Take(const Answers& answers) {
    const qint64 now = CurrentClock().Ticks();
    bool changed = false;
    for (const auto& [path, missing] : answers) {
        Finding& finding = findings_[path];
        changed |= finding.Missing != missing;
        finding = {missing, false, now};
    }
    if (changed && OnChange) OnChange();
}
