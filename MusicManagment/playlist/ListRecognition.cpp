#include "MusicManagment/playlist/ListRecognition.h"

#include <QFileInfo>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kHeadSize = 9;

struct Extension {
    QStringView Name;  // lower case
    PlayListFormat Format;
};

constexpr Extension kExtensions[] = {
    {u"rukpl", PlayListFormat::Native}, {u"rpl", PlayListFormat::Native},  {u"m3u", PlayListFormat::M3u},
    {u"extpl", PlayListFormat::M3u},    {u"pls", PlayListFormat::Pls},     {u"inipl", PlayListFormat::Pls},
    {u"pl", PlayListFormat::Plain},     {u"txtpl", PlayListFormat::Plain},
};

const Extension* FindExtension(const QString& fileName) {
    const QString suffix = QFileInfo(fileName).suffix().toLower();
    const auto* found = std::ranges::find(kExtensions, QStringView(suffix), &Extension::Name);
    return found != std::end(kExtensions) ? found : nullptr;
}

bool EqualsIgnoringCase(ByteSpan bytes, std::string_view lowerCase) {
    return std::ranges::equal(bytes, lowerCase, [](std::uint8_t byte, char expected) {
        const auto lower = byte >= 'A' && byte <= 'Z' ? byte + ('a' - 'A') : byte;
        return lower == static_cast<std::uint8_t>(expected);
    });
}

}  // namespace

RecognizedList RecognizeList(ByteSpan file) {
    if (StartsWith(file, "RUKPLYLST")) return {PlayListFormat::Native, file.subspan(kHeadSize)};
    const ByteSpan text = StartsWith(file, "\xEF\xBB\xBF") ? file.subspan(3) : file;
    if (text.size() < kHeadSize) return {PlayListFormat::Plain, text};
    const ByteSpan head = text.first(kHeadSize);
    if (EqualsIgnoringCase(head, "#extm3u\r\n")) return {PlayListFormat::M3u, text.subspan(kHeadSize)};
    if (EqualsIgnoringCase(head, "[playlist")) return {PlayListFormat::Pls, text};
    return {PlayListFormat::Plain, text.subspan(kHeadSize)};
}

PlayListFormat FormatOfName(const QString& fileName) {
    const Extension* extension = FindExtension(fileName);
    return extension != nullptr ? extension->Format : PlayListFormat::Plain;
}

bool IsPlayListName(const QString& fileName) {
    return FindExtension(fileName) != nullptr;
}
