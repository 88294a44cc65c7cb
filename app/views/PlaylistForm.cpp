#include "app/views/PlaylistForm.h"

#include <QComboBox>
#include <QDropEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMimeData>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QToolButton>
#include <QVBoxLayout>
#include <algorithm>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/playlist/PlayList.h"
#include "app/desktop/Icons.h"
#include "app/models/CollectionTotals.h"
#include "app/models/SongMime.h"
#include "app/views/VisPlayList.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kMillisecondsPerSecond = 1000;

struct OrderCaption {
    TPlayOrder Order;
    const char16_t* Caption;
};

constexpr OrderCaption kOrders[] = {
    {poDownwards, u"Abwärts"},
    {poUpwards, u"Aufwärts"},
    {poRandom, u"Zufällig"},
    {poStopAfterPlay, u"Nach dem Lied anhalten"},
};

void SetUpSwitch(QToolButton& button, const QString& caption, const QString& explanation) {
    button.setCheckable(true);
    button.setAutoRaise(true);
    button.setAccessibleName(caption);
    button.setToolTip(u"<b>%1</b><br>%2"_s.arg(caption, explanation));
}

}  // namespace

TPlaylistForm::TPlaylistForm(TPlayList& list, QWidget* parent)
    : QDockWidget(u"PlayList"_s, parent), list_(list) {
    setObjectName(u"PlaylistForm"_s);
    setAccessibleName(windowTitle());
    auto* contents = new QWidget(this);
    view_ = new TVisPlayList(list, contents);
    order_ = new QComboBox(contents);
    repeat_ = new QToolButton(contents);
    scan_ = new QToolButton(contents);
    scanTime_ = new QSpinBox(contents);
    totals_ = new QLabel(contents);
    totals_->setObjectName(u"playListTotals"_s);

    auto* layout = new QVBoxLayout(contents);
    layout->setContentsMargins(4, 0, 4, 0);
    layout->setSpacing(0);
    layout->addWidget(MakeOptions());
    layout->addWidget(view_, 1);
    layout->addWidget(totals_);
    totals_->setMargin(4);
    contents->setFocusProxy(view_);
    setWidget(contents);

    setAcceptDrops(true);
    FollowList();
    ShowTotals();
    ShowOptions();
}

void TPlaylistForm::FollowList() {
    PlayListEvents& events = list_.Events();
    const auto showTotals = [this] { ShowTotals(); };
    const auto showTotalsOf = [this](int) { ShowTotals(); };
    subscriptions_ += events.Inserted.Subscribe(showTotalsOf);
    subscriptions_ += events.Changed.Subscribe(showTotalsOf);
    subscriptions_ += events.Removed.Subscribe(showTotalsOf);
    subscriptions_ += events.Cleared.Subscribe(showTotals);
    subscriptions_ += events.Loaded.Subscribe(showTotals);
    // Who plays the list from elsewhere may set another order.
    subscriptions_ += events.OptionsChanged.Subscribe([this] { ShowOptions(); });
}

QWidget* TPlaylistForm::MakeOptions() {
    SetUpOrder();
    SetUpRepeat();
    SetUpScan();
    auto* options = new QWidget(widget());
    auto* layout = new QHBoxLayout(options);
    layout->setContentsMargins(0, 4, 0, 4);
    layout->setSpacing(4);
    layout->addWidget(order_, 1);
    layout->addWidget(repeat_);
    layout->addWidget(scan_);
    layout->addWidget(scanTime_);
    return options;
}

void TPlaylistForm::SetUpOrder() {
    order_->setObjectName(u"playOrder"_s);
    order_->setAccessibleName(u"Reihenfolge"_s);
    order_->setToolTip(u"In welcher Reihenfolge gespielt wird"_s);
    for (const auto& [order, caption] : kOrders)
        order_->addItem(QString::fromUtf16(caption), order);
    // A narrow window shows as much of it as there is room for.
    order_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    order_->setMinimumContentsLength(8);
    connect(order_, &QComboBox::activated, this, [this] {
        RunCommand([this] { list_.SetPlayOrder(static_cast<TPlayOrder>(order_->currentData().toInt())); });
    });
}

void TPlaylistForm::SetUpRepeat() {
    repeat_->setObjectName(u"repeatAll"_s);
    repeat_->setIcon(ThemeIcon(u"media-playlist-repeat"_s, QStyle::SP_BrowserReload));
    SetUpSwitch(*repeat_, u"Wiederholen"_s, u"Beginnt von vorn, wenn alle Lieder gespielt worden sind"_s);
    connect(repeat_, &QToolButton::toggled, this,
            [this](bool on) { RunCommand([&] { list_.SetRepeatAll(on); }); });
}

void TPlaylistForm::SetUpScan() {
    scan_->setObjectName(u"scan"_s);
    scan_->setIcon(ThemeIcon(u"media-seek-forward"_s, QStyle::SP_MediaSeekForward));
    SetUpSwitch(*scan_, u"Anspielen"_s, u"Spielt von jedem Lied nur den Anfang"_s);
    connect(scan_, &QToolButton::toggled, this, [this](bool on) { RunCommand([&] { list_.SetScan(on); }); });

    constexpr int kShortest = 2;  // seconds
    constexpr int kLongest = 600;
    scanTime_->setObjectName(u"scanTime"_s);
    scanTime_->setAccessibleName(u"Anspielzeit in Sekunden"_s);
    scanTime_->setToolTip(u"Wie lange jedes Lied angespielt wird"_s);
    scanTime_->setRange(kShortest, kLongest);
    scanTime_->setSuffix(u" s"_s);
    scanTime_->setKeyboardTracking(false);  // half a number is no time
    // It would take the names of files for text.
    for (auto* field : scanTime_->findChildren<QLineEdit*>())
        field->setAcceptDrops(false);
    connect(scanTime_, &QSpinBox::valueChanged, this, [this](int seconds) {
        RunCommand([&] { list_.SetScanTime(seconds * kMillisecondsPerSecond); });
    });
}

void TPlaylistForm::ShowOptions() {
    const QSignalBlocker blockers[] = {QSignalBlocker(order_), QSignalBlocker(repeat_), QSignalBlocker(scan_),
                                       QSignalBlocker(scanTime_)};
    order_->setCurrentIndex(order_->findData(list_.PlayOrder()));
    repeat_->setChecked(list_.RepeatAll());
    scan_->setChecked(list_.Scan());
    if (!scanTime_->hasFocus()) scanTime_->setValue(list_.ScanTime() / kMillisecondsPerSecond);
    scanTime_->setVisible(list_.Scan());
}

void TPlaylistForm::ShowTotals() {
    totals_->setText(TotalsText(list_.Count(), list_.TotalSeconds()));
}

// --- Drag and drop ---

// Between the entries the view takes it, and everywhere else it comes to the end of the list. What is dragged
// out of the list is in it already.
void TPlaylistForm::Consider(QDropEvent& drag) const {
    const QStringList formats = DropFormats();
    const bool isWelcome =
        drag.source() != view_ && std::ranges::any_of(formats, [&drag](const QString& format) {
            return drag.mimeData()->hasFormat(format);
        });
    if (!isWelcome) return drag.ignore();
    drag.setDropAction(Qt::CopyAction);
    drag.accept();
}

void TPlaylistForm::dragEnterEvent(QDragEnterEvent* event) {
    Consider(*event);
}

void TPlaylistForm::dragMoveEvent(QDragMoveEvent* event) {
    Consider(*event);
}

void TPlaylistForm::dropEvent(QDropEvent* event) {
    Consider(*event);
    if (event->isAccepted()) view_->TakeDrop(*event, list_.Count());
}
