#include "app/views/FilterField.h"

#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>

#include "app/models/FilteredSongs.h"
#include "app/views/FilterNotes.h"

using namespace Qt::StringLiterals;

namespace {

// Above so many songs the list waits for a pause in the typing, so that it does not lag behind the keys.
constexpr int kManySongs = 50'000;
constexpr int kPause = 60;  // milliseconds

QString HelpText() {
    return u"<p>Es bleiben die Songs, in denen alle Wörter vorkommen, in beliebiger Reihenfolge. Groß- und "
           "Kleinschreibung und Umlaute sind gleichgültig.</p>"
           "<p><b>\"zu spät\"</b> hält Wörter zusammen, <b>-live</b> schließt Songs aus.<br>"
           "<b>artist:ärzte</b> sucht nur in einem Feld, <b>jahr:1980..1989</b>, <b>bitrate:&gt;=192</b> und "
           "<b>länge:&lt;3:30</b> in einem Bereich.</p><p>Felder: %1</p>"_s.arg(
               SongFilter::FieldNames().join(u", "_s).toHtmlEscaped());
}

QString CountText(int shown, int all) {
    const QLocale german(QLocale::German);
    if (shown == all) return german.toString(all) + (all == 1 ? u" Song"_s : u" Songs"_s);
    return u"%1 von %2 Songs"_s.arg(german.toString(shown), german.toString(all));
}

}  // namespace

FilterField::FilterField(FilteredSongs& songs, QWidget* parent)
    : QWidget(parent),
      songs_(songs),
      edit_(new QLineEdit(this)),
      count_(new QLabel(this)),
      warning_(new QLabel(this)) {
    SetUpEdit();
    count_->setObjectName(u"filterCount"_s);
    warning_->setObjectName(u"filterWarning"_s);
    warning_->setTextFormat(Qt::PlainText);
    warning_->setWordWrap(true);
    warning_->hide();
    auto* layout = new QGridLayout(this);
    layout->setContentsMargins(4, 4, 8, 4);
    layout->setColumnStretch(0, 1);
    layout->addWidget(edit_, 0, 0);
    layout->addWidget(count_, 0, 1);
    layout->addWidget(warning_, 1, 0, 1, 2);
    setFocusProxy(edit_);
    FollowSongs();
    ShowCount();
}

// The line goes after this object and tells of losing the focus.
FilterField::~FilterField() {
    edit_->disconnect(this);
    edit_->removeEventFilter(this);
}

void FilterField::SetUpEdit() {
    edit_->setObjectName(u"filterEdit"_s);
    edit_->setAccessibleName(u"Filter"_s);
    edit_->setAccessibleDescription(u"Zeigt nur die Songs, in denen alle Wörter vorkommen"_s);
    edit_->setPlaceholderText(u"Filter: Wörter oder feld:wert, z. B. artist:ärzte jahr:1980..1989"_s);
    edit_->setToolTip(HelpText());
    edit_->setClearButtonEnabled(true);
    edit_->installEventFilter(this);
    pause_.setSingleShot(true);
    pause_.setInterval(kPause);
    connect(&pause_, &QTimer::timeout, this, &FilterField::Apply);
    connect(edit_, &QLineEdit::textChanged, this, &FilterField::TextChanged);
    connect(edit_, &QLineEdit::editingFinished, this, &FilterField::Remember);
}

void FilterField::FollowSongs() {
    const auto follow = [this] { ShowCount(); };
    connect(&songs_, &QAbstractItemModel::modelReset, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsInserted, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsRemoved, this, follow);
    // Songs that a filter hides come and go unseen.
    connect(&songs_.Songs(), &QAbstractItemModel::rowsInserted, this, follow);
    connect(&songs_.Songs(), &QAbstractItemModel::rowsRemoved, this, follow);
}

void FilterField::Activate() {
    edit_->setFocus(Qt::ShortcutFocusReason);
    edit_->selectAll();
}

QString FilterField::SearchText() const {
    const QString text = edit_->text().trimmed();
    return text.isEmpty() ? lastText_ : text;
}

void FilterField::TextChanged() {
    if (edit_->text().isEmpty() || songs_.Songs().rowCount() < kManySongs) return Apply();
    pause_.start();
}

void FilterField::Apply() {
    pause_.stop();
    songs_.SetText(edit_->text());
    ShowCount();
}

// An empty list says it itself.
void FilterField::ShowWarning() {
    const QString warning = songs_.rowCount() > 0 ? FilterWarning(edit_->text()) : QString();
    warning_->setText(warning);
    warning_->setVisible(!warning.isEmpty());
}

void FilterField::Remember() {
    const QString text = edit_->text().trimmed();
    if (!text.isEmpty()) lastText_ = text;
}

void FilterField::Leave() {
    Apply();
    if (OnLeave) OnLeave();
}

bool FilterField::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress) return QWidget::eventFilter(watched, event);
    switch (static_cast<QKeyEvent*>(event)->key()) {
        case Qt::Key_Escape:
            Remember();
            edit_->clear();
            break;
        case Qt::Key_Down:
        case Qt::Key_Return:
        case Qt::Key_Enter:
            Remember();
            break;
        default:
            return QWidget::eventFilter(watched, event);
    }
    Leave();
    return true;
}

void FilterField::ShowCount() {
    count_->setText(CountText(songs_.rowCount(), songs_.Songs().rowCount()));
    ShowWarning();
}
