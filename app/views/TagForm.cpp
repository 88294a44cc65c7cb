#include "app/views/TagForm.h"

#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QScrollArea>

#include "ReadMPEGHeader/Genres.h"
#include "app/models/SongProperties.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kCommentLines = 3;

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
    title_ = AddField(*form, u"Titel:"_s, u"title"_s);
    artist_ = AddField(*form, u"Artist:"_s, u"artist"_s);
    album_ = AddField(*form, u"Album:"_s, u"album"_s);
    year_ = AddField(*form, u"Jahr:"_s, u"year"_s);
    track_ = AddField(*form, u"Track:"_s, u"track"_s);
    genre_ = AddField(*form, u"Genre:"_s, u"genre"_s);
    mainGenre_ = AddField(*form, u"Hauptgenre:"_s, u"mainGenre"_s);
    comment_ = AddComment(*form, u"Kommentar:"_s);
    scroll->setWidget(sheet);
    setWidget(scroll);
}

// The fields are made in the order in which Tab goes through them; the form makes each the buddy of its
// label.
QLineEdit* TID3TagForm::AddField(QFormLayout& form, const QString& caption, const QString& name) {
    auto* field = new QLineEdit(form.parentWidget());
    field->setObjectName(name);
    field->setAccessibleName(caption.chopped(1));
    field->setReadOnly(true);
    form.addRow(caption, field);
    return field;
}

QPlainTextEdit* TID3TagForm::AddComment(QFormLayout& form, const QString& caption) {
    auto* field = new QPlainTextEdit(form.parentWidget());
    field->setObjectName(u"comment"_s);
    field->setAccessibleName(caption.chopped(1));
    field->setReadOnly(true);
    field->setTabChangesFocus(true);
    field->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    field->setMinimumHeight(kCommentLines * field->fontMetrics().lineSpacing());
    form.addRow(caption, field);
    return field;
}

void TID3TagForm::ShowSong(const TID3Tag* song) {
    const TID3Tag shown = song != nullptr ? *song : TID3Tag();
    Show(*title_, shown.Title);
    Show(*artist_, shown.Artist);
    Show(*album_, shown.Album);
    Show(*year_, ShownYear(shown));
    Show(*track_, ShownTrack(shown));
    Show(*genre_, song != nullptr ? ShownGenre(shown) : QString());
    Show(*mainGenre_, song != nullptr ? MainGenreLongName(shown.MainGenre) : QString());
    if (comment_->toPlainText() != shown.Comment) comment_->setPlainText(shown.Comment);
}
