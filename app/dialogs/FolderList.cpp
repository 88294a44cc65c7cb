#include "app/dialogs/FolderList.h"

#include <QDir>
#include <QHBoxLayout>
#include <QListWidget>
#include <QPushButton>
#include <QShortcut>
#include <QVBoxLayout>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/intake/UpdateFolders.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kShownFolders = 4;

// Asks for the height of some folders only; where there is more room it takes it.
class LowList : public QListWidget {
 public:
    using QListWidget::QListWidget;
    QSize sizeHint() const override {
        return {30 * fontMetrics().averageCharWidth(), kShownFolders * fontMetrics().lineSpacing() * 3 / 2};
    }
    QSize minimumSizeHint() const override { return sizeHint(); }
};

}  // namespace

FolderList::FolderList(QWidget* parent)
    : QWidget(parent),
      list_(new LowList(this)),
      add_(new QPushButton(ThemeIcon(u"list-add"_s, QStyle::SP_DirIcon), u"&Hinzufügen..."_s, this)),
      remove_(new QPushButton(ThemeIcon(u"list-remove"_s, QStyle::SP_TrashIcon), u"&Entfernen"_s, this)) {
    setFocusProxy(list_);
    list_->setObjectName(u"folders"_s);
    list_->setAccessibleName(u"Ordner"_s);
    list_->setSelectionMode(QAbstractItemView::ExtendedSelection);
    list_->setTextElideMode(Qt::ElideMiddle);
    add_->setObjectName(u"addFolder"_s);
    remove_->setObjectName(u"removeFolder"_s);
    auto* buttons = new QVBoxLayout;
    buttons->addWidget(add_);
    buttons->addWidget(remove_);
    buttons->addStretch();
    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(list_, 1);
    layout->addLayout(buttons);
    auto* deleteKey = new QShortcut(QKeySequence::Delete, list_);
    deleteKey->setContext(Qt::WidgetShortcut);
    connect(deleteKey, &QShortcut::activated, this, [this] { RemoveMarked(); });
    connect(add_, &QPushButton::clicked, this, [this] { Add(); });
    connect(remove_, &QPushButton::clicked, this, [this] { RemoveMarked(); });
    connect(list_, &QListWidget::itemSelectionChanged, this, [this] { EnableRemove(); });
    EnableRemove();
}

QStringList FolderList::Folders() const {
    QStringList folders;
    for (int i = 0; i < list_->count(); ++i)
        folders << QDir::fromNativeSeparators(list_->item(i)->text());
    return folders;
}

void FolderList::SetFolders(const QStringList& folders) {
    list_->clear();
    for (const QString& folder : folders) {
        auto* item = new QListWidgetItem(ThemeIcon(u"folder"_s, QStyle::SP_DirIcon),
                                         QDir::toNativeSeparators(folder), list_);
        item->setToolTip(item->text());
    }
}

void FolderList::Add() {
    const auto chosen =
        UserDialogs().ChooseFolder(u"Ordner zum Durchsuchen nach Songs auswählen (inkl. Unterordner):"_s);
    if (!chosen) return;
    const QString folder = AbsolutePath(*chosen);
    SetFolders(MergeFolders(Folders(), {folder}));
    const QString shown = QDir::toNativeSeparators(folder);
    for (int i = 0; i < list_->count(); ++i)
        if (list_->item(i)->text() == shown) list_->setCurrentRow(i);
}

void FolderList::RemoveMarked() {
    const int row = list_->currentRow();
    qDeleteAll(list_->selectedItems());
    list_->setCurrentRow(std::min(row, list_->count() - 1));
}

void FolderList::EnableRemove() {
    remove_->setEnabled(!list_->selectedItems().isEmpty());
}
