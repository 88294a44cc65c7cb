#include "ReadMPEGHeader/id3v2/ID3v2Frames.h"

#include <algorithm>
#include <array>
#include <limits>

#include "ReadMPEGHeader/FileTypeText.h"
#include "ReadMPEGHeader/id3v2/GenreText.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameFields.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameTexts.h"

using namespace Qt::StringLiterals;

namespace {

// The number that `text` is, 0 when it is none or beyond what Field can hold.
template <typename Field>
Field NumberOrZero(QStringView text, qint64 divisor = 1) {
    const qint64 number = text.trimmed().toLongLong() / divisor;
    return number < 0 || number > std::numeric_limits<Field>::max() ? Field{0} : static_cast<Field>(number);
}

QString FirstValue(FrameBody& body) {
    body.ReadEncoding();
    return body.Values().value(0);
}

bool IsYear(QStringView text) {
    return text.size() == 4 && std::ranges::all_of(text, [](QChar c) { return c >= u'0' && c <= u'9'; });
}

// The classic rules write a count from the other end. Of the two ways to read four bytes at most one gives a
// number up to this, which a song an hour for seven years does not reach.
constexpr quint32 kMostPlays = 0xFFFF;

// Foreign programs keep binary data in private frames and addresses; a comment takes only what can be read.
bool IsReadable(const QString& text) {
    return std::ranges::all_of(text.toUcs4(), [](uint code) {
        return QChar::isPrint(code) || code == u'\n' || code == u'\r' || code == u'\t';
    });
}

}  // namespace

struct ID3v2Frames::EffectRow {
    std::string_view Id;
    Effect Apply;
};

ID3v2Frames::Effect ID3v2Frames::EffectOf(std::string_view id) {
    static constexpr std::array<EffectRow, 14> kEffects = {{
        {"TIT2", &ID3v2Frames::TakeTitle},
        {"TPE1", &ID3v2Frames::TakeArtist},
        {"TALB", &ID3v2Frames::TakeAlbum},
        {"TYER", &ID3v2Frames::TakeYear},
        {"TDRC", &ID3v2Frames::TakeRecordingTime},
        {"TLEN", &ID3v2Frames::TakeLength},
        {"TRCK", &ID3v2Frames::TakeTrack},
        {"TCON", &ID3v2Frames::TakeGenre},
        {"COMM", &ID3v2Frames::TakeComment},
        {"TFLT", &ID3v2Frames::TakeFileType},
        {"WXXX", &ID3v2Frames::TakeAddress},
        {"PRIV", &ID3v2Frames::TakePrivate},
        {"PCNT", &ID3v2Frames::TakePlayCount},
        {"XRUK", &ID3v2Frames::TakeXruk},
    }};
    const auto row = std::ranges::find(kEffects, id, &EffectRow::Id);
    return row == kEffects.end() ? nullptr : row->Apply;
}

bool ID3v2Frames::NeedsBody(std::string_view id) const {
    return listener_ || FillsRecord(id);
}

void ID3v2Frames::Take(std::string_view id, const QString& shownId, ByteSpan body) {
    if (const Effect effect = EffectOf(id)) {
        FrameBody fields(body, rules_);
        (this->*effect)(fields);
    }
    if (listener_) listener_(DescribeFrame(id, shownId, FrameBody(body, rules_)));
}

void ID3v2Frames::TakeUnreadable(const QString& shownId, std::int64_t size, const QString& reason) {
    if (listener_) listener_({shownId, reason, size});
}

void ID3v2Frames::Finish() {
    tag_.Comment = comment_.Join();
    if (!recordingYear_.isEmpty()) tag_.Year = recordingYear_;
    if (hasOwnFrame_ && turnedPlayCount_ && tag_.PlayCount > kMostPlays && *turnedPlayCount_ <= kMostPlays)
        tag_.PlayCount = *turnedPlayCount_;
}

void ID3v2Frames::TakeTitle(FrameBody& body) {
    tag_.Title = FirstValue(body);
}

void ID3v2Frames::TakeArtist(FrameBody& body) {
    body.ReadEncoding();
    tag_.Artist = body.Values().join(u", ");
}

void ID3v2Frames::TakeAlbum(FrameBody& body) {
    tag_.Album = FirstValue(body);
}

void ID3v2Frames::TakeYear(FrameBody& body) {
    tag_.Year = FirstValue(body);
    // Some taggers put a whole date here, which only the later standard allows.
    const bool isDate = tag_.Year.size() > 4 && IsYear(QStringView(tag_.Year).left(4));
    if (rules_ != TextRules::Classic && isDate) tag_.Year.truncate(4);
}

void ID3v2Frames::TakeRecordingTime(FrameBody& body) {
    if (rules_ == TextRules::Classic) return;
    const QString year = FirstValue(body).left(4);
    if (IsYear(year)) recordingYear_ = year;
}

void ID3v2Frames::TakeLength(FrameBody& body) {
    tag_.Length = NumberOrZero<quint16>(FirstValue(body), 1000);
}

void ID3v2Frames::TakeTrack(FrameBody& body) {
    const QString text = FirstValue(body);
    tag_.Track = NumberOrZero<quint8>(QStringView(text).left(text.indexOf(u'/')));
}

void ID3v2Frames::TakeGenre(FrameBody& body) {
    body.ReadEncoding();
    const GenreText genre = ParseGenre(rules_, body.Values());
    if (genre.Genre) tag_.Genre = *genre.Genre;
    if (genre.Remix) tag_.Remix = true;
    tag_.MainGenre = genre.MainGenre;
}

void ID3v2Frames::TakeComment(FrameBody& body) {
    const CommentFrame frame = ReadCommentFrame(body);
    if (!IsBetterComment(frame.Description, frame.Text)) return;
    comment_.Comment = frame.Text;
    ++foldedFrames_;
}

// The classic rules take every comment, so that the last one stays. Otherwise the first without a description
// is the user's own; failing that, the first that is not one of a player's technical notes.
bool ID3v2Frames::IsBetterComment(const QString& description, const QString& text) {
    if (rules_ == TextRules::Classic) return true;
    if (text.isEmpty() || hasPlainComment_ || description.startsWith(u"iTun")) return false;
    hasPlainComment_ = description.isEmpty();
    return hasPlainComment_ || comment_.Comment.isEmpty();
}

void ID3v2Frames::TakeFileType(FrameBody& body) {
    tag_.MPEGLayer = FormatFromFileType(FirstValue(body));
}

void ID3v2Frames::TakeAddress(FrameBody& body) {
    const auto address = ReadAddressFrame(body);
    if (address.Url.isEmpty() || !IsReadable(address.Url) || !IsReadable(address.Description)) return;
    comment_.Addresses += address;
    ++foldedFrames_;
}

// This program's private frame is a text and nothing else. Data behind the text make the frame another
// program's, which is none of the user's words.
void ID3v2Frames::TakePrivate(FrameBody& body) {
    const QString text = body.Latin();
    if (body.Remaining() > 0 || !IsReadable(text)) return;
    if (!comment_.Private.isEmpty()) comment_.Private += u'\n';
    comment_.Private += text;
    ++foldedFrames_;
}

void ID3v2Frames::TakePlayCount(FrameBody& body) {
    FrameBody turned = body;
    const bool canBeTurned = rules_ != TextRules::Classic && body.Remaining() == sizeof(quint32);
    turnedPlayCount_ = canBeTurned ? std::optional(turned.TurnedNumber()) : std::nullopt;
    tag_.PlayCount = body.Counter();
}

void ID3v2Frames::TakeXruk(FrameBody& body) {
    const auto frame = XrukFrame::Parse(body.Rest());
    if (frame) hasOwnFrame_ = true;
    if (xruk_ && frame) *xruk_ = frame;
}
