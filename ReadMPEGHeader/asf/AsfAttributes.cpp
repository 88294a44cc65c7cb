#include "ReadMPEGHeader/asf/AsfAttributes.h"

#include <algorithm>
#include <array>

#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

// No attribute that is looked for needs more; pictures and song texts do.
constexpr std::uint32_t kLongestValue = 65'535;
constexpr std::uint32_t kLongestName = 128;

enum class ValueType { Unicode = 0, Bytes = 1, Bool = 2, Dword = 3, Qword = 4, Word = 5 };

// The value of one attribute in both of its readings.
struct Value {
    QString text;
    std::optional<quint64> number;
};

QString LeadingDigits(const QString& text) {
    const auto isDigit = [](QChar c) { return c >= u'0' && c <= u'9'; };
    const auto end = std::find_if_not(text.begin(), text.end(), isDigit);
    return text.left(end - text.begin());
}

// "3" and "3/12" are 3.
std::optional<quint64> LeadingNumber(const QString& text) {
    bool ok = false;
    const auto number = LeadingDigits(text.trimmed()).toULongLong(&ok);
    return ok ? std::optional<quint64>(number) : std::nullopt;
}

Value ReadValue(AsfCursor& body, quint16 type, std::uint32_t size) {
    const auto kind = static_cast<ValueType>(type);
    if (kind == ValueType::Unicode) {
        const QString text = body.Text(size);
        return {text, LeadingNumber(text)};
    }
    const bool isNumber = kind >= ValueType::Bool && kind <= ValueType::Word;
    if (!isNumber || size == 0 || size > 8) {
        body.Skip(size);
        return {};
    }
    // The declared size counts, not the type's: truth values take two or four bytes.
    quint64 number = 0;
    const auto bytes = body.Bytes(size);
    for (std::size_t i = bytes.size(); i > 0; --i)
        number = (number << 8) | bytes[i - 1];
    return {QString::number(number), number};
}

void TakeText(QString& field, const Value& value) {
    if (field.isEmpty()) field = value.text;
}

// "2004-05-06" is the year 2004; a number 0 is none.
void TakeYear(QString& year, const Value& value) {
    if (!year.isEmpty() || value.number == quint64{0}) return;
    const QString digits = LeadingDigits(value.text);
    year = digits.size() == 4 ? digits : value.text;
}

void TakeTrack(std::optional<quint8>& track, std::optional<quint64> number) {
    if (!track && number && *number >= 1 && *number <= 255) track = static_cast<quint8>(*number);
}

bool IsGenreNumber(quint64 number) {
    return std::ranges::any_of(GenreTable(), [number](const GenreRow& row) { return row.Number == number; });
}

// A name, "(17)", or the bare number.
std::optional<quint8> GenreOf(const Value& value) {
    const QString text = value.text.trimmed();
    const auto number = LeadingNumber(text.startsWith(u'(') ? text.mid(1) : text);
    if (number && IsGenreNumber(*number)) return static_cast<quint8>(*number);
    return GenreByName(text);
}

void TakeGenre(std::optional<quint8>& genre, const Value& value) {
    if (!genre) genre = GenreOf(value);
}

struct Attribute {
    QStringView name;
    void (*take)(AsfAttributes& attributes, const Value& value);
};

// Names without "WM/" repeat the content description; some writers use only them.
constexpr std::array<Attribute, 10> kAttributes = {{
    {u"Title", [](AsfAttributes& a, const Value& value) { TakeText(a.Title, value); }},
    {u"Author", [](AsfAttributes& a, const Value& value) { TakeText(a.Artist, value); }},
    {u"Description", [](AsfAttributes& a, const Value& value) { TakeText(a.Comment, value); }},
    {u"WM/AlbumTitle", [](AsfAttributes& a, const Value& value) { TakeText(a.Album, value); }},
    {u"WM/Year", [](AsfAttributes& a, const Value& value) { TakeYear(a.Year, value); }},
    {u"Date", [](AsfAttributes& a, const Value& value) { TakeYear(a.Year, value); }},
    {u"WM/Genre", [](AsfAttributes& a, const Value& value) { TakeGenre(a.GenreOfName, value); }},
    {u"WM/GenreID", [](AsfAttributes& a, const Value& value) { TakeGenre(a.GenreOfId, value); }},
    {u"WM/TrackNumber", [](AsfAttributes& a, const Value& value) { TakeTrack(a.TrackNumber, value.number); }},
    {u"WM/Track",
     [](AsfAttributes& a, const Value& value) {
         if (value.number && *value.number < 255) TakeTrack(a.TrackAfterIndex, *value.number + 1);
     }},
}};

const Attribute* FindAttribute(const QString& name) {
    const auto found = std::ranges::find_if(kAttributes, [&name](const Attribute& attribute) {
        return attribute.name.compare(name, Qt::CaseInsensitive) == 0;
    });
    return found == kAttributes.end() ? nullptr : &*found;
}

// A name that is too long to be one of ours is not read.
QString ReadName(AsfCursor& body, std::uint32_t size) {
    if (size <= kLongestName) return body.Text(size);
    body.Skip(size);
    return {};
}

void TakeValue(AsfCursor& body, const QString& name, quint16 type, std::uint32_t size,
               AsfAttributes& attributes) {
    const Attribute* attribute = FindAttribute(name);
    if (attribute == nullptr || size > kLongestValue) return body.Skip(size);
    const Value value = ReadValue(body, type, size);
    if (!value.text.isEmpty()) attribute->take(attributes, value);
}

void TakeIfEmpty(QString& field, const QString& text) {
    if (field.isEmpty()) field = text;
}

}  // namespace

bool ReadExtendedContent(AsfCursor& body, AsfAttributes& attributes) {
    for (int count = body.U16(); count > 0 && !body.Failed(); --count) {
        const QString name = ReadName(body, body.U16());
        const quint16 type = body.U16();
        TakeValue(body, name, type, body.U16(), attributes);
    }
    return !body.Failed();
}

bool ReadMetadata(AsfCursor& body, AsfAttributes& attributes) {
    for (int count = body.U16(); count > 0 && !body.Failed(); --count) {
        body.Skip(4);  // language and stream
        const auto nameSize = body.U16();
        const quint16 type = body.U16();
        const auto valueSize = body.U32();
        const QString name = ReadName(body, nameSize);
        TakeValue(body, name, type, valueSize, attributes);
    }
    return !body.Failed();
}

void AsfAttributes::Complete(TASFInfo& info) const {
    TakeIfEmpty(info.Title, Title);
    TakeIfEmpty(info.Artist, Artist);
    TakeIfEmpty(info.Comment, Comment);
    info.Album = Album;
    info.Year = Year;
    info.Genre = GenreOfName ? *GenreOfName : GenreOfId.value_or(kNoGenre);
    info.Track = TrackNumber ? *TrackNumber : TrackAfterIndex.value_or(0);
}
