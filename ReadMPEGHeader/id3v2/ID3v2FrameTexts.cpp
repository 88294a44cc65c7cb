#include "ReadMPEGHeader/id3v2/ID3v2FrameTexts.h"

#include <QStringList>
#include <algorithm>
#include <array>

#include "ReadMPEGHeader/FileTypeText.h"
#include "ReadMPEGHeader/id3v2/GenreText.h"
#include "ReadMPEGHeader/id3v2/ID3v2DataTexts.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameFields.h"
#include "ReadMPEGHeader/id3v2/MediaType.h"

using namespace Qt::StringLiterals;

namespace {

QString AllValues(FrameBody& body) {
    body.ReadEncoding();
    return body.Values().join(u", ");
}

// "(deu) Description: text", each part where there is one.
QString WithLanguage(const QString& language, const QString& description, const QString& text) {
    QString result;
    if (!language.isEmpty()) result += u"(%1) "_s.arg(language);
    if (!description.isEmpty()) result += description + u": "_s;
    return result + text;
}

FrameText PlainText(FrameBody& body) {
    return {AllValues(body)};
}

FrameText NumberText(FrameBody& body) {
    const QString text = AllValues(body);
    return {text, QStringView(text).left(text.indexOf(u'/')).trimmed().toLongLong()};
}

FrameText Genre(FrameBody& body) {
    body.ReadEncoding();
    const QStringList values = body.Values();
    const GenreText genre = ParseGenre(body.Rules(), values);
    return {values.join(u", "), genre.Genre};
}

FrameText FileType(FrameBody& body) {
    return {FormatFromFileType(AllValues(body))};
}

FrameText MediaType(FrameBody& body) {
    return {MediaTypeText(AllValues(body))};
}

FrameText DescribedText(FrameBody& body) {
    body.ReadEncoding();
    const QString description = body.TextHasEnd() ? body.Text() : QString();
    return {WithLanguage({}, description, body.Values().join(u", "))};
}

FrameText Comment(FrameBody& body) {
    const CommentFrame frame = ReadCommentFrame(body);
    return {WithLanguage(frame.Language, frame.Description, frame.Text)};
}

FrameText TermsOfUse(FrameBody& body) {
    body.ReadEncoding();
    const QString language = body.Language();
    return {WithLanguage(language, {}, body.Text())};
}

FrameText SynchronisedText(FrameBody& body) {
    body.ReadEncoding();
    const QString language = body.Language();
    body.Skip(2);  // unit of the times, kind of the text
    const QString description = body.Text();
    QString text;
    while (body.Remaining() > 0) {
        const QString piece = body.Text();
        body.Skip(std::min<std::size_t>(4, body.Remaining()));  // its time
        if (!text.isEmpty() && !piece.startsWith(u'\n')) text += u' ';
        text += piece;
    }
    return {WithLanguage(language, description, text)};
}

FrameText Address(FrameBody& body) {
    return {AddressText(ReadAddressFrame(body))};
}

FrameText Private(FrameBody& body) {
    return {PrivateText(body.Latin())};
}

struct DescriptionRow {
    std::string_view Id;
    FrameText (*Describe)(FrameBody&);
};

constexpr std::array<DescriptionRow, 36> kDescriptions = {{
    {"TIT2", PlainText},        {"TPE1", PlainText},        {"TPE2", PlainText},
    {"TALB", PlainText},        {"TYER", PlainText},        {"TDRC", PlainText},
    {"TLEN", NumberText},       {"TRCK", NumberText},       {"TCON", Genre},
    {"TFLT", FileType},         {"TMED", MediaType},        {"TXXX", DescribedText},
    {"COMM", Comment},          {"USLT", Comment},          {"USER", TermsOfUse},
    {"SYLT", SynchronisedText}, {"WXXX", Address},          {"PRIV", Private},
    {"PCNT", PlayCounterText},  {"UFID", BinarySizeText},   {"MCDI", BinarySizeText},
    {"ETCO", EventTimesText},   {"MLLT", StoredSizeText},   {"SYTC", TempoCodesText},
    {"RVAD", VolumeText},       {"EQUA", EqualisationText}, {"RVRB", ReverbText},
    {"APIC", PictureText},      {"GEOB", ObjectText},       {"POPM", PopularityText},
    {"RBUF", BufferText},       {"AENC", EncryptionText},   {"LINK", LinkText},
    {"POSS", PositionText},     {"OWNE", OwnershipText},    {"COMR", CommercialText},
}};

// A frame without a row: its size, and what it says if it is one of the many texts and addresses.
FrameText UnknownFrame(std::string_view id, FrameBody& body) {
    const auto size = static_cast<qint64>(body.Size());
    if (id.starts_with('T')) return {AllValues(body), size};
    if (id.starts_with('W')) return {body.Latin(), size};
    return {u"%1 Byte"_s.arg(size), size};
}

}  // namespace

FrameReport DescribeFrame(std::string_view id, const QString& shownId, FrameBody body) {
    // The picture frame of ID3v2.2 is the only one whose layout its successor changed.
    const bool isOldPicture = shownId == u"PIC";
    const auto row = std::ranges::find(kDescriptions, id, &DescriptionRow::Id);
    FrameText result = isOldPicture                 ? OldPictureText(body)
                       : row == kDescriptions.end() ? UnknownFrame(id, body)
                                                    : row->Describe(body);
    return {shownId, std::move(result.Text), result.Number};
}
