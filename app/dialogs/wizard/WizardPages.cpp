#include "app/dialogs/wizard/WizardPages.h"

#include <QCheckBox>
#include <QDir>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>
#include <QVBoxLayout>

#include "CommonRUKTools/Dialogs.h"
#include "app/dialogs/FolderList.h"
#include "app/dialogs/NamePatternEdit.h"
#include "app/dialogs/NamePatternTexts.h"
#include "app/dialogs/PageScroller.h"
#include "app/dialogs/RootFolderField.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

// Tells the user, unless the fault says that this has been done, and goes to the field.
bool Refuse(const QString& fault, QLineEdit& field) {
    if (!fault.isEmpty()) UserDialogs().ShowMessage(MessageKind::Warning, fault);
    field.setFocus();
    field.selectAll();
    return false;
}

QString SummaryOf(const WizardChoice& choice) {
    QStringList lines;
    if (choice.Folders.isEmpty()) {
        lines << u"Es wird noch kein Ordner nach Songs durchsucht."_s;
    } else {
        lines << u"Nach Songs durchsucht werden mit ihren Unterordnern:"_s;
        for (const QString& folder : choice.Folders)
            lines << u"    "_s + Breakable(folder);
    }
    lines << QString();
    if (!choice.RenameAndMove) {
        lines << u"Ihre Dateien behalten ihre Namen und ihren Ort."_s;
    } else {
        lines << u"Dateien werden nach diesem Muster benannt, wenn sich ihre Tags ändern:"_s
              << u"    "_s + choice.Pattern << u"und liegen dann nach Genres geordnet in:"_s
              << u"    "_s + Breakable(choice.RootFolder)
              << (choice.RenameInPlace ? u"Dateien ohne Genre bleiben in ihrem Ordner."_s
                                       : u"Dateien ohne Genre kommen mit ihrem alten Pfad dorthin."_s);
    }
    return lines.join(u'\n');
}

}  // namespace

WizardSheet::WizardSheet(const QString& title, const QString& subTitle, WizardChoice& choice)
    : choice_(choice) {
    setTitle(title);
    setSubTitle(subTitle);
    auto* sheet = new QWidget;
    rows_ = new QVBoxLayout(sheet);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(new PageScroller(sheet));
}

QLabel* WizardSheet::AddText(const QString& text) {
    auto* label = new QLabel(text);
    label->setTextFormat(Qt::PlainText);
    label->setWordWrap(true);
    rows_->addWidget(label);
    return label;
}

WelcomeSheet::WelcomeSheet(WizardChoice& choice)
    : WizardSheet(u"Willkommen"_s, u"Richten Sie Ihre Musiksammlung ein."_s, choice) {
    AddText(
        u"Tunestead verwaltet Ihre Songs: Es merkt sich, was in den Dateien steht, sortiert, sucht und "
        u"ordnet "
        "sie. Die Dateien selbst bleiben, wo sie sind, solange Sie nichts anderes wünschen."_s);
    AddText(
        u"Auf den nächsten Seiten sagen Sie, wo Ihre Musik liegt und ob Tunestead Dateien umbenennen darf. "
        "Alles lässt sich später unter „Extras → Einstellungen...“ ändern."_s);
    Rows().addStretch();
}

FoldersSheet::FoldersSheet(WizardChoice& choice)
    : WizardSheet(u"Wo liegt Ihre Musik?"_s,
                  u"Diese Ordner durchsucht Tunestead mit allen Unterordnern nach Songs."_s, choice),
      folders_(new FolderList) {
    folders_->SetFolders(choice.Folders);
    auto* label = new QLabel(u"&Ordner mit Musik:"_s);
    label->setBuddy(folders_);
    Rows().addWidget(label);
    Rows().addWidget(folders_, 1);
}

bool FoldersSheet::validatePage() {
    choice_.Folders = folders_->Folders();
    return true;
}

RenameSheet::RenameSheet(WizardChoice& choice)
    : WizardSheet(u"Dateien umbenennen und verschieben?"_s,
                  u"Tunestead kann Dateien nach ihren Tags benennen, sobald sich diese ändern."_s, choice),
      keep_(new QRadioButton(u"&Nein, die Dateien behalten ihre Namen und ihren Ort"_s)),
      rename_(new QRadioButton(u"&Ja, umbenennen und nach Genres ordnen"_s)),
      root_(new RootFolderField(u"Stammordner der Songs"_s)),
      pattern_(new NamePatternEdit),
      inPlace_(new QCheckBox(u"Dateien beim Umbenennen in ihrem &Ordner lassen"_s)),
      placeExample_(new WrappedLabel(u"placeExample"_s)) {
    keep_->setObjectName(u"keep"_s);
    rename_->setObjectName(u"rename"_s);
    Rows().addWidget(keep_);
    Rows().addWidget(rename_);
    auto* details = new QWidget;
    auto* form = new QFormLayout(details);
    form->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    form->setRowWrapPolicy(QFormLayout::WrapLongRows);
    form->addRow(u"&Stammordner:"_s, root_);
    form->addRow(u"&Muster der Namen:"_s, pattern_);
    inPlace_->setObjectName(u"KeepFolders"_s);
    inPlace_->setChecked(choice.RenameInPlace);
    form->addRow(inPlace_);
    form->addRow(placeExample_);
    Rows().addWidget(details);
    AddText(
        u"Platzhalter stehen zwischen Prozentzeichen und werden durch die Angaben des Songs ersetzt, etwa "
        "%ARTIST%, %TITLE%, %ALBUM%, %TRACKNR% oder %YEAR%. Alle nennt der Knopf „Platzhalter“. Ein Song mit "
        "einem Genre kommt in dessen Ordner im Stammordner."_s);
    Rows().addStretch();
    connect(rename_, &QRadioButton::toggled, details, &QWidget::setEnabled);
    details->setEnabled(choice.RenameAndMove);
    (choice.RenameAndMove ? rename_ : keep_)->setChecked(true);
    root_->SetFolder(choice.RootFolder);
    pattern_->SetPattern(choice.Pattern);
    connect(inPlace_, &QCheckBox::toggled, this, [this] { ShowExample(); });
    for (const QLineEdit* field : {&pattern_->Edit(), &root_->Edit()})
        connect(field, &QLineEdit::textChanged, this, [this] { ShowExample(); });
    ShowExample();
}

void RenameSheet::ShowExample() {
    placeExample_->setText(choice_.Example.Text({.Pattern = pattern_->Pattern(),
                                                 .RootFolder = root_->Folder(),
                                                 .ByGenre = true,
                                                 .GenreFolders = choice_.GenreFolders,
                                                 .InPlace = inPlace_->isChecked()}));
}

bool RenameSheet::validatePage() {
    choice_.RenameAndMove = rename_->isChecked();
    if (!choice_.RenameAndMove) return true;
    if (const auto fault = root_->Fault()) return Refuse(*fault, root_->Edit());
    if (const auto fault = FaultOfPattern(pattern_->Pattern())) return Refuse(*fault, pattern_->Edit());
    choice_.RootFolder = root_->Folder();
    choice_.Pattern = pattern_->Pattern();
    choice_.RenameInPlace = inPlace_->isChecked();
    return true;
}

FinishSheet::FinishSheet(WizardChoice& choice)
    : WizardSheet(u"Fertig"_s, u"So wird Ihre Sammlung eingerichtet."_s, choice),
      summary_(AddText(QString())),
      scan_(new QCheckBox(u"Jetzt nach &Songs suchen"_s)) {
    summary_->setObjectName(u"summary"_s);
    QSizePolicy policy = summary_->sizePolicy();
    policy.setHorizontalPolicy(QSizePolicy::Ignored);
    summary_->setSizePolicy(policy);
    scan_->setObjectName(u"scanNow"_s);
    scan_->setChecked(choice.ScanNow);
    Rows().addStretch();
    Rows().addWidget(scan_);
}

void FinishSheet::initializePage() {
    summary_->setText(SummaryOf(choice_));
    scan_->setEnabled(!choice_.Folders.isEmpty());
}

bool FinishSheet::validatePage() {
    choice_.ScanNow = scan_->isEnabled() && scan_->isChecked();
    return true;
}
