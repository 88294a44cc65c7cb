#include "app/Playing.h"

#include <QFileInfo>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QScopeGuard>
#include <QSet>
#include <QTimer>
#include <algorithm>
#include <utility>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/MusicFolder.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "MusicManagment/playback/PlaySoundMenu.h"
#include "MusicManagment/playlist/PlayListMenu.h"
#include "MusicManagmentRemoteControl/LineDialogs.h"
#include "app/MenuIcons.h"
#include "app/ShellCommands.h"
#include "app/desktop/Icons.h"
#include "app/desktop/MimeTypes.h"
#include "app/desktop/RaiseWindow.h"
#include "app/models/CollectionTotals.h"
#include "app/views/DSPDraw.h"
#include "app/views/DockAction.h"
#include "app/views/PlayerForm.h"
#include "app/views/PlaylistForm.h"
#include "app/views/SongListWidget.h"
#include "app/views/SpectrumForm.h"
#include "app/views/VisPlayList.h"
#include "app/views/VisPlaySound.h"
#include "app/views/VolumeSlider.h"

using namespace Qt::StringLiterals;

namespace {

QSet<QString> NamesIn(const TPlayList& list) {
    QSet<QString> names;
    for (int i = 0; i < list.Count(); ++i)
        names.insert(list.Entry(i).Name);
    return names;
}

QString InOneLine(const QString& text) {
    QStringList lines = text.split(u'\n', Qt::SkipEmptyParts);
    for (QString& line : lines)
        line = line.simplified();
    lines.removeAll(QString());
    return lines.join(u" – "_s);
}

}  // namespace

Playing::Playing(QMainWindow& window, TMusicDatabase& database, SongListWidget& songs, PlayingOptions options)
    : database_(database),
      songs_(songs),
      standardList_(std::move(options.StandardList)),
      player_(std::move(options.Engines)),
      listForm_(new TPlaylistForm(list_, &window)),
      playerForm_(new TPlayerForm(player_, list_, &window)),
      spectrumForm_(new TSpectrumForm(&window)),
      contextMenu_(new QMenu(listForm_)) {
    player_.UseRules(Rules::Modern);
    // Before the settings, which may ask for it.
    if (options.MakeExternalPlayer) player_.SetExternalPlayer(options.MakeExternalPlayer());
    list_.UseRules(Rules::Modern);
    list_.SetStandardFileName(standardList_);
    list_.SetMusicDatabase(&database);
    player_.SetMusicDatabase(&database);
    player_.SetPlayList(&list_);
    SetUpWindows(window);
    SetUpSpectrum(window, std::move(options.Spectrum));
    SetUpContextMenu();
    JoinDesktop(window);
    FollowPlayer();
    database.JoinSettings(followers_);
    handlers_ += database.Commands().Handle(mcPlay, {.Run = [this] { PlayChosen(); }});
    handlers_ += database.Commands().Handle(mcAddToPlayList, {.Run = [this] { AddChosen(); }});
    handlers_ += player_.Commands().Handle(plPlay, {.Run = [this] { Play(); }});
    subscriptions_ +=
        database.Events().MediaChanged.Subscribe([this] { listForm_->View().LookForFilesSoon(); });
    database.OnMarkSong = [this](TMusicDatabase&, SongIndex song) {
        if (!songs_.FocusSong(song) && OnDone) OnDone(u"Der Filter zeigt dieses Lied nicht."_s);
    };
    QObject::connect(&songs, &QAbstractItemView::doubleClicked, listForm_,
                     Guarded([this] { PlayFromFocus(); }));
}

// The window would let its tool windows live longer than what they show.
Playing::~Playing() {
    database_.OnMarkSong = {};
    subscriptions_.End();
    mpris_.reset();
    database_.LeaveSettings(followers_);
    database_.LeaveSettings(*spectrumForm_);
    database_.LeaveSettings(playerForm_->Panel().Volume());
    delete listForm_;
    delete playerForm_;
    delete spectrumForm_;
}

void Playing::SetUpWindows(QMainWindow& window) {
    window.addDockWidget(Qt::RightDockWidgetArea, listForm_);
    window.addDockWidget(Qt::BottomDockWidgetArea, playerForm_);
    TVisPlayList& view = listForm_->View();
    view.OnPlay = [this](int index) { RunCommand([&] { PlayChosenEntry(index); }); };
    view.OnContextMenu = [this](const QPoint& place) { contextMenu_->popup(place); };
    TVisPlaySound& panel = playerForm_->Panel();
    panel.Volume().Follow([this](float gain) {
        player_.SetGain(gain);
        if (mpris_) mpris_->Update();
    });
    database_.JoinSettings(panel.Volume());
}

// Nothing is computed unless somebody looks at it.
void Playing::SetUpSpectrum(QMainWindow& window, SpectrumSource source) {
    window.addDockWidget(Qt::RightDockWidgetArea, spectrumForm_);
    spectrumForm_->hide();
    database_.JoinSettings(*spectrumForm_);
    player_.SetDSPDraw(&spectrumForm_->Draw());
    if (!source.Get) return;
    // A player in another program tells the block itself.
    source.Get = [this, get = std::move(source.Get)]() -> const float* {
        return player_.PlayExtern() ? nullptr : get();
    };
    spectrumFeed_ = std::make_unique<SpectrumFeed>(std::move(source));
    spectrumForm_->Draw().OnDrawing = [this](bool drawing) {
        drawing ? spectrumFeed_->Start() : spectrumFeed_->Stop();
    };
}

// Without a session bus it is as if nobody was listening.
void Playing::JoinDesktop(QMainWindow& window) {
    mpris_ = std::make_unique<Mpris>(
        player_, list_,
        Mpris::Hooks{.OpenFile = [this](const QString& path) { OpenFile(path); },
                     .Raise = [&window] { RaiseWindow(window, QString()); },
                     .Quit = [this] { database_.ClickMenuItem(scExit); },
                     .Tell = [this](const QString& text) { Tell(text); },
                     .Volume = [this] { return playerForm_->Panel().Volume().Part(); },
                     .SetVolume = [this](double volume) { playerForm_->Panel().Volume().SetPart(volume); },
                     .MusicFolder = [] { return MusicFolder(); },
                     .StandardList = standardList_});
    mpris_->Register(QDBusConnection::sessionBus());
    awake_ = std::make_unique<StayAwake>(QDBusConnection::sessionBus());
}

void Playing::FollowPlayer() {
    PlayerEvents& events = player_.Events();
    subscriptions_ += events.Changed.Subscribe([this] { FollowSong(); });
    subscriptions_ += events.Started.Subscribe([this] { followers_.FollowSong(); });
    subscriptions_ += events.Notice.Subscribe([this](const QString& text) { Tell(InOneLine(text)); });
}

void Playing::Tell(const QString& sentence) {
    if (OnDone) OnDone(sentence);
}

// The lists go along with the songs that are played.
void Playing::FollowSong() {
    const TPSStatus status = player_.GetStatus();
    if (awake_) awake_->SetPlaying(status == psPlaying);
    songs_.SetPlaying(status == psClosed ? QString() : SongOf(player_, list_).FileName);
    if (list_.CurrentSong() == shownSong_) return;
    shownSong_ = list_.CurrentSong();
    listForm_->View().ShowEntry(list_.IndexOf());
}

// --- Menus ---

void Playing::AddMenusTo(QMenuBar& bar) {
    QString taken = u"dbseüfh"_s;  // by the menus of others
    QMenu* list = bar.addMenu(WithAccessKey(list_.Menu().Caption(), taken));
    listMenu_.Bind(pcRemoveSelected, listForm_->View());
    listMenu_.Fill(*list, list_.Commands().ShownMenu());
    playerMenu_.Fill(*bar.addMenu(WithAccessKey(player_.Menu().Caption(), taken)),
                     player_.Commands().ShownMenu());
    contextMenu_->addActions(list->actions());
}

// The keys are those of the view, which acts on them itself.
void Playing::SetUpContextMenu() {
    TVisPlayList& view = listForm_->View();
    QAction* play = contextMenu_->addAction(MenuIcon(u"media-playback-start"), u"A&bspielen"_s,
                                            QKeySequence(u"Return"_s), &view, &TVisPlayList::PlaySelected);
    contextMenu_->addAction(ThemeIcon(u"go-next"_s, QStyle::SP_ArrowRight), u"Als nächs&tes spielen"_s,
                            QKeySequence(u"Ctrl+Return"_s), &view, &TVisPlayList::QueueSelected);
    contextMenu_->addAction(u"Aus der &Warteschlange nehmen"_s, QKeySequence(u"Ctrl+Backspace"_s), &view,
                            &TVisPlayList::UnqueueSelected);
    contextMenu_->addSeparator();
    contextMenu_->setDefaultAction(play);
}

void Playing::AddTo(QMenu& menu) {
    AddDockAction(menu, *listForm_);
    AddDockAction(menu, *playerForm_);
    AddDockAction(menu, *spectrumForm_);
}

// Without a song it begins with the list.
void Playing::Play() {
    if (player_.GetStatus() != psClosed) return player_.Play();
    const int entry = listForm_->View().CurrentEntry();
    if (entry >= 0)
        PlayChosenEntry(entry);
    else
        list_.PlayNext();
}

// --- Songs of the collection ---

// At the end; what is listed already stays where it is. Returns how many came in.
int Playing::Append(const std::vector<SongIndex>& songs) {
    QSet<QString> listed = NamesIn(list_);
    const int before = list_.Count();
    for (const SongIndex song : songs) {
        const QString name = database_.Song(song).FileName;
        if (listed.contains(name)) continue;
        listed.insert(name);
        list_.InsertSong(list_.Count(), song);
    }
    return list_.Count() - before;
}

void Playing::PlayChosen() {
    const auto songs = songs_.ChosenSongs();
    if (songs.empty()) return;
    const SongIndex focused = songs_.FocusedSong();
    const SongIndex song = std::ranges::binary_search(songs, focused) ? focused : songs.front();
    Append(songs);
    PlayChosenEntry(list_.IndexOf(database_.Song(song).FileName), song);
}

// The song that was double-clicked, and then what follows it in the shown list.
void Playing::PlayFromFocus() {
    const SongIndex song = songs_.FocusedSong();
    if (song < 0) return;
    std::vector<QString> shown = songs_.ShownFromFocus(ShownFollowers::kMost);
    Append({song});
    PlayChosenEntry(list_.IndexOf(database_.Song(song).FileName), song);
    followers_.Begin(std::move(shown));
}

void Playing::AddChosen() {
    const auto songs = songs_.ChosenSongs();
    if (songs.empty()) return;
    const auto added = static_cast<std::size_t>(Append(songs));
    QString sentence = SongCountText(added) + u" zur PlayList hinzugefügt"_s;
    if (const std::size_t known = songs.size() - added; known > 0)
        sentence += u", %1 schon darin"_s.arg(known == 1 ? u"1 war"_s : u"%1 waren"_s.arg(known));
    Tell(sentence + u'.');
}

// What the user has chosen ends what he chose before.
void Playing::PlayChosenEntry(int index, SongIndex hint) {
    followers_.End();
    PlayEntry(index, hint);
}

void Playing::PlayEntry(int index, SongIndex hint) {
    const QString name = list_.Entry(index).Name;
    if (list_.PlayEntry(index, {.Change = player_.ChangeOnDemand(), .DatabaseHint = hint})) return;
    // That its medium is not at hand the user has just said himself.
    const QString file = FileWithinReach(database_, name);
    if (!file.isEmpty()) throw EPlayListException(u"Die Datei ist nicht verfügbar: "_s + file);
    Tell(u"Der Datenträger ist nicht eingelegt: "_s + PathForPeople(database_, name));
}

// --- Files ---

void Playing::OpenStandardList() {
    if (QFileInfo::exists(standardList_)) list_.SetPlayListFileName(standardList_);
    standardListIsUnread_ = false;
}

void Playing::OpenPlayList(const QString& path) {
    if (list_.MayBeReplaced()) list_.SetPlayListFileName(path);
}

// It plays without being in the list, where "Nächstes" goes on.
void Playing::OpenSong(const QString& path) {
    player_.SetFileName(path);
    if (!player_.AutoPlay()) player_.Play();
}

void Playing::OpenFile(const QString& path) {
    const QFileInfo file(path);
    if (!file.exists()) throw EPlayListException(u"Datei nicht gefunden: "_s + path);
    if (file.isDir()) return OpenFolder(path);
    const FileKind kind = KindOfFile(path);
    if (kind == FileKind::Song) return OpenSong(path);
    if (kind == FileKind::PlayList) return OpenPlayListLater(path);
    throw EPlayListException(u"Unbekannter Dateityp: "_s + FileExtension(path));
}

void Playing::OpenFolder(const QString& path) {
    const int first = list_.Count();
    if (list_.InsertFiles(first, {path}) == 0)
        throw EPlayListException(u"In diesem Ordner sind keine Songs: "_s + path);
    PlayChosenEntry(first);
}

// The other program has its answer first: the user may be asked what becomes of the open list. One question
// at a time.
void Playing::OpenPlayListLater(const QString& path) {
    if (std::exchange(opensList_, true))
        throw EPlayListException(u"Tunestead wartet noch auf eine Antwort zur PlayList."_s);
    QTimer::singleShot(0, listForm_, [this, path] {
        const auto asksNoMore = qScopeGuard([this] { opensList_ = false; });
        const std::function<void(const QString&)> tell = [this](const QString& text) {
            Tell(InOneLine(text));
        };
        const LineDialogs lines(tell);
        RunCommand([&] {
            const bool mayBe = list_.MayBeReplaced();
            Tell({});  // that somebody else wants an answer
            if (!mayBe) return;
            list_.SetPlayListFileName(path);
            PlayFromStart(path);
        });
    });
}

// Unless the user has kept the former list. What cannot be played is passed over.
void Playing::PlayFromStart(const QString& list) {
    if (list_.PlayListFileName() != list || list_.Count() == 0) return;
    followers_.End();
    const SongChange change = player_.ChangeOnDemand();
    if (!list_.PlayEntry(0, {.Change = change})) list_.PlayNext(change);
}

void Playing::OpenSongInstead(const QString& path, const QString& instead) {
    const bool goesOn = player_.GetStatus() != psClosed && player_.FileName() == instead;
    const quint32 position = goesOn ? player_.GetPosition() : 0;
    OpenSong(path);
    if (position > 0 && position < player_.GetLength()) player_.SetPosition(position);
}

void Playing::Close(bool keepList) {
    player_.SetFileName(QString());
    // An empty list is no reason to make a file, and none to lose what could not be read.
    const bool nothingToKeep = standardListIsUnread_ || !QFileInfo::exists(standardList_);
    if (keepList && (list_.Count() > 0 || !nothingToKeep)) list_.Save(standardList_);
}
