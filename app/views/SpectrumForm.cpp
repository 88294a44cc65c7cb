#include "app/views/SpectrumForm.h"

#include <QAction>
#include <QActionGroup>

#include "app/views/DSPDraw.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

struct StyleCaption {
    TSpectrumStyle Style;
    const char16_t* Caption;
};

constexpr StyleCaption kStyles[] = {{ssBars, u"&Balken"}, {ssLine, u"&Linie"}, {ssCircle, u"&Kreis"}};

}  // namespace

TSpectrumForm::TSpectrumForm(QWidget* parent)
    : QDockWidget(u"Spektrum"_s, parent), draw_(new TDSPDraw(this)), styles_(new QActionGroup(this)) {
    setObjectName(u"SpectrumForm"_s);
    setAccessibleName(windowTitle());
    setWidget(draw_);
    AddStyles();
}

void TSpectrumForm::AddStyles() {
    for (const auto& [style, caption] : kStyles) {
        QAction* action = styles_->addAction(QString::fromUtf16(caption));
        action->setCheckable(true);
        action->setData(style);
        connect(action, &QAction::triggered, this, [this, chosen = style] { draw_->SetStyle(chosen); });
    }
    draw_->addActions(styles_->actions());
    draw_->setContextMenuPolicy(Qt::ActionsContextMenu);
    draw_->setToolTip(u"Die Darstellung wählt das Kontextmenü."_s);
    ShowStyle();
}

void TSpectrumForm::ShowStyle() {
    for (QAction* action : styles_->actions())
        action->setChecked(action->data().toInt() == draw_->Style());
}

void TSpectrumForm::LoadSettings(const TRWReg& settings) {
    if (const auto style = ReadSetting(settings, WindowSettings::kSpectrumStyle))
        draw_->SetStyle(static_cast<TSpectrumStyle>(*style));
    ShowStyle();
}

void TSpectrumForm::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kSpectrumStyle, draw_->Style());
}
