#include "app/dialogs/ProgressWindow.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QProgressBar>
#include <QPushButton>
#include <QVBoxLayout>
#include <limits>

#include "CommonRUKTools/Clock.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/ProgressTexts.h"
#include "app/views/ElidedLabel.h"

using namespace Qt::StringLiterals;

namespace {

// Milliseconds between two pictures. A run comes to thousands of points a second, and painting each would
// take longer than the run.
constexpr qint64 kShowInterval = 50;

// A bar counts in int; greater numbers keep their proportion. A maximum of 0 shows a bar without an end.
void SetBar(QProgressBar& bar, qint64 current, qint64 maximum) {
    const qint64 unit = maximum / std::numeric_limits<int>::max() + 1;
    bar.setRange(0, static_cast<int>(maximum / unit));
    bar.setValue(static_cast<int>(std::min(current, maximum) / unit));
}

}  // namespace

TPrgForm::TPrgForm(QWidget* parent)
    : QDialog(parent),
      heading_(new QLabel(this)),
      mainBar_(new QProgressBar(this)),
      mainLabel_(new ElidedLabel(this)),
      subBar_(new QProgressBar(this)),
      subLabel_(new ElidedLabel(this)),
      remaining_(new QLabel(this)),
      stop_(new QPushButton(ThemeIcon(u"process-stop"_s, QStyle::SP_BrowserStop), u"Abbrechen"_s, this)) {
    setObjectName(u"progressWindow"_s);
    heading_->setObjectName(u"heading"_s);
    mainBar_->setObjectName(u"mainBar"_s);
    mainLabel_->setObjectName(u"mainLabel"_s);
    subBar_->setObjectName(u"subBar"_s);
    subLabel_->setObjectName(u"subLabel"_s);
    remaining_->setObjectName(u"remaining"_s);
    stop_->setObjectName(u"stop"_s);
    connect(stop_, &QPushButton::clicked, this, &TPrgForm::reject);
    SetUpLayout();
    Reset();
    constexpr int kWidth = 70;  // average characters
    resize(kWidth * fontMetrics().averageCharWidth(), sizeHint().height());
}

void TPrgForm::SetUpLayout() {
    QFont bold = heading_->font();
    bold.setBold(true);
    heading_->setFont(bold);

    auto* bottom = new QHBoxLayout;
    bottom->addWidget(remaining_, 1);
    bottom->addWidget(stop_);
    auto* layout = new QVBoxLayout(this);
    for (QWidget* widget :
         {static_cast<QWidget*>(heading_), static_cast<QWidget*>(mainBar_), static_cast<QWidget*>(mainLabel_),
          static_cast<QWidget*>(subBar_), static_cast<QWidget*>(subLabel_)})
        layout->addWidget(widget);
    layout->addStretch();
    layout->addLayout(bottom);
}

void TPrgForm::Start() {
    Reset();
    stop_->setEnabled(true);
    stop_->setText(u"Abbrechen"_s);
    estimate_.Start(CurrentClock().Ticks());
    show();
}

void TPrgForm::ShowPoint(const ProgressPoint& point, int percent) {
    const qint64 now = CurrentClock().Ticks();
    const bool sameStage = point.Type == shownType_ && point.Max == shownMax_;
    const bool last = point.Max > 0 && point.Cur >= point.Max;
    if (sameStage && !last && now - shownAt_ < kShowInterval) return;
    shownType_ = point.Type;
    shownMax_ = point.Max;
    shownAt_ = now;
    heading_->setText(ProgressHeading(point.Type));
    SetBar(*mainBar_, point.Cur, point.Max);
    mainLabel_->setText(ProgressLabel(point.Cur, point.Max, point.Description));
    const bool hasSub = point.MaxSub > 0;
    subBar_->setVisible(hasSub);
    subLabel_->setVisible(hasSub);
    SetBar(*subBar_, point.CurSub, point.MaxSub);
    subLabel_->setText(ProgressLabel(point.CurSub, point.MaxSub));
    setWindowTitle(ProgressTitle(percent));
    ShowRemaining(estimate_.Estimate(point.Cur, point.Max, now));
}

void TPrgForm::Reset() {
    shownMax_ = -1;
    setWindowTitle(ProgressTitle(-1));
    heading_->setText(ProgressHeading(ptOther));
    SetBar(*mainBar_, 0, 0);
    mainLabel_->clear();
    subBar_->hide();
    subLabel_->hide();
    ShowRemaining(std::nullopt);
}

void TPrgForm::Finish() {
    hide();
    Reset();
}

void TPrgForm::reject() {
    if (!stop_->isEnabled()) return;
    stop_->setEnabled(false);
    stop_->setText(u"Wird abgebrochen..."_s);
    if (OnStop) OnStop();
}

void TPrgForm::ShowRemaining(std::optional<int> seconds) {
    remaining_->setText(seconds ? u"Verbleibende Zeit: "_s + FormatLength(*seconds, true) : QString());
}
