#include <QDir>
#include <QFileInfo>
#include <algorithm>
#include <limits>
#include <utility>

#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/ListBuilder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/ListRules.h"
#include "MusicManagment/playlist/PlayListFiles.h"
#include "MusicManagment/playlist/PlsSection.h"

// Lists as the world writes them.

using namespace Qt::StringLiterals;

namespace {

// --- What a list is ---

bool IsLineEnd(std::uint8_t byte) {
    return byte == '\r' || byte == '\n';
}

constexpr std::size_t kMagicSize = 9;

// Behind the magic comes a version word; in a text that begins with the same letters others follow. A file
// that is named so is no text, whatever version it claims.
bool IsNative(ByteSpan file, PlayListFormat named) {
    if (!StartsWith(file, "RUKPLYLST")) return false;
    if (named == PlayListFormat::Native || file.size() == kMagicSize) return true;
    return file[kMagicSize] < 0x20 && !IsLineEnd(file[kMagicSize]);
}

QString FirstLine(ByteSpan text) {
    constexpr std::size_t kEnough = 80;  // bytes
    LineReader lines(text.first(std::min(text.size(), kEnough)));
    const auto line = lines.Next();
    return line ? CodePage::FromSystem(*line).trimmed() : QString();
}

PlayListFormat FormatOf(const QString& fileName) {
    const bool isUtf8 = QFileInfo(fileName).suffix().compare("m3u8"_L1, Qt::CaseInsensitive) == 0;
    return isUtf8 ? PlayListFormat::M3u8 : FormatOfName(fileName);
}

// By its contents where they tell, and else by its name: M3U lists need no head, and all that they share with
// plain ones are the names.
RecognizedList Recognize(ByteSpan file, const QString& fileName) {
    const PlayListFormat named = FormatOf(fileName);
    if (IsNative(file, named)) return {PlayListFormat::Native, file.subspan(kMagicSize)};
    const ByteSpan text = StartsWith(file, "\xEF\xBB\xBF") ? file.subspan(3) : file;
    const QString line = FirstLine(text);
    const bool isNamedM3u = named == PlayListFormat::M3u || named == PlayListFormat::M3u8;
    if (line.startsWith("[playlist]"_L1, Qt::CaseInsensitive)) return {PlayListFormat::Pls, text};
    if (isNamedM3u || line.startsWith("#EXT"_L1, Qt::CaseInsensitive)) return {PlayListFormat::M3u, text};
    return {PlayListFormat::Plain, text};
}

// --- What it says of its songs ---

// What was noted of a song by who wrote the list.
struct Remark {
    QString Text{};   // "artist - title", or a title
    int Seconds = 0;  // 0 unknown

    bool IsEmpty() const { return Text.isEmpty() && Seconds == 0; }
};

int SecondsFrom(QStringView text) {
    const double seconds = text.trimmed().toDouble();  // -1 for streams, 0 for what is no number
    return static_cast<int>(std::clamp(seconds, 0.0, double{std::numeric_limits<quint16>::max()}));
}

// "seconds attributes,text"; an attribute can have commas in quotes.
Remark RemarkFrom(const QString& text) {
    bool quoted = false;
    qsizetype comma = 0;
    for (; comma < text.size() && (quoted || text[comma] != u','); ++comma)
        if (text[comma] == u'"') quoted = !quoted;
    const QStringView head = QStringView(text).first(comma).trimmed();
    const qsizetype blank = head.indexOf(u' ');
    return {.Text = text.sliced(std::min(comma + 1, text.size())).trimmed(),
            .Seconds = SecondsFrom(blank < 0 ? head : head.first(blank))};
}

TID3Tag RecordFrom(const Remark& remark, const QString& name) {
    TID3Tag record;
    record.FileName = name;
    record.Length = static_cast<quint16>(remark.Seconds);
    const qsizetype dash = remark.Text.indexOf(" - "_L1);
    record.Artist = dash > 0 ? remark.Text.first(dash) : QString();
    record.Title = dash > 0 ? remark.Text.sliced(dash + 3) : remark.Text;
    return record;
}

class Names {
 public:
    explicit Names(const ListOrigin& origin)
        : origin_(origin), folder_(QFileInfo(origin.FileName).absolutePath()) {}

    PlayListEntry Entry(const QString& text, const Remark& remark) const {
        PlayListEntry entry{.Name = NameFromList(Separated(text), folder_)};
        const TID3Tag* known = origin_.Known ? origin_.Known(entry.Name) : nullptr;
        if (known != nullptr)
            entry.Record = *known;
        else if (!remark.IsEmpty())
            entry.Record = RecordFrom(remark, entry.Name);
        return entry;
    }

 private:
    // A relative name that was written on another system.
    static QString Separated(const QString& text) {
        const bool isRelative = text.size() > 1 && text[0] != u'\\' && text[0] != u':' && text[1] != u':';
        const bool isForeign = isRelative && text.contains(u'\\') && !text.contains(u'/');
        return isForeign ? QString(text).replace(u'\\', u'/') : text;
    }

    const ListOrigin& origin_;
    QString folder_;
};

// --- The formats ---

bool IsBlank(ByteSpan line) {
    return std::ranges::all_of(line, [](std::uint8_t byte) { return byte == ' ' || byte == '\t'; });
}

std::vector<PlayListEntry> ParseM3u(ByteSpan contents, const Names& names) {
    ListBuilder list;
    Remark remark;
    LineReader lines(contents);
    while (const auto line = lines.Next()) {
        if (IsBlank(*line)) continue;
        if (StartsWith(*line, kM3uRemark))
            remark = RemarkFrom(CodePage::FromSystem(line->subspan(kM3uRemark.size())));
        else if (!StartsWith(*line, "#"))
            list.Add(names.Entry(CodePage::FromSystem(*line), std::exchange(remark, {})));
    }
    return list.Take();
}

// How many there are is seen.
std::vector<PlayListEntry> ParsePls(ByteSpan contents, const Names& names) {
    ListBuilder list;
    for (const auto& [number, item] : ReadPlsSection(contents).Items)
        if (number >= 1 && !item.File.isEmpty())
            list.Add(names.Entry(item.File, {.Text = item.Title, .Seconds = SecondsFrom(item.Length)}));
    return list.Take();
}

std::vector<PlayListEntry> ParsePlain(ByteSpan contents, const Names& names) {
    ListBuilder list;
    LineReader lines(contents);
    while (const auto line = lines.Next())
        if (!IsBlank(*line)) list.Add(names.Entry(CodePage::FromSystem(*line), {}));
    return list.Take();
}

std::vector<PlayListEntry> Parse(ByteSpan file, const ListOrigin& origin) {
    const auto& [format, contents] = Recognize(file, origin.FileName);
    const Names names(origin);
    switch (format) {
        case PlayListFormat::Native:
            return ParseNativeList(contents);
        case PlayListFormat::M3u:
        case PlayListFormat::M3u8:
            return ParseM3u(contents, names);
        case PlayListFormat::Pls:
            return ParsePls(contents, names);
        case PlayListFormat::Plain:
            break;
    }
    return ParsePlain(contents, names);
}

bool IsListName(const QString& fileName) {
    return IsPlayListName(fileName) || FormatOf(fileName) == PlayListFormat::M3u8;
}

QString Filter() {
    return kClassicLists.DialogFilter().replace("*.m3u;"_L1, "*.m3u;*.m3u8;"_L1);
}

}  // namespace

const ListRules kModernLists = {Parse, FormatOf, IsListName, Filter};
