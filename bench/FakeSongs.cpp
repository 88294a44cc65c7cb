#include "bench/FakeSongs.h"

#include <array>
#include <random>

#include "bench/SongNames.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::array<QStringView, 6> kFormats = {u"MPEG 1.0 Layer III",  u"MPEG 1.0 Layer III",
                                                 u"MPEG 1.0 Layer III",  u"MPEG 2.0 Layer III",
                                                 u"Windows Media Audio", u"Wave"};
constexpr std::array<quint16, 6> kBitRates = {128, 160, 192, 192, 256, 320};

// 0 to limit - 1, the same on every system, which the standard library's distributions are not.
class Random {
 public:
    int Below(int limit) { return static_cast<int>(engine_() % static_cast<unsigned>(limit)); }
    template <typename T, std::size_t size>
    const T& Of(const std::array<T, size>& table) {
        return table[engine_() % size];
    }

 private:
    std::mt19937 engine_;
};

// Most titles are two phrases, because there are only some ten thousand of one.
QString Title(Random& random, int number) {
    const QString title = SongNames::Title(number);
    return random.Below(3) == 0 ? title : title + u", "_s + SongNames::Title(number * 2 + 1);
}

QString Album(Random& random, int artist, int number) {
    const QString album = SongNames::Album(artist, number);
    return random.Below(6) == 0 ? album : album + u" & "_s + SongNames::Album(number, artist);
}

QString Comment(Random& random) {
    const int kind = random.Below(10);
    if (kind < 6) return {};
    if (kind < 9) return u"Encoded by "_s + SongNames::Artist(random.Below(20));
    return u"Track from "_s + SongNames::Title(random.Below(100'000)) + u' ' +
           QString::number(random.Below(100'000));
}

void FillNumbers(Random& random, TID3Tag& song) {
    song.Length = static_cast<quint16>(90 + random.Below(300));
    song.BitRate = random.Of(kBitRates);
    song.SampleRate = random.Below(20) == 0 ? 48000 : 44100;
    song.ChannelMode = static_cast<quint8>(2 + random.Below(2));
    song.Emphasis = 1;
    song.Original = random.Below(2) == 0;
    song.FrameSize = static_cast<quint16>(144'000 * song.BitRate / song.SampleRate);
    song.PlayCount = static_cast<quint32>(random.Below(4) == 0 ? random.Below(60) : 0);
    song.Reserved = 65535;
    song.Flags = random.Below(8) == 0 ? 1 : 0;
    song.AddTime = 37'000 + random.Below(8'000) + random.Below(86'400) / 86'400.0;
}

struct FakeArtist {
    int Number;
    QString Name;
    quint8 Genre;
    quint8 MainGenre;
};

void AddAlbum(Random& random, const FakeArtist& artist, int number, std::size_t wanted,
              std::vector<TID3Tag>& songs) {
    const QString album = Album(random, artist.Number, number);
    const QString year = QString::number(1965 + random.Below(58));
    const QString format = random.Of(kFormats).toString();
    const QString folder = u"/home/anna/Musik/"_s + artist.Name + u'/' + album + u'/';
    const int tracks = 10 + random.Below(14);
    for (int track = 1; track <= tracks && songs.size() < wanted; ++track) {
        TID3Tag& song = songs.emplace_back();
        song.Title = Title(random, static_cast<int>(songs.size()));
        song.FileName = folder + u"%1 - %2.mp3"_s.arg(track, 2, 10, QChar(u'0')).arg(song.Title);
        song.Artist = artist.Name;
        song.Album = album;
        song.Year = year;
        song.Comment = Comment(random);
        song.MPEGLayer = format;
        song.Genre = artist.Genre;
        song.MainGenre = artist.MainGenre;
        song.Track = static_cast<quint8>(track);
        FillNumbers(random, song);
    }
}

}  // namespace

std::vector<TID3Tag> MakeFakeSongs(int count) {
    const auto wanted = static_cast<std::size_t>(count);
    Random random;
    std::vector<TID3Tag> songs;
    songs.reserve(wanted);
    for (int number = 0; songs.size() < wanted; ++number) {
        const FakeArtist artist{number, SongNames::Artist(number), static_cast<quint8>(random.Below(80)),
                                static_cast<quint8>(random.Below(20))};
        const int albums = 1 + random.Below(5);
        for (int album = 0; album < albums; ++album)
            AddAlbum(random, artist, album, wanted, songs);
    }
    return songs;
}
