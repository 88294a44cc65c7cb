#include "app/views/OverviewForm.h"

#include "app/views/MusicOverview.h"

using namespace Qt::StringLiterals;

TOverviewForm::TOverviewForm(TMusicDatabase& database, QWidget* parent)
    : QDockWidget(u"Übersicht"_s, parent), overview_(new TMusicOverview(database, this)) {
    setObjectName(u"OverviewForm"_s);
    setAccessibleName(windowTitle());
    setWidget(overview_);
}
