#include "app/dialogs/options/GeneralPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>

#include "MusicManagment/database/MusicManagment.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

// In the order of TSortType.
QStringList SortTypes() {
    return {u"Titel"_s, u"Artist"_s, u"Album"_s,       u"Kommentar"_s, u"Jahr"_s,  u"Länge"_s,
            u"Genre"_s, u"Pfad"_s,   u"Beliebtheit"_s, u"Datum"_s,     u"Flags"_s, u"Cache-Typ"_s};
}

// In the order of TSubSortType.
QStringList SubSortTypes() {
    return {u"Genre, Artist, Titel, Länge"_s, u"Artist, Titel, Länge"_s, u"Pfad"_s};
}

}  // namespace

GeneralPage::GeneralPage()
    : OptionsPage(u"Allgemein"_s, ThemeIcon(u"configure"_s, QStyle::SP_FileDialogDetailedView)) {
    QFormLayout& use = AddGroup(u"Bedienung"_s);
    asynchronous_ =
        AddCheck(use, u"Asynchronous"_s, u"O&berfläche während langer Vorgänge bedienbar halten"_s,
                 u"Ohne diese Option lässt sich ein Vorgang nicht anhalten, bis er fertig ist."_s);
    QFormLayout& list = AddGroup(u"Liste"_s);
    sortType_ = AddField(list, u"SortType"_s, u"Songs an&ordnen nach"_s, new QComboBox);
    sortType_->addItems(SortTypes());
    subSortType_ = AddField(list, u"SubSortType"_s, u"&Untergeordnet nach"_s, new QComboBox,
                            u"Entscheidet zwischen Songs, die sonst gleich sind"_s);
    subSortType_->addItems(SubSortTypes());
    sortBackwards_ = AddCheck(list, u"SortBackwards"_s, u"&Reihenfolge umkehren"_s);
    followFocus_ = AddCheck(list, u"FollowFocus"_s, u"&Markierung verfolgen"_s,
                            u"Der gewählte Song bleibt im Blick, wenn die Liste neu sortiert wird."_s);
}

void GeneralPage::Load(const TMusicDatabase& database, const TRWReg&) {
    asynchronous_->setChecked(database.Asynchronous());
    sortType_->setCurrentIndex(database.SortType());
    subSortType_->setCurrentIndex(database.SubSortType());
    sortBackwards_->setChecked(database.SortBackwards());
    followFocus_->setChecked(database.FollowFocus());
}

void GeneralPage::Apply(TMusicDatabase& database, TRWReg&) {
    database.SetAsynchronous(asynchronous_->isChecked());
    database.SetFollowFocus(followFocus_->isChecked());
    SongOrder order = database.Order();
    order.SortType = static_cast<TSortType>(sortType_->currentIndex());
    order.SubSortType = static_cast<TSubSortType>(subSortType_->currentIndex());
    order.Backwards = sortBackwards_->isChecked();
    database.SetOrder(order);
}
