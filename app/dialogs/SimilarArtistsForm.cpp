#include "app/dialogs/SimilarArtistsForm.h"

#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QShortcut>
#include <QSortFilterProxyModel>
#include <QSplitter>
#include <QTableView>
#include <QVBoxLayout>

#include "CommonRUKTools/Collation.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FoldedText.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "app/models/SongRows.h"
#include "app/views/RowList.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 130;      // average characters
constexpr int kHeight = 36;      // lines
constexpr int kNameLength = 24;  // average characters of an artist on a button
constexpr int kSongsLater = 60;  // milliseconds

// Every song of an artist costs a look at all songs.
std::vector<SongHandle> SongsOf(const TMusicDatabase& database, const QString& artist) {
    std::vector<SongHandle> songs;
    for (SongIndex index = 0; index < database.Count(); ++index)
        if (database.Song(index).Artist == artist) songs.push_back(database.Songs().HandleOf(index));
    return songs;
}

QString Quoted(const QString& name) {
    return u'„' + name + u'“';
}

}  // namespace

class SimilarArtistsForm::OpenPairs : public QSortFilterProxyModel {
 public:
    explicit OpenPairs(SimilarArtistsModel& pairs, QObject* parent)
        : QSortFilterProxyModel(parent), pairs_(pairs) {
        setSourceModel(&pairs);
        setSortRole(SimilarArtistsModel::kSortRole);
    }

    void SetText(const QString& text) {
        text_ = FoldText(text.trimmed());
        invalidateFilter();
    }
    void Refresh() { invalidateFilter(); }

 protected:
    bool filterAcceptsRow(int row, const QModelIndex&) const override {
        const SimilarArtists& pair = pairs_.PairAt(row);
        return pairs_.IsOpen(row) &&
               (ContainsFolded(pair.First, text_) || ContainsFolded(pair.Second, text_));
    }
    bool lessThan(const QModelIndex& left, const QModelIndex& right) const override {
        if (left.column() != SimilarArtistsModel::FirstArtist &&
            left.column() != SimilarArtistsModel::SecondArtist)
            return QSortFilterProxyModel::lessThan(left, right);
        return Collation::CompareExactly(left.data().toString(), right.data().toString()) < 0;
    }

 private:
    SimilarArtistsModel& pairs_;
    QString text_;
};

SimilarArtistsForm::SimilarArtistsForm(TMusicDatabase& database, QWidget* parent)
    : QDialog(parent),
      database_(database),
      pairs_(new SimilarArtistsModel(database, this)),
      shown_(new OpenPairs(*pairs_, this)),
      filter_(new QLineEdit(this)),
      count_(new QLabel(this)),
      table_(new QTableView(this)),
      done_(new QLabel(this)) {
    setObjectName(u"similarArtistsForm"_s);
    setWindowTitle(u"Ähnlich klingende Artists"_s);
    SetUpTable();
    SetUpLayout();
    FollowDatabase();
    songsLater_.setSingleShot(true);
    songsLater_.setInterval(kSongsLater);
    songsLater_.callOnTimeout(this, Guarded([this] { ShowSongs(); }));
    auto* undo = new QShortcut(QKeySequence::Undo, this);
    connect(undo, &QShortcut::activated, this, Guarded([this] {
                if (OnUndo && OnUndo()) done_->setText(u"Rückgängig gemacht."_s);
            }));
}

void SimilarArtistsForm::SetUpTable() {
    table_->setObjectName(u"pairs"_s);
    table_->setAccessibleName(u"Ähnlich klingende Artists"_s);
    table_->setModel(shown_);
    table_->setItemDelegate(new RowDelegate(table_));
    SetUpRowList(*table_);
    table_->setSelectionMode(QTableView::SingleSelection);
    table_->installEventFilter(this);
    QHeaderView& header = *table_->horizontalHeader();
    header.setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    header.setSectionResizeMode(QHeaderView::ResizeToContents);
    for (const int column : {SimilarArtistsModel::FirstArtist, SimilarArtistsModel::SecondArtist})
        header.setSectionResizeMode(column, QHeaderView::Stretch);
    // Shown as they were found, the most alike first, until the user wants another order.
    header.setSortIndicator(-1, Qt::AscendingOrder);
    table_->setSortingEnabled(true);
    connect(table_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            Guarded([this] { ShowPair(); }));
}

QSplitter* SimilarArtistsForm::MakeSongLists() {
    auto* splitter = new QSplitter(Qt::Horizontal, this);
    splitter->setChildrenCollapsible(false);
    for (std::size_t side = 0; side < songs_.size(); ++side) {
        auto* page = new QWidget(splitter);
        headings_[side] = new QLabel(page);
        headings_[side]->setTextFormat(Qt::PlainText);
        headings_[side]->setMinimumWidth(1);  // a long name is cut, and widens nothing
        songs_[side] = new SongRows(
            database_, {SongFieldId::Title, SongFieldId::Album, SongFieldId::Year, SongFieldId::Length},
            page);
        auto* list = new QTableView(page);
        list->setModel(songs_[side]);
        SetUpRowList(*list);
        list->setAccessibleName(side == 0 ? u"Songs des ersten Artists"_s : u"Songs des zweiten Artists"_s);
        list->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
        list->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
        for (const int narrow : {2, 3})
            list->horizontalHeader()->setSectionResizeMode(narrow, QHeaderView::ResizeToContents);
        auto* layout = new QVBoxLayout(page);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->addWidget(headings_[side]);
        layout->addWidget(list, 1);
    }
    return splitter;
}

QWidget* SimilarArtistsForm::MakeButtons() {
    auto* bar = new QWidget(this);
    auto* layout = new QHBoxLayout(bar);
    layout->setContentsMargins(0, 0, 0, 0);
    for (std::size_t i = 0; i < decisions_.size(); ++i) {
        decisions_[i] = new QPushButton(bar);
        decisions_[i]->setObjectName(u"decision"_s + QString::number(i + 1));
        decisions_[i]->setAutoDefault(false);
        connect(decisions_[i], &QPushButton::clicked, this,
                Guarded([this, i] { Decide(static_cast<Spelling>(i)); }));
        layout->addWidget(decisions_[i]);
    }
    decisions_[2]->setText(u"&3: Andere Schreibweise..."_s);
    decisions_[3]->setText(u"&4: Es sind zwei"_s);
    layout->addStretch();
    auto* correct = new QPushButton(u"&Korrekturdatei..."_s, bar);
    correct->setObjectName(u"correct"_s);
    correct->setToolTip(u"Ändert alle Songs, wie eine Datei mit richtigen Schreibweisen es sagt"_s);
    correct->setAutoDefault(false);
    connect(correct, &QPushButton::clicked, this, Guarded([this] {
                if (OnCorrect) OnCorrect();
            }));
    layout->addWidget(correct);
    auto* close = new QPushButton(u"S&chließen"_s, bar);
    close->setAutoDefault(false);
    connect(close, &QPushButton::clicked, this, &QDialog::close);
    layout->addWidget(close);
    return bar;
}

void SimilarArtistsForm::SetUpLayout() {
    filter_->setObjectName(u"filter"_s);
    filter_->setPlaceholderText(u"Filter"_s);
    filter_->setAccessibleName(u"Filter"_s);
    filter_->setClearButtonEnabled(true);
    filter_->installEventFilter(this);
    connect(filter_, &QLineEdit::textChanged, this, Guarded([this](const QString& text) {
                shown_->SetText(text);
                ShowCount();
            }));
    auto* find = new QShortcut(QKeySequence::Find, this);
    connect(find, &QShortcut::activated, filter_, [this] { filter_->setFocus(Qt::ShortcutFocusReason); });
    done_->setObjectName(u"done"_s);
    done_->setTextFormat(Qt::PlainText);
    done_->setWordWrap(true);
    done_->setText(u"Die Tasten 1 bis 4 entscheiden über die gewählte Zeile, Strg+Z nimmt zurück."_s);
    auto* top = new QHBoxLayout;
    top->addWidget(filter_, 1);
    top->addWidget(count_);
    auto* halves = new QSplitter(Qt::Vertical, this);
    halves->setChildrenCollapsible(false);
    halves->addWidget(table_);
    halves->addWidget(MakeSongLists());
    halves->setStretchFactor(0, 3);
    halves->setStretchFactor(1, 2);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top);
    layout->addWidget(halves, 1);
    layout->addWidget(done_);
    layout->addWidget(MakeButtons());
    setTabOrder(filter_, table_);
    table_->setFocus();
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

// A batch changes the rows of the artists one by one.
void SimilarArtistsForm::FollowDatabase() {
    refreshLater_.setSingleShot(true);
    refreshLater_.callOnTimeout(this, Guarded([this] { Refresh(); }));
    GroupEvents& groups = database_.GroupChanges();
    const auto later = [this](TOVType type) {
        if (type == ovArtist && !refreshLater_.isActive()) refreshLater_.start(0);
    };
    subscriptions_ +=
        groups.Inserted.Subscribe([later](TOVType type, int, const QString&, int) { later(type); });
    subscriptions_ += groups.Deleted.Subscribe([later](TOVType type, int) { later(type); });
    subscriptions_ += groups.Updated.Subscribe([later](TOVType type, int, int) { later(type); });
    subscriptions_ += groups.Rebuilt.Subscribe([later] { later(ovArtist); });
}

void SimilarArtistsForm::SetPairs(std::vector<SimilarArtists> pairs, bool stopped) {
    stopped_ = stopped;
    pairs_->SetPairs(std::move(pairs));
    ShowCount();
    table_->setCurrentIndex(shown_->index(0, 0));
    ShowPair();
}

// The row below takes the place of one that goes.
void SimilarArtistsForm::Refresh() {
    const int place = table_->currentIndex().row();
    const int before = CurrentRow();
    pairs_->Recount();
    shown_->Refresh();
    if (before < 0 || !pairs_->IsOpen(before))
        table_->setCurrentIndex(shown_->index(std::clamp(place, 0, std::max(shown_->rowCount() - 1, 0)), 0));
    ShowCount();
    ShowPair();
}

int SimilarArtistsForm::CurrentRow() const {
    const QModelIndex current = table_->currentIndex();
    return current.isValid() ? shown_->mapToSource(current).row() : -1;
}

void SimilarArtistsForm::ShowCount() {
    const QLocale german(QLocale::German);
    const int count = shown_->rowCount();
    count_->setText(german.toString(count) + (count == 1 ? u" Paar"_s : u" Paare"_s) +
                    (stopped_ ? u" (Suche abgebrochen)"_s : QString()));
}

void SimilarArtistsForm::ShowPair() {
    const int row = CurrentRow();
    for (QPushButton* decision : decisions_)
        decision->setEnabled(row >= 0);
    for (std::size_t side = 0; side < 2; ++side) {
        QString name;
        if (row >= 0) name = side == 0 ? pairs_->PairAt(row).First : pairs_->PairAt(row).Second;
        const int width = kNameLength * fontMetrics().averageCharWidth();
        QString cut = fontMetrics().elidedText(name, Qt::ElideMiddle, width);
        decisions_[side]->setText(u"&%1: Alle "_s.arg(side + 1) + Quoted(cut.replace(u'&', u"&&"_s)));
        decisions_[side]->setToolTip(row >= 0 ? u"Beide heißen dann "_s + Quoted(name) : QString());
        headings_[side]->setText(name);
    }
    songsLater_.start();
}

void SimilarArtistsForm::ShowSongs() {
    const int row = CurrentRow();
    songs_[0]->SetSongs(row >= 0 ? SongsOf(database_, pairs_->PairAt(row).First) : std::vector<SongHandle>());
    songs_[1]->SetSongs(row >= 0 ? SongsOf(database_, pairs_->PairAt(row).Second)
                                 : std::vector<SongHandle>());
}

void SimilarArtistsForm::Decide(Spelling spelling) {
    const int row = CurrentRow();
    if (row < 0) return;
    const SimilarArtists pair = pairs_->PairAt(row);  // a question lets time pass
    switch (spelling) {
        case Spelling::First:
            return Unify({pair.Second}, pair.First);
        case Spelling::Second:
            return Unify({pair.First}, pair.Second);
        case Spelling::AreTwo:
            pairs_->Settle(row);
            return Refresh();
        case Spelling::Other:
            break;
    }
    const auto typed =
        UserDialogs().Input(u"Artist vereinheitlichen"_s,
                            u"Wie sollen %1 und %2 heißen?"_s.arg(Quoted(pair.First), Quoted(pair.Second)),
                            {}, pair.FirstSongs >= pair.SecondSongs ? pair.First : pair.Second);
    if (typed && !typed->trimmed().isEmpty()) Unify({pair.First, pair.Second}, typed->trimmed());
}

void SimilarArtistsForm::Unify(const QStringList& artists, const QString& spelling) {
    const BatchResult result = UnifyArtists(database_, artists, spelling);
    done_->setText(SongCountText(static_cast<std::size_t>(result.Changed)) +
                   (result.Changed == 1 ? u" steht jetzt unter "_s : u" stehen jetzt unter "_s) +
                   Quoted(spelling) + u". Strg+Z nimmt das zurück."_s);
    Refresh();
    ReportBatch(result);
}

// --- Keys ---

bool SimilarArtistsForm::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress) return QDialog::eventFilter(watched, event);
    const auto& press = static_cast<const QKeyEvent&>(*event);
    if (watched == filter_) return LeavesFilter(press.key()) || QDialog::eventFilter(watched, event);
    const int decision = press.key() - Qt::Key_1;
    const bool isPlain = (press.modifiers() & ~Qt::KeypadModifier) == Qt::NoModifier;
    if (!isPlain || decision < 0 || decision >= static_cast<int>(decisions_.size()))
        return QDialog::eventFilter(watched, event);
    RunCommand([&] { Decide(static_cast<Spelling>(decision)); });
    return true;
}

bool SimilarArtistsForm::LeavesFilter(int key) {
    if (key == Qt::Key_Escape && !filter_->text().isEmpty()) {
        filter_->clear();
        return true;
    }
    if (key != Qt::Key_Down && key != Qt::Key_Return && key != Qt::Key_Enter) return false;
    table_->setFocus();
    if (!table_->currentIndex().isValid()) table_->setCurrentIndex(shown_->index(0, 0));
    return true;
}
