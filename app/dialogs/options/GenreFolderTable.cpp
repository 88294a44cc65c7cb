#include "app/dialogs/options/GenreFolderTable.h"

#include <QHeaderView>

#include "ReadMPEGHeader/Genres.h"
#include "app/dialogs/TableLook.h"

using namespace Qt::StringLiterals;

namespace {

enum Column { cGenre, cFolder };
constexpr int kShownRows = 6;

// The name is put behind the root folder and must not lead out of it.
bool LeadsOut(const QString& name) {
    const QStringList parts = QString(name).replace(u'\\', u'/').split(u'/');
    return name.startsWith(u'/') || parts.contains(u"."_s) || parts.contains(u".."_s);
}

}  // namespace

GenreFolderTable::GenreFolderTable(QWidget* parent) : QTableWidget(kMainGenreCount, 2, parent) {
    SetTableLook(*this, {u"Genre"_s, u"Ordner"_s}, kShownRows);
    for (int genre = 0; genre < kMainGenreCount; ++genre) {
        auto* caption = new QTableWidgetItem(MainGenreLongName(genre));
        caption->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
        setItem(genre, cGenre, caption);
        setItem(genre, cFolder, new QTableWidgetItem);
    }
    setCurrentCell(0, cFolder);
}

QStringList GenreFolderTable::Names() const {
    QStringList names;
    for (int genre = 0; genre < kMainGenreCount; ++genre)
        names << item(genre, cFolder)->text().trimmed();
    return names;
}

void GenreFolderTable::SetNames(const QStringList& names) {
    for (int genre = 0; genre < kMainGenreCount; ++genre)
        item(genre, cFolder)->setText(names.value(genre));
}

std::optional<QString> GenreFolderTable::Fault() {
    const QStringList names = Names();
    for (int genre = 0; genre < kMainGenreCount; ++genre) {
        const QString& name = names[genre];
        if (!name.isEmpty() && !LeadsOut(name)) continue;
        setCurrentCell(genre, cFolder);
        const QString where = u" für das Genre "_s + item(genre, cGenre)->text();
        if (name.isEmpty()) return u"Der Name des Ordners"_s + where + u" fehlt."_s;
        return u"Der Ordner "_s + name + where + u" liegt nicht im Stammordner."_s;
    }
    return std::nullopt;
}
