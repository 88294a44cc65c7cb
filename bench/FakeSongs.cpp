#include "bench/FakeSongs.h"

#include <array>
#include <cstdint>

using namespace Qt::StringLiterals;

namespace {

constexpr auto kFirstWords = std::to_array<QStringView>(
    {u"The", u"Die", u"Black", u"Golden", u"Electric", u"Silent", u"Blue", u"Grüne", u"Lost", u"Little",
     u"Big", u"Schöne", u"Midnight", u"Summer", u"Broken", u"Wild"});
constexpr auto kSyllables = std::to_array<QStringView>(
    {u"ka", u"ro",  u"mi",  u"len", u"tor", u"ban", u"shi", u"del", u"ver", u"on",
     u"al", u"gri", u"sta", u"bü",  u"lo",  u"zen", u"mar", u"tin", u"wol", u"fe",
     u"hu", u"ber", u"dan", u"ce",  u"jö",  u"nas", u"pe",  u"tra", u"sky", u"ler"});
constexpr auto kTitleWords = std::to_array<QStringView>(
    {u"love",  u"night", u"day",   u"heart",  u"dance", u"fire",    u"rain",  u"road",  u"dream",
     u"home",  u"river", u"star",  u"moon",   u"sun",   u"Liebe",   u"Nacht", u"Stadt", u"Himmel",
     u"Leben", u"Traum", u"Herz",  u"Straße", u"you",   u"me",      u"my",    u"in",    u"of",
     u"the",   u"and",   u"for",   u"away",   u"again", u"forever", u"baby",  u"time",  u"world",
     u"blue",  u"stone", u"light", u"über",   u"ohne",  u"dich"});
constexpr auto kFormats =
    std::to_array<QStringView>({u"MPEG 1.0 Layer III", u"MPEG 1.0 Layer III", u"MPEG 1.0 Layer III",
                                u"MPEG 2.0 Layer III", u"Windows Media Audio", u"Wave"});
constexpr std::array<quint16, 6> kBitRates = {128, 160, 192, 192, 256, 320};

// splitmix64 (https://prng.di.unimi.it/splitmix64.c): unlike the standard library's distributions the same
// everywhere.
class Random {
 public:
    std::uint64_t Next() {
        std::uint64_t z = state_ += 0x9E3779B97F4A7C15u;
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9u;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBu;
        return z ^ (z >> 31);
    }
    // 0 to limit - 1.
    int Below(int limit) { return static_cast<int>(Next() % static_cast<std::uint64_t>(limit)); }
    template <typename T, std::size_t size>
    const T& Of(const std::array<T, size>& table) {
        return table[Next() % size];
    }

 private:
    std::uint64_t state_ = 2024;
};

QString Capitalised(QString text) {
    if (!text.isEmpty()) text[0] = text[0].toUpper();
    return text;
}

QString Name(Random& random, int syllables) {
    QString name;
    for (int i = 0; i < syllables; ++i)
        name += random.Of(kSyllables);
    return Capitalised(name);
}

QString ArtistName(Random& random) {
    if (random.Below(3) > 0)
        return Name(random, 2 + random.Below(2)) + u' ' + Name(random, 2 + random.Below(2));
    return random.Of(kFirstWords).toString() + u' ' + Name(random, 3);
}

QString Words(Random& random, int count) {
    QString text = Capitalised(random.Of(kTitleWords).toString());
    for (int i = 1; i < count; ++i)
        text += u' ' + random.Of(kTitleWords).toString();
    return text;
}

QString CommentText(Random& random) {
    const int kind = random.Below(10);
    if (kind < 6) return {};
    if (kind < 9) return u"Encoded by "_s + random.Of(kFirstWords).toString();
    return Words(random, 4) + u' ' + QString::number(random.Below(100'000));
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

void AddAlbum(Random& random, const QString& artist, quint8 mainGenre, std::size_t count,
              std::vector<TID3Tag>& songs) {
    const QString album = Words(random, 2 + random.Below(3));
    const QString year = QString::number(1965 + random.Below(58));
    const QString format = random.Of(kFormats).toString();
    const QString folder = u"/home/anna/Musik/"_s + artist + u'/' + album + u'/';
    const int tracks = 10 + random.Below(14);
    for (int track = 1; track <= tracks && songs.size() < count; ++track) {
        TID3Tag song;
        song.Title = Words(random, 2 + random.Below(4));
        song.FileName =
            folder + QString::number(track).rightJustified(2, u'0') + u" - "_s + song.Title + u".mp3"_s;
        song.Artist = artist;
        song.Album = album;
        song.Year = year;
        song.Comment = CommentText(random);
        song.MPEGLayer = format;
        song.Genre = static_cast<quint8>(random.Below(80));
        song.MainGenre = mainGenre;
        song.Track = static_cast<quint8>(track);
        FillNumbers(random, song);
        songs.push_back(std::move(song));
    }
}

}  // namespace

std::vector<TID3Tag> MakeFakeSongs(int count) {
    const auto wanted = static_cast<std::size_t>(count);
    Random random;
    std::vector<TID3Tag> songs;
    songs.reserve(wanted);
    while (songs.size() < wanted) {
        const QString artist = ArtistName(random);
        const auto mainGenre = static_cast<quint8>(random.Below(20));
        const int albums = 1 + random.Below(5);
        for (int i = 0; i < albums; ++i)
            AddAlbum(random, artist, mainGenre, wanted, songs);
    }
    return songs;
}
