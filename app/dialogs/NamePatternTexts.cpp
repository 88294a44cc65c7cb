#include "app/dialogs/NamePatternTexts.h"

#include <QRegularExpression>

#include "MusicManagment/database/songfiles/NameMatch.h"
#include "MusicManagment/database/songfiles/NamePattern.h"

using namespace Qt::StringLiterals;

namespace {

constexpr PlaceholderText kTexts[] = {
    {u"%ARTIST%", u"Artist"},
    {u"%TITLE%", u"Titel"},
    {u"%ALBUM%", u"Album"},
    {u"%TRACKNR%", u"Nummer des Tracks"},
    {u"%YEAR%", u"Jahr"},
    {u"%COMMENT%", u"Kommentar"},
    {u"%ID3GENRE%", u"Genre des Tags"},
    {u"%MAINGENRE%", u"Hauptgenre"},
    {u"%LENGTHV%", u"Länge, kurz (45 s, 3:45)"},
    {u"%LENGTHF%", u"Länge, immer mit Minuten (0:45)"},
    {u"%FORMAT%", u"Format"},
    {u"%KBPS%", u"Bitrate in kbit/s"},
    {u"%FRQ%", u"Abtastrate in Hz"},
    {u"%CHANNELS%", u"Kanäle"},
    {u"%EMPHASIS%", u"Emphasis"},
    {u"%ID3FLAGS%", u"Angaben des MPEG-Kopfes"},
};

// The first text between percent signs that looks like a place-holder and is none.
QString UnknownPlaceholder(QString pattern) {
    for (const QString& name : NamePatternPlaceholders())
        pattern.remove(name);
    static const QRegularExpression expression(u"%[A-Za-z]\\w*%"_s);
    return expression.match(pattern).captured();
}

// Whatever it is for.
std::optional<QString> FaultOfText(const QString& pattern) {
    if (pattern.trimmed().isEmpty()) return u"Das Muster für die Dateinamen ist leer."_s;
    const QString unknown = UnknownPlaceholder(pattern);
    if (unknown.isEmpty()) return std::nullopt;
    return u"Den Platzhalter "_s + unknown +
           u" im Muster für die Dateinamen gibt es nicht. Platzhalter werden groß geschrieben."_s;
}

bool HasPlaceholder(const QString& pattern) {
    const QStringList names = NamePatternPlaceholders();
    return std::any_of(names.begin(), names.end(),
                       [&pattern](const QString& name) { return pattern.contains(name); });
}

}  // namespace

std::span<const PlaceholderText> PlaceholderTexts() {
    return kTexts;
}

TID3Tag ExampleSong() {
    TID3Tag song;
    song.Artist = u"Die Beispiele"_s;
    song.Title = u"Ein schöner Tag"_s;
    song.Album = u"Sommer"_s;
    song.Year = u"2003"_s;
    song.Comment = u"Radiofassung"_s;
    song.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    song.Length = 225;
    song.Genre = 13;  // Pop
    song.BitRate = 192;
    song.SampleRate = 44100;
    song.ChannelMode = 3;
    song.Emphasis = 1;
    song.Original = true;
    song.Track = 4;
    song.MainGenre = 8;  // Rock/Pop
    return song;
}

QString ExampleName(const QString& pattern) {
    return BuildNameFromPattern(pattern, u"song.mp3"_s, ExampleSong());
}

std::optional<QString> FaultOfPattern(const QString& pattern) {
    if (auto fault = FaultOfText(pattern)) return fault;
    if (!HasPlaceholder(pattern))
        return u"Das Muster für die Dateinamen enthält keinen Platzhalter: alle Songs bekämen denselben Namen."_s;
    return std::nullopt;
}

std::optional<QString> FaultOfReading(const QString& pattern) {
    if (auto fault = FaultOfText(pattern)) return fault;
    const NameMatcher matcher(pattern);
    return matcher.Fault().isEmpty() ? std::nullopt : std::optional(matcher.Fault());
}
