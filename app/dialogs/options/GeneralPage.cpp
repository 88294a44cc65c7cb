#include "app/dialogs/options/GeneralPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QStandardPaths>

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "app/desktop/Icons.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

// In the order of TSortType.
QStringList SortTypes() {
    return {u"Titel"_s,           u"Artist"_s, u"Album"_s,       u"Kommentar"_s, u"Jahr"_s,  u"Länge"_s,
            u"Genre"_s,           u"Pfad"_s,   u"Beliebtheit"_s, u"Datum"_s,     u"Flags"_s, u"Cache-Typ"_s,
            u"Albumreihenfolge"_s};
}

// In the order of TSubSortType.
QStringList SubSortTypes() {
    return {u"Genre, Artist, Titel, Länge"_s, u"Artist, Titel, Länge"_s, u"Pfad"_s};
}

}  // namespace

GeneralPage::GeneralPage()
    : OptionsPage(u"Allgemein"_s, ThemeIcon(u"configure"_s, QStyle::SP_FileDialogDetailedView)) {
    QFormLayout& use = AddGroup(u"Bedienung"_s);
    fields_.Bind(AddCheck(use, u"Asynchronous"_s, u"O&berfläche während langer Vorgänge bedienbar halten"_s,
                          u"Ohne diese Option lässt sich ein Vorgang nicht anhalten, bis er fertig ist."_s),
                 DatabaseSettings::kAsynchronous);
    AddProgram(use);
    QFormLayout& list = AddGroup(u"Liste"_s);
    sortType_ = AddField(list, u"SortType"_s, u"Songs an&ordnen nach"_s, new QComboBox);
    sortType_->addItems(SortTypes());
    fields_.Bind(sortType_, DatabaseSettings::kSortType);
    subSortType_ = AddField(list, u"SubSortType"_s, u"&Untergeordnet nach"_s, new QComboBox,
                            u"Entscheidet zwischen Songs, die sonst gleich sind"_s);
    subSortType_->addItems(SubSortTypes());
    fields_.Bind(subSortType_, DatabaseSettings::kSubSortType);
    sortBackwards_ = AddCheck(list, u"SortBackwards"_s, u"&Reihenfolge umkehren"_s);
    fields_.Bind(sortBackwards_, DatabaseSettings::kSortBackwards);
    fields_.Bind(AddCheck(list, u"FollowFocus"_s, u"&Markierung verfolgen"_s,
                          u"Der gewählte Song bleibt im Blick, wenn die Liste neu sortiert wird."_s),
                 DatabaseSettings::kFollowFocus);
}

void GeneralPage::AddProgram(QFormLayout& group) {
    program_ =
        AddField(group, WindowSettings::kExternalProgram.Name.toString(), u"&Externes Programm für Songs"_s,
                 new QLineEdit, u"Für „Mit externem Programm öffnen“: ein Name oder Pfad"_s);
    program_->setPlaceholderText(u"das Programm des Desktops"_s);
    fields_.Bind(program_, WindowSettings::kExternalProgram);
}

std::optional<OptionsFault> GeneralPage::Check() {
    const QString program = program_->text();
    if (program.isEmpty() || !QStandardPaths::findExecutable(program).isEmpty()) return std::nullopt;
    return OptionsFault{u"Das Programm %1 ist nicht zu finden."_s.arg(program), program_};
}

// What the order consists of is set at once, which sorts once.
void GeneralPage::Apply(TMusicDatabase& database, TRWReg& settings) {
    database.SetOrder({static_cast<TSortType>(sortType_->currentIndex()),
                       static_cast<TSubSortType>(subSortType_->currentIndex()), sortBackwards_->isChecked()});
    OptionsPage::Apply(database, settings);
}
