#include "app/views/CompFilesForm.h"

#include <QGridLayout>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/database/duplicates/SongQuality.h"
#include "app/desktop/Icons.h"
#include "app/views/CoverView.h"
#include "app/views/RowList.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kReadDelay = 150;           // milliseconds after the last change
constexpr double kDifferenceTint = 0.25;  // of the color of selections

enum ComparisonColumn { kName, kFirst, kSecond, kColumnCount };

}  // namespace

TCompFilesForm::TCompFilesForm(TMusicDatabase& database, QWidget* parent)
    : QWidget(parent),
      database_(database),
      table_(new QTableWidget(this)),
      verdict_(new WrappedLabel(u"verdict"_s, this)) {
    setObjectName(u"CompFilesForm"_s);
    setAccessibleName(u"Songs vergleichen"_s);
    SetUpTable();
    SetUpLayout();
    thread_.setMaxThreadCount(1);
    readTimer_.setSingleShot(true);
    readTimer_.setInterval(kReadDelay);
    readTimer_.callOnTimeout(this, Guarded([this] { ReadFiles(); }));
    CollectionEvents& events = database_.Events();
    subscriptions_ += events.Changed.Subscribe([this](SongIndex place, const TID3Tag&, const TID3Tag&) {
        const SongHandle song = database_.Songs().HandleOf(place);
        if (song == sides_[0].Song || song == sides_[1].Song) Refresh();
    });
    subscriptions_ += events.Cleared.Subscribe([this] { ShowSongs({}, {}); });
    Refresh();
}

TCompFilesForm::~TCompFilesForm() {
    StopReading();
    thread_.waitForDone();
}

void TCompFilesForm::SetUpTable() {
    table_->setObjectName(u"comparison"_s);
    table_->setAccessibleName(u"Unterschiede"_s);
    table_->setColumnCount(kColumnCount);
    table_->setHorizontalHeaderLabels({u"Feld"_s, u"Titel 1"_s, u"Titel 2"_s});
    SetUpRowList(*table_);
    table_->setTextElideMode(Qt::ElideMiddle);
    QHeaderView* header = table_->horizontalHeader();
    header->setSectionResizeMode(kName, QHeaderView::ResizeToContents);
    header->setSectionResizeMode(kFirst, QHeaderView::Stretch);
    header->setSectionResizeMode(kSecond, QHeaderView::Stretch);
}

QWidget* TCompFilesForm::MakeSide(int number) {
    Side& side = sides_[static_cast<std::size_t>(number)];
    auto* widget = new QWidget(this);
    side.Cover = new CoverView(widget);
    side.Cover->setAccessibleName(u"Cover von Titel %1"_s.arg(number + 1));
    side.Listen = new QPushButton(ThemeIcon(u"media-playback-start"_s, QStyle::SP_MediaPlay),
                                  u"Titel &%1 anhören"_s.arg(number + 1), widget);
    side.Listen->setToolTip(
        u"Spielt ab der Stelle, an der der andere Titel gerade ist (Leertaste schaltet um)"_s);
    connect(side.Listen, &QPushButton::clicked, this, Guarded([this, number] {
                if (OnListen) OnListen(number);
            }));
    auto* layout = new QVBoxLayout(widget);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(side.Listen);
    layout->addWidget(side.Cover, 1);
    layout->addStretch();
    return widget;
}

void TCompFilesForm::SetUpLayout() {
    constexpr int kTableShare = 5;  // of the width, beside 1 for the covers of each side
    auto* layout = new QGridLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(verdict_, 0, 0, 1, 3);
    layout->addWidget(MakeSide(0), 1, 0);
    layout->addWidget(table_, 1, 1);
    layout->addWidget(MakeSide(1), 1, 2);
    layout->setColumnStretch(0, 1);
    layout->setColumnStretch(1, kTableShare);
    layout->setColumnStretch(2, 1);
}

void TCompFilesForm::ShowSongs(SongHandle first, SongHandle second) {
    sides_[0].Song = first;
    sides_[1].Song = second;
    Refresh();
}

void TCompFilesForm::Refresh() {
    StopReading();
    const bool areThere = database_.Songs().Find(sides_[0].Song) != nullptr &&
                          database_.Songs().Find(sides_[1].Song) != nullptr;
    for (Side& side : sides_) {
        side.Details = {};
        side.Record = areThere ? std::optional(*database_.Songs().Find(side.Song)) : std::nullopt;
        side.Listen->setEnabled(areThere);
        if (!areThere) side.Cover->SetImage({});
    }
    ShowVerdict();
    ShowRows();
    if (areThere) readTimer_.start();
}

void TCompFilesForm::ShowVerdict() {
    if (!sides_[0].Record) return verdict_->setText(QString());
    const SongVerdict verdict = CompareQuality(*sides_[0].Record, *sides_[1].Record);
    if (verdict.Better == SongVerdict::Side::Neither) return verdict_->setText(u"Beide sind gleich gut."_s);
    const int better = verdict.Better == SongVerdict::Side::First ? 1 : 2;
    verdict_->setText(u"Titel %1 ist besser: %2."_s.arg(QString::number(better), verdict.Reason));
}

void TCompFilesForm::ShowRows() {
    table_->setRowCount(0);
    if (!sides_[0].Record) return;
    for (const DifferenceRow& row : FieldDifferences(*sides_[0].Record, *sides_[1].Record))
        AddRow(row);
    for (const DifferenceRow& row : FileDifferences(sides_[0].Details, sides_[1].Details))
        AddRow(row);
}

void TCompFilesForm::AddRow(const DifferenceRow& row) {
    const int number = table_->rowCount();
    table_->insertRow(number);
    QColor tint = palette().color(QPalette::Highlight);
    tint.setAlphaF(kDifferenceTint);
    const QString texts[] = {row.Name, row.First, row.Second};
    for (int column = 0; column < kColumnCount; ++column) {
        auto* item = new QTableWidgetItem(texts[column]);
        item->setToolTip(texts[column]);
        if (row.Differs()) {
            QFont bold = font();
            bold.setBold(true);
            item->setFont(bold);
            item->setBackground(tint);
        }
        table_->setItem(number, column, item);
    }
}

// --- The files ---

void TCompFilesForm::StopReading() {
    readTimer_.stop();
    if (stop_) *stop_ = true;
    stop_.reset();
}

// In a thread: a disk that sleeps takes its time.
void TCompFilesForm::ReadFiles() {
    StopReading();
    if (!sides_[0].Record) return;
    std::array<QString, 2> paths;
    for (std::size_t i = 0; i < paths.size(); ++i)
        paths[i] = sides_[i].Record->FileName;
    stop_ = std::make_shared<std::atomic<bool>>(false);
    thread_.start([this, paths, options = database_.AudioReadOptions(), stop = stop_] {
        std::array<FileDetails, 2> details;
        for (std::size_t i = 0; i < paths.size() && !*stop; ++i)
            if (!IsCdPath(paths[i])) details[i] = ReadFileDetails(paths[i], options);
        if (*stop) return;
        const auto show = [this, stop, details = std::move(details)] {
            if (*stop) return;
            for (std::size_t i = 0; i < details.size(); ++i) {
                sides_[i].Details = details[i];
                sides_[i].Cover->SetImage(details[i].Cover);
            }
            ShowRows();
        };
        QMetaObject::invokeMethod(this, show, Qt::QueuedConnection);
    });
}
