#include "CommonRUKTools/FileNames.h"

#include <QStringList>
#include <QTextBoundaryFinder>

using namespace Qt::StringLiterals;

namespace {

QChar Replacement(QChar character) {
    switch (character.unicode()) {
        case u'/':
        case u'\\':
        case u'|':
        case u':':
            return u'-';
        case u'"':
            return u'\'';
        case u'<':
            return u'(';
        case u'>':
            return u')';
        case u'*':
        case u'?':
            return u'_';
        default:
            return character.unicode() < 0x20 || character.unicode() == 0x7F ? QChar(u' ') : character;
    }
}

bool IsDeviceName(const QString& name) {
    static const QStringList devices{u"CON"_s, u"PRN"_s, u"AUX"_s, u"NUL"_s};
    const QString base = name.section(u'.', 0, 0).trimmed().toUpper();
    const bool isPort =
        base.size() == 4 && base[3].isDigit() && (base.startsWith(u"COM"_s) || base.startsWith(u"LPT"_s));
    return devices.contains(base) || isPort;
}

}  // namespace

QString MakeValidFileName(const QString& text) {
    QString name = text;
    for (QChar& character : name)
        character = Replacement(character);
    while (name.endsWith(u'.') || name.endsWith(u' '))
        name.chop(1);
    if (name.isEmpty() || IsDeviceName(name)) name.prepend(u'_');
    return name;
}

qsizetype FileNameLength(QStringView name) {
#ifdef Q_OS_WIN
    return name.size();
#else
    return name.toUtf8().size();
#endif
}

QString CutToFileNameLength(const QString& text, qsizetype longest) {
    if (FileNameLength(text) <= longest) return text;
    QTextBoundaryFinder characters(QTextBoundaryFinder::Grapheme, text);
    qsizetype length = 0;
    qsizetype end = 0;
    for (qsizetype next = characters.toNextBoundary(); next > 0; next = characters.toNextBoundary()) {
        length += FileNameLength(QStringView(text).mid(end, next - end));
        if (length > longest) break;
        end = next;
    }
    return text.left(end);
}
