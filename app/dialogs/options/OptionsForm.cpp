#include "app/dialogs/options/OptionsForm.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QScreen>
#include <QStackedWidget>
#include <QStyledItemDelegate>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/database/commands/Settings.h"
#include "app/dialogs/PageScroller.h"
#include "app/dialogs/options/CdsPage.h"
#include "app/dialogs/options/ConversionPage.h"
#include "app/dialogs/options/DatabasePage.h"
#include "app/dialogs/options/FilesPage.h"
#include "app/dialogs/options/GeneralPage.h"
#include "app/dialogs/options/InternetPage.h"
#include "app/dialogs/options/PlaybackPage.h"
#include "app/dialogs/options/RemoteControlPage.h"
#include "app/dialogs/options/RulesPage.h"
#include "app/dialogs/options/WatchChanges.h"

using namespace Qt::StringLiterals;

namespace {

// Gives every icon the same room, whatever sizes the icon theme has.
class PageDelegate : public QStyledItemDelegate {
 public:
    using QStyledItemDelegate::QStyledItemDelegate;

 protected:
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        if (const auto* view = qobject_cast<const QAbstractItemView*>(option->widget))
            option->decorationSize = view->iconSize();
    }
};

}  // namespace

TOptionsForm::TOptionsForm(TMusicDatabase& database, TRWReg& settings, QWidget* parent)
    : QDialog(parent),
      database_(database),
      settings_(settings),
      list_(new QListWidget(this)),
      stack_(new QStackedWidget(this)),
      buttons_(new QDialogButtonBox(this)) {
    setObjectName(u"OptionsForm"_s);
    setWindowTitle(u"Einstellungen"_s);
    list_->setObjectName(u"pages"_s);
    list_->setAccessibleName(u"Seiten der Einstellungen"_s);
    // In the order of OptionsTab.
    AddPage(new GeneralPage);
    AddPage(new DatabasePage);
    AddPage(new FilesPage);
    AddPage(new RulesPage(database_));
    AddPage(new PlaybackPage(database_));
    AddPage(new CdsPage);
    AddPage(new ConversionPage);
    AddPage(new RemoteControlPage(database_));
    AddPage(new InternetPage);
    LinkTwins();
    SetUpButtons();  // after the pages, as the tab key goes
    SetUpLayout();
    connect(list_, &QListWidget::currentRowChanged, this, [this](int row) {
        stack_->setCurrentIndex(row);
        defaults_->setEnabled(CurrentPage().HasDefaults());
    });
    Load();
    ShowTab(OptionsTab::General);
    SetUpSize();
}

// Lists that are taken down report it as a change, which must find the dialog still whole.
TOptionsForm::~TOptionsForm() {
    delete list_;
    delete stack_;
}

void TOptionsForm::AddPage(OptionsPage* page) {
    list_->addItem(new QListWidgetItem(page->Icon(), page->Caption()));
    stack_->addWidget(new PageScroller(page));
    pages_.push_back(page);
    WatchChanges(*page, [this] { SetChanged(true); });
}

// One setting on two pages: with the rules, and where it is about.
void TOptionsForm::LinkTwins() {
    auto* rule = stack_->findChild<QCheckBox*>(DatabaseSettings::kRenameInPlace.Row.Name.toString());
    auto* field = stack_->findChild<QCheckBox*>(u"KeepFolders"_s);
    connect(rule, &QCheckBox::toggled, field, &QCheckBox::setChecked);
    connect(field, &QCheckBox::toggled, rule, &QCheckBox::setChecked);
}

void TOptionsForm::SetUpButtons() {
    auto* ok = buttons_->addButton(u"OK"_s, QDialogButtonBox::AcceptRole);
    auto* cancel = buttons_->addButton(u"Abbrechen"_s, QDialogButtonBox::RejectRole);
    apply_ = buttons_->addButton(u"Übernehme&n"_s, QDialogButtonBox::ApplyRole);
    defaults_ = buttons_->addButton(u"Standard&werte"_s, QDialogButtonBox::ResetRole);
    ok->setObjectName(u"ok"_s);
    cancel->setObjectName(u"cancel"_s);
    apply_->setObjectName(u"apply"_s);
    defaults_->setObjectName(u"defaults"_s);
    defaults_->setToolTip(u"Zeigt auf dieser Seite die Werte einer neuen Installation"_s);
    ok->setDefault(true);
    connect(buttons_, &QDialogButtonBox::accepted, this, &TOptionsForm::accept);
    connect(buttons_, &QDialogButtonBox::rejected, this, &TOptionsForm::reject);
    connect(apply_, &QPushButton::clicked, this, [this] { RunCommand([this] { Apply(); }); });
    connect(defaults_, &QPushButton::clicked, this, [this] { LoadDefaults(); });
}

void TOptionsForm::SetUpLayout() {
    const int iconSize = 3 * fontMetrics().height() / 2;
    list_->setItemDelegate(new PageDelegate(list_));
    list_->setIconSize(QSize(iconSize, iconSize));
    list_->setSpacing(fontMetrics().height() / 6);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    list_->setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Expanding);
    list_->setFixedWidth(list_->sizeHintForColumn(0) + 2 * list_->frameWidth() + 2 * list_->spacing() +
                         fontMetrics().averageCharWidth());
    auto* middle = new QHBoxLayout;
    middle->addWidget(list_);
    middle->addWidget(stack_, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(middle, 1);
    layout->addWidget(buttons_);
}

// As large as its pages ask for, where the screen is.
void TOptionsForm::SetUpSize() {
    resize(sizeHint().boundedTo(screen()->availableSize() * 0.9));
}

OptionsPage& TOptionsForm::CurrentPage() const {
    return *pages_[static_cast<std::size_t>(std::max(0, stack_->currentIndex()))];
}

void TOptionsForm::ShowTab(OptionsTab tab) {
    list_->setCurrentRow(static_cast<int>(tab));
}

void TOptionsForm::SetChanged(bool changed) {
    apply_->setEnabled(changed);
}

// --- Values ---

void TOptionsForm::Load() {
    // What was changed outside the options is in the components and not in the store yet.
    for (const SettingsClient* client : database_.SettingsClients())
        client->SaveSettings(settings_);
    for (OptionsPage* page : pages_)
        page->Load(database_, settings_);
    SetChanged(false);
}

void TOptionsForm::LoadDefaults() {
    CurrentPage().LoadDefaults();
}

// A button that is chosen by its key leaves the focus where it is; the cell being edited counts all the same.
void TOptionsForm::CommitOpenEditor() {
    const QWidget* editor = focusWidget();
    const QWidget* viewport = editor != nullptr ? editor->parentWidget() : nullptr;
    if (viewport == nullptr) return;
    if (auto* view = qobject_cast<QAbstractItemView*>(viewport->parentWidget())) view->setFocus();
}

bool TOptionsForm::Check() {
    for (std::size_t i = 0; i < pages_.size(); ++i) {
        const auto fault = pages_[i]->Check();
        if (!fault) continue;
        list_->setCurrentRow(static_cast<int>(i));
        if (!fault->Text.isEmpty()) UserDialogs().ShowMessage(MessageKind::Warning, fault->Text);
        fault->Field->setFocus();
        if (auto* edit = qobject_cast<QLineEdit*>(fault->Field)) edit->selectAll();
        return false;
    }
    return true;
}

// The components take over what the pages have stored before everything is stored by those who own it.
void TOptionsForm::Store() {
    for (OptionsPage* page : pages_)
        page->Apply(database_, settings_);
    for (SettingsClient* client : database_.SettingsClients())
        client->LoadSettings(settings_);
    SaveDatabaseSettings(database_, settings_);
    settings_.Flush();
}

bool TOptionsForm::Apply() {
    if (database_.ProgressRunning()) {
        UserDialogs().ShowMessage(
            MessageKind::Warning,
            u"Die Einstellungen lassen sich erst ändern, wenn der laufende Vorgang beendet "
            "ist."_s);
        return false;
    }
    CommitOpenEditor();
    if (!Check()) return false;
    Store();
    SetChanged(false);
    if (OnApplied) OnApplied();
    return true;
}

void TOptionsForm::accept() {
    RunCommand([this] {
        if (Apply()) QDialog::accept();
    });
}
