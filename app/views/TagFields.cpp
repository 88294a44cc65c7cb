#include "app/views/TagFields.h"

#include <QCheckBox>
#include <QComboBox>
#include <QCompleter>
#include <QEvent>
#include <QFormLayout>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QShortcut>
#include <QSignalBlocker>
#include <QStringListModel>
#include <QStyle>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/database/MusicManagment.h"
#include "ReadMPEGHeader/Genres.h"
#include "app/models/TagEdits.h"

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

constexpr int kCommentLines = 3;
constexpr int kNumberWidth = 7;  // average characters
constexpr int kTextWidth = 16;

const QString kDifferent = u"(verschieden)"_s;

QString CaptionOf(SongFieldId id) {
    return QString::fromUtf16(FieldOf(id).Caption);
}

QString NameOf(SongFieldId id) {
    return QString::fromLatin1(FieldOf(id).FormName);
}

// From its beginning, however long the text is; the user's own cursor stays.
void Show(QLineEdit& line, const std::optional<QString>& text, const QString& different = kDifferent) {
    const QSignalBlocker silent(line);
    line.setPlaceholderText(text ? QString() : different);
    if (line.text() == text.value_or(QString())) return;
    line.setText(text.value_or(QString()));
    line.setCursorPosition(0);
}

void Show(QPlainTextEdit& box, const std::optional<QString>& text) {
    const QSignalBlocker silent(box);
    box.setPlaceholderText(text ? QString() : kDifferent);
    if (box.toPlainText() != text.value_or(QString())) box.setPlainText(text.value_or(QString()));
}

// The wheel scrolls the sheet and chooses nothing in what happens to lie below the mouse.
class CalmCombo : public QComboBox {
 public:
    CalmCombo() {
        setFocusPolicy(Qt::StrongFocus);
        setSizeAdjustPolicy(AdjustToMinimumContentsLengthWithIcon);
        setMinimumContentsLength(kTextWidth);
        setInsertPolicy(NoInsert);
    }

 protected:
    void wheelEvent(QWheelEvent* event) override {
        if (hasFocus())
            QComboBox::wheelEvent(event);
        else
            event->ignore();
    }
};

QPalette FaultyPalette(const QPalette& palette) {
    constexpr qreal kShare = 0.25;
    const QColor base = palette.color(QPalette::Base);
    const QColor mixed = QColor::fromRgbF(static_cast<float>(base.redF() * (1 - kShare) + kShare),
                                          static_cast<float>(base.greenF() * (1 - kShare)),
                                          static_cast<float>(base.blueF() * (1 - kShare)));
    QPalette faulty = palette;
    faulty.setColor(QPalette::Base, mixed);
    return faulty;
}

}  // namespace

TagFields::TagFields(TagEdits& edits, const TMusicDatabase& database, QWidget* parent)
    : QWidget(parent), edits_(edits), database_(database), form_(new QFormLayout(this)) {
    form_->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    // In the order in which Tab goes through them.
    AddLine(Id::Title);
    AddLine(Id::Artist);
    AddLine(Id::Album);
    AddTracks();
    AddLine(Id::Year, kNumberWidth);
    AddGenre();
    AddRemix();
    AddMainGenre();
    AddLine(Id::PlayCount, kNumberWidth);
    AddFlags();
    AddComment();
    AddSuggestions(NameOf(Id::Artist), [this] {
        QStringList artists;
        for (const auto& row : database_.Artists())
            artists << row.Text;
        return artists;
    });
    AddSuggestions(NameOf(Id::Album), [this] {
        QStringList albums;
        for (const auto& row : database_.Albums())
            albums << row.Text;
        return albums;
    });
    auto* restore = new QShortcut(Qt::Key_Escape, this);
    restore->setContext(Qt::WidgetWithChildrenShortcut);
    connect(restore, &QShortcut::activated, this, &TagFields::RestoreFocused);
}

// --- Rows ---

QLabel* TagFields::AddRow(const QString& caption, QWidget* widget) {
    auto* label = new QLabel(caption + u':');
    label->setBuddy(widget);
    form_->addRow(label, widget);
    return label;
}

QLineEdit* TagFields::MakeLine(SongFieldId id) {
    auto* line = new QLineEdit;
    line->setObjectName(NameOf(id));
    line->setAccessibleName(CaptionOf(id));
    connect(line, &QLineEdit::textChanged, this,
            [this, id, line](const QString& text) { Edited(id, text, !line->isUndoAvailable()); });
    Follow(id, line, nullptr, [this, id, line] { ::Show(*line, edits_.Shown(id)); });
    return line;
}

void TagFields::AddLine(SongFieldId id, int width) {
    QLineEdit* line = MakeLine(id);
    if (width > 0)
        line->setMaximumWidth(2 * width * fontMetrics().averageCharWidth());
    else
        line->setMinimumWidth(kTextWidth * fontMetrics().averageCharWidth());
    fields_.back().Label = AddRow(CaptionOf(id), line);
}

void TagFields::AddComment() {
    auto* box = new QPlainTextEdit;
    box->setObjectName(NameOf(Id::Comment));
    box->setAccessibleName(CaptionOf(Id::Comment));
    box->setTabChangesFocus(true);
    box->setMinimumHeight(kCommentLines * box->fontMetrics().lineSpacing());
    connect(box, &QPlainTextEdit::textChanged, this,
            [this, box] { Edited(Id::Comment, box->toPlainText(), !box->document()->isUndoAvailable()); });
    Follow(Id::Comment, box, AddRow(CaptionOf(Id::Comment), box),
           [this, box] { ::Show(*box, edits_.Shown(Id::Comment)); });
}

// Track, total and the button that numbers the songs.
void TagFields::AddTracks() {
    auto* row = new QWidget;
    auto* layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    QLineEdit* track = MakeLine(Id::Track);
    Field& trackField = fields_.back();
    trackField.Show = [this, track] {
        if (edits_.Numbered())
            ::Show(*track, std::nullopt, u"1, 2, …"_s);
        else
            ::Show(*track, edits_.Shown(Id::Track));
    };
    track->setMinimumWidth(fontMetrics().horizontalAdvance(kDifferent + u"  "_s) +
                           2 * style()->pixelMetric(QStyle::PM_DefaultFrameWidth));
    trackField.Label = AddRow(CaptionOf(Id::Track), row);
    trackField.Label->setBuddy(track);
    auto* total = new QLineEdit;
    total->setObjectName(u"trackTotal"_s);
    total->setAccessibleName(u"Tracks gesamt"_s);
    connect(total, &QLineEdit::textChanged, this, [this, total](const QString& text) {
        if (text.isEmpty() && !total->isUndoAvailable())
            edits_.RestoreTotal();
        else
            edits_.EditTotal(text);
        Tell();
    });
    auto* of = new QLabel(u"von"_s);
    number_ = new QPushButton(u"Nu&mmerieren"_s);
    number_->setObjectName(u"number"_s);
    number_->setToolTip(u"Gibt den Songs in der Reihenfolge der Liste die Tracks 1, 2, 3 ..."_s);
    connect(number_, &QPushButton::clicked, this, Guarded([this] {
                if (OnNumber) OnNumber();
                Tell();
            }));
    layout->addWidget(track, 1);
    layout->addWidget(of);
    layout->addWidget(total, 1);
    layout->addWidget(number_);
    fields_.push_back({.Widget = total,
                       .Label = of,
                       .Caption = u"von"_s,
                       .Show = [this, total] { ::Show(*total, edits_.ShownTotal(), u"?"_s); },
                       .Touched = [this] { return edits_.TotalTouched(); },
                       .Restore = [this] { edits_.RestoreTotal(); },
                       .Faulty = [this] { return edits_.TotalFaulty(); }});
}

void TagFields::AddGenre() {
    auto* combo = new CalmCombo;
    combo->setObjectName(NameOf(Id::Genre));
    combo->setAccessibleName(CaptionOf(Id::Genre));
    combo->setEditable(true);
    combo->addItem(QString());
    for (const GenreRow& row : GenreTable())
        combo->addItem(QString::fromUtf16(row.Name));
    combo->completer()->setCompletionMode(QCompleter::PopupCompletion);
    combo->completer()->setFilterMode(Qt::MatchContains);
    connect(combo, &QComboBox::editTextChanged, this, [this, combo](const QString& text) {
        Edited(Id::Genre, text, !combo->lineEdit()->isUndoAvailable());
    });
    Follow(Id::Genre, combo, AddRow(CaptionOf(Id::Genre), combo), [this, combo] {
        const auto text = edits_.Shown(Id::Genre);
        const QSignalBlocker silent(combo);
        combo->lineEdit()->setPlaceholderText(text ? QString() : kDifferent);
        if (combo->currentText() != text.value_or(QString())) combo->setEditText(text.value_or(QString()));
    });
}

void TagFields::AddMainGenre() {
    auto* combo = new CalmCombo;
    combo->setObjectName(NameOf(Id::MainGenre));
    combo->setAccessibleName(CaptionOf(Id::MainGenre));
    combo->setPlaceholderText(kDifferent);
    for (int i = 0; i < kMainGenreCount; ++i)
        combo->addItem(MainGenreLongName(i));
    connect(combo, &QComboBox::activated, this,
            [this, combo] { Edited(Id::MainGenre, combo->currentText(), false); });
    Follow(Id::MainGenre, combo, AddRow(CaptionOf(Id::MainGenre), combo), [this, combo] {
        const auto text = edits_.Shown(Id::MainGenre);
        combo->setCurrentIndex(text ? combo->findText(*text) : -1);
    });
}

void TagFields::AddRemix() {
    auto* box = new QCheckBox;
    box->setObjectName(NameOf(Id::Remix));
    form_->addRow(QString(), box);
    const auto shown = [this]() -> std::optional<bool> {
        const auto text = edits_.Shown(Id::Remix);
        return text ? std::optional(*text == u"ja"_s) : std::nullopt;
    };
    FollowCheck(
        box, shown, [this](bool on) { edits_.Edit(Id::Remix, on ? u"ja"_s : u"nein"_s); },
        [this] { return edits_.Touched(Id::Remix); }, [this] { edits_.Restore(Id::Remix); });
    fields_.back().Caption = CaptionOf(Id::Remix);
}

void TagFields::AddFlags() {
    auto* row = new QWidget;
    auto* grid = new QGridLayout(row);
    grid->setContentsMargins(0, 0, 0, 0);
    const QStringList names = SongFlagNames();
    for (int i = 0; i < names.size(); ++i) {
        const quint32 bit = 1U << i;
        auto* box = new QCheckBox;
        box->setObjectName(u"flag%1"_s.arg(bit));
        grid->addWidget(box, i / 2, i % 2);
        FollowCheck(
            box, [this, bit] { return edits_.Flag(bit); }, [this, bit](bool on) { edits_.SetFlag(bit, on); },
            [this, bit] { return edits_.FlagTouched(bit); }, [this, bit] { edits_.RestoreFlag(bit); });
        fields_.back().Caption = names[i];
    }
    grid->setColumnStretch(1, 1);
    form_->addRow(CaptionOf(Id::Flags) + u':', row);
}

void TagFields::AddSuggestions(const QString& field, const std::function<QStringList()>& texts) {
    auto* line = findChild<QLineEdit*>(field);
    auto* model = new QStringListModel(line);
    auto* completer = new QCompleter(model, line);
    completer->setCaseSensitivity(Qt::CaseInsensitive);
    completer->setFilterMode(Qt::MatchContains);
    line->setCompleter(completer);
    line->installEventFilter(this);
    suggestions_.emplace_back(model, texts);
}

bool TagFields::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::FocusIn)
        for (const auto& [model, texts] : suggestions_)
            if (model->parent() == watched) model->setStringList(texts());
    return QWidget::eventFilter(watched, event);
}

// --- Edits ---

void TagFields::Follow(SongFieldId id, QWidget* widget, QLabel* label, std::function<void()> show) {
    fields_.push_back({.Widget = widget,
                       .Label = label,
                       .Caption = CaptionOf(id),
                       .Show = std::move(show),
                       .Touched = [this, id] { return edits_.Touched(id); },
                       .Restore = [this, id] { edits_.Restore(id); },
                       .Faulty = [this, id] { return edits_.Faulty(id); }});
}

// Where the songs differ there is a third state, which is also the way back to it.
void TagFields::FollowCheck(QCheckBox* box, const std::function<std::optional<bool>()>& shown,
                            const std::function<void(bool)>& edit, std::function<bool()> touched,
                            std::function<void()> restore) {
    connect(box, &QCheckBox::clicked, this, [this, box, edit, restore] {
        if (box->checkState() == Qt::PartiallyChecked)
            restore();
        else
            edit(box->isChecked());
        Tell();
    });
    const auto show = [box, shown, restore, touched] {
        const auto on = shown();
        if (!touched()) box->setTristate(!on);
        box->setToolTip(on ? QString() : kDifferent);
        box->setCheckState(!on ? Qt::PartiallyChecked : *on ? Qt::Checked : Qt::Unchecked);
    };
    fields_.push_back({.Widget = box,
                       .Button = box,
                       .Show = show,
                       .Touched = std::move(touched),
                       .Restore = std::move(restore)});
}

// A field of songs that differ is empty; who undoes all that was typed there has touched nothing.
void TagFields::Edited(SongFieldId id, const QString& text, bool asAtFirst) {
    if (text.isEmpty() && asAtFirst && !edits_.Common(id))
        edits_.Restore(id);
    else
        edits_.Edit(id, text);
    Tell();
}

void TagFields::Tell() {
    Refresh();
    if (OnEdited) OnEdited();
}

void TagFields::RestoreFocused() {
    for (const Field& field : fields_)
        if (field.Widget->hasFocus() && field.Touched()) {
            field.Restore();
            return Tell();
        }
}

// --- What is shown ---

void TagFields::Refresh() {
    for (Field& field : fields_) {
        field.Show();
        Mark(field);
    }
}

// What is not applied yet has a star, what cannot be has a colour.
void TagFields::Mark(Field& field) const {
    const QString caption = field.Touched() ? field.Caption + u" *"_s : field.Caption;
    if (field.Label != nullptr)
        field.Label->setText(field.Label->text().endsWith(u':') ? caption + u':' : caption);
    else
        field.Button->setText(caption);
    field.Widget->setPalette(field.Faulty() ? FaultyPalette(palette()) : QPalette());
}

void TagFields::SetEditable(bool editable) {
    for (const Field& field : fields_) {
        if (auto* line = qobject_cast<QLineEdit*>(field.Widget))
            line->setReadOnly(!editable);
        else if (auto* box = qobject_cast<QPlainTextEdit*>(field.Widget))
            box->setReadOnly(!editable);
        else
            field.Widget->setEnabled(editable);
    }
    number_->setEnabled(editable && edits_.Count() > 0);
}

void TagFields::FocusFirst() {
    fields_.front().Widget->setFocus(Qt::OtherFocusReason);
}

void TagFields::FocusFault() {
    for (const Field& field : fields_)
        if (field.Faulty()) return field.Widget->setFocus(Qt::OtherFocusReason);
}
