#include "MusicManagment/conversion/ConvertSong.h"

#include <algorithm>
#include <cmath>
#include <span>
#include <vector>

#include "CommonRUKTools/FileChange.h"
#include "MusicManagment/conversion/EncoderScript.h"
#include "MusicManagment/conversion/PartialFile.h"
#include "MusicManagment/conversion/SongDecoder.h"
#include "MusicManagment/conversion/SongEncoder.h"
#include "MusicManagment/playback/fmod/FFmpegFile.h"
#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/id3v2/CoverArt.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kBlock = 8192;  // frames
// Of the time that a script needs nothing is known: the samples that it gets count as half of the work.
constexpr double kDecodingForScript = 0.5;

// --- Sound ---

struct Sound {
    std::int64_t Frames = 0;
    int Rate = 0;  // Hz
};

class Conversion {
 public:
    Conversion(const ConversionJob& job, const EncoderSettings& settings, const ConversionProgress& goOn)
        : job_(job), settings_(settings), goOn_(goOn) {}

    void Run(const QString& target) {
        const DecodedSong song = Open();
        if (song.File != nullptr && song.File->Channels() > 2) gain_ = GainOfMix();
        const SampleKind samples{.Rate = song.Rate, .IsMono = song.IsMono, .FitsIn16Bits = song.FitsIn16Bits};
        if (job_.Format == MusicFormat::Wma)
            EncodeByScript(song, samples, target);
        else
            Encode(song, *MakeEncoder(target, samples), 1);
    }
    const Sound& Made() const { return made_; }

 private:
    DecodedSong Open() const {
        return OpenDecodedSong(job_.Source,
                               [this](int rate) { return TargetRate(job_.Format, settings_, rate); });
    }

    // Many sides in two may be louder than samples can be, and what a file cuts off stays lost: the whole is
    // as loud as it plays, or as loud as it may be.
    float GainOfMix() const {
        const DecodedSong song = Open();
        std::vector<float> block(2 * kBlock);
        float peak = 1;
        while (const std::size_t frames = song.Source->Read(block.data(), kBlock)) {
            for (const float sample : std::span(block).first(2 * frames))
                peak = std::max(peak, std::abs(sample));
            GoOn(0);
        }
        return std::isfinite(peak) ? 1 / peak : 1;
    }

    std::unique_ptr<SongEncoder> MakeEncoder(const QString& target, const SampleKind& samples) const {
        return job_.Format == MusicFormat::Mp3 ? MakeMp3Encoder(target, settings_.Mp3, samples)
                                               : MakeWaveEncoder(target, settings_.Wav, samples);
    }

    // `share`: how much of the whole work this is.
    void Encode(const DecodedSong& song, SongEncoder& encoder, double share) {
        const auto length = static_cast<double>(std::max<std::uint64_t>(1, song.Source->Length()));
        std::vector<float> block(2 * kBlock);
        made_.Rate = song.Rate;
        for (;;) {
            const std::size_t frames = song.Source->Read(block.data(), kBlock);
            if (frames == 0) break;
            for (float& sample : std::span(block).first(2 * frames))
                sample *= gain_;
            encoder.Write(block.data(), frames);
            made_.Frames += static_cast<std::int64_t>(frames);
            GoOn(share * std::min(1.0, static_cast<double>(made_.Frames) / length));
        }
        // Not the first half of a song for the whole, of a disk that was pulled out.
        if (song.File != nullptr && song.File->ReadingFailed())
            throw EStreamError(u"Die Datei lässt sich nicht bis zu ihrem Ende lesen."_s);
        if (made_.Frames == 0) throw ERukException(u"Die Datei enthält keinen Ton."_s);
        encoder.Finish();
    }

    void EncodeByScript(const DecodedSong& song, const SampleKind& samples, const QString& target) {
        const PartialFile wave(job_.Target);
        Encode(song, *MakeWaveEncoder(wave.Path(), {}, samples), kDecodingForScript);
        RunScript(ScriptCallFor(settings_, wave.Path(), target), [this] {
            GoOn(kDecodingForScript);
            return true;
        });
        if (!StateOf(target).Exists())
            throw ERukException(u"Das Encoder-Skript hat keine Datei geschrieben."_s);
    }

    void GoOn(double done) const {
        if (!goOn_(done)) throw EAbort();
    }

    const ConversionJob& job_;
    const EncoderSettings& settings_;
    const ConversionProgress& goOn_;
    float gain_ = 1;
    Sound made_;
};

// --- The new file ---

std::int64_t ToleratedFrames(MusicFormat format) {
    constexpr std::int64_t kMpegFrame = 1152;
    // Two of the longest: one that decoders leave out, and what fills up the last.
    constexpr std::int64_t kWmaFrames = 2 * 2048;
    switch (format) {
        case MusicFormat::Mp3:
            return kMpegFrame;
        case MusicFormat::Wav:
            return 0;
        case MusicFormat::Wma:
            break;
    }
    return kWmaFrames;
}

SoundLength LengthOfNew(const QString& file) {
    try {
        return MeasureSound(file);
    } catch (const ESoundFileError&) {
        throw ERukException(u"Was entstanden ist, ist keine Musikdatei, die sich lesen lässt."_s);
    }
}

void CheckLength(const QString& file, MusicFormat format, const Sound& wanted) {
    const SoundLength found = LengthOfNew(file);
    // At another rate, which a script may have chosen, as long in time.
    const std::int64_t frames = found.Samples * wanted.Rate / found.Rate;
    const std::int64_t difference = std::abs(frames - wanted.Frames);
    if (difference <= ToleratedFrames(format)) return;
    const auto seconds = [&](std::int64_t samples) {
        return QString::number(static_cast<double>(samples) / wanted.Rate, 'f', 2);
    };
    throw ERukException(
        u"Die neue Datei ist %1 statt %2 Sekunden lang."_s.arg(seconds(frames)).arg(seconds(wanted.Frames)));
}

QString MimeTypeOf(const QByteArray& picture) {
    if (picture.startsWith("\x89PNG")) return u"image/png"_s;
    if (picture.startsWith("GIF8")) return u"image/gif"_s;
    if (picture.startsWith("RIFF") && picture.mid(8).startsWith("WEBP")) return u"image/webp"_s;
    return u"image/jpeg"_s;
}

void WriteTags(const ConversionJob& job, const QString& file) {
    TagEdit edit{.Record = job.Record};
    {
        FileSource source(job.Source);
        edit.TrackTotal = ReadTrackTotal(source);
        if (const auto cover = ReadCoverArt(source)) edit.Cover = CoverPicture{*cover, MimeTypeOf(*cover)};
    }
    const FileState before = StateOf(file);
    FilePatch patch;
    {
        FileSource sound(file);
        patch = PlanTag(sound, job.Target, edit, {.Profile = job.Profile});
    }
    if (patch.ChangesNothing(before.Size)) return;
    const PatchPlan plan = PlanPatch(file, std::move(patch), before);
    WritePatch(plan);
    FinishPatch(plan);
}

TID3Tag ReadBack(const ConversionJob& job) {
    ReadOptions options;
    options.Profile = job.Profile;
    SongReading reading = ReadSong(job.Target, options);
    if (!reading.Succeeded()) throw ERukException(reading.Failure());
    return std::move(reading.Tag);
}

void MakeTarget(const ConversionJob& job, const EncoderSettings& settings, const ConversionProgress& goOn) {
    PartialFile file(job.Target);
    Conversion conversion(job, settings, goOn);
    conversion.Run(file.Path());
    CheckLength(file.Path(), job.Format, conversion.Made());
    WriteTags(job, file.Path());
    file.TakeName();
}

}  // namespace

TID3Tag ConvertSong(const ConversionJob& job, const EncoderSettings& settings,
                    const ConversionProgress& goOn) {
    if (StateOf(job.Target).Exists()) throw EStreamError(u"Diese Datei gibt es schon: "_s + job.Target);
    try {
        MakeTarget(job, settings, goOn);
    } catch (const ESoundFileError& error) {
        throw ERukException(ReasonOf(error));
    } catch (const EStreamError& error) {
        throw EStreamError(NamedAsTarget(error.Message(), job.Target));
    }
    return ReadBack(job);
}
