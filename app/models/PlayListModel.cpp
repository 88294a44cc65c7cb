#include "app/models/PlayListModel.h"

#include <QApplication>
#include <QFileInfo>
#include <QFont>
#include <QPalette>
#include <algorithm>
#include <utility>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "MusicManagment/playlist/ListNames.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kColumns = 3;
constexpr const char16_t* kCaptions[kColumns] = {u"Nr.", u"Artist - Titel", u"Länge"};

QString SongText(const PlayListEntry& entry) {
    const QString title = entry.Record ? entry.Record->Title : QString();
    if (title.isEmpty()) return IsAddress(entry.Name) ? entry.Name : QFileInfo(entry.Name).completeBaseName();
    return TitleBehindArtist(entry.Record->Artist, title);
}

Qt::Alignment AlignmentOf(PlayListColumn column) {
    return (column == PlayListColumn::Title ? Qt::AlignLeft : Qt::AlignRight) | Qt::AlignVCenter;
}

}  // namespace

PlayListModel::PlayListModel(TPlayList& list, QObject* parent) : QAbstractTableModel(parent), list_(list) {
    files_.OnChange = [this] { ShowAgain(0, rows_ - 1); };
    FollowList();
    Reset();
}

// --- Following the list ---

void PlayListModel::FollowList() {
    PlayListEvents& events = list_.Events();
    const auto reset = [this] { Reset(); };
    const auto showAll = [this] { ShowAgain(0, rows_ - 1); };
    subscriptions_ += events.Inserted.Subscribe([this](int row) { EntryInserted(row); });
    subscriptions_ += events.Changed.Subscribe([this](int row) { ShowAgain(row, row); });
    subscriptions_ += events.Removed.Subscribe([this](int row) { EntryRemoved(row); });
    subscriptions_ += events.Moved.Subscribe([this](const auto& former) { EntriesMoved(former); });
    subscriptions_ += events.Cleared.Subscribe(reset);
    subscriptions_ += events.Loaded.Subscribe(reset);
    subscriptions_ += events.CurrentChanged.Subscribe([this] { CurrentChanged(); });
    subscriptions_ += events.QueueChanged.Subscribe(showAll);
}

// Another list: nothing of what was marked in the old one is in it.
void PlayListModel::Reset() {
    beginResetModel();
    rows_ = list_.Count();
    current_ = list_.IndexOf();
    endResetModel();
}

// Thousands of entries may come and go one by one, so nothing here looks through the whole list.
void PlayListModel::EntryInserted(int row) {
    beginInsertRows({}, row, row);
    ++rows_;
    if (current_ >= row)
        ++current_;
    else if (current_ < 0 && list_.Entry(row).Name == list_.CurrentSong())
        current_ = row;
    endInsertRows();
}

void PlayListModel::EntryRemoved(int row) {
    beginRemoveRows({}, row, row);
    --rows_;
    if (current_ == row)
        current_ = list_.IndexOf();
    else if (current_ > row)
        --current_;
    endRemoveRows();
}

// Marks and focus go along with their entries.
void PlayListModel::EntriesMoved(const std::vector<int>& former) {
    Q_EMIT layoutAboutToBeChanged({}, VerticalSortHint);
    std::vector<int> rowOf(former.size());
    for (std::size_t row = 0; row < former.size(); ++row)
        rowOf[static_cast<std::size_t>(former[row])] = static_cast<int>(row);
    const QModelIndexList from = persistentIndexList();
    QModelIndexList to;
    to.reserve(from.size());
    for (const QModelIndex& entry : from)
        to << index(rowOf[static_cast<std::size_t>(entry.row())], entry.column());
    changePersistentIndexList(from, to);
    if (current_ >= 0) current_ = rowOf[static_cast<std::size_t>(current_)];
    Q_EMIT layoutChanged({}, VerticalSortHint);
}

void PlayListModel::CurrentChanged() {
    const int former = std::exchange(current_, list_.IndexOf());
    ShowAgain(former, former);
    ShowAgain(current_, current_);
}

void PlayListModel::ShowAgain(int first, int last) {
    if (first >= 0 && last >= first && last < rows_)
        Q_EMIT dataChanged(index(first, 0), index(last, kColumns - 1));
}

// --- Files that are not there ---

void PlayListModel::LookForFiles(int first, int last) {
    QStringList wanted;
    for (int row = std::max(first, 0); row <= std::min(last, list_.Count() - 1); ++row) {
        const QString& name = list_.Entry(row).Name;
        if (IsAddress(name)) continue;
        if (!IsCdPath(name) || list_.MusicDatabase() == nullptr) {
            wanted << name;
            continue;
        }
        const QString path = list_.MusicDatabase()->ResolveSongPath(name, {.Ask = false});
        if (!path.isEmpty()) wanted << path;
        const auto before = paths_.constFind(name);
        if (before != paths_.constEnd() && *before == path) continue;
        paths_.insert(name, path);
        ShowAgain(row, row);
    }
    files_.LookFor(wanted);
}

bool PlayListModel::IsMissing(const QString& name) const {
    if (!IsCdPath(name)) return files_.IsMissing(name);
    const auto path = paths_.constFind(name);
    if (path == paths_.constEnd()) return false;
    return path->isEmpty() || files_.IsMissing(*path);
}

std::vector<SongRef> PlayListModel::Songs(const std::vector<int>& rows) const {
    std::vector<SongRef> songs;
    songs.reserve(rows.size());
    for (const int row : rows)
        songs.push_back({.Name = list_.Entry(row).Name});
    return songs;
}

// --- What views ask ---

int PlayListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : rows_;
}

int PlayListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : kColumns;
}

// Songs are dropped between the entries, not on one.
Qt::ItemFlags PlayListModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return Qt::ItemIsDropEnabled;
    return QAbstractTableModel::flags(index) | Qt::ItemIsDragEnabled | Qt::ItemNeverHasChildren;
}

QStringList PlayListModel::mimeTypes() const {
    return DropFormats();
}

QVariant PlayListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= list_.Count()) return {};
    const int row = index.row();
    const auto column = static_cast<PlayListColumn>(index.column());
    switch (role) {
        case Qt::DisplayRole:
            return Text(row, column);
        case Qt::AccessibleTextRole:
            return Spoken(row, column);
        case Qt::TextAlignmentRole:
            return QVariant::fromValue(AlignmentOf(column));
        case Qt::DecorationRole:
            if (row != current_ || column != PlayListColumn::Number) return {};
            return ThemeIcon(u"media-playback-start"_s, QStyle::SP_MediaPlay);
        case Qt::FontRole:
            return Font(row);
        case Qt::ForegroundRole:
            if (!IsMissing(list_.Entry(row).Name)) return {};
            return QApplication::palette().brush(QPalette::Disabled, QPalette::Text);
        case Qt::ToolTipRole:
            return ToolTip(row);
        case QueueRole: {
            const int place = QueuePlace(row);
            return place > 0 ? QVariant(place) : QVariant();
        }
        case CurrentRole:
            return row == current_;
        default:
            return {};
    }
}

QString PlayListModel::Text(int row, PlayListColumn column) const {
    const PlayListEntry& entry = list_.Entry(row);
    switch (column) {
        case PlayListColumn::Number:
            return row == current_ ? QString() : QString::number(row + 1);
        case PlayListColumn::Title:
            return SongText(entry);
        case PlayListColumn::Length:
            return entry.Record && entry.Record->Length > 0 ? FormatLength(entry.Record->Length, true)
                                                            : QString();
    }
    return {};
}

// For those who cannot see the marks.
QString PlayListModel::Spoken(int row, PlayListColumn column) const {
    if (column != PlayListColumn::Number) return Text(row, column);
    QString text = QString::number(row + 1);
    if (row == current_) text += u", läuft"_s;
    if (const int place = QueuePlace(row); place > 0) text += u", Warteschlange %1"_s.arg(place);
    if (IsMissing(list_.Entry(row).Name)) text += u", nicht verfügbar"_s;
    return text;
}

QVariant PlayListModel::Font(int row) const {
    const bool missing = IsMissing(list_.Entry(row).Name);
    if (row != current_ && !missing) return {};
    QFont font;
    font.setBold(row == current_);
    font.setItalic(missing);
    return font;
}

QString PlayListModel::ToolTip(int row) const {
    const QString& name = list_.Entry(row).Name;
    const TMusicDatabase* database = list_.MusicDatabase();
    QStringList lines(database != nullptr ? PathForPeople(*database, name) : name);
    if (const int place = QueuePlace(row); place > 0)
        lines << (place == 1 ? u"Wird als Nächstes gespielt"_s
                             : u"Wird als %1. der Warteschlange gespielt"_s.arg(place));
    if (IsMissing(name)) lines << u"Die Datei ist nicht verfügbar"_s;
    return lines.join(u'\n');
}

QVariant PlayListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || section < 0 || section >= kColumns) return {};
    if (role == Qt::TextAlignmentRole)
        return QVariant::fromValue(AlignmentOf(static_cast<PlayListColumn>(section)));
    return role == Qt::DisplayRole ? QString::fromUtf16(kCaptions[section]) : QVariant();
}
