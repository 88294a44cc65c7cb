#include "bench/SongFile.h"

#include <QFile>
#include <algorithm>
#include <array>
#include <string_view>

#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v1/ID3v1.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kTagPadding = 1024;
// Sound that is really written at either end.
constexpr std::int64_t kHeadBytes = 8 * 1024;
constexpr std::int64_t kTailBytes = 4 * 1024;

struct Rate {
    int BitRate;  // kbit/s
    std::uint8_t Index;
};
constexpr Rate kConstantRate = {128, 9};
constexpr std::array<Rate, 5> kVariableRates = {{{96, 7}, {128, 9}, {160, 10}, {192, 11}, {112, 8}}};

constexpr std::size_t kXingFrameSize = 417;

ByteSpan View(const QByteArray& bytes) {
    return AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())});
}

void SynchSafe(ByteWriter& writer, std::size_t value) {
    for (int shift = 21; shift >= 0; shift -= 7)
        writer.U8(static_cast<std::uint8_t>((value >> shift) & 0x7F));
}

// Frames of an ID3v2 tag.
class TagFrames {
 public:
    explicit TagFrames(int version) : version_(version) {}

    void Text(std::string_view id, const QString& text) {
        ByteWriter body;
        if (version_ == 4) {
            body.U8(3);
            body.Raw(View(text.toUtf8()));
        } else {
            body.U8(1);
            body.U16Le(0xFEFF);
            for (const QChar c : text)
                body.U16Le(c.unicode());
        }
        Frame(id, body.Bytes());
    }

    void Picture(std::size_t size) {
        ByteWriter body;
        body.U8(0);
        body.Raw(std::string_view("image/jpeg\0\3\0", 13));
        Noise(body, size);
        Frame("APIC", body.Bytes());
    }

    const ByteWriter& Frames() const { return frames_; }

    // Bytes without a frame sync.
    static void Noise(ByteWriter& writer, std::size_t count) {
        for (std::size_t i = 0; i < count; ++i)
            writer.U8(static_cast<std::uint8_t>((i * 167 + i / 251) % 255));
    }

 private:
    void Frame(std::string_view id, ByteSpan body) {
        frames_.Raw(id);
        if (version_ == 4)
            SynchSafe(frames_, body.size());
        else
            frames_.U32Be(static_cast<std::uint32_t>(body.size()));
        frames_.U16Be(0);
        frames_.Raw(body);
    }

    int version_;
    ByteWriter frames_;
};

void AppendId3v2(ByteWriter& file, const SongFile& song) {
    TagFrames tag(song.TagVersion);
    tag.Text("TIT2", song.Title);
    tag.Text("TPE1", song.Artist);
    tag.Text("TALB", song.Album);
    tag.Text(song.TagVersion == 4 ? "TDRC" : "TYER", QString::number(song.Year));
    tag.Text("TRCK", QString::number(song.Track));
    tag.Text("TCON", u'(' + QString::number(song.Genre) + u')');
    if (song.CoverBytes > 0) tag.Picture(song.CoverBytes);
    file.Raw("ID3");
    file.U8(static_cast<std::uint8_t>(song.TagVersion));
    file.U16Be(0);
    SynchSafe(file, tag.Frames().Size() + kTagPadding);
    file.Raw(tag.Frames().Bytes());
    file.Zeros(kTagPadding);
}

void AppendFrame(ByteWriter& file, std::uint8_t index, std::size_t size, bool padding) {
    file.U16Be(0xFFFB);
    file.U8(static_cast<std::uint8_t>((index << 4) | (padding ? 2 : 0)));
    file.U8(0x64);
    TagFrames::Noise(file, size - 4);
}

// Where frame `number` of a constant stream begins: sizes alternate so that the bit rate comes out exactly.
std::int64_t ConstantFrameStart(std::int64_t number) {
    return number * 144 * kConstantRate.BitRate * 1000 / 44100;
}

std::int64_t VariableFrameSize(std::int64_t number) {
    return 144 * std::int64_t{kVariableRates[static_cast<std::size_t>(number % 5)].BitRate} * 1000 / 44100;
}

std::int64_t VariableFrameStart(std::int64_t number) {
    std::int64_t fiveFrames = 0;
    for (int i = 0; i < 5; ++i)
        fiveFrames += VariableFrameSize(i);
    std::int64_t start = number / 5 * fiveFrames;
    for (std::int64_t i = number / 5 * 5; i < number; ++i)
        start += VariableFrameSize(i);
    return start;
}

// The stream of frames of one song.
class FrameStream {
 public:
    explicit FrameStream(const SongFile& song) : vbr_(song.Vbr) {
        while (Start(count_) < song.AudioBytes)
            count_ += 1 + (song.AudioBytes - Start(count_)) / 1000;
    }

    std::int64_t Count() const { return count_; }
    std::int64_t Bytes() const { return Start(count_); }
    std::int64_t Start(std::int64_t number) const {
        return vbr_ ? VariableFrameStart(number) : ConstantFrameStart(number);
    }
    void Append(ByteWriter& file, std::int64_t number) const {
        const auto size = static_cast<std::size_t>(Start(number + 1) - Start(number));
        const auto& rate = vbr_ ? kVariableRates[static_cast<std::size_t>(number % 5)] : kConstantRate;
        const bool padding = !vbr_ && size > 417;
        AppendFrame(file, rate.Index, size, padding);
    }

 private:
    bool vbr_;
    std::int64_t count_ = 0;
};

void AppendXing(ByteWriter& file, const FrameStream& frames) {
    ByteWriter frame;
    frame.U32Be(0xFFFB9064);
    frame.Zeros(32);
    frame.Raw("Xing");
    frame.U32Be(3);
    frame.U32Be(static_cast<std::uint32_t>(frames.Count()));
    frame.U32Be(static_cast<std::uint32_t>(frames.Bytes() + std::int64_t{kXingFrameSize}));
    frame.Zeros(kXingFrameSize - frame.Size());
    file.Raw(frame.Bytes());
}

TID3Tag Record(const SongFile& song) {
    TID3Tag tag;
    tag.Title = song.Title;
    tag.Artist = song.Artist;
    tag.Album = song.Album;
    tag.Year = QString::number(song.Year);
    tag.Track = static_cast<quint8>(song.Track);
    tag.Genre = static_cast<quint8>(song.Genre);
    return tag;
}

void Put(QFile& file, std::int64_t position, const ByteWriter& bytes) {
    const auto size = static_cast<qint64>(bytes.Size());
    if (!file.seek(position) || file.write(reinterpret_cast<const char*>(bytes.Bytes().data()), size) != size)
        throw EStreamError(u"Kann die Datei nicht schreiben: "_s + file.fileName());
}

}  // namespace

void WriteSongFile(const QString& path, const SongFile& song) {
    const FrameStream frames(song);
    ByteWriter head;
    AppendId3v2(head, song);
    if (song.Vbr) AppendXing(head, frames);
    const auto audioStart = static_cast<std::int64_t>(head.Size());
    std::int64_t number = 0;
    const std::int64_t headBytes = song.HasHole ? kHeadBytes : frames.Bytes();
    for (; number < frames.Count() && frames.Start(number) < headBytes; ++number)
        frames.Append(head, number);

    while (number < frames.Count() && frames.Bytes() - frames.Start(number) > kTailBytes)
        ++number;
    ByteWriter tail;
    const auto tailStart = audioStart + frames.Start(number);
    for (; number < frames.Count(); ++number)
        frames.Append(tail, number);
    TID3Tag record = Record(song);
    WriteID3v1(tail, record);

    QFile file(path);
    if (!file.open(QIODevice::WriteOnly)) throw EStreamError(u"Kann die Datei nicht anlegen: "_s + path);
    Put(file, 0, head);
    Put(file, tailStart, tail);
}
