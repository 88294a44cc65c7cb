#include "MusicManagment/playlist/ListNames.h"

#include <QDir>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/CodePage.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

bool IsLineEnd(QChar character) {
    return character == u'\r' || character == u'\n';
}

bool IsHexDigit(char character) {
    return (character >= '0' && character <= '9') || (character >= 'A' && character <= 'F') ||
           (character >= 'a' && character <= 'f');
}

// ':' + 8 hexadecimal digits + ':'
bool IsStoredCdPath(const QString& text) {
    if (text.size() < 10 || text[0] != u':' || text[9] != u':') return false;
    const QStringView digits = QStringView(text).sliced(1, 8);
    return std::ranges::all_of(digits, [](QChar digit) { return IsHexDigit(digit.toLatin1()); });
}

// "%20" is a blank; a percent sign without two hexadecimal digits is itself.
QByteArray PercentDecoded(const QByteArray& text) {
    QByteArray bytes;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const bool isCode =
            text[i] == '%' && i + 2 < text.size() && IsHexDigit(text[i + 1]) && IsHexDigit(text[i + 2]);
        bytes += isCode ? QByteArray::fromHex(text.sliced(i + 1, 2)).front() : text[i];
        if (isCode) i += 2;
    }
    return bytes;
}

bool ReadsBack(const QString& name) {
    if (std::ranges::any_of(name, IsLineEnd)) return false;
    return !name.startsWith(u'/') || !name.back().isSpace();
}

QString OnOneLine(QString text) {
    std::ranges::replace_if(text, IsLineEnd, QChar(u' '));
    return text;
}

}  // namespace

QString LocalPath(const QString& address) {
    if (!address.startsWith("file:/"_L1, Qt::CaseInsensitive)) return {};
    QString rest = address.sliced(5);
    if (rest.startsWith("//"_L1)) {
        const qsizetype path = rest.indexOf(u'/', 2);
        if (path < 0) return {};
        const QStringView host = QStringView(rest).sliced(2, path - 2);
        if (!host.isEmpty() && host.compare("localhost"_L1, Qt::CaseInsensitive) != 0) return {};
        rest = rest.sliced(path);
    }
    const QByteArray bytes = PercentDecoded(rest.toUtf8());
    if (bytes.contains('\0')) return {};
    const QString path =
        CodePage::FromSystem(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())}));
    // "/C:/Musik" names a drive where there are drives. Qt takes what begins with a colon for absolute, too.
    const bool namesDrive = path.size() > 1 && path[1] != u'/' && path[1] != u':';
    return namesDrive && QDir::isAbsolutePath(path.sliced(1)) ? path.sliced(1) : path;
}

bool IsAddress(const QString& text) {
    const qsizetype colon = text.indexOf("://"_L1);
    // A scheme of one letter would be a drive.
    if (colon < 2) return false;
    const QStringView scheme = QStringView(text).first(colon);
    return std::ranges::all_of(scheme, [](QChar character) {
        return character.unicode() < 0x80 &&
               (character.isLetterOrNumber() || character == u'+' || character == u'-' || character == u'.');
    });
}

std::optional<ByteSpan> LineReader::Next() {
    const auto isLineEnd = [](std::uint8_t byte) { return byte == '\r' || byte == '\n'; };
    const auto begin = std::ranges::find_if_not(rest_, isLineEnd);
    if (begin == rest_.end()) return std::nullopt;
    const auto end = std::find_if(begin, rest_.end(), isLineEnd);
    const ByteSpan line(begin, end);
    rest_ = ByteSpan(end, rest_.end());
    return line;
}

QString NameFromList(const QString& text, const QString& folder) {
    const QString local = LocalPath(text);
    if (!local.isEmpty()) return AbsolutePath(local);
    const bool isAsItIs = text.size() < 2 || text[1] == u':' || IsStoredCdPath(text) || IsAddress(text);
    if (isAsItIs) return text;
    // Qt takes a name that begins with a colon for one inside the program, and so for absolute.
    const bool isAbsolute = !text.startsWith(u':') && QDir::isAbsolutePath(text);
    return AbsolutePath(isAbsolute ? text : folder + u'/' + text);
}

QString NameFromList(ByteSpan text, const QString& folder) {
    return NameFromList(CodePage::FromSystem(text), folder);
}

QByteArray ToUtf8(QStringView text) {
    return text.toUtf8();
}

QByteArray PathForList(const QString& name, ListEncoder encode) {
    if (ReadsBack(name)) return encode(name);
    if (IsAddress(name)) return name.toUtf8().replace('\r', "%0D").replace('\n', "%0A");
    const QString path = NameFromList(name, QDir::currentPath());
    if (path.startsWith(u'/')) return "file://" + path.toUtf8().toPercentEncoding("/");
    return encode(OnOneLine(name));
}

QByteArray TitleForList(const QString& artist, const QString& title, ListEncoder encode) {
    return encode(OnOneLine(ArtistAndTitle(artist, title)));
}
