#include "MusicManagment/conversion/SongDecoder.h"

#include <QFileInfo>

#include "MusicManagment/playback/fmod/FFmpegSource.h"
#include "MusicManagment/playback/fmod/SongFile.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRateOfNotes = 44100;  // Hz

using RateFor = std::function<int(int ownRate)>;

DecodedSong OpenNotes(const QString& path, const RateFor& rateFor) {
    const int rate = rateFor(kRateOfNotes);
    return {.Source = LoadSongFile(path, rate, {}), .Rate = rate};
}

DecodedSong OpenSound(const QString& path, const RateFor& rateFor) {
    auto source = std::make_unique<FFmpegSource>(path, FFmpegFile::LengthBy::Header, rateFor);
    const FFmpegFile& file = source->File();
    DecodedSong song{.File = &file, .Rate = source->Rate(), .IsMono = file.Channels() == 1};
    song.FitsIn16Bits = file.FitsIn16Bits() && file.Rate() == song.Rate && file.Channels() <= 2;
    song.Source = std::move(source);
    return song;
}

bool IsCalledNotes(const QString& path) {
    static const QStringList kExtensions = {u"mod"_s, u"s3m"_s, u"xm"_s, u"it"_s, u"mid"_s, u"rmi"_s};
    return kExtensions.contains(QFileInfo(path).suffix().toLower());
}

}  // namespace

// The name says what is tried first; the contents decide.
DecodedSong OpenDecodedSong(const QString& path, const RateFor& rateFor) {
    const bool notesFirst = IsCalledNotes(path);
    try {
        return notesFirst ? OpenNotes(path, rateFor) : OpenSound(path, rateFor);
    } catch (const ESoundFileError& error) {
        if (error.code != FMOD_ERR_FILE_FORMAT) throw;
    }
    return notesFirst ? OpenSound(path, rateFor) : OpenNotes(path, rateFor);
}

SoundLength MeasureSound(const QString& path) {
    const FFmpegFile file(path, FFmpegFile::LengthBy::Counting);
    return {file.Length(), file.Rate()};
}

QString ReasonOf(const ESoundFileError& error) {
    switch (error.code) {
        case FMOD_ERR_FILE_NOTFOUND:
            return u"Die Datei ist nicht da."_s;
        case FMOD_ERR_FILE_FORMAT:
            return u"Die Datei ist beschädigt oder hat ein Format, das Tunestead nicht dekodiert."_s;
        case FMOD_ERR_MEDIAPLAYER:
            return u"Zum Dekodieren fehlt ein Decoder oder, für MIDI, ein SoundFont."_s;
        case FMOD_ERR_MEMORY:
            return u"Der Speicher reicht nicht aus."_s;
        default:
            return u"Die Datei lässt sich nicht lesen."_s;
    }
}
