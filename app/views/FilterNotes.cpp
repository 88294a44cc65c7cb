#include "app/views/FilterNotes.h"

#include "app/models/FilteredSongs.h"

using namespace Qt::StringLiterals;

QString FilterWarning(const QString& filter) {
    const QStringList unknown = SongFilter::UnknownFields(filter);
    if (unknown.isEmpty()) return {};
    return u"Kein Feld „%1“. Felder: %2"_s.arg(unknown.join(u"“, „"_s),
                                               SongFilter::FieldNames().join(u", "_s));
}

QString NothingShownText(const FilteredSongs& songs) {
    const QString text = songs.Text().trimmed();
    if (text.isEmpty()) return u"Kein Song gehört zur Auswahl in der Übersicht."_s;
    QString reason = songs.Restricted()
                         ? u"Kein Song der Auswahl in der Übersicht passt zum Filter „%1“."_s.arg(text)
                         : u"Kein Song passt zum Filter „%1“."_s.arg(text);
    const QString warning = FilterWarning(text);
    if (!warning.isEmpty()) reason += u"\n"_s + warning;
    return reason + u"\nDie Taste Esc im Filter zeigt wieder alle Songs."_s;
}
