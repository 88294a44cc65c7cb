#include "app/views/DuplicatesForm.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QScreen>
#include <QShortcut>
#include <QSlider>
#include <QSplitter>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "app/views/CompFilesForm.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPause = 150;  // milliseconds after the last key
constexpr int kWidth = 150;  // average characters
constexpr int kHeight = 44;  // lines

struct DecisionButton {
    QStringView Caption;
    QStringView Hint;
    PairDecision Decision;
};
constexpr DecisionButton kDecisions[] = {
    {u"Titel 1 behalten (1)", u"Titel 2 kommt in den Papierkorb", PairDecision::KeepFirst},
    {u"Titel 2 behalten (2)", u"Titel 1 kommt in den Papierkorb", PairDecision::KeepSecond},
    {u"Beide behalten (B)", u"Das Paar wird nicht mehr gezeigt; bei einem behaltenen Paar: wieder zeigen",
     PairDecision::KeepBoth},
    {u"Beide verbannen (V)", u"Beide kommen in den Papierkorb und auf die Bann-Liste", PairDecision::Ban},
};

QString PairCount(std::size_t count) {
    return QLocale(QLocale::German).toString(static_cast<qulonglong>(count)) +
           (count == 1 ? u" Paar"_s : u" Paare"_s);
}

}  // namespace

DuplicatesForm::DuplicatesForm(TMusicDatabase& database, QWidget* parent)
    : QWidget(parent, Qt::Window),
      database_(database),
      pairs_(database),
      filter_(new QLineEdit(this)),
      percentText_(new QLabel(this)),
      percent_(new QSlider(Qt::Horizontal, this)),
      groups_(new QCheckBox(u"&Gruppen"_s, this)),
      keptToo_(new QCheckBox(u"Auch b&ehaltene"_s, this)),
      count_(new QLabel(this)),
      list_(new TSrchDblsListView(pairs_, this)),
      comparison_(new TCompFilesForm(database, this)),
      splitter_(new QSplitter(Qt::Vertical, this)),
      buttons_(new QHBoxLayout),
      told_(new QLabel(this)) {
    setObjectName(u"duplicatesForm"_s);
    setWindowTitle(u"Doppelte Einträge"_s);
    SetUpChoice();
    SetUpButtons();
    SetUpKeys();
    SetUpLayout();
    pairs_.OnChanged = [this] { ShowCount(); };
    list_->OnRow = [this](int row) { ShowRow(row); };
    list_->OnDecision = [this](PairDecision decision) { RunCommand([&] { Decide(decision); }); };
    list_->OnListen = [this] { RunCommand([this] { Listen(1 - listened_); }); };
    comparison_->OnListen = [this](int song) { Listen(song); };
    ShowCount();
}

void DuplicatesForm::SetUpChoice() {
    filter_->setObjectName(u"duplicateFilter"_s);
    filter_->setAccessibleName(u"Filter"_s);
    filter_->setPlaceholderText(u"Filtern: Wörter, artist:ärzte, bitrate:>=192 (Strg+F)"_s);
    filter_->setClearButtonEnabled(true);
    percent_->setObjectName(u"leastPercent"_s);
    percent_->setAccessibleName(u"Nur ab dieser Wahrscheinlichkeit"_s);
    percent_->setRange(DuplicateQuery().LeastPercent, 100);
    percent_->setPageStep(5);
    groups_->setToolTip(u"Songs, die zusammenhängen, stehen beieinander"_s);
    keptToo_->setToolTip(u"Zeigt auch Paare, die Sie beide behalten wollen"_s);
    pause_.setSingleShot(true);
    pause_.setInterval(kPause);
    pause_.callOnTimeout(this, Guarded([this] { ChoiceChanged(); }));
    const auto later = [this] { pause_.start(); };
    connect(filter_, &QLineEdit::textChanged, this, later);
    connect(percent_, &QSlider::valueChanged, this, [this, later](int percent) {
        percentText_->setText(u"&nur ab %1 %"_s.arg(percent));
        later();
    });
    percentText_->setText(u"&nur ab %1 %"_s.arg(percent_->value()));
    percentText_->setBuddy(percent_);
    percentText_->setMinimumWidth(percentText_->fontMetrics().horizontalAdvance(u"nur ab 100 %  "_s));
    connect(groups_, &QCheckBox::toggled, this, Guarded([this](bool shown) {
                list_->ShowGroups(shown);
                ChoiceChanged();
            }));
    connect(keptToo_, &QCheckBox::toggled, this, Guarded([this](bool) { ChoiceChanged(); }));
}

void DuplicatesForm::SetUpButtons() {
    const auto add = [this](const QString& caption, const QString& hint, auto run) {
        auto* button = new QPushButton(caption, this);
        button->setToolTip(hint);
        connect(button, &QPushButton::clicked, this, Guarded([run](bool) { run(); }));
        buttons_->addWidget(button);
    };
    for (const DecisionButton& row : kDecisions)
        add(row.Caption.toString(), row.Hint.toString(), [this, &row] {
            Decide(row.Decision);
            list_->setFocus();
        });
    buttons_->addStretch();
    add(u"&Vorschlag für alle..."_s, u"Zeigt erst, welche Songs gehen würden"_s, [this] {
        pairs_.FinishWork();
        if (OnSuggest && !searching_) OnSuggest(pairs_.ShownPairs());
    });
    add(u"Neu &suchen"_s, u"Sucht ab der eingestellten Wahrscheinlichkeit (F5)"_s, [this] {
        if (OnSearchAgain) OnSearchAgain();
    });
}

void DuplicatesForm::SetUpKeys() {
    const auto bind = [this](const QKeySequence& keys, auto run) {
        connect(new QShortcut(keys, this), &QShortcut::activated, this, Guarded(run));
    };
    bind(QKeySequence::Undo, [this] {
        if (OnUndo) OnUndo();
    });
    bind(u"Ctrl+Shift+Z"_s, [this] {
        if (OnRedo) OnRedo();
    });
    bind(u"F5"_s, [this] {
        if (OnSearchAgain) OnSearchAgain();
    });
    bind(QKeySequence::Find, [this] {
        filter_->setFocus();
        filter_->selectAll();
    });
    bind(u"Esc"_s, [this] { filter_->hasFocus() ? list_->setFocus() : hide(); });
    connect(filter_, &QLineEdit::returnPressed, list_, [this] { list_->setFocus(); });
}

void DuplicatesForm::SetUpLayout() {
    auto* choice = new QHBoxLayout;
    choice->addWidget(filter_, 2);
    choice->addWidget(percentText_);
    choice->addWidget(percent_, 1);
    choice->addWidget(groups_);
    choice->addWidget(keptToo_);
    choice->addWidget(count_);
    splitter_->addWidget(list_);
    splitter_->addWidget(comparison_);
    splitter_->setChildrenCollapsible(false);
    splitter_->setStretchFactor(0, 1);
    splitter_->setStretchFactor(1, 1);
    told_->setTextFormat(Qt::PlainText);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(choice);
    layout->addWidget(splitter_, 1);
    layout->addLayout(buttons_);
    layout->addWidget(told_);
    setTabOrder(filter_, percent_);
    setTabOrder(percent_, groups_);
    setTabOrder(groups_, keptToo_);
    setTabOrder(keptToo_, list_);
    const QSize wanted(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
    resize(wanted.boundedTo(screen()->availableSize() * 0.9));
}

int DuplicatesForm::LeastPercent() const {
    return percent_->value();
}

void DuplicatesForm::Tell(const QString& sentence) {
    told_->setText(sentence);
}

// --- A search ---

DuplicateRows& DuplicatesForm::Begin(const DuplicateQuery& query) {
    searching_ = true;
    Tell({});
    percent_->setValue(query.LeastPercent);
    ChoiceChanged();
    DuplicateRows& rows = pairs_.Begin(query.SameArtistOnly);
    show();
    raise();
    activateWindow();
    list_->setFocus();
    return rows;
}

void DuplicatesForm::End(DuplicateEnd end) {
    searching_ = false;
    pairs_.EndSearch();
    if (end != DuplicateEnd::Done) Tell(u"Die Suche wurde vorzeitig beendet; die Liste ist unvollständig."_s);
    ShowCount();
}

// --- What is shown ---

void DuplicatesForm::ChoiceChanged() {
    pause_.stop();
    pairs_.SetChoice({.LeastPercent = percent_->value(),
                      .Filter = SongFilter::Parse(filter_->text()),
                      .InGroups = groups_->isChecked(),
                      .WithKeptPairs = keptToo_->isChecked()});
}

void DuplicatesForm::ShowCount() {
    if (pairs_.Works()) return count_->setText(u"Wird geordnet …"_s);
    QString text = PairCount(pairs_.Chosen());
    if (pairs_.Chosen() != pairs_.Found()) text += u" von "_s + PairCount(pairs_.Found());
    if (pairs_.Chosen() > DuplicateListModel::kMostShown)
        text += u", gezeigt werden die ersten "_s + PairCount(DuplicateListModel::kMostShown);
    count_->setText(text);
    if (!searching_ && pairs_.Found() == 0) Tell(u"Es gibt keine doppelten Einträge."_s);
}

void DuplicatesForm::ShowRow(int row) {
    listened_ = 1;
    const auto pair = pairs_.PairAt(row);
    comparison_->ShowSongs(pair ? pair->First : SongHandle(), pair ? pair->Second : SongHandle());
}

// --- What the user does ---

void DuplicatesForm::Decide(PairDecision decision) {
    if (searching_) return Tell(u"Warten Sie, bis die Suche zu Ende ist, oder brechen Sie sie ab."_s);
    std::vector<DuplicatePair> chosen;
    for (const int row : list_->ChosenRows())
        if (const auto pair = pairs_.PairAt(row)) chosen.push_back(*pair);
    if (!chosen.empty() && OnDecision) OnDecision(decision, chosen);
}

void DuplicatesForm::Listen(int song) {
    const auto pair = pairs_.PairAt(list_->currentIndex().row());
    if (!pair || !OnListen) return;
    listened_ = song;
    song == 0 ? OnListen(pair->First, pair->Second) : OnListen(pair->Second, pair->First);
}

// --- Settings ---

void DuplicatesForm::LoadSettings(const TRWReg& settings) {
    restoreGeometry(ReadSetting(settings, WindowSettings::kDuplicatesForm).value_or(QByteArray()));
}

void DuplicatesForm::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kDuplicatesForm, saveGeometry());
}
