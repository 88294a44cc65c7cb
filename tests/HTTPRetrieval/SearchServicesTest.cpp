#include <gtest/gtest.h>

#include <QUrl>

#include "HTTPRetrieval/MusicBrainz.h"
#include "HTTPRetrieval/OnlineSearch.h"
#include "HTTPRetrieval/SearchPage.h"
#include "tests/HTTPRetrieval/LoopbackServer.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

QStringList HitsOf(const HitSource& source) {
    QStringList hits;
    while (const auto hit = source())
        hits << hit->Artist + u'|' + hit->Title;
    return hits;
}

QStringList HitsOnPage(const QString& text) {
    SearchPage page(text);
    return HitsOf([&page] { return page.Next(); });
}

TEST(SearchPageTest, TheQueryIsEscapedAsFarAsAnAddressNeedsIt) {
    const QString path = u"/list/searches.php?searchType=0&searchStr="_s;
    const std::pair<QString, QString> cases[] = {
        {u"a b  c"_s, u"a+b++c"_s},
        {u"Grüße #1\n"_s, u"Gr%C3%BC%C3%9Fe+%231%0A"_s},
        {u"AC/DC & 100% \"live\" <x>+?"_s, u"AC/DC+&+100%+\"live\"+<x>+?"_s},
        {u"\u4f60\x7f"_s, u"%E4%BD%A0%7F"_s},
    };
    for (const auto& [query, escaped] : cases)
        EXPECT_EQ(SearchPageUrl(u"musik.example"_s, query), u"http://musik.example"_s + path + escaped);
    EXPECT_EQ(SearchPageUrl(u" https://musik.example:8080/ "_s, u"x"_s),
              u"https://musik.example:8080"_s + path + u'x');
}

TEST(SearchPageTest, EveryHitIsReadAndAnIncompleteOneEndsIt) {
    const QString artist = u"<a href=\"/list/artistInfo.php?a=1\" class=\"x\">%1</a>"_s;
    const QString song = u"<a href='/list/song.php?g=12'>%1</a>"_s;
    const QString one = artist.arg(u"Die <span class='match'>Band</span>"_s) + song.arg(u"Das\n Lied"_s);
    const std::pair<QString, QStringList> cases[] = {
        {{}, {}},
        {u"<p>"_s + one + u"</p>"_s, {u"Die Band|Das Lied"_s}},
        {one + artist.arg(u"B"_s) + song.arg(u"2"_s), {u"Die Band|Das Lied"_s, u"B|2"_s}},
        {one + artist.arg(u"B"_s), {u"Die Band|Das Lied"_s}},
        {song.arg(u"1"_s) + one, {u"Die Band|Das Lied"_s}},
        // Between the two nothing is looked at.
        {artist.arg(u"A"_s) + artist.arg(u"B"_s) + song.arg(u"1"_s), {u"A|1"_s}},
        // A link that is not closed ends with the next one, unless that is too far away.
        {u"/list/artistInfo.php\">A /list/song.php?g=1>T</a>"_s, {u"A /list/song.php?g=1>T|T"_s}},
        {artist.arg(QString(501, u'x')) + song.arg(u"1"_s), {}},
        {u"/list/artistInfo.php\">A</a>/list/song.php?g=1>no end"_s, {}},
        {u"/list/artistInfo.php no quote</a>/list/song.php?g=1>x</a>"_s, {}},
        {u"/list/artistInfo.php\">A</a>/list/song.php?x=1>t</a>"_s, {}},
    };
    for (const auto& [page, hits] : cases)
        EXPECT_EQ(HitsOnPage(page), hits) << page.toStdString();
}

TEST(MusicBrainzTest, AQueryIsWordsOrArtistAndTitle) {
    const auto queryOf = [](const QString& text) {
        const QString url = MusicBrainzUrl(u"https://mb.example/"_s, text);
        EXPECT_TRUE(url.startsWith(u"https://mb.example/ws/2/recording?fmt=json&limit=50&query="_s));
        return QUrl::fromPercentEncoding(url.section(u"query="_s, 1).toLatin1());
    };
    EXPECT_EQ(queryOf(u" Grüße & 100% "_s), u"Grüße \\& 100%"_s);
    EXPECT_EQ(queryOf(u"AC/DC - T.N.T. (live) \"x\""_s),
              u"artist:\"AC\\/DC\" AND recording:\"T.N.T. \\(live\\) \\\"x\\\"\""_s);
    EXPECT_EQ(CoverUrl(u"https://cover.example"_s, u"../x y"_s),
              u"https://cover.example/release/..%2Fx%20y/front-500"_s);
}

TEST(MusicBrainzTest, ARecordingIsAHitForEachOfItsAlbums) {
    const QByteArray json = R"({"count": 2, "recordings": [
        {"title": "Lied", "length": 215499, "first-release-date": "1975-10-31",
         "artist-credit": [{"name": "Die Band", "joinphrase": " & "}, {"name": "Er"}],
         "releases": [
            {"id": "r1", "title": "Album", "date": "1976", "media": [{"track": [{"number": "7"}]}]},
            {"id": "r2", "title": "Album", "date": "1976-03", "media": [{"track": [{"number": "7"}]}]},
            {"id": "r3", "title": "Platte", "media": [{"track": [{"number": "A2"}], "track-offset": 1}]}]},
        {"title": "Allein", "length": null, "artist-credit": "wrong"},
        {"length": 1}, 5]})";
    const std::vector<SearchHit> expected = {
        {u"Die Band & Er"_s, u"Lied"_s, u"Album"_s, u"1976"_s, 7, 215, u"r1"_s},
        {u"Die Band & Er"_s, u"Lied"_s, u"Platte"_s, u"1975"_s, 2, 215, u"r3"_s},
        {.Title = u"Allein"_s},
    };
    EXPECT_EQ(ReadMusicBrainz(json), expected);
    EXPECT_EQ(ReadMusicBrainz(R"({"recordings": []})"), std::vector<SearchHit>());
    for (const QByteArray& broken : {QByteArray(), QByteArray("<html>"), QByteArray(R"({"error": "no"})")})
        EXPECT_EQ(ReadMusicBrainz(broken), std::nullopt) << broken.toStdString();
}

TEST(OnlineSearchTest, MusicBrainzIsAskedOnceASecondAndThePageServiceAtOnce) {
    HandClock clock;
    QByteArrayList seen;
    LoopbackServer server([&](QTcpSocket& socket, const QByteArray& request) {
        seen << request;
        SendAnswer(socket, request.startsWith("GET /ws/2/recording?")
                               ? QByteArray(R"({"recordings": [{"title": "T"}]})")
                               : "/list/artistInfo.php\">A</a>/list/song.php?g=>T</a>");
    });
    OnlineServices services{
        .Service = ssMusicBrainz, .Host = server.Host(), .MusicBrainz = server.URL({}), .CoverArt = {}};
    OnlineSearch search;
    QStringList found;
    search.OnFound = [&](const HitSource& hits) { found = HitsOf(hits); };
    const auto finds = [&] {
        found.clear();
        return Comes([&] { return !found.isEmpty(); }) ? found : QStringList();
    };

    search.Ask(services, u"x"_s);
    EXPECT_EQ(finds(), QStringList{u"|T"_s});
    EXPECT_TRUE(seen.last().contains("User-Agent: Tunestead/")) << seen.last().toStdString();

    clock.Milliseconds += kMusicBrainzPause / 2;
    search.Ask(services, u"y"_s);
    QCoreApplication::processEvents();
    EXPECT_EQ(seen.size(), 1);
    EXPECT_TRUE(search.IsRunning());
    clock.Milliseconds += kMusicBrainzPause / 2;
    search.Ask(services, u"z"_s);
    EXPECT_EQ(finds(), QStringList{u"|T"_s});
    EXPECT_TRUE(seen.size() == 2 && seen.last().contains("query=z "));

    services.Service = ssPage;
    search.Ask(services, u"a b"_s);
    EXPECT_EQ(finds(), QStringList{u"A|T"_s});
    EXPECT_TRUE(seen.last().startsWith("GET /list/searches.php?searchType=0&searchStr=a+b HTTP"));
    EXPECT_TRUE(seen.last().contains("User-Agent: Tunestead INetSearch\r\n"));
}

}  // namespace
