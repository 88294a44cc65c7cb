#include "app/views/SongListWidget.h"

#include <QContextMenuEvent>
#include <QHeaderView>
#include <QPainter>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QSet>
#include <algorithm>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/models/FilteredSongs.h"
#include "app/models/SongColumns.h"
#include "app/models/SongMime.h"
#include "app/views/ColumnLayout.h"
#include "app/views/ColumnMenu.h"
#include "app/views/FilterNotes.h"
#include "app/views/RowList.h"
#include "app/views/SongDrag.h"
#include "app/views/SongMarks.h"
#include "app/views/WaitCursor.h"

using namespace Qt::StringLiterals;

SongListWidget::SongListWidget(FilteredSongs& songs, TMusicDatabase& database, QWidget* parent)
    : QTableView(parent), songs_(songs), database_(database), order_(database.Order()) {
    setObjectName(u"songList"_s);
    setAccessibleName(u"Songs"_s);
    setModel(&songs);
    setItemDelegate(new RowDelegate(this));
    SetUpRowList(*this);
    setDragDropMode(DragOnly);
    SetUpHeader();
    ResetColumns();
    FollowModel();
    ShowSortIndicator();
}

void SongListWidget::SetUpHeader() {
    QHeaderView* header = horizontalHeader();
    // A header that knew the selection would look through all rows for columns that are selected whole.
    header->setSelectionModel(new QItemSelectionModel(&songs_, header));
    header->setSectionsMovable(true);
    header->setStretchLastSection(true);
    header->setSortIndicatorShown(true);
    header->setSectionsClickable(true);
    connect(header, &QHeaderView::sectionClicked, this, &SongListWidget::HeaderClicked);
    header->setContextMenuPolicy(Qt::CustomContextMenu);
    header->setResizeContentsPrecision(0);  // a column is fitted to the rows in sight
    connect(header, &QHeaderView::customContextMenuRequested, this, &SongListWidget::ShowColumnMenu);
}

void SongListWidget::changeEvent(QEvent* event) {
    QTableView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) FitRowsToFont(*this);
}

// In a list of rows Home and End go to the first and the last row, Left and Right move the columns.
QModelIndex SongListWidget::moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) {
    if (songs_.rowCount() == 0) return {};
    switch (action) {
        case MoveHome:
            return songs_.index(0, 0);
        case MoveEnd:
            return songs_.index(songs_.rowCount() - 1, 0);
        case MoveLeft:
            horizontalScrollBar()->triggerAction(QScrollBar::SliderSingleStepSub);
            return currentIndex();
        case MoveRight:
            horizontalScrollBar()->triggerAction(QScrollBar::SliderSingleStepAdd);
            return currentIndex();
        default:
            return QTableView::moveCursor(action, modifiers);
    }
}

// Which cell of its row was clicked or has the focus does not matter.
void SongListWidget::scrollTo(const QModelIndex& index, ScrollHint hint) {
    const int sideways = horizontalScrollBar()->value();
    QTableView::scrollTo(index, hint);
    horizontalScrollBar()->setValue(sideways);
}

void SongListWidget::paintEvent(QPaintEvent* event) {
    QTableView::paintEvent(event);
    if (songs_.rowCount() > 0) return;
    QPainter painter(viewport());
    painter.setPen(palette().color(QPalette::Disabled, QPalette::Text));
    const int margin = fontMetrics().height();
    painter.drawText(viewport()->rect().adjusted(margin, margin, -margin, -margin),
                     static_cast<int>(Qt::AlignCenter) | Qt::TextWordWrap, NothingShownText(songs_));
}

// --- Order ---

void SongListWidget::SetOrder(const SongOrder& order) {
    {
        const WaitCursor wait;
        const QScopedValueRollback sorting(sorting_, true);
        songs_.Songs().SetOrder(order);
        songs_.SetOrder(std::nullopt);
    }
    ShowSortIndicator();
    KeepFocusInSight();
}

void SongListWidget::SortShown(int section) {
    {
        const WaitCursor wait;
        const QScopedValueRollback sorting(sorting_, true);
        const auto& order = songs_.Order();
        songs_.SetOrder(ShownOrder{section, order && order->Column == section && !order->Backwards});
    }
    KeepFocusInSight();
}

void SongListWidget::KeepFocusInSight() {
    if (!database_.FollowFocus() || !currentIndex().isValid()) return;
    executeDelayedItemsLayout();
    scrollTo(currentIndex(), PositionAtCenter);
}

// Who sorts the database wants to see that order; songs also change their places within one.
void SongListWidget::FollowOrder() {
    if (database_.Order() == order_) return;
    order_ = database_.Order();
    songs_.SetOrder(std::nullopt);
    ShowSortIndicator();
    KeepFocusInSight();
}

void SongListWidget::SetSortingAllowed(bool allowed) {
    horizontalHeader()->setSectionsClickable(allowed);
}

void SongListWidget::HeaderClicked(int section) {
    const auto type = SongColumns()[static_cast<std::size_t>(section)].Field().Sort;
    if (type) {
        SongOrder order = database_.Order();
        order.Backwards = SortedColumn() == section && !order.Backwards;
        order.SortType = *type;
        RunCommand([&] { SetOrder(order); });
    } else {
        SortShown(section);
    }
    ShowSortIndicator();  // the header has moved it already, also where the order was refused
}

void SongListWidget::ShowSortIndicator() {
    const bool backwards = songs_.Order() ? songs_.Order()->Backwards : database_.SortBackwards();
    horizontalHeader()->setSortIndicator(SortedColumn(),
                                         backwards ? Qt::DescendingOrder : Qt::AscendingOrder);
}

// -1 when no column shows what the songs are sorted by.
int SongListWidget::SortedColumn() const {
    return songs_.Order() ? songs_.Order()->Column : ColumnOfSortType(database_.SortType());
}

// --- Columns ---

QByteArray SongListWidget::SaveColumns() const {
    return SaveColumnLayout(*horizontalHeader());
}

bool SongListWidget::RestoreColumns(const QByteArray& saved) {
    return RestoreColumnLayout(*horizontalHeader(), saved);
}

// A caption is never cut, whatever the font.
void SongListWidget::ResetColumns() {
    ensurePolished();
    QHeaderView& header = *horizontalHeader();
    for (int i = 0; i < songs_.columnCount(); ++i) {
        const SongColumn& column = SongColumns()[static_cast<std::size_t>(i)];
        header.showSection(i);
        header.moveSection(header.visualIndex(i), i);
        header.resizeSection(
            i, std::max(column.Width * fontMetrics().averageCharWidth(), header.sectionSizeHint(i)));
        header.setSectionHidden(i, !column.Shown);
    }
}

void SongListWidget::ShowColumnMenu(const QPoint& position) {
    QHeaderView& header = *horizontalHeader();
    auto* menu = new ColumnMenu(header, header.logicalIndexAt(position), this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->OnFit = [this](int section) { resizeColumnToContents(section); };
    menu->OnReset = [this] { ResetColumns(); };
    menu->AddFlags(database_.ShownFlag(), Guarded([this](quint32 flag) { ShowFlag(flag); }));
    menu->popup(header.viewport()->mapToGlobal(position));
}

void SongListWidget::ShowFlag(quint32 flag) {
    SongOrder order = database_.Order();
    order.ShownFlag = flag;
    if (order.SortType == stFlags)
        SetOrder(order);
    else
        database_.SetShownFlag(flag);
    songs_.Songs().ShownFlagChanged();
}

// --- Focus and marks ---

std::vector<SongIndex> SongListWidget::MarkedSongs() const {
    std::vector<SongIndex> marked;
    for (const auto& [first, last] : MarkedRows(*selectionModel()))
        for (int row = first; row <= last; ++row)
            if (const SongIndex index = songs_.IndexAt(row); index >= 0) marked.push_back(index);
    std::ranges::sort(marked);
    return marked;
}

std::vector<SongIndex> SongListWidget::ChosenSongs() const {
    auto songs = MarkedSongs();
    if (songs.empty() && FocusedSong() >= 0) songs.push_back(FocusedSong());
    return songs;
}

std::vector<SongHandle> SongListWidget::ChosenHandles() const {
    std::vector<SongHandle> handles;
    for (const SongIndex song : ChosenSongs())
        handles.push_back(database_.Songs().HandleOf(song));
    return handles;
}

std::vector<SongHandle> SongListWidget::ChosenInShownOrder(std::size_t most) const {
    std::vector<SongHandle> chosen;
    const auto add = [&](int row) {
        if (const SongIndex index = songs_.IndexAt(row); index >= 0)
            chosen.push_back(database_.Songs().HandleOf(index));
    };
    const RowRanges marked = MarkedRows(*selectionModel());
    const bool several = marked.size() > 1 || (marked.size() == 1 && marked[0].First < marked[0].Last);
    if (!several && currentIndex().isValid()) {
        add(currentIndex().row());
        return chosen;
    }
    for (const auto& [first, last] : marked)
        for (int row = first; row <= last && chosen.size() < most; ++row)
            add(row);
    return chosen;
}

SongIndex SongListWidget::FocusedSong() const {
    return currentIndex().isValid() ? songs_.IndexAt(currentIndex().row()) : -1;
}

std::vector<SongRef> SongListWidget::DraggedSongs() const {
    std::vector<SongRef> songs;
    for (const auto& [first, last] : MarkedRows(*selectionModel()))
        for (int row = first; row <= last; ++row)
            if (const SongIndex index = songs_.IndexAt(row); index >= 0)
                songs.push_back({database_.Song(index).FileName, index});
    return songs;
}

// The view's own way would paint every marked row, of which there may be a million.
void SongListWidget::startDrag(Qt::DropActions) {
    if (auto songs = DraggedSongs(); !songs.empty())
        DragSongs(*this, std::make_unique<SongMimeData>(std::move(songs)), Qt::CopyAction);
}

void SongListWidget::MarkAll() {
    MarkRows(*selectionModel(), Complement({}, songs_.rowCount()));
}

void SongListWidget::InvertMarks() {
    MarkRows(*selectionModel(), Complement(MarkedRows(*selectionModel()), songs_.rowCount()));
}

void SongListWidget::MarkByFilter() {
    const auto text =
        UserDialogs().Input(u"Mit Filter markieren"_s, u"Songs markieren, auf die passt:"_s, {}, markFilter_);
    if (!text || text->trimmed().isEmpty()) return;
    markFilter_ = *text;
    const SongFilter filter = SongFilter::Parse(*text);
    std::vector<int> rows;
    for (int row = 0; row < songs_.rowCount(); ++row) {
        const TID3Tag* song = songs_.SongAt(row);
        if (song != nullptr && filter.Matches(*song)) rows.push_back(row);
    }
    MarkRows(*selectionModel(), RangesOf(rows));
}

bool SongListWidget::FocusNext(const SongFilter& filter) {
    const int count = songs_.rowCount();
    const int start = currentIndex().row() + 1;  // the first one when none has the focus
    for (int i = 0; i < count; ++i) {
        const int row = (start + i) % count;
        const TID3Tag* song = songs_.SongAt(row);
        if (song == nullptr || !filter.Matches(*song)) continue;
        FocusRow(row);
        return true;
    }
    return false;
}

bool SongListWidget::FocusSong(SongIndex song, ScrollHint where) {
    songs_.Songs().SyncViews();
    const int row = songs_.RowOfSource(song);
    if (row < 0) return false;
    FocusRow(row);
    scrollTo(currentIndex(), where);
    return true;
}

std::vector<QString> SongListWidget::ShownFromFocus(std::size_t most) const {
    std::vector<QString> paths;
    if (!currentIndex().isValid()) return paths;
    for (int row = currentIndex().row(); row < songs_.rowCount() && paths.size() < most; ++row)
        if (const TID3Tag* song = songs_.SongAt(row)) paths.push_back(song->FileName);
    return paths;
}

void SongListWidget::SetPlaying(const QString& path) {
    songs_.Songs().SetPlaying(path);
}

SongHandle SongListWidget::NextAfter(const std::vector<SongHandle>& going) const {
    QSet<const TID3Tag*> records;
    for (const SongHandle song : going)
        records.insert(database_.Songs().Find(song));
    const auto stays = [&](int row) {
        const TID3Tag* song = songs_.SongAt(row);
        return song != nullptr && !records.contains(song);
    };
    const int focus = std::max(0, currentIndex().row());
    int row = focus;
    while (row < songs_.rowCount() && !stays(row))
        ++row;
    if (row == songs_.rowCount())
        for (row = focus - 1; row >= 0 && !stays(row);)
            --row;
    return row >= 0 && row < songs_.rowCount() ? database_.Songs().HandleOf(*songs_.SongAt(row))
                                               : SongHandle();
}

SongHandle SongListWidget::Neighbour(SongHandle song, int rows) const {
    songs_.Songs().SyncViews();
    const SongIndex place = database_.Songs().PositionOf(song);
    int row = place >= 0 ? songs_.RowOfSource(place) : -1;
    if (row < 0) row = currentIndex().row();
    const SongIndex neighbour = row >= 0 ? songs_.IndexAt(row + rows) : -1;
    return neighbour >= 0 ? database_.Songs().HandleOf(neighbour) : SongHandle();
}

std::size_t SongListWidget::MarkSongs(const QStringList& paths) {
    songs_.Songs().SyncViews();
    const QSet<QString> wanted(paths.begin(), paths.end());
    std::vector<int> rows;
    for (int row = 0; row < songs_.rowCount(); ++row) {
        const TID3Tag* song = songs_.SongAt(row);
        if (song != nullptr && wanted.contains(song->FileName)) rows.push_back(row);
    }
    if (rows.empty()) return 0;
    FocusRow(rows.front());
    MarkRows(*selectionModel(), RangesOf(rows));
    scrollTo(currentIndex(), PositionAtCenter);
    return rows.size();
}

void SongListWidget::Enter() {
    setFocus(Qt::OtherFocusReason);
    if (!currentIndex().isValid() && songs_.rowCount() > 0) FocusRow(0);
}

void SongListWidget::FocusRow(int row) {
    setCurrentIndex(songs_.index(row, 0));
}

void SongListWidget::keyboardSearch(const QString& letters) {
    const int section = std::max(0, SortedColumn());
    const int row = typeAhead_.Next(songs_, SongColumns()[static_cast<std::size_t>(section)],
                                    currentIndex().row(), letters);
    if (row >= 0) FocusRow(row);
}

void SongListWidget::contextMenuEvent(QContextMenuEvent* event) {
    if (!OnContextMenu) return;
    QPoint position = event->globalPos();
    if (event->reason() == QContextMenuEvent::Keyboard && currentIndex().isValid()) {
        scrollTo(currentIndex());
        position = viewport()->mapToGlobal(visualRect(currentIndex()).bottomLeft());
    }
    OnContextMenu(position);
}

// --- What stays when the list changes under the user's eyes ---

void SongListWidget::FollowModel() {
    connect(selectionModel(), &QItemSelectionModel::currentChanged, this, [this](const QModelIndex& current) {
        const TID3Tag* song = current.isValid() ? songs_.SongAt(current.row()) : nullptr;
        if (song != nullptr) focusedPath_ = song->FileName;
        viewport()->update();  // the focus shows in whole rows, the view would paint single cells
    });
    connect(&songs_, &QAbstractItemModel::layoutAboutToBeChanged, this, &SongListWidget::KeepTopRow);
    connect(&songs_, &QAbstractItemModel::layoutChanged, this, &SongListWidget::RestoreTopRow);
    connect(&songs_, &QAbstractItemModel::modelReset, this, &SongListWidget::RestoreFocus);
    songs_.OnFilterChange = [this] { FilterChanged(); };
    subscriptions_ += database_.Events().Reordered.Subscribe([this] { FollowOrder(); });
    subscriptions_ += database_.Events().Renamed.Subscribe(
        [this](const PathChanges& renamed) { focusedPath_ = renamed.value(focusedPath_, focusedPath_); });
}

// Songs that come in above the visible ones do not push them out of sight; a list at its top stays there.
void SongListWidget::KeepTopRow() {
    topRow_ = QPersistentModelIndex();
    if (!sorting_ && verticalScrollBar()->value() > 0) topRow_ = indexAt(QPoint(0, 0));
}

void SongListWidget::RestoreTopRow() {
    if (!topRow_.isValid()) return;
    executeDelayedItemsLayout();
    verticalScrollBar()->setValue(topRow_.row());
    topRow_ = QPersistentModelIndex();
}

void SongListWidget::RestoreFocus() {
    ShowSortIndicator();
    const SongIndex index = focusedPath_.isEmpty() ? -1 : database_.IndexOf(focusedPath_);
    if (index < 0 || index >= songs_.Songs().rowCount()) {
        focusedPath_.clear();
        return;
    }
    const int row = songs_.RowOfSource(index);
    if (row < 0) return;
    FocusRow(row);
    KeepFocusInSight();
}

// A song that the filter has hidden gets the focus back when it is shown again, unless another one has it.
void SongListWidget::FilterChanged() {
    if (!currentIndex().isValid() && !focusedPath_.isEmpty()) {
        songs_.Songs().SyncViews();
        const int row = songs_.RowOfSource(database_.IndexOf(focusedPath_));
        selectionModel()->setCurrentIndex(songs_.index(row, 0), QItemSelectionModel::NoUpdate);
    }
    executeDelayedItemsLayout();
    if (songs_.rowCount() == 0) viewport()->update();  // it says why it is empty
    if (currentIndex().isValid())
        scrollTo(currentIndex(), PositionAtCenter);
    else
        scrollToTop();
}
