#include "app/dialogs/BannListDialog.h"

#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPushButton>
#include <QShortcut>
#include <QSortFilterProxyModel>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/BannList.h"
#include "app/dialogs/DecisionButtons.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 80;   // average characters
constexpr int kHeight = 26;  // lines

FileDialogOptions FileOptions(const QString& title) {
    return {.Title = title,
            .DefaultExtension = u"str"_s,
            .Filter = u"Bann-Listen|*.str|Alle Dateien|*.*"_s,
            .Preset = {},
            .ConfirmOverwrite = true};
}

}  // namespace

BannListDialog::BannListDialog(const SortedTextList& list, QWidget* parent)
    : QDialog(parent),
      list_(list),
      shown_(new QSortFilterProxyModel(this)),
      filter_(new QLineEdit(this)),
      view_(new QListView(this)) {
    setObjectName(u"bannListDialog"_s);
    setWindowTitle(u"Bann-Liste"_s);
    shown_->setSourceModel(&entries_);
    shown_->setFilterCaseSensitivity(Qt::CaseInsensitive);
    SetUpLayout();
    Show();
}

void BannListDialog::SetUpLayout() {
    filter_->setPlaceholderText(u"Filtern"_s);
    filter_->setAccessibleName(u"Filter"_s);
    filter_->setClearButtonEnabled(true);
    connect(filter_, &QLineEdit::textChanged, shown_,
            Guarded([this](const QString& text) { shown_->setFilterFixedString(text); }));
    view_->setModel(shown_);
    view_->setAccessibleName(u"Verbannte Songs"_s);
    view_->setUniformItemSizes(true);
    view_->setEditTriggers(QListView::NoEditTriggers);
    view_->setSelectionMode(QListView::ExtendedSelection);
    auto* deleteKey = new QShortcut(QKeySequence::Delete, view_, nullptr, nullptr, Qt::WidgetShortcut);
    connect(deleteKey, &QShortcut::activated, this, Guarded([this] { RemoveChosen(); }));
    auto* side = new QVBoxLayout;
    const auto addButton = [this, side](const QString& caption, std::function<void()> run) {
        auto* button = new QPushButton(caption, this);
        button->setAutoDefault(false);
        connect(button, &QPushButton::clicked, this, Guarded(std::move(run)));
        side->addWidget(button);
    };
    addButton(u"&Hinzufügen..."_s, [this] { Add(); });
    addButton(u"&Entfernen"_s, [this] { RemoveChosen(); });
    addButton(u"&Importieren..."_s, [this] { Import(); });
    addButton(u"E&xportieren..."_s, [this] { Export(); });
    side->addStretch();
    const DecisionButtons buttons = MakeDecisionButtons(*this, u"&Übernehmen"_s);
    buttons.Agree->setDefault(true);
    auto* middle = new QHBoxLayout;
    middle->addWidget(view_, 1);
    middle->addLayout(side);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(filter_);
    layout->addLayout(middle, 1);
    layout->addWidget(buttons.Box);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void BannListDialog::Show() {
    QStringList entries;
    for (const auto& row : list_)
        entries << row.Text;
    entries_.setStringList(entries);
}

void BannListDialog::Add() {
    const auto entry = UserDialogs().Input(u"Bann-Liste"_s, u"Artist und Titel, mit \" - \" dazwischen:"_s,
                                           {}, filter_->text());
    if (!entry || entry->trimmed().isEmpty()) return;
    const int place = list_.Insert(entry->trimmed());
    filter_->clear();
    Show();
    view_->setCurrentIndex(shown_->mapFromSource(entries_.index(place)));
}

void BannListDialog::RemoveChosen() {
    for (const QModelIndex& index : view_->selectionModel()->selectedIndexes())
        if (const int place = list_.IndexOf(index.data().toString()); place >= 0) list_.RemoveAt(place);
    Show();
}

void BannListDialog::Import() {
    const auto path = UserDialogs().OpenFile(FileOptions(u"Bann-Liste importieren"_s));
    if (!path) return;
    SortedTextList more;
    LoadBannList(more, *path);
    for (const auto& row : more)
        list_.Insert(row.Text);
    Show();
}

void BannListDialog::Export() const {
    if (const auto path = UserDialogs().SaveFile(FileOptions(u"Bann-Liste exportieren"_s)))
        SaveBannList(list_, *path);
}
