#include "ReadMPEGHeader/FileNameTag.h"

#include <QStringView>
#include <algorithm>
#include <array>

namespace {

// Tried in this order; the first that occurs in the name divides it.
constexpr std::array<QStringView, 4> kSeparators = {u" - ", u"-", u" / ", u"/"};

struct PathParts {
    QStringView Folder;  // name of the folder that holds the file, without its path
    QStringView Name;    // without extension
};

PathParts Split(QStringView path) {
    const qsizetype slash = path.lastIndexOf(u'/');
    QStringView name = path.mid(slash + 1);
    // A dot in front makes a hidden file, not an extension.
    if (const qsizetype dot = name.lastIndexOf(u'.'); dot > 0) name.truncate(dot);
    if (slash <= 0) return {{}, name};
    const QStringView folderPath = path.first(slash);
    return {folderPath.mid(folderPath.lastIndexOf(u'/') + 1), name};
}

bool IsDigitOrDot(QChar c) {
    return c == u'.' || (c >= u'0' && c <= u'9');
}

// "Waterloo (2)" -> "Waterloo": the number of a copy.
QStringView WithoutCopyNumber(QStringView title) {
    if (!title.endsWith(u')')) return title;
    const qsizetype open = title.lastIndexOf(u'(');
    if (open < 0) return title;
    const QStringView inside = title.sliced(open + 1).chopped(1);
    if (!std::all_of(inside.begin(), inside.end(), IsDigitOrDot)) return title;
    QStringView rest = title.first(open);
    while (!rest.isEmpty() && rest.back().isSpace())
        rest.chop(1);
    return rest;
}

}  // namespace

TID3Tag TagFromFileName(const QString& path, const QStringList& excludedFolders) {
    TID3Tag tag;
    ResetTag(false, tag, 0);
    tag.FileName = path;
    const auto [folder, name] = Split(path);
    for (const QStringView separator : kSeparators) {
        const qsizetype at = name.indexOf(separator);
        if (at < 0) continue;
        tag.Artist = name.first(at).trimmed().toString();
        tag.Title = WithoutCopyNumber(name.sliced(at + separator.size()).trimmed()).toString();
        return tag;
    }
    tag.Title = name.trimmed().toString();
    tag.Artist = folder.toString();
    if (excludedFolders.contains(tag.Artist.toUpper())) tag.Artist.clear();
    return tag;
}
