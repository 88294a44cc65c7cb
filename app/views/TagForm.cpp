#include "app/views/TagForm.h"

#include <QCloseEvent>
#include <QHBoxLayout>
#include <QLocale>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QShortcut>
#include <QTabWidget>
#include <QToolButton>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/PageScroller.h"
#include "app/views/CoverEdit.h"
#include "app/views/ElidedLabel.h"
#include "app/views/TagFields.h"
#include "app/views/TagPreviewList.h"
#include "app/views/WaitCursor.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

// Milliseconds. The question waits until nobody types into the list any more: its letters are keys, too.
constexpr int kAskDelay = 500;
constexpr int kReadDelay = 150;
constexpr int kPreviewDelay = 200;

constexpr int kApply = 0;
constexpr int kDiscard = 1;
constexpr int kGoOn = 2;

const QString kTitle = u"ID3-Tag"_s;

}  // namespace

TID3TagForm::TID3TagForm(TMusicDatabase& database, QWidget* parent)
    : QDockWidget(kTitle, parent), database_(database), edits_(database) {
    setObjectName(u"ID3TagForm"_s);
    setAccessibleName(kTitle);
    auto* content = new QWidget(this);
    auto* layout = new QVBoxLayout(content);
    layout->addWidget(MakeHead());
    tabs_ = new QTabWidget(content);
    tabs_->setObjectName(u"tagTabs"_s);
    fields_ = new TagFields(edits_, database);
    cover_ = new CoverEdit(edits_);
    preview_ = new TagPreviewList;
    // In a small window with a large font the sheets are scrolled, not squeezed.
    tabs_->addTab(new PageScroller(fields_), u"Felde&r"_s);
    tabs_->addTab(new PageScroller(cover_), u"&Cover"_s);
    tabs_->addTab(preview_, u"V&orschau"_s);
    layout->addWidget(tabs_, 1);
    summary_ = new WrappedLabel(u"tagSummary"_s, content);
    layout->addWidget(summary_);
    layout->addWidget(MakeButtons());
    setWidget(content);
    fields_->OnEdited = [this] { Edited(); };
    fields_->OnNumber = [this] { Number(); };
    cover_->OnEdited = [this] { Edited(); };
    SetUpKeys();
    FollowDatabase();
    ShowAll();
}

QWidget* TID3TagForm::MakeHead() {
    auto* head = new QWidget;
    auto* layout = new QHBoxLayout(head);
    layout->setContentsMargins(0, 0, 0, 0);
    head_ = new ElidedLabel(head);
    head_->setObjectName(u"tagHead"_s);
    previous_ = MakeStep(-1);
    next_ = MakeStep(1);
    layout->addWidget(head_, 1);
    layout->addWidget(previous_);
    layout->addWidget(next_);
    return head;
}

QAbstractButton* TID3TagForm::MakeStep(int step) {
    auto* button = new QToolButton;
    const QString caption = step < 0 ? u"Vorheriger Song"_s : u"Nächster Song"_s;
    button->setObjectName(step < 0 ? u"previousSong"_s : u"nextSong"_s);
    button->setAccessibleName(caption);
    button->setToolTip(caption + (step < 0 ? u" (Strg+Bild auf)"_s : u" (Strg+Bild ab)"_s));
    button->setIcon(step < 0 ? ThemeIcon(u"go-up"_s, QStyle::SP_ArrowUp)
                             : ThemeIcon(u"go-down"_s, QStyle::SP_ArrowDown));
    const auto go = Guarded([this, step] {
        if (OnStep) OnStep(step);
    });
    connect(button, &QToolButton::clicked, this, go);
    return button;
}

QWidget* TID3TagForm::MakeButtons() {
    auto* row = new QWidget;
    auto* layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    apply_ = new QPushButton(u"An&wenden"_s, row);
    apply_->setObjectName(u"applyTag"_s);
    apply_->setToolTip(u"Schreibt die Tags in die Dateien (Strg+Eingabe)"_s);
    discard_ = new QPushButton(u"&Verwerfen"_s, row);
    discard_->setObjectName(u"discardTag"_s);
    discard_->setToolTip(u"Nimmt alle Änderungen zurück, die noch nicht angewendet sind"_s);
    connect(apply_, &QPushButton::clicked, this, Guarded([this] { Apply(); }));
    connect(discard_, &QPushButton::clicked, this, [this] { Discard(); });
    layout->addStretch();
    layout->addWidget(apply_);
    layout->addWidget(discard_);
    return row;
}

void TID3TagForm::SetUpKeys() {
    const auto press = [this](const QKeySequence& keys, QAbstractButton* button) {
        auto* shortcut = new QShortcut(keys, this);
        shortcut->setContext(Qt::WidgetWithChildrenShortcut);
        connect(shortcut, &QShortcut::activated, button, [button] {
            if (button->isEnabled()) button->click();
        });
    };
    press(u"Ctrl+Return"_s, apply_);
    press(u"Ctrl+Enter"_s, apply_);
    press(u"Ctrl+PgUp"_s, previous_);
    press(u"Ctrl+PgDown"_s, next_);
    const auto start = [this](QTimer& timer, int delay, void (TID3TagForm::*act)()) {
        timer.setSingleShot(true);
        timer.setInterval(delay);
        connect(&timer, &QTimer::timeout, this, Guarded([this, act] { (this->*act)(); }));
    };
    start(askTimer_, kAskDelay, &TID3TagForm::AskToLeave);
    start(readTimer_, kReadDelay, &TID3TagForm::ReadFiles);
    start(lookTimer_, 0, &TID3TagForm::LookAgain);
    start(previewTimer_, kPreviewDelay, &TID3TagForm::ShowPreview);
    reader_.OnRead = [this](const FileTags& tags) {
        edits_.TakeFileTags(tags);
        cover_->ShowFiles(&tags);
        ShowAll();
    };
}

// --- Songs ---

void TID3TagForm::ShowSongs(const std::vector<SongHandle>& songs, ChosenBy by) {
    chosen_ = songs;
    if (!edits_.Touched()) {
        stale_ = !isVisible();
        if (!stale_) Take(songs);
        return;
    }
    const bool others = !songs.empty() && songs != kept_ && !AreSameSongs(songs, edits_.Songs());
    if (others && by == ChosenBy::User && !visibleRegion().isEmpty())
        askTimer_.start();
    else
        askTimer_.stop();
    ShowHead();
}

void TID3TagForm::Take(const std::vector<SongHandle>& songs) {
    stale_ = false;
    kept_.clear();
    proposed_.clear();
    tooMany_ = songs.size() > kMostSongs;
    const auto wanted = tooMany_ ? std::vector<SongHandle>() : songs;
    if (wanted == edits_.Songs() && !edits_.Touched()) return ShowHead();
    edits_.SetSongs(wanted);
    reader_.Stop();
    const bool mayRead = !wanted.empty() && wanted.size() <= kMostFilesRead;
    if (mayRead)
        readTimer_.start();
    else
        readTimer_.stop();
    QString reason;
    if (mayRead) reason = u"Wird gelesen ..."_s;
    if (wanted.size() > kMostFilesRead) reason = u"Bei so vielen Songs werden die Cover nicht gezeigt."_s;
    cover_->ShowFiles(nullptr, reason);
    ShowAll();
}

void TID3TagForm::ReadFiles() {
    reader_.Read(edits_.Paths());
}

void TID3TagForm::showEvent(QShowEvent* event) {
    QDockWidget::showEvent(event);
    if (std::exchange(stale_, false)) LookAgain();
}

void TID3TagForm::Edit() {
    show();
    raise();
    tabs_->setCurrentIndex(0);
    fields_->FocusFirst();
}

SongHandle TID3TagForm::EditedSong(int end) const {
    const auto songs = edits_.Songs();
    if (songs.empty()) return {};
    return end > 0 ? songs.back() : songs.front();
}

// --- What others do with the songs meanwhile ---

void TID3TagForm::FollowDatabase() {
    CollectionEvents& events = database_.Events();
    subscriptions_ += events.Changed.Subscribe([this](auto&&...) { RecordsChanged(); });
    subscriptions_ += events.Removed.Subscribe([this](auto&&...) { RecordsChanged(); });
    subscriptions_ += events.Replaced.Subscribe([this] { RecordsChanged(); });
    subscriptions_ += events.Cleared.Subscribe([this] { RecordsChanged(); });
    subscriptions_ += events.ReadOnlyChanged.Subscribe([this] { ShowState(); });
    Operation& operation = database_.CurrentOperation();
    subscriptions_ += operation.Started.Subscribe([this] { ShowState(); });
    subscriptions_ += operation.Ended.Subscribe([this] {
        ShowState();
        RecordsChanged();
    });
}

// A run changes thousands of songs; its end is soon enough.
void TID3TagForm::RecordsChanged() {
    if (edits_.Count() > 0 && !database_.ProgressRunning() && !lookTimer_.isActive()) lookTimer_.start();
}

void TID3TagForm::LookAgain() {
    if (!isVisible() && !edits_.Touched()) {
        stale_ = true;
        return;
    }
    const bool wasTouched = edits_.Touched();
    const std::size_t before = edits_.Count();
    edits_.Refresh();
    std::erase_if(chosen_, [this](SongHandle song) { return database_.Songs().Find(song) == nullptr; });
    if (wasTouched && edits_.Count() == 0 && before > 0 && OnDone)
        OnDone(u"Die Songs, deren Tags bearbeitet wurden, sind nicht mehr in der Datenbank."_s);
    if (edits_.Count() > 0 && edits_.Count() <= kMostFilesRead) readTimer_.start();
    if (!edits_.Touched() && chosen_ != edits_.Songs()) return Take(chosen_);
    if (edits_.Count() == 0) cover_->ShowFiles(nullptr);
    ShowAll();
}

// --- Proposals ---

SongHandle TID3TagForm::SongToProposeTo() const {
    if (chosen_.size() != 1)
        throw ERukException(u"Markieren Sie in der Liste zuerst den einen Song, um den es geht."_s);
    return chosen_.front();
}

void TID3TagForm::Propose(const TagProposal& proposal) {
    const SongHandle song = SongToProposeTo();
    if (edits_.Songs() != std::vector{song} && !MayLeave()) throw EAbort();
    if (!edits_.Touched()) Take({song});
    if (!IsEditable()) throw ERukException(u"Der Tag lässt sich im Augenblick nicht bearbeiten."_s);
    if (!proposal.Fields.empty()) TakeProposed(proposal.Fields);
    if (proposal.Cover) edits_.SetCover(*proposal.Cover);
    show();
    raise();
    tabs_->setCurrentIndex(proposal.Cover ? 1 : 0);
    Edited();
}

// What an earlier proposal says, and this one does not, is of no use beside it.
void TID3TagForm::TakeProposed(const FieldTexts& fields) {
    for (const auto& [field, text] : proposed_)
        if (edits_.Touched(field) && edits_.Shown(field) == text) edits_.Restore(field);
    for (const auto& [field, text] : fields)
        edits_.Edit(field, text);
    proposed_ = fields;
}

// --- Edits that are not applied ---

void TID3TagForm::Edited() {
    kept_.clear();
    ShowAll();
}

// The list may have another order than when the songs were chosen.
void TID3TagForm::Number() {
    if (OnAskOrder) edits_.Reorder(OnAskOrder());
    edits_.Number();
}

bool TID3TagForm::MayLeave() {
    if (asking_ || applying_) return false;
    if (!edits_.Touched()) return true;
    const QScopedValueRollback asking(asking_, true);
    askTimer_.stop();
    const int answer =
        UserDialogs().Ask({.Text = u"Die Änderungen an den Tags (%1) sind noch nicht angewendet."_s.arg(
                               SongCountText(edits_.Count())),
                           .Buttons = {u"Anwenden"_s, u"Verwerfen"_s, u"Weiter bearbeiten"_s},
                           .Cancel = kGoOn});
    if (answer == kApply) return Apply();
    if (answer == kDiscard) Discard();
    return answer == kDiscard;
}

// Once a choice of other songs: who goes on editing sees the edited songs marked again.
void TID3TagForm::AskToLeave() {
    if (asking_ || applying_ || database_.ProgressRunning()) return;
    if (MayLeave()) return Take(chosen_);
    if (OnReturn) kept_ = OnReturn(edits_.Songs());
    ShowHead();
}

void TID3TagForm::Discard() {
    edits_.Discard();
    if (chosen_ != edits_.Songs()) return Take(chosen_);
    ShowAll();
}

void TID3TagForm::closeEvent(QCloseEvent* event) {
    bool mayLeave = false;
    RunCommand([&] { mayLeave = MayLeave(); });
    if (mayLeave)
        QDockWidget::closeEvent(event);
    else
        event->ignore();
}

// --- Applying ---

bool TID3TagForm::Apply() {
    if (applying_ || !edits_.Touched()) return !edits_.Touched();
    if (const auto fault = edits_.Fault()) {
        UserDialogs().ShowMessage(MessageKind::Warning, *fault);
        Edit();
        fields_->FocusFault();
        return false;
    }
    const BatchResult result = Update();
    // Where something is left to do the edits stay; songs that have them already do not change again.
    if (result.Failed.isEmpty() && !result.Stopped) edits_.Discard();
    LookAgain();
    if (result.Changed > 0 || !result.Failed.isEmpty()) ReportBatch(result);
    return !edits_.Touched();
}

BatchResult TID3TagForm::Update() {
    const QScopedValueRollback applying(applying_, true);
    std::vector<SongUpdate> updates = edits_.Updates();
    if (updates.empty()) return {};
    const QString caption = updates.size() == 1 ? u"1 Tag"_s : u"%1 Tags"_s.arg(updates.size());
    return UpdateSongs(database_, caption, updates, Renaming::BySettings);
}

// --- What is shown ---

bool TID3TagForm::IsEditable() const {
    return edits_.Count() > 0 && !database_.ReadOnly() && !database_.ProgressRunning();
}

void TID3TagForm::ShowAll() {
    fields_->Refresh();
    cover_->Refresh();
    ShowHead();
    ShowState();
    if (edits_.Touched())
        previewTimer_.start();
    else
        ShowPreview();
}

void TID3TagForm::ShowHead() {
    QString text = u"Kein Song gewählt"_s;
    if (tooMany_)
        text =
            u"Zu viele Songs: höchstens %1"_s.arg(QLocale(QLocale::German).toString(qulonglong{kMostSongs}));
    else if (edits_.Count() > 1)
        text = SongCountText(edits_.Count());
    else if (const TID3Tag* song = edits_.First())
        text = song->FileName.mid(LastSeparator(song->FileName) + 1);
    const bool others = edits_.Touched() && !chosen_.empty() && !AreSameSongs(chosen_, edits_.Songs());
    head_->setText(others ? text + u" (nicht die markierten)"_s : text);
    const TID3Tag* song = edits_.First();
    head_->setToolTip(song != nullptr && edits_.Count() == 1 ? song->FileName : head_->text());
}

void TID3TagForm::ShowState() {
    const bool editable = IsEditable();
    const bool touched = edits_.Touched();
    fields_->SetEditable(editable);
    cover_->SetEditable(editable);
    apply_->setEnabled(editable && touched);
    discard_->setEnabled(touched && !applying_);
    previous_->setEnabled(edits_.Count() > 0);
    next_->setEnabled(edits_.Count() > 0);
    const QString title = touched ? kTitle + u" *"_s : kTitle;
    if (title != windowTitle()) setWindowTitle(title);
}

void TID3TagForm::ShowPreview() {
    previewTimer_.stop();
    if (applying_) return;
    const auto fault = edits_.Fault();
    TagPreview preview;
    if (!fault && edits_.Touched()) {
        const WaitCursor wait;
        preview =
            PreviewOf(database_, edits_.Updates(), [this](SongHandle song) { return edits_.TotalOf(song); });
    }
    summary_->setText(fault ? *fault : edits_.Touched() ? PreviewSummary(preview, u"Anwenden"_s) : QString());
    tabs_->setTabText(2, preview.Songs > 0 ? u"V&orschau (%1)"_s.arg(preview.Songs) : u"V&orschau"_s);
    preview_->SetRows(std::move(preview.Rows));
}
