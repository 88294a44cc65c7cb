#include "app/views/MusicOverview.h"

#include <QComboBox>
#include <QEvent>
#include <QHeaderView>
#include <QLineEdit>
#include <QScrollBar>
#include <QTreeView>
#include <QVBoxLayout>
#include <limits>

#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

// In the order of TOVType.
constexpr const char16_t* kTypeCaptions[kOverviewTypeCount] = {u"Artisten", u"Alben", u"Jahre", u"Längen",
                                                               u"Genre"};

// The widest bucket; genres are wider and, like names, shortened where they do not fit.
int WidestBucket(const QFontMetrics& metrics) {
    const QString farFuture = YearBucket(std::numeric_limits<int>::max());
    const QString tenMinutes = LengthBucket(600);
    return std::max(metrics.horizontalAdvance(farFuture), metrics.horizontalAdvance(tenMinutes));
}

}  // namespace

TMusicOverview::TMusicOverview(TMusicDatabase& database, QWidget* parent)
    : QWidget(parent),
      database_(&database),
      model_(database),
      switch_(new QComboBox(this)),
      filter_(new QLineEdit(this)),
      list_(new QTreeView(this)) {
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(switch_);
    layout->addWidget(filter_);
    layout->addWidget(list_, 1);
    SetUpSwitch();
    SetUpFilter();
    SetUpList();
    FitToFont();
    database.JoinSettings(*this);
}

TMusicOverview::~TMusicOverview() {
    if (database_ != nullptr) database_->LeaveSettings(*this);
}

void TMusicOverview::SetUpSwitch() {
    switch_->setObjectName(u"overviewType"_s);
    switch_->setAccessibleName(u"Liste der Übersicht"_s);
    for (const char16_t* caption : kTypeCaptions)
        switch_->addItem(QString::fromUtf16(caption));
    connect(switch_, &QComboBox::currentIndexChanged, this,
            [this](int index) { SetOVType(static_cast<TOVType>(index)); });
}

void TMusicOverview::SetUpFilter() {
    filter_->setObjectName(u"overviewFilter"_s);
    filter_->setAccessibleName(u"Übersicht filtern"_s);
    filter_->setPlaceholderText(u"Filtern"_s);
    filter_->setClearButtonEnabled(true);
    connect(filter_, &QLineEdit::textChanged, this, [this](const QString& text) { model_.SetFilter(text); });
}

void TMusicOverview::SetUpList() {
    list_->setObjectName(u"overviewList"_s);
    list_->setAccessibleName(u"Übersicht"_s);
    list_->setModel(&model_);
    list_->setSelectionMode(QAbstractItemView::ExtendedSelection);
    list_->setAllColumnsShowFocus(true);
    list_->setRootIsDecorated(false);
    list_->setUniformRowHeights(true);  // a long list is not measured row by row
    QHeaderView* header = list_->header();
    header->setSectionsMovable(false);
    header->setStretchLastSection(false);
    header->setSectionResizeMode(OverviewModel::CaptionColumn, QHeaderView::Stretch);
    header->setSectionResizeMode(OverviewModel::SongsColumn, QHeaderView::Fixed);
    // A group that goes takes its selection with it, which the selection itself does not always tell.
    connect(list_->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &TMusicOverview::FollowSelection);
    connect(&model_, &QAbstractItemModel::layoutChanged, this, &TMusicOverview::FollowSelection);
    connect(&model_, &QAbstractItemModel::rowsRemoved, this, &TMusicOverview::FollowSelection);
    connect(&model_, &QAbstractItemModel::modelReset, this, &TMusicOverview::FollowSelection);
}

// Numbers and the captions of buckets are never cut, whatever the font.
void TMusicOverview::FitToFont() {
    ensurePolished();
    const int number = list_->fontMetrics().horizontalAdvance(u" 100.000 "_s);
    QHeaderView* header = list_->header();
    const int songs = std::max(number, header->sectionSizeHint(OverviewModel::SongsColumn));
    header->resizeSection(OverviewModel::SongsColumn, songs);
    const int frame =
        4 * list_->fontMetrics().averageCharWidth() + list_->verticalScrollBar()->sizeHint().width();
    list_->setMinimumWidth(WidestBucket(list_->fontMetrics()) + songs + frame);
}

void TMusicOverview::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) FitToFont();
}

void TMusicOverview::SetOVType(TOVType type) {
    if (type == model_.Type()) return;
    filter_->clear();  // what was looked for is of another kind
    model_.SetType(type);
    switch_->setCurrentIndex(type);
    if (OnTypeChanged) OnTypeChanged(type);
}

// --- What is chosen ---

void TMusicOverview::ClearSelection() {
    list_->clearSelection();
}

GroupSelection TMusicOverview::ReadSelection() const {
    GroupSelection selection;
    selection.Type = model_.Type();
    const QItemSelectionModel& chosen = *list_->selectionModel();
    if (chosen.isRowSelected(OverviewModel::kAllRow)) return selection;
    for (const QModelIndex& index : chosen.selectedRows()) {
        if (selection.Type == ovGenre)
            selection.Genres.set(static_cast<std::size_t>(model_.ListRowOf(index.row())));
        else
            selection.Captions.insert(model_.GroupCaptionOf(index.row()));
    }
    return selection;
}

void TMusicOverview::FollowSelection() {
    GroupSelection selection = ReadSelection();
    const bool narrowsAlike = selection == selection_ || (selection.IsEmpty() && selection_.IsEmpty());
    selection_ = std::move(selection);
    if (!narrowsAlike && OnSelectionChanged) OnSelectionChanged(selection_);
}

// --- Settings ---

void TMusicOverview::LoadSettings(const TRWReg& settings) {
    if (const auto type = ReadSetting(settings, WindowSettings::kOVType))
        SetOVType(static_cast<TOVType>(*type));
}

void TMusicOverview::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kOVType, OVType());
}
