#include "app/dialogs/ConversionDialog.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QDir>
#include <QFormLayout>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QStackedWidget>
#include <QVBoxLayout>

#include "app/dialogs/ConversionPages.h"
#include "app/dialogs/DecisionButtons.h"
#include "app/dialogs/RootFolderField.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 75;  // average characters

}  // namespace

ConversionDialog::ConversionDialog(const ConversionChoice& choice, std::size_t marked, std::size_t all,
                                   QWidget* parent)
    : QDialog(parent),
      given_(choice),
      songs_(new QComboBox(this)),
      format_(new QComboBox(this)),
      mp3_(new Mp3Page(choice.Settings.Mp3)),
      wav_(new WavPage(choice.Settings.Wav)),
      wma_(new WmaPage(choice.Settings.Wma)),
      folder_(new RootFolderField(u"Ordner für die konvertierten Songs"_s)) {
    setObjectName(u"conversionDialog"_s);
    setWindowTitle(u"Songs konvertieren"_s);
    AddSongs(marked, all, choice.Range);
    format_->setObjectName(u"format"_s);
    for (const MusicFormat format : kMusicFormats)
        format_->addItem(NameOf(format), static_cast<int>(format));
    SetUpLayout();
    connect(format_, &QComboBox::currentIndexChanged, this, [this] { ShowFormat(); });
    format_->setCurrentIndex(format_->findData(static_cast<int>(choice.Order.Format)));
    ShowFormat();
}

void ConversionDialog::AddSongs(std::size_t marked, std::size_t all, BatchRange range) {
    songs_->setObjectName(u"songs"_s);
    if (marked > 0)
        songs_->addItem(u"markierte ("_s + SongCountText(marked) + u')',
                        static_cast<int>(BatchRange::Marked));
    songs_->addItem(u"alle ("_s + SongCountText(all) + u')', static_cast<int>(BatchRange::All));
    songs_->setCurrentIndex(std::max(0, songs_->findData(static_cast<int>(range))));
}

// In the order of the formats.
QGroupBox* ConversionDialog::MakePages() {
    box_ = new QGroupBox;
    pages_ = new QStackedWidget;
    for (QWidget* page : std::initializer_list<QWidget*>{mp3_, wav_, wma_})
        pages_->addWidget(page);
    auto* layout = new QVBoxLayout(box_);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(pages_);
    return box_;
}

QGroupBox* ConversionDialog::MakePlaces() {
    auto* box = new QGroupBox(u"Wohin"_s);
    beside_ = new QRadioButton(u"&Neben die Quellen"_s);
    inFolder_ = new QRadioButton(u"In diesen &Ordner:"_s);
    inPlace_ = new QRadioButton(u"Anst&elle der Quellen, die in den Papierkorb kommen"_s);
    beside_->setObjectName(u"beside"_s);
    inFolder_->setObjectName(u"inFolder"_s);
    inPlace_->setObjectName(u"inPlace"_s);
    note_ = new WrappedLabel(u"note"_s);
    note_->setText(
        u"Songs auf Datenträgern bekommen, außer im Ordner, eine Kopie auf der Festplatte. "
        "Rückgängig holt die Quellen zurück."_s);
    auto* layout = new QVBoxLayout(box);
    for (QWidget* row : std::initializer_list<QWidget*>{beside_, inFolder_, folder_, inPlace_, note_})
        layout->addWidget(row);
    QRadioButton* const rows[] = {beside_, inFolder_, inPlace_};
    rows[static_cast<std::size_t>(given_.Order.Place)]->setChecked(true);
    folder_->SetFolder(given_.Order.Folder);
    connect(inFolder_, &QRadioButton::toggled, this, [this] { EnableFolder(); });
    connect(inFolder_, &QRadioButton::clicked, folder_, [this] { folder_->setFocus(); });
    EnableFolder();
    return box;
}

void ConversionDialog::SetUpLayout() {
    auto* form = new QFormLayout;
    form->addRow(u"&Songs:"_s, songs_);
    form->addRow(u"Forma&t:"_s, format_);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(MakePages());
    layout->addWidget(MakePlaces());
    layout->addStretch();
    // The last, so that the keyboard comes to them last.
    const DecisionButtons buttons = MakeDecisionButtons(*this, u"&Konvertieren"_s);
    buttons.Agree->setDefault(true);
    layout->addWidget(buttons.Box);
    // The note needs more lines the narrower it is.
    const int width = kWidth * fontMetrics().averageCharWidth();
    resize(width, layout->totalHeightForWidth(width));
}

void ConversionDialog::ShowFormat() {
    pages_->setCurrentIndex(static_cast<int>(Format()));
    box_->setTitle(u"Einstellungen für "_s + NameOf(Format()));
}

void ConversionDialog::EnableFolder() {
    folder_->setEnabled(inFolder_->isChecked());
}

MusicFormat ConversionDialog::Format() const {
    return static_cast<MusicFormat>(format_->currentData().toInt());
}

ConversionPlace ConversionDialog::Place() const {
    if (inFolder_->isChecked()) return ConversionPlace::Folder;
    return inPlace_->isChecked() ? ConversionPlace::InPlace : ConversionPlace::Beside;
}

ConversionChoice ConversionDialog::Choice() const {
    ConversionChoice choice = given_;
    choice.Range = static_cast<BatchRange>(songs_->currentData().toInt());
    choice.Order = {.Format = Format(), .Place = Place(), .Folder = folder_->Folder()};
    choice.Settings.Mp3 = mp3_->Settings();
    choice.Settings.Wav = wav_->Settings();
    choice.Settings.Wma = wma_->Settings();
    return choice;
}

void ConversionDialog::accept() {
    if (Place() != ConversionPlace::Folder || QDir::isAbsolutePath(folder_->Folder()))
        return QDialog::accept();
    QFont strong = note_->font();
    strong.setBold(true);
    note_->setFont(strong);
    note_->setText(folder_->Folder().isEmpty() ? u"Wählen Sie den Ordner für die konvertierten Songs."_s
                                               : folder_->Folder() + u" ist kein vollständiger Pfad."_s);
    folder_->Edit().setFocus();
}
