#include "app/dialogs/ProgressTexts.h"

using namespace Qt::StringLiterals;

QString ProgressHeading(TProgressType type) {
    switch (type) {
        case ptLoadDatabase:
            return u"Lade die Datenbank"_s;
        case ptSaveDatabase:
            return u"Speichere die Datenbank"_s;
        case ptSearchFolders:
            return u"Dursuche Ordner nach neuen Songs"_s;
        case ptAddSongs:
            return u"Nehme Songs in die Datenbank auf"_s;
        case ptReadBackupCd:
            return u"Lese die Songs einer Backup-CD ein"_s;
        case ptCopySongs:
            return u"Kopiere die Songs an die Zielorte"_s;
        case ptOther:
            break;
    }
    return u"Fortschritt"_s;
}

QString ProgressLabel(qint64 current, qint64 maximum, const QString& description) {
    if (maximum <= 0 && !description.isEmpty()) return description;
    const QString label = QString::number(current) + u" von "_s + QString::number(maximum);
    return description.isEmpty() ? label : label + u" - "_s + description;
}

QString ProgressTitle(int percent) {
    if (percent < 0) return u"Tunestead"_s;
    return u"Tunestead - "_s + QString::number(percent) + u" %"_s;
}
