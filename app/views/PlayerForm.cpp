#include "app/views/PlayerForm.h"

#include <QMainWindow>

#include "app/views/VisPlaySound.h"

using namespace Qt::StringLiterals;

TPlayerForm::TPlayerForm(TPlaySound& player, const TPlayList& list, QWidget* parent)
    : QDockWidget(u"Player"_s, parent), panel_(new TVisPlaySound(player, list, this)) {
    setObjectName(u"PlayerForm"_s);
    setAccessibleName(windowTitle());
    setWidget(panel_);
    connect(this, &QDockWidget::dockLocationChanged, this, [this] { FitTitle(); });
    connect(this, &QDockWidget::topLevelChanged, this, [this] { FitTitle(); });
}

// A strip at the upper or lower edge stays low with its title at the side, where there is no room for text.
void TPlayerForm::FitTitle() {
    const auto* window = qobject_cast<QMainWindow*>(parentWidget());
    const Qt::DockWidgetArea area = window != nullptr ? window->dockWidgetArea(this) : Qt::NoDockWidgetArea;
    const bool strip = !isFloating() && (area == Qt::TopDockWidgetArea || area == Qt::BottomDockWidgetArea);
    setFeatures(features().setFlag(DockWidgetVerticalTitleBar, strip));
    setWindowTitle(strip ? QString() : accessibleName());
    toggleViewAction()->setText(accessibleName());
}
