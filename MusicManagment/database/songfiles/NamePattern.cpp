#include "MusicManagment/database/songfiles/NamePattern.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "CommonRUKTools/FileNames.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

// In the order in which they are replaced.
std::vector<std::pair<QString, QString>> Values(const TID3Tag& info) {
    return {
        {u"%TITLE%"_s, info.Title},
        {u"%ARTIST%"_s, info.Artist},
        {u"%ALBUM%"_s, info.Album},
        {u"%YEAR%"_s, info.Year},
        {u"%COMMENT%"_s, info.Comment},
        {u"%FORMAT%"_s, info.MPEGLayer},
        {u"%LENGTHV%"_s, FormatLength(info.Length, false)},
        {u"%LENGTHF%"_s, FormatLength(info.Length, true)},
        {u"%ID3GENRE%"_s, GenreName(info.Genre)},
        {u"%KBPS%"_s, QString::number(info.BitRate)},
        {u"%FRQ%"_s, QString::number(info.SampleRate)},
        {u"%CHANNELS%"_s, FormatChannelMode(info.ChannelMode)},
        {u"%EMPHASIS%"_s, FormatEmphasis(info.Emphasis)},
        {u"%TRACKNR%"_s, QString::number(info.Track)},
        {u"%ID3FLAGS%"_s, FormatHeaderFlags(info)},
        {u"%MAINGENRE%"_s, MainGenreLongName(info.MainGenre)},
    };
}

QString Expand(const QString& pattern, const TID3Tag& info) {
    QString name = pattern;
    for (const auto& [placeholder, value] : Values(info))
        name.replace(placeholder, value);
    return MakeValidFileName(name);
}

QString FittingName(const QString& pattern, TID3Tag info, qsizetype longest) {
    QString name = Expand(pattern, info);
    if (FileNameLength(name) <= longest) return name;
    info.Title = CutToFileNameLength(info.Title, longest);
    while (FileNameLength(name) > longest && !info.Title.isEmpty()) {
        info.Title = CutToFileNameLength(info.Title, FileNameLength(info.Title) - 1);
        name = Expand(pattern, info);
    }
    return CutToFileNameLength(name, longest);
}

}  // namespace

QString BuildNameFromPattern(const QString& pattern, const QString& path, const TID3Tag& info) {
    const qsizetype slash = path.lastIndexOf(u'/');
    const qsizetype dot = path.lastIndexOf(u'.');
    const QString extension = dot > slash ? path.mid(dot) : QString();
    const qsizetype longest = std::max<qsizetype>(kLongestFileName - FileNameLength(extension), 0);
    return path.left(slash + 1) + FittingName(pattern, info, longest) + extension;
}

QStringList NamePatternPlaceholders() {
    QStringList names;
    for (const auto& value : Values(TID3Tag()))
        names << value.first;
    return names;
}
