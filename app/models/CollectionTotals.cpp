#include "app/models/CollectionTotals.h"

#include <QLocale>

#include "MusicManagment/database/MusicManagment.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kSecondsPerDay = 86'400;

QString PlayingTime(qint64 seconds) {
    const qint64 days = seconds / kSecondsPerDay;
    QString clock = FormatLength(static_cast<int>(seconds % kSecondsPerDay), true);
    if (days == 0) return clock;
    return QLocale(QLocale::German).toString(days) + (days == 1 ? u" Tag "_s : u" Tage "_s) + clock;
}

}  // namespace

CollectionTotals::CollectionTotals(TMusicDatabase& database) : database_(database) {
    CollectionEvents& events = database.Events();
    subscriptions_ +=
        events.Inserted.Subscribe([this](SongIndex index) { seconds_ += database_.Song(index).Length; });
    subscriptions_ +=
        events.Removed.Subscribe([this](SongIndex, const TID3Tag& record) { seconds_ -= record.Length; });
    subscriptions_ +=
        events.Changed.Subscribe([this](SongIndex, const TID3Tag& before, const TID3Tag& after) {
            seconds_ += after.Length - before.Length;
        });
    const auto forget = [this] { stale_ = true; };
    subscriptions_ += events.Replaced.Subscribe(forget);
    subscriptions_ += events.Cleared.Subscribe(forget);
}

qint64 CollectionTotals::Seconds() {
    if (!stale_) return seconds_;
    seconds_ = 0;
    for (const auto& song : database_.Songs())
        seconds_ += song->Length;
    stale_ = false;
    return seconds_;
}

QString CollectionTotals::Text() {
    return TotalsText(database_.Count(), Seconds());
}

QString TotalsText(qint64 songs, qint64 seconds) {
    const QString count = QLocale(QLocale::German).toString(songs) + (songs == 1 ? u" Song"_s : u" Songs"_s);
    return count + u", Spielzeit "_s + PlayingTime(seconds);
}
