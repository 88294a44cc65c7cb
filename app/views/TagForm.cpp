#include "app/views/TagForm.h"

#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QScrollArea>

using namespace Qt::StringLiterals;

namespace {

constexpr int kCommentLines = 3;

// From top to bottom.
constexpr SongFieldId kShown[] = {SongFieldId::Title,     SongFieldId::Artist, SongFieldId::Album,
                                  SongFieldId::Year,      SongFieldId::Track,  SongFieldId::Genre,
                                  SongFieldId::MainGenre, SongFieldId::Comment};

// From its beginning, however long the text is.
void Show(QLineEdit& field, const QString& text) {
    if (field.text() == text) return;
    field.setText(text);
    field.setCursorPosition(0);
}

}  // namespace

TID3TagForm::TID3TagForm(QWidget* parent) : QDockWidget(u"ID3-Tag"_s, parent) {
    setObjectName(u"ID3TagForm"_s);
    setAccessibleName(windowTitle());
    // In a small window with a large font the sheet is scrolled, not squeezed.
    auto* scroll = new QScrollArea(this);
    scroll->setWidgetResizable(true);
    scroll->setFrameShape(QFrame::NoFrame);
    scroll->setFocusPolicy(Qt::NoFocus);
    auto* sheet = new QWidget(scroll);
    auto* form = new QFormLayout(sheet);
    form->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    for (const SongFieldId id : kShown) {
        const SongField& field = FieldOf(id);
        if (id == SongFieldId::Comment)
            comment_ = AddComment(*form, field);
        else
            fields_.push_back({id, AddField(*form, field)});
    }
    scroll->setWidget(sheet);
    setWidget(scroll);
}

// The fields are made in the order in which Tab goes through them; the form makes each the buddy of its
// label.
QLineEdit* TID3TagForm::AddField(QFormLayout& form, const SongField& shown) {
    const QString caption = QString::fromUtf16(shown.Caption);
    auto* field = new QLineEdit(form.parentWidget());
    field->setObjectName(QString::fromLatin1(shown.FormName));
    field->setAccessibleName(caption);
    field->setReadOnly(true);
    form.addRow(caption + u':', field);
    return field;
}

QPlainTextEdit* TID3TagForm::AddComment(QFormLayout& form, const SongField& shown) {
    const QString caption = QString::fromUtf16(shown.Caption);
    auto* field = new QPlainTextEdit(form.parentWidget());
    field->setObjectName(QString::fromLatin1(shown.FormName));
    field->setAccessibleName(caption);
    field->setReadOnly(true);
    field->setTabChangesFocus(true);
    field->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    field->setMinimumHeight(kCommentLines * field->fontMetrics().lineSpacing());
    form.addRow(caption + u':', field);
    return field;
}

void TID3TagForm::ShowSong(const TID3Tag* song) {
    for (const auto& [id, field] : fields_)
        Show(*field, song != nullptr ? FieldOf(id).Text(*song) : QString());
    const QString comment = song != nullptr ? song->Comment : QString();
    if (comment_->toPlainText() != comment) comment_->setPlainText(comment);
}
