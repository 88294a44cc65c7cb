#include <QDir>

#include "MusicManagment/playlist/ListRules.h"
#include "MusicManagment/playlist/PlayListFiles.h"

using namespace Qt::StringLiterals;

namespace {

std::vector<PlayListEntry> Parse(ByteSpan file, const ListOrigin&) {
    const auto& [format, contents] = RecognizeList(file);
    const QString folder = QDir::currentPath();
    switch (format) {
        case PlayListFormat::Native:
            return ParseNativeList(contents);
        case PlayListFormat::M3u:
        case PlayListFormat::M3u8:
            return ParseM3uList(contents, folder);
        case PlayListFormat::Pls:
            return ParsePlsList(contents, folder);
        case PlayListFormat::Plain:
            break;
    }
    return ParsePlainList(contents, folder);
}

QString Filter() {
    return u"Alle PlayLists|*.rukpl;*.rpl;*.m3u;*.extpl;*.pl;*.txtpl;*.pls;*.inipl|RUK "
           u"Playlist|*.rukpl;*.rpl|"
           "M3U PlayLists|*.m3u;*.extpl|PL PlayLists|*.pl;*.txtpl|PLS PlayLists|*.pls;*.inipl|"
           "Alle Dateien|*.*"_s;
}

}  // namespace

const ListRules kClassicLists = {Parse, FormatOfName, IsPlayListName, Filter};
