#include "app/views/PropertyForm.h"

#include <QVBoxLayout>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "app/views/CoverView.h"
#include "app/views/PropertyTree.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kReadDelay = 150;  // milliseconds after the last change

}  // namespace

TPropertyForm::TPropertyForm(const TMusicDatabase& database, QWidget* parent)
    : QDockWidget(u"Datei-Eigenschaften"_s, parent),
      database_(database),
      tree_(new PropertyTree(this)),
      cover_(new CoverView(this)) {
    setObjectName(u"PropertyForm"_s);
    setAccessibleName(windowTitle());
    tree_->setObjectName(u"properties"_s);
    tree_->setAccessibleName(windowTitle());
    auto* content = new QWidget(this);
    auto* layout = new QVBoxLayout(content);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(tree_, 1);
    layout->addWidget(cover_);
    setWidget(content);
    readTimer_.setSingleShot(true);
    connect(&readTimer_, &QTimer::timeout, this, &TPropertyForm::ReadFile);
}

void TPropertyForm::ShowSong(const TID3Tag* song) {
    const std::optional<TID3Tag> shown = song != nullptr ? std::optional(*song) : std::nullopt;
    if (shown == song_) return;
    song_ = shown;
    Reload();
}

void TPropertyForm::Reload() {
    details_.reset();
    stale_ = true;
    if (isVisible()) Refresh();
}

void TPropertyForm::Refresh() {
    stale_ = false;
    ShowRows();
    if (song_)
        readTimer_.start(kReadDelay);
    else
        readTimer_.stop();
}

void TPropertyForm::ReadFile() {
    readTimer_.stop();
    if (!song_) return;
    const QString file = FileWithinReach(database_, song_->FileName);
    // Of one that is away the reader says so.
    details_ = ReadFileDetails(file.isEmpty() ? song_->FileName : file, database_.AudioReadOptions());
    ShowRows();
}

void TPropertyForm::showEvent(QShowEvent* event) {
    QDockWidget::showEvent(event);
    if (stale_) Refresh();
}

void TPropertyForm::hideEvent(QHideEvent* event) {
    QDockWidget::hideEvent(event);
    if (!readTimer_.isActive()) return;
    readTimer_.stop();
    stale_ = true;
}

// --- Rows ---

std::vector<PropertyRow> TPropertyForm::FrameRows() const {
    if (!details_) return {};
    std::vector<PropertyRow> rows = details_->Frames;
    if (!details_->Error.isEmpty()) rows.insert(rows.begin(), {u"Fehler"_s, details_->Error});
    return rows;
}

std::vector<PropertyGroup> TPropertyForm::Groups() const {
    if (!song_) return {};
    PropertyGroup file{u"Datei"_s, PathProperties(*song_)};
    const std::vector<PropertyRow> pending = {{u"Größe"_s, u"…"_s}, {u"Änderungsdatum"_s, u"…"_s}};
    const auto& onDisk = details_ ? details_->File : pending;
    file.Rows.insert(file.Rows.end(), onDisk.begin(), onDisk.end());
    return {file,
            {u"Tags"_s, TagProperties(*song_)},
            {u"Technische Daten"_s, TechnicalProperties(*song_)},
            {u"Sammlung"_s, CollectionProperties(*song_)},
            {u"ID3v2-Frames"_s, FrameRows()}};
}

void TPropertyForm::ShowRows() {
    tree_->SetGroups(Groups());
    // The last cover stays until the next has been read: it is mostly the same, and would flicker.
    if (details_ || !song_) cover_->SetImage(details_ ? details_->Cover : QImage());
}
