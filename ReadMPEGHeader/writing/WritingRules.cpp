#include "ReadMPEGHeader/writing/WritingRules.h"

#include <algorithm>
#include <iterator>
#include <limits>
#include <vector>

#include "CommonRUKTools/CodePage.h"
#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/id3v2/GenreText.h"
#include "ReadMPEGHeader/writing/RecordFrames.h"
#include "ReadMPEGHeader/writing/TagReading.h"

using namespace Qt::StringLiterals;

namespace {

bool IsAscii(QChar c) {
    return c < u'\x80';
}

QString RemixMark(const TID3Tag& record) {
    return record.Remix ? u" (RX)"_s : QString();
}

QString GenreReference(const TID3Tag& record) {
    return u"(%1)"_s.arg(record.Genre);
}

class Classic : public WritingRules {
 public:
    TextRules Reading() const override { return TextRules::Classic; }

    bool IsSingleByte(const QString& text) const override {
        return std::ranges::all_of(text, IsAscii) || CodePage::FitsLegacy(text);
    }

    std::optional<QString> GenreText(const TID3Tag& record) const override {
        return GenreReference(record) + MainGenreName(record.MainGenre) + RemixMark(record);
    }

    std::optional<QString> TrackText(int track, int total) const override {
        return NumberedTrack(track, total);
    }

    // Least significant byte first, though the readers take it from the other end.
    void WritePlayCount(ByteWriter& body, quint32 count) const override { body.U32Le(count); }

    CommentFields SplitComment(const QString& comment) const override {
        CommentFields fields = CommentFields::Split(comment);
        QString& text = fields.Private;
        text = text.replace(u"\r\n"_s, u" "_s).replace(u'\n', u' ').replace(u'\r', u' ').trimmed();
        return fields;
    }
};

// Other programs take encoding 0 for ISO 8859-1, and our own readers take it for UTF-8 where it can be that.
bool MeansTheSameToEverybody(const QString& text) {
    const auto isLatin = [](QChar c) { return c < u'\x80' || (c >= u'\xA0' && c <= u'\xFF'); };
    if (!std::ranges::all_of(text, isLatin)) return false;
    const QByteArray bytes = text.toLatin1();
    return CodePage::FromLegacy(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())})) == text;
}

class Modern : public WritingRules {
 public:
    TextRules Reading() const override { return TextRules::Id3v23; }

    bool IsSingleByte(const QString& text) const override {
        return std::ranges::all_of(text, IsAscii) ||
               (MeansTheSameToEverybody(text) && CodePage::ToLegacy(text) == text.toLatin1());
    }

    std::optional<QString> GenreText(const TID3Tag& record) const override {
        const QString name = MainGenreName(record.MainGenre);
        const bool hasName = name != MainGenreName(0);
        if (record.Genre == kNoGenre && !hasName)
            return record.Remix ? std::optional(RemixMark(record).trimmed()) : std::nullopt;
        const QString text = GenreReference(record) + (hasName ? name : QString()) + RemixMark(record);
        // Behind a number without a row in the table the name of a main genre is taken for the genre.
        if (ParseGenre(Reading(), {text}).Genre == record.Genre) return text;
        return GenreReference(record) + RemixMark(record);
    }

    std::optional<QString> TrackText(int track, int total) const override {
        if (track == 0 && total <= 0) return std::nullopt;
        return NumberedTrack(track, total);
    }

    // Four bytes, most significant first; five for a number whose four bytes would be taken for a count of
    // the classic rules.
    void WritePlayCount(ByteWriter& body, quint32 count) const override {
        if (count > std::numeric_limits<quint16>::max() && (count & 0xFFFF) == 0) body.U8(0);
        body.U32Be(count);
    }

    // A comment that would not read back as it stands is not taken apart.
    CommentFields SplitComment(const QString& comment) const override {
        TID3Tag record;
        const RecordContents contents{.Record = record, .Comment = CommentFields::Split(comment)};
        std::vector<TagFrame> frames;
        for (const TagField field : {TagField::Comment, TagField::Private, TagField::Address})
            std::ranges::move(FramesOfField(field, contents, *this), std::back_inserter(frames));
        if (ReadTagFrames(frames, Reading()).Record.Comment == comment) return contents.Comment;
        CommentFields whole;
        whole.Comment = comment;
        return whole;
    }
};

}  // namespace

const WritingRules& WritingRulesOf(ReadProfile profile) {
    static const Classic classic;
    static const Modern modern;
    if (profile == ReadProfile::Modern) return modern;
    return classic;
}

QString NumberedTrack(int track, int total) {
    return total > 0 && track <= total ? u"%1/%2"_s.arg(track).arg(total) : QString::number(track);
}
