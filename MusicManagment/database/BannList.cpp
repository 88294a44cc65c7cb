#include "MusicManagment/database/BannList.h"

#include <algorithm>
#include <string_view>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

// Some editors put it at the head of an UTF-8 file.
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
// Far more than anybody bans; a file beyond it is something else under the list's name.
constexpr std::int64_t kLargestFile = std::int64_t{256} << 20;

bool EndsLine(std::uint8_t byte) {
    return byte == '\r' || byte == '\n';
}

ByteSpan WithoutByteOrderMark(ByteSpan bytes) {
    const ByteSpan mark = AsBytes(kByteOrderMark);
    return bytes.size() >= mark.size() && std::ranges::equal(bytes.first(mark.size()), mark)
               ? bytes.subspan(mark.size())
               : bytes;
}

}  // namespace

QString BanEntry(const TID3Tag& record) {
    QString entry = ArtistAndTitle(record);
    return entry.replace(u'\r', u' ').replace(u'\n', u' ');
}

void LoadBannList(SortedTextList& list, const QString& path) {
    FileSource file(path);
    if (file.Size() > kLargestFile) throw EStreamError(u"Die Datei ist keine Bann-Liste: "_s + path);
    const auto bytes = file.ReadExactly(0, static_cast<std::size_t>(file.Size()));
    list.Clear();
    ByteSpan rest = WithoutByteOrderMark(bytes);
    while (!rest.empty()) {
        const auto end = std::ranges::find_if(rest, EndsLine);
        const auto length = static_cast<std::size_t>(end - rest.begin());
        if (length > 0) list.Insert(CodePage::FromSystem(rest.first(length)));
        rest = rest.subspan(std::min(length + 1, rest.size()));
    }
}

void SaveBannList(const SortedTextList& list, const QString& path) {
    QByteArray text;
    for (const auto& row : list)
        text += CodePage::ToSystem(row.Text) + "\r\n";
    SafeFile file(path);
    file.Write(AsBytes(std::string_view(text.constData(), static_cast<std::size_t>(text.size()))));
    file.Commit();
}
