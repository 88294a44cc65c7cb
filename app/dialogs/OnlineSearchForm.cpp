#include "app/dialogs/OnlineSearchForm.h"

#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "app/views/RowList.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 110;           // average characters
constexpr int kHeight = 28;           // lines
constexpr std::size_t kAtOnce = 200;  // hits; then the window comes to its turn

}  // namespace

OnlineSearchForm::OnlineSearchForm(HitSource source, Details details, QWidget* parent)
    : QDialog(parent),
      source_(std::move(source)),
      details_(details),
      hits_(new SearchHitsModel(this)),
      table_(new QTableView(this)),
      count_(new QLabel(this)),
      take_(new QPushButton(u"In den &Tag übernehmen"_s, this)),
      cover_(new QPushButton(u"C&over übernehmen"_s, this)) {
    setObjectName(u"onlineSearchForm"_s);
    setWindowTitle(u"Such-Ergebnisse im Internet"_s);
    SetUpTable();
    SetUpLayout();
    readOn_.callOnTimeout(this, Guarded([this] { ReadOn(); }));
    readOn_.start(0);
    ShowState();
}

void OnlineSearchForm::SetUpTable() {
    table_->setObjectName(u"hits"_s);
    table_->setAccessibleName(windowTitle());
    table_->setModel(hits_);
    table_->setItemDelegate(new RowDelegate(table_));
    SetUpRowList(*table_);
    table_->setSelectionMode(QTableView::SingleSelection);
    QHeaderView& header = *table_->horizontalHeader();
    header.setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    header.setSectionResizeMode(QHeaderView::Stretch);
    FitColumns();
    for (int column = SearchHitsModel::Album; column < SearchHitsModel::ColumnCount; ++column)
        table_->setColumnHidden(column, details_ == Details::ArtistAndTitle);
    connect(table_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            Guarded([this] { ShowState(); }));
    connect(table_, &QTableView::activated, take_, &QPushButton::click);
}

// Rows that come later widen no column by themselves.
void OnlineSearchForm::FitColumns() {
    for (int column = SearchHitsModel::Year; column < SearchHitsModel::ColumnCount; ++column)
        table_->horizontalHeader()->setSectionResizeMode(column, QHeaderView::ResizeToContents);
}

void OnlineSearchForm::SetUpLayout() {
    take_->setObjectName(u"take"_s);
    take_->setToolTip(u"Trägt den Treffer in den Tag-Editor ein; geändert wird erst mit „Anwenden“ dort"_s);
    cover_->setObjectName(u"takeCover"_s);
    cover_->setToolTip(u"Holt das Cover des Albums aus dem Cover Art Archive in den Tag-Editor"_s);
    cover_->setVisible(details_ == Details::Album);
    auto* close = new QPushButton(u"S&chließen"_s, this);
    for (QPushButton* button : {take_, cover_, close})
        button->setAutoDefault(false);
    connect(take_, &QPushButton::clicked, this, Guarded([this] {
                if (const SearchHit* hit = Chosen(); hit != nullptr && OnTake) OnTake(*hit);
            }));
    connect(cover_, &QPushButton::clicked, this, Guarded([this] {
                if (const SearchHit* hit = Chosen(); hit != nullptr && OnTakeCover) OnTakeCover(*hit);
            }));
    connect(close, &QPushButton::clicked, this, &QDialog::close);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(take_);
    buttons->addWidget(cover_);
    buttons->addStretch();
    buttons->addWidget(close);
    count_->setObjectName(u"count"_s);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(table_, 1);
    layout->addWidget(count_);
    layout->addLayout(buttons);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void OnlineSearchForm::ReadOn() {
    std::vector<SearchHit> more;
    while (more.size() < kAtOnce) {
        auto hit = source_();
        if (!hit) {
            readOn_.stop();
            break;
        }
        more.push_back(std::move(*hit));
    }
    hits_->Append(more);
    if (!readOn_.isActive()) FitColumns();
    if (!table_->currentIndex().isValid()) table_->setCurrentIndex(hits_->index(0, 0));
    ShowState();
}

const SearchHit* OnlineSearchForm::Chosen() const {
    const QModelIndex current = table_->currentIndex();
    return current.isValid() ? &hits_->HitAt(current.row()) : nullptr;
}

void OnlineSearchForm::ShowState() {
    const int count = hits_->rowCount();
    count_->setText(count == 0 && !readOn_.isActive()
                        ? u"Nichts gefunden."_s
                        : QLocale(QLocale::German).toString(count) + u" Treffer"_s);
    const SearchHit* hit = Chosen();
    take_->setEnabled(hit != nullptr);
    cover_->setEnabled(hit != nullptr && !hit->Release.isEmpty());
}
