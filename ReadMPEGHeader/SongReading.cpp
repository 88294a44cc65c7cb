#include "ReadMPEGHeader/SongReading.h"

#include <array>
#include <optional>

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/DerivedGenre.h"
#include "ReadMPEGHeader/FileNameTag.h"
#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/ReadingProfile.h"
#include "ReadMPEGHeader/TitleCleaning.h"
#include "ReadMPEGHeader/asf/Asf.h"
#include "ReadMPEGHeader/id3v1/ID3v1.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"
#include "ReadMPEGHeader/wave/Wave.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kHeadSize = 16;  // holds the marks of RIFF and ASF

const ReadingProfile& ProfileOf(ReadProfile profile) {
    return profile == ReadProfile::Modern ? ModernProfile() : ClassicProfile();
}

bool HasTitleAndArtist(const std::optional<TID3Tag>& tag) {
    return tag && !tag->Title.isEmpty() && !tag->Artist.isEmpty();
}

bool StandsAt(ByteSource& stream, std::int64_t position, std::string_view mark) {
    std::array<std::uint8_t, 4> bytes{};
    const auto wanted = std::span(bytes).first(mark.size());
    return stream.ReadAt(position, wanted) == mark.size() && StartsWith(bytes, mark);
}

// One file on its way into the record. Every source of data is read into a copy of its own, so that a damaged
// one takes nothing from the others.
class AudioFileReading {
 public:
    AudioFileReading(ByteSource& stream, const QString& path, const ReadOptions& options,
                     SongReading& reading)
        : stream_(stream),
          path_(path),
          options_(options),
          profile_(ProfileOf(options.Profile)),
          reading_(reading),
          result_(reading.Tag) {}

    void Run() {
        ReadContainer();
        ReadTrailingTag();
        if (!isContainer_ && !id3v2_) SearchHead();
        if (!hasTechnicalData_) RestoreTechnicalData();
        ReadId3v1();
        fileName_ = TagFromFileName(path_, options_.ExcludedArtistFolders);
        CleanSources();
        MergeSources();
        if (result_.Genre == kNoGenre) result_.Genre = MainGenreGenre(result_.MainGenre);
        if (options_.DeriveMainGenre && result_.MainGenre == 0) result_.MainGenre = DerivedMainGenre();
    }

 private:
    // Runs one reader. A file whose contents are damaged costs only what this reader would have told; a
    // failing medium ends the whole read.
    template <typename Reader>
    bool Guarded(const QString& what, Reader reader) {
        try {
            return reader();
        } catch (const EMediumError&) {
            throw;
        } catch (const EStreamError& error) {
            reading_.Remarks.Text += what + u": "_s + error.Message() + u'\n';
            return false;
        }
    }

    void ReadContainer() {
        std::array<std::uint8_t, kHeadSize> head{};
        const auto held = stream_.ReadAt(0, head);
        const ByteSpan bytes = ByteSpan(head).first(held);
        if (StartsWith(bytes, "RIFF")) {
            isContainer_ = true;
            Guarded(u"Wave"_s, [this] { return ReadWave(); });
        } else if (IsAsf(bytes)) {
            isContainer_ = true;
            Guarded(u"ASF"_s, [this] { return ReadAsf(); });
        }
    }

    bool ReadWave() {
        const auto info = ReadWaveHeader(stream_);
        if (!info) return false;
        wave_ = TagFromWave(*info, result_.AddTime);
        MergeTag(result_, *wave_, MergeMode::Technical);
        hasTechnicalData_ = true;
        return true;
    }

    bool ReadAsf() {
        const auto info = ReadAsfHeader(stream_);
        if (!info) throw EStreamError(u"Der Kopf der Datei ist beschädigt"_s);
        wma_ = TagFromAsf(*info, profile_.WmaLength());
        if (wma_->AddTime == 0) wma_->AddTime = result_.AddTime;  // the header names no creation time
        hasTechnicalData_ = true;
        return true;
    }

    void ReadTrailingTag() {
        const auto position = TagOfTrailerBefore(stream_, stream_.Size());
        if (position && *position < stream_.Size() && StandsAt(stream_, *position, "ID3")) ReadTag(*position);
    }

    // The first byte behind the tag.
    std::int64_t ReadTag(std::int64_t position) {
        std::int64_t end = position;
        TID3Tag tag;
        std::optional<XrukFrame> xruk;
        const bool read = Guarded(u"ID3v2"_s, [&] {
            return profile_.ReadTag(stream_, position, end, tag, options_.OnFrame, &xruk);
        });
        if (read) {
            id3v2_ = std::move(tag);
            xruk_ = std::move(xruk);
        }
        // The size of a damaged tag may be part of the damage.
        return end <= stream_.Size() ? end : position;
    }

    void SearchHead() {
        const auto frame =
            profile_.FindFirstFrame(stream_, [this](std::int64_t position) { return ReadTag(position); });
        if (!frame) return;
        reading_.Mpeg = AnalyseMpegFrame(stream_, *frame, profile_.FrameRules(), result_);
        hasTechnicalData_ = true;
    }

    // Nothing in the audio told its technical data: the program's own frame may have kept them, else the
    // extension says what the file is.
    void RestoreTechnicalData() {
        DescribeByExtension(path_, result_);
        if (xruk_) xruk_->ApplyTechnicalFields(result_);
    }

    void ReadId3v1() {
        const std::int64_t position = stream_.Size() - static_cast<std::int64_t>(kId3v1Size);
        if (position < 0 || !StandsAt(stream_, position, "TAG")) return;
        TID3Tag tag;
        if (Guarded(u"ID3v1"_s, [&] { return ::ReadID3v1(stream_, position, tag); })) id3v1_ = std::move(tag);
    }

    void CleanSources() {
        const TitleCleaning cleaning{options_.RemoveJunkTexts, options_.TakeTrackNumbers};
        if (id3v1_) CleanTitles(*id3v1_, cleaning);
        if (id3v2_) CleanTitles(*id3v2_, cleaning);
        CleanTitles(fileName_, cleaning);
    }

    void MergeSources() {
        if (wave_) MergeTag(result_, *wave_, MergeMode::Technical);
        if (wma_) MergeTag(result_, *wma_, MergeMode::Technical);
        if (xruk_) xruk_->ApplyCollectionFields(result_);
        if (HasTitleAndArtist(id3v2_)) {
            MergeTag(result_, *id3v2_, MergeMode::FillEmpty);
            result_.Remix = result_.Remix || id3v2_->Remix;
        } else if (HasTitleAndArtist(id3v1_)) {
            MergeTag(result_, *id3v1_, MergeMode::Tags);
        } else if (!wma_) {
            MergeTag(result_, fileName_, MergeMode::Tags);
        }
    }

    // The text of the genre says more than its number, where the tags come from an ID3v2 tag.
    quint8 DerivedMainGenre() const {
        if (HasTitleAndArtist(id3v2_) && id3v2_->MainGenre != 0) return id3v2_->MainGenre;
        return MainGenreOfGenre(result_.Genre);
    }

    ByteSource& stream_;
    const QString& path_;
    const ReadOptions& options_;
    const ReadingProfile& profile_;
    SongReading& reading_;
    TID3Tag& result_;  // of the reading

    bool isContainer_ = false;       // RIFF or ASF: not searched for MPEG frames
    bool hasTechnicalData_ = false;  // from the file's audio
    std::optional<TID3Tag> wave_;
    std::optional<TID3Tag> wma_;
    std::optional<TID3Tag> id3v2_;
    std::optional<XrukFrame> xruk_;
    std::optional<TID3Tag> id3v1_;
    TID3Tag fileName_;
};

SongReading Fresh(const ReadOptions& options) {
    SongReading reading;
    ResetTag(false, reading.Tag, options.FileTime == -1 ? CurrentClock().Now() : options.FileTime);
    return reading;
}

void ReadInto(SongReading& reading, ByteSource& source, const QString& path, const ReadOptions& options) {
    BufferedSource stream(source);
    AudioFileReading(stream, path, options, reading).Run();
}

// Fills the reading; returns the refusal.
QString ReadFile(SongReading& reading, const QString& path, const ReadOptions& options) {
    if (path.isEmpty()) return u"Keine Datei angegeben"_s;
    if (path.startsWith(u':')) return u"CD nicht eingelegt"_s;
    reading.Tag.FileName = path;
    const auto file = FileSource::TryOpen(path);
    if (!file) {
        MergeTag(reading.Tag, TagFromFileName(path, options.ExcludedArtistFolders), MergeMode::Tags);
        return u"Datei nicht gefunden"_s;
    }
    ReadInto(reading, *file, path, options);
    return {};
}

}  // namespace

SongReading ReadSong(const QString& path, const ReadOptions& options) {
    SongReading reading = Fresh(options);
    try {
        reading.Refusal = ReadFile(reading, path, options);
    } catch (const EStreamError& error) {
        reading.Error = error.Message();
    }
    return reading;
}

SongReading ReadSong(ByteSource& source, const QString& path, const ReadOptions& options) {
    SongReading reading = Fresh(options);
    reading.Tag.FileName = path;
    try {
        ReadInto(reading, source, path, options);
    } catch (const EStreamError& error) {
        reading.Error = error.Message();
    }
    return reading;
}
