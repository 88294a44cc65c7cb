#include "tests/playback/engines/TypeFiles.h"

#include <algorithm>
#include <stdexcept>

#include "CommonRUKTools/ByteWriter.h"
#include "tests/playback/SongFiles.h"
#include "tests/playback/SoundFiles.h"

namespace {

constexpr double kSeconds = 2;
constexpr quint32 kLength = 2000;
constexpr int kRate = 44100;

// The FMOD back end counts 144 ms a row.
constexpr quint32 kPattern = 64 * 144;
constexpr quint32 kMidiRow = 144;

template <const char* Codec, const char* Format>
void WriteEncoded(const QString& path) {
    Encode(path, Sine({}, kSeconds), {.codec = Codec, .format = Format});
}

constexpr char kLame[] = "libmp3lame";
constexpr char kMp2Codec[] = "mp2";
constexpr char kWmaCodec[] = "wmav2";
constexpr char kVorbisCodec[] = "vorbis";
constexpr char kMp3[] = "mp3";
constexpr char kMp2[] = "mp2";
constexpr char kAsf[] = "asf";
constexpr char kOgg[] = "ogg";

void WriteWave(const QString& path) {
    WriteWav(path, Sine({}, kSeconds));
}

void WriteSamples(const QString& path) {
    WriteRaw(path, Sine({}, kSeconds));
}

QByteArray Tune() {
    MidiTrack track;
    for (const int key : {60, 64, 67, 72})
        track.Note(0, key, 480);
    return Midi({track.End(0)});
}

void WriteMidi(const QString& path) {
    WriteBytes(path, Tune());
}

void WriteRmi(const QString& path) {
    WriteBytes(path, Rmi(Tune()));
}

template <QByteArray (*Make)(const ModuleSong&)>
void WriteModule(const QString& path) {
    WriteBytes(path, Make({}));
}

// --- A film: ten grey pictures of 16 x 16 dots a second, and a tone ---

constexpr std::uint32_t kPictures = 20;
constexpr std::uint32_t kPictureBytes = 16 * 16 * 3;
constexpr std::uint32_t kSoundBytes = kRate / 10 * 4;  // a tenth of a second

ByteWriter Chunk(std::string_view name, const ByteWriter& content) {
    ByteWriter chunk;
    chunk.Raw(name);
    chunk.U32Le(static_cast<std::uint32_t>(content.Size()));
    chunk.Raw(content.Bytes());
    chunk.Zeros(content.Size() % 2);
    return chunk;
}

ByteWriter List(std::string_view kind, std::initializer_list<ByteWriter> chunks) {
    ByteWriter content;
    content.Raw(kind);
    for (const ByteWriter& chunk : chunks)
        content.Raw(chunk.Bytes());
    return Chunk("LIST", content);
}

ByteWriter Numbers(std::initializer_list<std::uint32_t> numbers) {
    ByteWriter out;
    for (const std::uint32_t number : numbers)
        out.U32Le(number);
    return out;
}

ByteWriter StreamHeader(std::string_view kind, std::uint32_t scale, std::uint32_t rate, std::uint32_t length,
                        std::uint32_t largest, std::uint32_t sampleBytes) {
    ByteWriter header;
    header.Raw(kind);
    header.Zeros(4 + 12);
    header.Raw(Numbers({scale, rate, 0, length, largest, 0xFFFF'FFFF, sampleBytes, 0, 0}).Bytes());
    return Chunk("strh", header);
}

ByteWriter PictureFormat() {
    ByteWriter format = Numbers({40, 16, 16});
    format.U16Le(1);
    format.U16Le(24);
    format.Raw(Numbers({0, kPictureBytes, 0, 0, 0, 0}).Bytes());
    return Chunk("strf", format);
}

ByteWriter SoundFormat() {
    ByteWriter format;
    format.U16Le(1);
    format.U16Le(2);
    format.U32Le(kRate);
    format.U32Le(kRate * 4);
    format.U16Le(4);
    format.U16Le(16);
    return Chunk("strf", format);
}

ByteWriter FilmHeader() {
    ByteWriter head = Numbers({100'000, kRate * 4, 0, 0x10, kPictures, 0, 2, kSoundBytes, 16, 16});
    head.Zeros(16);
    return List("hdrl",
                {Chunk("avih", head),
                 List("strl", {StreamHeader("vids", 1, 10, kPictures, kPictureBytes, 0), PictureFormat()}),
                 List("strl", {StreamHeader("auds", 1, kRate, kPictures * kSoundBytes / 4, kSoundBytes, 4),
                               SoundFormat()})});
}

void WriteFilm(const QString& path) {
    WriteWave(path);
    const QByteArray samples = ReadBytes(path).mid(44);
    ByteWriter film;
    film.Raw("movi");
    ByteWriter index;
    for (std::uint32_t i = 0; i < kPictures; ++i) {
        ByteWriter picture;
        picture.Zeros(kPictureBytes);
        ByteWriter sound;
        sound.Raw(std::string_view(samples.constData() + i * kSoundBytes, kSoundBytes));
        for (const auto& [name, content] : {std::pair("00db", picture), std::pair("01wb", sound)}) {
            index.Raw(name);
            index.Raw(Numbers({0x10, static_cast<std::uint32_t>(film.Size()),
                               static_cast<std::uint32_t>(content.Size())})
                          .Bytes());
            film.Raw(Chunk(name, content).Bytes());
        }
    }
    ByteWriter content;
    content.Raw("AVI ");
    content.Raw(FilmHeader().Bytes());
    content.Raw(Chunk("LIST", film).Bytes());
    content.Raw(Chunk("idx1", index).Bytes());
    const ByteWriter file = Chunk("RIFF", content);
    WriteBytes(path,
               {reinterpret_cast<const char*>(file.Bytes().data()), static_cast<qsizetype>(file.Size())});
}

}  // namespace

const std::vector<FileType>& FileTypes() {
    static const std::vector<FileType> types = {
        {"mp3", WriteEncoded<kLame, kMp3>, kLength, 60, 0},
        {"mp2", WriteEncoded<kMp2Codec, kMp2>, kLength, 60, 0},
        {"wma", WriteEncoded<kWmaCodec, kAsf>, kLength, 120, 0},
        {"asf", WriteEncoded<kWmaCodec, kAsf>, kLength, 120, 0},
        {"ogg", WriteEncoded<kVorbisCodec, kOgg>, kLength, 60, 0},
        {"wav", WriteWave, kLength, 1, 0},
        {"raw", WriteSamples, kLength, 1, 0},
        {"mid", WriteMidi, kLength, kMidiRow, kMidiRow},
        {"rmi", WriteRmi, kLength, kMidiRow, kMidiRow},
        {"mod", WriteModule<Mod>, 3 * kPattern, 0, kPattern},
        {"s3m", WriteModule<S3m>, 3 * kPattern, 0, kPattern},
        {"xm", WriteModule<Xm>, 3 * kPattern, 0, kPattern},
        {"it", WriteModule<It>, 3 * kPattern, 0, kPattern},
        {"avi", WriteFilm, kLength, 20, 0},
    };
    return types;
}

const FileType& FileTypeOf(const QString& extension) {
    const auto found = std::ranges::find_if(
        FileTypes(), [&](const FileType& type) { return extension == QLatin1StringView(type.extension); });
    if (found == FileTypes().end()) throw std::runtime_error("no such type: " + extension.toStdString());
    return *found;
}
