#pragma once

#include <QPersistentModelIndex>
#include <QTableView>
#include <functional>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/SongList.h"
#include "MusicManagment/database/search/SongFilter.h"
#include "MusicManagment/database/sorting/Sorting.h"
#include "app/views/TypeAhead.h"

class FilteredSongs;
class TMusicDatabase;
struct SongRef;

// The list of songs. A click on a column's header sorts by it, a second one backwards: the database, or where
// that has no such order, only this list. The song that has the focus and the marked (selected) songs are two
// things; of both only shown songs count. The list moves sideways only when the user moves it.
class SongListWidget : public QTableView {
 public:
    SongListWidget(FilteredSongs& songs, TMusicDatabase& database, QWidget* parent = nullptr);

    // Sorts the database, and the list like it; the focused song stays in sight when the database wants that.
    // Throws EMusicDatabaseException while a long operation runs.
    void SetOrder(const SongOrder& order);
    // Whether a click on a header sorts.
    void SetSortingAllowed(bool allowed);

    // Positions in the database, ascending.
    std::vector<SongIndex> MarkedSongs() const;
    // What a command is about: the marked songs, else the focused one.
    std::vector<SongIndex> ChosenSongs() const;
    std::vector<SongHandle> ChosenHandles() const;
    // What an editor of many songs is about, in the order that is shown: the marked songs; where only one is
    // marked the focused one. At most so many.
    std::vector<SongHandle> ChosenInShownOrder(std::size_t most) const;
    // -1 when no song has the focus.
    SongIndex FocusedSong() const;
    // The marked songs as a drag takes them along, in the order of the list.
    std::vector<SongRef> DraggedSongs() const;
    void MarkAll();
    void InvertMarks();
    // Asks for a filter and marks the shown songs that it lets through, and no others.
    void MarkByFilter();
    // Goes to the next shown song that the filter lets through, round the end of the list; false when there
    // is none.
    bool FocusNext(const SongFilter& filter);
    // Gives the focus to a song and shows it. False when it is not shown.
    bool FocusSong(SongIndex song, ScrollHint where = PositionAtCenter);
    // The song that gets the focus when these have gone: the next one below the focus, else the next above.
    SongHandle NextAfter(const std::vector<SongHandle>& going) const;
    // The shown song so many rows below this one (above, when negative), or below the focus where this one is
    // not shown; no song at the ends of the list.
    SongHandle Neighbour(SongHandle song, int rows) const;
    // Marks these songs and no others, and shows the first of them, which gets the focus. Returns how many of
    // them are shown.
    std::size_t MarkSongs(const QStringList& paths);
    // The focused song and those shown below it, by path; at most so many.
    std::vector<QString> ShownFromFocus(std::size_t most) const;
    // Marks the song that plays, by its path; empty for none.
    void SetPlaying(const QString& path);
    // Takes the keys; a list in which no song has the focus gives it to its first.
    void Enter();

    // Which columns are shown, in which order and how wide, for the settings.
    QByteArray SaveColumns() const;
    // False when these are no saved columns; nothing has changed then.
    bool RestoreColumns(const QByteArray& saved);
    void ResetColumns();

    // The flag that the column of the flags shows as a mark, which a click changes; 0: the names of all
    // flags. Throws EMusicDatabaseException while a long operation runs.
    void ShowFlag(quint32 flag);

    // Where the menu of the marked songs is asked for, on the screen.
    std::function<void(const QPoint&)> OnContextMenu;

    void keyboardSearch(const QString& letters) override;
    void scrollTo(const QModelIndex& index, ScrollHint hint = EnsureVisible) override;

 protected:
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void changeEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void startDrag(Qt::DropActions actions) override;

 private:
    void SetUpHeader();
    void HeaderClicked(int section);
    void SortShown(int section);
    void FollowOrder();
    int SortedColumn() const;
    void KeepFocusInSight();
    void ShowColumnMenu(const QPoint& position);
    void ShowSortIndicator();
    void FocusRow(int row);
    void FollowModel();
    void KeepTopRow();
    void RestoreTopRow();
    void RestoreFocus();
    void FilterChanged();

    FilteredSongs& songs_;
    TMusicDatabase& database_;
    TypeAhead typeAhead_;
    QString markFilter_;
    QString focusedPath_;
    QPersistentModelIndex topRow_;
    bool sorting_ = false;
    SongOrder order_;  // of the database, as the list knows it
    Subscriptions subscriptions_;
};
