#include "CommonRUKTools/FileNames.h"

#include <QStringList>

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
