#include "HTTPRetrieval/SearchPage.h"

#include "HTTPRetrieval/WebAddress.h"

using namespace Qt::StringLiterals;

namespace {

// The service puts these around the words that were looked for.
constexpr QStringView kMarks[] = {u"\n", u"<span class='match'>", u"</span>"};

bool FitsAddress(char byte) {
    return byte > ' ' && byte < 0x7F && byte != '#';
}

QString Escaped(const QString& query) {
    QByteArray escaped;
    for (const char byte : query.toUtf8()) {
        if (byte == ' ')
            escaped += '+';
        else if (FitsAddress(byte))
            escaped += byte;
        else
            escaped += '%' + QByteArray(1, byte).toHex().toUpper();
    }
    return QString::fromLatin1(escaped);
}

}  // namespace

QString SearchPageUrl(const QString& host, const QString& query) {
    const QString protocol = host.contains(u"://"_s) ? QString() : u"http://"_s;
    return protocol + AddressBase(host) + u"/list/searches.php?searchType=0&searchStr="_s + Escaped(query);
}

std::optional<SearchHit> SearchPage::Next() {
    if (!Pass(u"/list/artistInfo.php") || !Pass(u"\">")) return std::nullopt;
    const auto artist = TextOfLink();
    // Behind "g=" stands the song's number at the service, which nobody needs.
    if (!artist || !Pass(u"/list/song.php") || !Pass(u"g=") || !Pass(u">")) return std::nullopt;
    const auto title = TextOfLink();
    if (!title) return std::nullopt;
    return SearchHit{.Artist = *artist, .Title = *title};
}

// Goes on behind the mark; nothing is left of a page without it.
bool SearchPage::Pass(QStringView mark) {
    const qsizetype found = page_.indexOf(mark, place_);
    place_ = found < 0 ? page_.size() : found + mark.size();
    return found >= 0;
}

std::optional<QString> SearchPage::TextOfLink() const {
    constexpr QStringView kEnd = u"</a>";
    const QStringView near = QStringView(page_).mid(place_, kLongestLink + kEnd.size());
    const qsizetype end = near.indexOf(kEnd);
    if (end < 0) return std::nullopt;
    QString text = near.left(end).toString();
    for (const QStringView mark : kMarks)
        text.remove(mark.toString());
    return text;
}
