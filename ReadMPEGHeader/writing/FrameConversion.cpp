#include "ReadMPEGHeader/writing/FrameConversion.h"

#include <QStringList>
#include <algorithm>
#include <array>
#include <utility>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameCoding.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameIds.h"
#include "ReadMPEGHeader/writing/FrameTextWriter.h"
#include "ReadMPEGHeader/writing/FrameTexts.h"

using namespace Qt::StringLiterals;

namespace {

// Flags of a frame header of version 2.3.
constexpr std::uint8_t kCompressed = 0x80;
constexpr std::uint8_t kEncrypted = 0x40;
constexpr std::uint8_t kGrouped = 0x20;

void SetId(TagFrame& frame, std::string_view id) {
    frame.Id = id;
    frame.ShownId = QString::fromStdString(frame.Id);
}

TagFrame TextFrame(std::string_view id, const QStringList& texts, const WritingRules& rules) {
    const FrameTextWriter writer(rules, texts);
    ByteWriter body;
    body.U8(writer.Encoding());
    for (qsizetype i = 0; i < texts.size(); ++i) {
        if (i > 0) writer.Terminator(body);
        writer.Text(body, texts[i]);
    }
    TagFrame frame;
    SetId(frame, id);
    frame.Stored = body.Bytes();
    return frame;
}

// "PIC" has three letters for the kind of image where "APIC" has a media type.
void ConvertPicture(TagFrame& frame) {
    ByteReader reader(frame.Stored);
    const std::uint8_t encoding = reader.U8();
    const std::string_view format = AsText(reader.Take(3));
    if (reader.Failed()) throw EStreamError(u"ein Bild darin ist beschädigt"_s);
    std::string type = "image/";
    if (format == "-->")
        type = format;
    else if (format == "JPG")
        type += "jpeg";
    else
        for (const char c : format)
            type += c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    ByteWriter body;
    body.U8(encoding);
    body.Raw(type);
    body.U8(0);
    body.Raw(reader.Rest());
    frame.Stored = body.Bytes();
}

// The id of the frame that "LNK" leads to has become longer, too.
void ConvertLink(TagFrame& frame) {
    ByteReader reader(frame.Stored);
    const std::string_view id = AsText(reader.Take(3));
    if (reader.Failed() || !IsFrameId(id)) return;
    ByteWriter body;
    body.Block(SuccessorOfFrameId(id), 4);
    body.Raw(reader.Rest());
    frame.Stored = body.Bytes();
}

// Frames with ids of three letters.
void ConvertOld(TagFrame& frame) {
    if (frame.ShownId == u"CRM") throw EStreamError(u"ein Teil davon ist verschlüsselt"_s);
    if (frame.ShownId == u"PIC") ConvertPicture(frame);
    if (frame.ShownId == u"LNK") ConvertLink(frame);
    SetId(frame, frame.Id);
}

// Version 2.4 has the same bytes before the data, in another order and behind other flags.
void ConvertEncrypted(TagFrame& frame, const FrameCoding& coding) {
    ByteReader reader(frame.Stored);
    const std::uint8_t group = coding.Grouped ? reader.U8() : std::uint8_t{0};
    const std::uint8_t method = reader.U8();
    const std::uint32_t length = coding.HasDataLength ? reader.SynchSafe32() : 0;
    if (reader.Failed() || (coding.Compressed && !coding.HasDataLength))
        throw EStreamError(u"ein verschlüsselter Teil davon ist beschädigt"_s);
    std::vector<std::uint8_t> data(reader.Rest().begin(), reader.Rest().end());
    if (coding.Unsynchronised) Resynchronise(data);
    ByteWriter body;
    if (coding.Compressed) body.U32Be(length);
    body.U8(method);
    if (coding.Grouped) body.U8(group);
    body.Raw(data);
    frame.Stored = body.Bytes();
    frame.FormatFlags = static_cast<std::uint8_t>(kEncrypted | (coding.Compressed ? kCompressed : 0) |
                                                  (coding.Grouped ? kGrouped : 0));
}

void ConvertCoding24(TagFrame& frame) {
    frame.StatusFlags = static_cast<std::uint8_t>((frame.StatusFlags << 1) & 0xE0);
    if (frame.Decoded) {
        frame.Stored = std::move(*frame.Decoded);
        frame.Decoded.reset();
        frame.IsCoded = false;
    }
    const FrameCoding coding = FrameCoding::FromFlags24(frame.FormatFlags);
    frame.FormatFlags = 0;
    if (!frame.IsCoded) return;
    if (!coding.Encrypted) throw EStreamError(u"ein Teil davon ist nicht lesbar"_s);
    ConvertEncrypted(frame, coding);
}

// "2004-05-01T12:30", or the front of it.
struct RecordingTime {
    QString Year;
    QString Date;  // day and month, four digits; empty when one is missing
    QString Time;  // hour and minute, likewise

    static std::optional<RecordingTime> Parse(const QString& text) {
        const auto digits = [&text](qsizetype at, qsizetype count) {
            const QString part = text.mid(at, count);
            const bool valid = part.size() == count &&
                               std::ranges::all_of(part, [](QChar c) { return c >= u'0' && c <= u'9'; });
            return valid ? part : QString();
        };
        const auto both = [](const QString& one, const QString& other) {
            return one.isEmpty() || other.isEmpty() ? QString() : one + other;
        };
        RecordingTime time{digits(0, 4), both(digits(8, 2), digits(5, 2)),
                           both(digits(11, 2), digits(14, 2))};
        if (time.Year.isEmpty()) return std::nullopt;
        return time;
    }
};

class Conversion {
 public:
    Conversion(std::uint8_t version, const WritingRules& rules) : version_(version), rules_(rules) {}

    std::vector<TagFrame> Run(std::vector<TagFrame> frames) {
        if (version_ == 4) hasRecordingTime_ = std::ranges::any_of(frames, IsRecordingTime);
        for (TagFrame& frame : frames)
            Take(frame);
        if (!people_.isEmpty()) result_.push_back(TextFrame("IPLS", people_, rules_));
        return std::move(result_);
    }

 private:
    static bool IsRecordingTime(const TagFrame& frame) {
        return frame.Id == "TDRC" && frame.IsReadable() &&
               RecordingTime::Parse(TextValues(frame.Body()).value(0)).has_value();
    }

    void Take(TagFrame& frame) {
        if (frame.HasOldId()) ConvertOld(frame);
        if (version_ == 4) ConvertCoding24(frame);
        if (version_ == 4 && !frame.IsCoded && TakeSuccessor(frame)) return;
        if (version_ != 3 && !frame.IsCoded) ConvertTexts(frame);
        result_.push_back(std::move(frame));
    }

    void ConvertTexts(TagFrame& frame) {
        // Only version 2.4 has several values.
        const bool canChange = version_ == 4 || (!frame.Stored.empty() && frame.Stored[0] > 1);
        if (!canChange) return;
        if (auto body = BodyWithTexts23(frame.Id, frame.Stored, rules_)) frame.Stored = std::move(*body);
    }

    // True for a frame that others have taken the place of.
    bool TakeSuccessor(const TagFrame& frame) {
        if (frame.Id == "TIPL" || frame.Id == "TMCL" || frame.Id == "IPLS") return TakePeople(frame);
        if (frame.Id == "TDOR") return TakeOriginalTime(frame);
        if (frame.Id == "TDRC") return TakeRecordingTime(frame);
        // The recording time says the same with more right.
        return hasRecordingTime_ && (frame.Id == "TYER" || frame.Id == "TDAT" || frame.Id == "TIME");
    }

    bool TakePeople(const TagFrame& frame) {
        people_ += TextValues(frame.Body());
        return true;
    }

    bool TakeOriginalTime(const TagFrame& frame) {
        const auto time = RecordingTime::Parse(TextValues(frame.Body()).value(0));
        if (time) Add(frame, "TORY", time->Year);
        return time.has_value();
    }

    bool TakeRecordingTime(const TagFrame& frame) {
        const auto time = RecordingTime::Parse(TextValues(frame.Body()).value(0));
        if (!time) return false;
        Add(frame, "TYER", time->Year);
        if (!time->Date.isEmpty()) Add(frame, "TDAT", time->Date);
        if (!time->Date.isEmpty() && !time->Time.isEmpty()) Add(frame, "TIME", time->Time);
        return true;
    }

    void Add(const TagFrame& source, std::string_view id, const QString& text) {
        result_.push_back(TextFrame(id, {text}, rules_));
        if (id == "TYER") result_.back().Field = source.Field;
    }

    std::uint8_t version_;
    const WritingRules& rules_;
    std::vector<TagFrame> result_;
    QStringList people_;  // what they do and their names by turns
    bool hasRecordingTime_ = false;
};

}  // namespace

std::vector<TagFrame> ConvertedTo23(std::vector<TagFrame> frames, std::uint8_t version,
                                    const WritingRules& rules) {
    return Conversion(version, rules).Run(std::move(frames));
}
