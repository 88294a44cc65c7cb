#include "app/views/CoverEdit.h"

#include <QClipboard>
#include <QDragEnterEvent>
#include <QGridLayout>
#include <QGuiApplication>
#include <QMimeData>
#include <QPushButton>
#include <QShortcut>
#include <QTimer>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileNames.h"
#include "CommonRUKTools/SafeFile.h"
#include "app/models/CoverImage.h"
#include "app/models/CoverPictures.h"
#include "app/models/TagEdits.h"
#include "app/views/CoverView.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

CoverEdit::CoverEdit(TagEdits& edits, QWidget* parent)
    : QWidget(parent),
      edits_(edits),
      view_(new CoverView(this)),
      state_(new WrappedLabel(u"coverState"_s, this)) {
    setAcceptDrops(true);
    add_ = AddButton(u"addCover"_s, u"Hin&zufügen..."_s, &CoverEdit::Add);
    add_->setToolTip(u"PNG oder JPEG. Ein Bild lässt sich auch hierher ziehen."_s);
    paste_ = AddButton(u"pasteCover"_s, u"E&infügen"_s, &CoverEdit::Paste);
    paste_->setToolTip(u"Das Bild der Zwischenablage (Strg+V)"_s);
    save_ = AddButton(u"saveCover"_s, u"Speichern &unter..."_s, &CoverEdit::Save);
    remove_ = AddButton(u"removeCover"_s, u"En&tfernen"_s, &CoverEdit::Remove);
    auto* buttons = new QGridLayout;
    buttons->addWidget(add_, 0, 0);
    buttons->addWidget(paste_, 0, 1);
    buttons->addWidget(save_, 1, 0);
    buttons->addWidget(remove_, 1, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(view_);
    layout->addWidget(state_);
    layout->addLayout(buttons);
    layout->addStretch();
    auto* paste = new QShortcut(QKeySequence::Paste, this);
    paste->setContext(Qt::WidgetWithChildrenShortcut);
    connect(paste, &QShortcut::activated, this, Guarded([this] {
                if (paste_->isEnabled()) Paste();
            }));
    connect(QGuiApplication::clipboard(), &QClipboard::dataChanged, this, Guarded([this] { Refresh(); }));
    Refresh();
}

QPushButton* CoverEdit::AddButton(const QString& name, const QString& caption, void (CoverEdit::*command)()) {
    auto* button = new QPushButton(caption, this);
    button->setObjectName(name);
    connect(button, &QPushButton::clicked, this, Guarded([this, command] { (this->*command)(); }));
    return button;
}

// --- What is shown ---

void CoverEdit::ShowFiles(const FileTags* tags, const QString& reason) {
    cover_ = tags != nullptr && !tags->CoversDiffer ? tags->Cover : std::nullopt;
    differ_ = tags != nullptr && tags->CoversDiffer;
    reason_ = tags != nullptr ? tags->Failure : reason;
    Refresh();
}

QByteArray CoverEdit::Picture() const {
    if (!edits_.Cover()) return cover_.value_or(QByteArray());
    const auto* picture = std::get_if<CoverPicture>(&*edits_.Cover());
    return picture != nullptr ? picture->Bytes : QByteArray();
}

QString CoverEdit::State() const {
    const QByteArray picture = Picture();
    if (edits_.Cover())
        return picture.isEmpty() ? u"Das Cover wird mit „Anwenden“ entfernt. *"_s
                                 : u"Neu: %1 *"_s.arg(DescribePicture(picture));
    if (!reason_.isEmpty()) return reason_;
    if (differ_) return u"(verschieden)"_s;
    return picture.isEmpty() ? u"Kein Cover. Ein Bild (PNG, JPEG) lässt sich hierher ziehen."_s
                             : DescribePicture(picture);
}

void CoverEdit::Refresh() {
    const QByteArray picture = Picture();
    view_->SetImage(picture.isEmpty() ? QImage() : DecodeCover(picture));
    state_->setText(State());
    const bool mayHaveOne = !picture.isEmpty() || differ_ || (!edits_.Cover() && !reason_.isEmpty());
    add_->setEnabled(editable_);
    paste_->setEnabled(editable_ && CanPaste());
    save_->setEnabled(!picture.isEmpty());
    remove_->setEnabled(editable_ && mayHaveOne);
}

void CoverEdit::SetEditable(bool editable) {
    editable_ = editable;
    Refresh();
}

// --- Commands ---

void CoverEdit::Tell() {
    Refresh();
    if (OnEdited) OnEdited();
}

void CoverEdit::Add() {
    const auto path = UserDialogs().OpenFile({.Title = u"Cover auswählen"_s,
                                              .DefaultExtension = {},
                                              .Filter = u"Bilder|*.png;*.jpg;*.jpeg|Alle Dateien|*.*"_s,
                                              .Preset = {}});
    if (!path) return;
    edits_.SetCover(ReadPicture(*path));
    Tell();
}

bool CoverEdit::CanPaste() {
    const QMimeData* held = QGuiApplication::clipboard()->mimeData();
    return held != nullptr && MayHoldPicture(*held);
}

void CoverEdit::Paste() {
    if (const QMimeData* held = QGuiApplication::clipboard()->mimeData()) Take(*held);
}

void CoverEdit::Take(const QMimeData& given) {
    edits_.SetCover(PictureFrom(given));
    Tell();
}

void CoverEdit::Save() {
    const QByteArray picture = Picture();
    const TID3Tag* song = edits_.First();
    if (picture.isEmpty() || song == nullptr) return;
    const QString suffix = SuffixOfPicture(picture);
    const QString name = song->Album.isEmpty() ? song->Title : song->Album;
    const auto path = UserDialogs().SaveFile(
        {.Title = u"Cover speichern"_s,
         .DefaultExtension = suffix,
         .Filter = u"Bilder|*."_s + suffix + u"|Alle Dateien|*.*"_s,
         .Preset = FolderOf(song->FileName) + u'/' + MakeValidFileName(name) + u'.' + suffix,
         .ConfirmOverwrite = true});
    if (!path) return;
    SafeFile file(*path);
    file.Write({reinterpret_cast<const std::uint8_t*>(picture.constData()),
                static_cast<std::size_t>(picture.size())});
    file.Commit();
}

// A picture that has only just been chosen goes without a trace.
void CoverEdit::Remove() {
    const bool onlyChosen = edits_.Cover() && !cover_ && !differ_ && reason_.isEmpty();
    edits_.SetCover(onlyChosen ? std::nullopt : std::optional<CoverChange>(CoverRemoval()));
    Tell();
}

// --- Dropped pictures ---

void CoverEdit::dragEnterEvent(QDragEnterEvent* event) {
    if (!editable_ || !MayHoldPicture(*event->mimeData())) return event->ignore();
    event->setDropAction(Qt::CopyAction);  // the file stays where it is
    event->accept();
}

// A message would hold up the other program; it comes after the drop.
void CoverEdit::dropEvent(QDropEvent* event) {
    event->setDropAction(Qt::CopyAction);
    event->accept();
    try {
        Take(*event->mimeData());
    } catch (const ERukException& error) {
        QTimer::singleShot(0, this, [message = error.Message()] {
            UserDialogs().ShowMessage(MessageKind::Warning, message);
        });
    }
}
