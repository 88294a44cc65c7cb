#include "app/views/VisPlayList.h"

#include <QContextMenuEvent>
#include <QDropEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QPainter>
#include <QScrollBar>
#include <algorithm>
#include <optional>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "app/views/PlayListDelegate.h"
#include "app/views/SongDrag.h"
#include "app/views/SongMarks.h"
#include "app/views/WaitCursor.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kTitle = static_cast<int>(PlayListColumn::Title);
constexpr int kNumber = static_cast<int>(PlayListColumn::Number);
constexpr int kLength = static_cast<int>(PlayListColumn::Length);

}  // namespace

TVisPlayList::TVisPlayList(TPlayList& list, QWidget* parent) : QTableView(parent), list_(list) {
    setObjectName(u"playList"_s);
    setAccessibleName(u"PlayList"_s);
    setAccessibleDescription(u"Eingabetaste spielt, Entf entfernt, Alt+Pfeil verschiebt"_s);
    setModel(&model_);
    setItemDelegate(new PlayListDelegate(this));
    SetUpRowList(*this);
    setDragDropMode(DragDrop);
    setDropIndicatorShown(true);
    setDragDropOverwriteMode(false);
    SetUpColumns();

    constexpr int kDelay = 120;  // milliseconds after the last scrolling
    lookTimer_.setSingleShot(true);
    lookTimer_.setInterval(kDelay);
    connect(&lookTimer_, &QTimer::timeout, this, [this] { RunCommand([this] { LookForFiles(); }); });
    connect(verticalScrollBar(), &QScrollBar::valueChanged, this, &TVisPlayList::LookForFilesSoon);
    connect(&model_, &QAbstractItemModel::modelReset, this, &TVisPlayList::CountChanged);
    connect(&model_, &QAbstractItemModel::rowsInserted, this, &TVisPlayList::CountChanged);
    connect(&model_, &QAbstractItemModel::rowsRemoved, this, &TVisPlayList::CountChanged);
    // The focus shows in whole rows, the view would paint single cells.
    connect(selectionModel(), &QItemSelectionModel::currentChanged, viewport(),
            QOverload<>::of(&QWidget::update));
    list_.SetView(this);
}

TVisPlayList::~TVisPlayList() {
    if (list_.View() == this) list_.SetView(nullptr);
    setModel(nullptr);  // goes before this view's base does
}

// --- Look ---

void TVisPlayList::SetUpColumns() {
    QHeaderView* header = horizontalHeader();
    header->setSectionsClickable(false);
    header->setSectionResizeMode(QHeaderView::Fixed);
    header->setSectionResizeMode(kTitle, QHeaderView::Stretch);
    FitColumns();
}

void TVisPlayList::FitColumns() {
    ensurePolished();
    QHeaderView* header = horizontalHeader();
    QFont bold = font();
    bold.setBold(true);
    const QFontMetrics metrics(bold);
    const int margin = metrics.averageCharWidth() * 2;
    header->setMinimumSectionSize(margin);
    const auto fit = [&](int section, const QString& widest) {
        const int width = metrics.horizontalAdvance(widest) + margin;
        header->resizeSection(section, std::max(width, header->sectionSizeHint(section)));
    };
    digits_ = std::max<qsizetype>(QString::number(model_.rowCount()).size(), 2);
    fit(kNumber, QString(digits_ + 1, u'0'));  // room for the mark of the current song
    fit(kLength, u"0:00:00"_s);
}

void TVisPlayList::changeEvent(QEvent* event) {
    QTableView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) {
        FitRowsToFont(*this);
        FitColumns();
    }
    if (event->type() == QEvent::ActivationChange) LookForFilesSoon();
}

void TVisPlayList::resizeEvent(QResizeEvent* event) {
    QTableView::resizeEvent(event);
    LookForFilesSoon();
}

void TVisPlayList::paintEvent(QPaintEvent* event) {
    QTableView::paintEvent(event);
    if (model_.rowCount() > 0) return;
    QPainter painter(viewport());
    painter.setPen(palette().color(QPalette::Disabled, QPalette::Text));
    const int margin = fontMetrics().height();
    painter.drawText(
        viewport()->rect().adjusted(margin, margin, -margin, -margin),
        static_cast<int>(Qt::AlignCenter) | Qt::TextWordWrap,
        u"Die PlayList ist leer.\nSongs aus der Liste oder Dateien und Ordner hierher ziehen."_s);
}

// --- Which files are there ---

void TVisPlayList::CountChanged() {
    if (QString::number(model_.rowCount()).size() > digits_) FitColumns();
    LookForFilesSoon();
}

void TVisPlayList::LookForFilesSoon() {
    if (isVisible()) lookTimer_.start();
}

void TVisPlayList::LookForFiles() {
    const int first = rowAt(0);
    if (first < 0) return;
    const int last = rowAt(viewport()->height() - 1);
    model_.LookForFiles(first, last < 0 ? model_.rowCount() - 1 : last);
}

// --- Entries ---

std::vector<int> TVisPlayList::SelectedEntries() const {
    std::vector<int> entries;
    for (const auto& [first, last] : MarkedRows(*selectionModel()))
        for (int row = first; row <= last; ++row)
            entries.push_back(row);
    return entries;
}

void TVisPlayList::ShowEntry(int index) {
    const QModelIndex entry = model_.index(index, kTitle);
    if (entry.isValid()) scrollTo(entry);
}

void TVisPlayList::Select(int first, int count) {
    if (count <= 0) return;
    selectionModel()->setCurrentIndex(model_.index(first, kTitle), QItemSelectionModel::NoUpdate);
    MarkRows(*selectionModel(), {{first, first + count - 1}});
    ShowEntry(first);
}

void TVisPlayList::PlaySelected() {
    int entry = CurrentEntry();
    const auto selected = SelectedEntries();
    if (entry < 0 && !selected.empty()) entry = selected.front();
    if (entry >= 0) PlayEntry(entry);
}

void TVisPlayList::PlayEntry(int index) {
    RunCommand([this, index] {
        if (OnPlay) OnPlay(index);
    });
}

void TVisPlayList::QueueSelected() {
    RunCommand([this] {
        for (const int entry : SelectedEntries())
            list_.Enqueue(entry);
    });
}

void TVisPlayList::UnqueueSelected() {
    RunCommand([this] {
        for (const int entry : SelectedEntries())
            list_.Dequeue(entry);
    });
}

void TVisPlayList::MoveTo(int before) {
    RunCommand([this, before] {
        const auto entries = SelectedEntries();
        if (!entries.empty()) ShowEntry(list_.Move(entries, before));
    });
}

void TVisPlayList::MoveSelected(int step) {
    const auto entries = SelectedEntries();
    if (entries.empty()) return;
    if (step < 0)
        MoveTo(std::max(entries.front() - 1, 0));
    else
        MoveTo(std::min(entries.back() + 2, list_.Count()));
}

void TVisPlayList::Insert(int position, const DroppedSongs& drop) {
    RunCommand([&] {
        // Reading files has a window of its own, with a button in it.
        std::optional<WaitCursor> wait;
        if (drop.Paths.isEmpty()) wait.emplace();
        const int count = InsertDrop(list_, position, drop);
        // Meanwhile the list may have become shorter.
        Select(std::min(position, list_.Count() - count), count);
    });
}

// --- Keys and mouse ---

void TVisPlayList::keyPressEvent(QKeyEvent* event) {
    const bool control = (event->modifiers() & Qt::ControlModifier) != 0;
    const bool alt = (event->modifiers() & Qt::AltModifier) != 0;
    switch (event->key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            return control ? QueueSelected() : PlaySelected();
        case Qt::Key_Backspace:
            if (control) return UnqueueSelected();
            break;
        case Qt::Key_Delete:
            if (event->modifiers() == Qt::NoModifier)
                return RunCommand([this] { list_.ClickMenuItem(pcRemoveSelected); });
            break;
        case Qt::Key_Up:
        case Qt::Key_Down:
            if (alt) return MoveSelected(event->key() == Qt::Key_Up ? -1 : 1);
            break;
        default:
            break;
    }
    QTableView::keyPressEvent(event);
}

void TVisPlayList::keyboardSearch(const QString& letters) {
    if (currentIndex().isValid())
        selectionModel()->setCurrentIndex(currentIndex().siblingAtColumn(kTitle),
                                          QItemSelectionModel::NoUpdate);
    QTableView::keyboardSearch(letters);
}

void TVisPlayList::scrollTo(const QModelIndex& index, ScrollHint hint) {
    const int place = horizontalScrollBar()->value();
    QTableView::scrollTo(index, hint);
    horizontalScrollBar()->setValue(place);
}

void TVisPlayList::mouseDoubleClickEvent(QMouseEvent* event) {
    const QModelIndex entry = indexAt(event->position().toPoint());
    if (event->button() != Qt::LeftButton || !entry.isValid())
        return QTableView::mouseDoubleClickEvent(event);
    PlayEntry(entry.row());
}

void TVisPlayList::contextMenuEvent(QContextMenuEvent* event) {
    if (!OnContextMenu) return;
    QPoint position = event->globalPos();
    if (event->reason() == QContextMenuEvent::Keyboard && currentIndex().isValid()) {
        scrollTo(currentIndex());
        position = viewport()->mapToGlobal(visualRect(currentIndex()).bottomLeft());
    }
    OnContextMenu(position);
}

// --- Drag and drop ---

void TVisPlayList::startDrag(Qt::DropActions) {
    auto songs = model_.Songs(SelectedEntries());
    // Where they go in the list is seen to when they are dropped; other programs may copy only.
    if (!songs.empty())
        DragSongs(*this, std::make_unique<SongMimeData>(std::move(songs)), Qt::CopyAction | Qt::MoveAction);
}

// Files from elsewhere stay where they are.
void TVisPlayList::ChooseAction(QDropEvent& event) const {
    if (!event.isAccepted()) return;
    event.setDropAction(event.source() == this ? Qt::MoveAction : Qt::CopyAction);
    event.accept();
}

void TVisPlayList::dragEnterEvent(QDragEnterEvent* event) {
    QTableView::dragEnterEvent(event);
    ChooseAction(*event);
}

void TVisPlayList::dragMoveEvent(QDragMoveEvent* event) {
    QTableView::dragMoveEvent(event);
    ChooseAction(*event);
}

int TVisPlayList::DropRow(const QPoint& position) const {
    const QModelIndex entry = indexAt(position);
    if (!entry.isValid()) return model_.rowCount();
    return position.y() < visualRect(entry).center().y() ? entry.row() : entry.row() + 1;
}

void TVisPlayList::dropEvent(QDropEvent* event) {
    const int row = DropRow(event->position().toPoint());
    setState(NoState);
    stopAutoScroll();
    viewport()->update();
    event->accept();
    if (event->source() == this) {
        event->setDropAction(Qt::MoveAction);
        return MoveTo(row);
    }
    TakeDrop(*event, row);
}

// The other program waits until the drop is over, so the files are read after it.
void TVisPlayList::TakeDrop(QDropEvent& event, int position) {
    event.setDropAction(Qt::CopyAction);
    event.accept();
    const DroppedSongs drop = ReadDrop(*event.mimeData());
    if (!drop.IsEmpty()) QTimer::singleShot(0, this, [this, position, drop] { Insert(position, drop); });
}
