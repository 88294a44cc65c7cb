#include "MusicManagment/database/CdPath.h"

#include <QStringList>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype kDigits = 8;
constexpr qsizetype kHead = 1 + kDigits + 1;

// A path is not to lead away from its medium, whatever a database says.
QString WithoutUps(const QString& path) {
    QStringList parts = path.split(u'/');
    parts.removeAll(u".."_s);
    return parts.join(u'/');
}

bool IsHexDigit(QChar c) {
    return (c >= u'0' && c <= u'9') || (c >= u'a' && c <= u'f') || (c >= u'A' && c <= u'F');
}

}  // namespace

quint32 SerialOfCdPath(const QString& path) {
    const QStringView digits = QStringView(path).mid(1, kDigits);
    const bool isNumber =
        IsCdPath(path) && digits.size() == kDigits && std::ranges::all_of(digits, IsHexDigit);
    return isNumber ? digits.toUInt(nullptr, 16) : 0;
}

QString PathOnMedium(const QString& cdPath) {
    return cdPath.mid(kHead);
}

QString MakeCdPath(quint32 serial, const QString& path) {
    QString onMedium = path;
    return u':' + SerialText(serial) + u':' + onMedium.replace(u'/', u'\\');
}

QString FileAt(const QString& mountPoint, const QString& cdPath) {
    QString onMedium = PathOnMedium(cdPath);
    onMedium.replace(u'\\', u'/');
    if (onMedium.contains(u".."_s)) onMedium = WithoutUps(onMedium);
    const bool isRoot = mountPoint.endsWith(u'/');
    return (isRoot ? mountPoint.chopped(1) : mountPoint) + onMedium;
}

QString SerialText(quint32 serial) {
    return QString::number(serial, 16).toUpper().rightJustified(kDigits, u'0');
}
