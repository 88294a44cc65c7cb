#include "HTTPRetrieval/MusicBrainz.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QUrl>
#include <algorithm>
#include <cmath>

#include "HTTPRetrieval/WebAddress.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kMostRecordings = 50;
constexpr int kMostTracks = 9999;
constexpr qint64 kMostSeconds = 0xFFFF;  // that a record can hold

// The query language gives these characters a meaning of their own.
QString Plain(const QString& words) {
    QString plain;
    for (const QChar letter : words) {
        if (u"+-&|!(){}[]^\"~*?:\\/"_s.contains(letter)) plain += u'\\';
        plain += letter;
    }
    return plain;
}

QString QueryOf(const QString& text) {
    const qsizetype dash = text.indexOf(u" - "_s);
    if (dash < 0) return Plain(text.trimmed());
    return u"artist:\"%1\" AND recording:\"%2\""_s.arg(Plain(text.left(dash).trimmed()),
                                                       Plain(text.mid(dash + 3).trimmed()));
}

// Several artists stand with what joins them: "A", " feat. ", "B".
QString ArtistOf(const QJsonObject& owner) {
    QString artist;
    const QJsonArray credits = owner["artist-credit"_L1].toArray();
    for (const auto& credit : credits)
        artist += credit["name"_L1].toString() + credit["joinphrase"_L1].toString();
    return artist;
}

QString YearOf(const QString& date) {
    const QString year = date.left(4);
    const bool isYear = year.size() == 4 &&
                        std::ranges::all_of(year, [](QChar digit) { return digit >= u'0' && digit <= u'9'; });
    return isYear ? year : QString();
}

// A track is numbered as its sleeve has it, which on records may be "A1"; its place counts then.
int TrackOf(const QJsonObject& release) {
    const QJsonValue medium = release["media"_L1][0];
    const QJsonValue number = medium["track"_L1][0]["number"_L1];
    bool isNumber = false;
    int track = number.toString().toInt(&isNumber);
    if (!isNumber) {
        const int before = medium["track-offset"_L1].toInt(-1);
        track = before >= 0 && before < kMostTracks ? before + 1 : 0;
    }
    return track > 0 && track <= kMostTracks ? track : 0;
}

int SecondsOf(const QJsonValue& milliseconds) {
    constexpr double kSecond = 1000;
    const double seconds = milliseconds.toDouble() / kSecond;
    return seconds > 0 && seconds <= kMostSeconds ? static_cast<int>(std::lround(seconds)) : 0;
}

void AddHits(const QJsonObject& recording, std::vector<SearchHit>& hits) {
    const QString firstYear = YearOf(recording["first-release-date"_L1].toString());
    SearchHit hit{.Artist = ArtistOf(recording),
                  .Title = recording["title"_L1].toString(),
                  .Year = firstYear,
                  .Length = SecondsOf(recording["length"_L1])};
    if (hit.Title.isEmpty()) return;
    const QJsonArray releases = recording["releases"_L1].toArray();
    if (releases.isEmpty()) hits.push_back(hit);
    const auto first = static_cast<std::ptrdiff_t>(hits.size());
    for (const auto& value : releases) {
        const QJsonObject release = value.toObject();
        hit.Album = release["title"_L1].toString();
        hit.Release = release["id"_L1].toString();
        hit.Track = TrackOf(release);
        const QString year = YearOf(release["date"_L1].toString());
        hit.Year = year.isEmpty() ? firstYear : year;
        // The same album came out in many countries.
        const auto isSame = [&hit](const SearchHit& other) {
            return other.Album == hit.Album && other.Year == hit.Year && other.Track == hit.Track;
        };
        if (std::none_of(hits.begin() + first, hits.end(), isSame)) hits.push_back(hit);
    }
}

}  // namespace

QString MusicBrainzUrl(const QString& address, const QString& query) {
    return AddressBase(address) + u"/ws/2/recording?fmt=json&limit=%1&query="_s.arg(kMostRecordings) +
           QString::fromLatin1(QUrl::toPercentEncoding(QueryOf(query)));
}

std::optional<std::vector<SearchHit>> ReadMusicBrainz(const QByteArray& json) {
    const QJsonValue recordings = QJsonDocument::fromJson(json).object()["recordings"_L1];
    if (!recordings.isArray()) return std::nullopt;
    std::vector<SearchHit> hits;
    const QJsonArray found = recordings.toArray();
    for (qsizetype i = 0; i < found.size() && i < kMostRecordings; ++i)
        AddHits(found[i].toObject(), hits);
    return hits;
}

QString CoverUrl(const QString& address, const QString& release) {
    return AddressBase(address) + u"/release/"_s + QString::fromLatin1(QUrl::toPercentEncoding(release)) +
           u"/front-500"_s;
}
