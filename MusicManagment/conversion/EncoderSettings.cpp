#include "MusicManagment/conversion/EncoderSettings.h"

#include <algorithm>
#include <array>
#include <optional>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"

using namespace Qt::StringLiterals;

namespace {

// The first byte of a record. 0 there: nothing was ever chosen.
constexpr std::uint8_t kLayout = 1;
constexpr std::uint32_t kHighestRate = 192000;
constexpr int kHighestMp3BitRate = 320;
constexpr int kHighestWmaBitRate = 768;
constexpr int kLowestBitRate = 8;

// Reads the fields of a record; what is out of its range spoils the whole.
class RecordReader {
 public:
    explicit RecordReader(const QByteArray& record)
        : reader_({reinterpret_cast<const std::uint8_t*>(record.constData()),
                   static_cast<std::size_t>(record.size())}),
          isGood_(!record.isEmpty() && reader_.U8() == kLayout) {}

    int Byte(int least, int most) { return Checked(reader_.U8(), least, most); }
    int Word(int least, int most) { return Checked(reader_.U16Le(), least, most); }
    int Rate() {
        const std::uint32_t rate = reader_.U32Le();
        isGood_ = isGood_ && (rate == 0 || (rate >= 8000 && rate <= kHighestRate));
        return static_cast<int>(rate);
    }
    template <typename T>
    T Choice(T last) {
        return static_cast<T>(Byte(0, static_cast<int>(last)));
    }
    bool IsGood() const { return isGood_; }

 private:
    int Checked(int value, int least, int most) {
        isGood_ = isGood_ && value >= least && value <= most;
        return value;
    }

    ByteReader reader_;
    bool isGood_;
};

QByteArray Bytes(ByteWriter record, std::size_t size) {
    record.Zeros(size - record.Size());
    return {reinterpret_cast<const char*>(record.Bytes().data()), static_cast<qsizetype>(record.Size())};
}

std::optional<WavSettings> ReadWav(const QByteArray& record) {
    if (record.size() != kWavRecordSize) return std::nullopt;
    RecordReader reader(record);
    WavSettings wav;
    wav.Bits = reader.Byte(16, 24);
    wav.Sides = reader.Choice(WavSettings::Channels::Mono);
    wav.Dither = reader.Byte(0, 1) != 0;
    wav.Rate = reader.Rate();
    if (!reader.IsGood() || (wav.Bits != 16 && wav.Bits != 24)) return std::nullopt;
    return wav;
}

QByteArray RecordOf(const WavSettings& wav) {
    ByteWriter record;
    record.U8(kLayout);
    record.U8(static_cast<std::uint8_t>(wav.Bits));
    record.U8(static_cast<std::uint8_t>(wav.Sides));
    record.U8(wav.Dither ? 1 : 0);
    record.U32Le(static_cast<std::uint32_t>(wav.Rate));
    return Bytes(std::move(record), kWavRecordSize);
}

std::optional<Mp3Settings> ReadMp3(const QByteArray& record) {
    if (record.size() != kMp3RecordSize) return std::nullopt;
    RecordReader reader(record);
    Mp3Settings mp3;
    mp3.Bits = reader.Choice(Mp3Settings::Method::Average);
    mp3.Quality = reader.Byte(0, 9);
    mp3.Effort = reader.Byte(0, 9);
    mp3.Sides = reader.Choice(Mp3Settings::Channels::Mono);
    mp3.BitRate = reader.Word(kLowestBitRate, kHighestMp3BitRate);
    mp3.Rate = reader.Rate();
    if (!reader.IsGood()) return std::nullopt;
    return mp3;
}

QByteArray RecordOf(const Mp3Settings& mp3) {
    ByteWriter record;
    record.U8(kLayout);
    record.U8(static_cast<std::uint8_t>(mp3.Bits));
    record.U8(static_cast<std::uint8_t>(mp3.Quality));
    record.U8(static_cast<std::uint8_t>(mp3.Effort));
    record.U8(static_cast<std::uint8_t>(mp3.Sides));
    record.U16Le(static_cast<std::uint16_t>(mp3.BitRate));
    record.U32Le(static_cast<std::uint32_t>(mp3.Rate));
    return Bytes(std::move(record), kMp3RecordSize);
}

std::optional<WmaSettings> ReadWma(const QByteArray& record) {
    if (record.size() != kWmaRecordSize) return std::nullopt;
    RecordReader reader(record);
    WmaSettings wma;
    wma.BitRate = reader.Word(kLowestBitRate, kHighestWmaBitRate);
    wma.Rate = reader.Rate();
    wma.TimeLimit = std::chrono::seconds(reader.Word(1, 65535));
    if (!reader.IsGood()) return std::nullopt;
    return wma;
}

QByteArray RecordOf(const WmaSettings& wma) {
    using std::chrono::seconds;
    const auto limit = std::clamp<qint64>(std::chrono::ceil<seconds>(wma.TimeLimit).count(), 1, 65535);
    ByteWriter record;
    record.U8(kLayout);
    record.U16Le(static_cast<std::uint16_t>(wma.BitRate));
    record.U32Le(static_cast<std::uint32_t>(wma.Rate));
    record.U16Le(static_cast<std::uint16_t>(limit));
    return Bytes(std::move(record), kWmaRecordSize);
}

// The nearest rate of MPEG sound that loses nothing; of those beyond 48 kHz the one that divides them.
int MpegRate(int rate) {
    const int whole = rate > 48000 && rate % 44100 == 0 ? 44100 : rate;
    const auto* next = std::ranges::lower_bound(kRatesToChoose, whole);
    return next != std::end(kRatesToChoose) ? *next : 48000;
}

}  // namespace

MusicFormat FormatOf(int number) {
    const bool isOne = number >= 0 && number < static_cast<int>(std::size(kMusicFormats));
    return isOne ? static_cast<MusicFormat>(number) : MusicFormat::Mp3;
}

QString NameOf(MusicFormat format) {
    return ExtensionOf(format).mid(1).toUpper();
}

QString ExtensionOf(MusicFormat format) {
    static const std::array extensions = {u".mp3"_s, u".wav"_s, u".wma"_s};
    return extensions.at(static_cast<std::size_t>(format));
}

EncoderSettings ReadEncoderSettings(const ConversionSettings& stored) {
    return {.Mp3 = ReadMp3(stored.Mp3).value_or(Mp3Settings()),
            .Wav = ReadWav(stored.Wav).value_or(WavSettings()),
            .Wma = ReadWma(stored.Wma).value_or(WmaSettings()),
            .Script = stored.WmaScript,
            .ScriptArguments = stored.WmaArguments};
}

void StoreEncoderSettings(const EncoderSettings& settings, ConversionSettings& stored) {
    stored.Mp3 = RecordOf(settings.Mp3);
    stored.Wav = RecordOf(settings.Wav);
    stored.Wma = RecordOf(settings.Wma);
    stored.WmaScript = settings.Script;
    stored.WmaArguments = settings.ScriptArguments;
}

int TargetRate(MusicFormat format, const EncoderSettings& settings, int sourceRate) {
    const auto wanted = [sourceRate](int chosen) { return chosen != 0 ? chosen : sourceRate; };
    switch (format) {
        case MusicFormat::Mp3:
            return MpegRate(wanted(settings.Mp3.Rate));
        case MusicFormat::Wav:
            return wanted(settings.Wav.Rate);
        case MusicFormat::Wma:
            break;
    }
    // Encoders of Windows Media know no others.
    return MpegRate(wanted(settings.Wma.Rate));
}
