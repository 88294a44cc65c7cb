#include "app/MainWindow.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDragEnterEvent>
#include <QFileInfo>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QMimeData>
#include <QScreen>
#include <QStackedWidget>
#include <QStatusBar>
#include <QTimer>
#include <QUrl>
#include <QVBoxLayout>
#include <bit>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/batches/BatchReport.h"
#include "MusicManagment/database/batches/FlagBatch.h"
#include "MusicManagment/database/commands/Settings.h"
#include "MusicManagment/database/intake/IntakeReport.h"
#include "MusicManagmentRemoteControl/RemoteControl.h"
#include "app/ArrangementCommands.h"
#include "app/BatchCommands.h"
#include "app/CommandMenu.h"
#include "app/ConversionCommands.h"
#include "app/CorrectionCommands.h"
#include "app/DuplicateCommands.h"
#include "app/ExtraCommands.h"
#include "app/HelpMenu.h"
#include "app/MainMenu.h"
#include "app/OnlineCommands.h"
#include "app/Playing.h"
#include "app/ProgramCommands.h"
#include "app/SettingsCommands.h"
#include "app/ShellCommands.h"
#include "app/SongCommands.h"
#include "app/ToolWindows.h"
#include "app/desktop/Icons.h"
#include "app/desktop/MenuFiles.h"
#include "app/desktop/NewInstallation.h"
#include "app/desktop/RaiseWindow.h"
#include "app/desktop/SingleInstance.h"
#include "app/views/EmptyState.h"
#include "app/views/FilterField.h"
#include "app/views/PlaylistForm.h"
#include "app/views/SongListWidget.h"
#include "app/views/TagForm.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

// One more than the editor takes, so that it can tell the user.
constexpr std::size_t kMostEditedSongs = TID3TagForm::kMostSongs + 1;

// A batch of this program or another was ended in its middle.
void TellTakenBack(const RecoveryResult& result) {
    if (!result.IsEmpty()) UserDialogs().ShowMessage(MessageKind::Information, result.Message());
}

constexpr QStringView kSettingsKey = u"\\Software\\RUK\\Tunestead3";

QStringList LocalFiles(const QMimeData& data) {
    QStringList files;
    for (const QUrl& url : data.urls())
        if (url.isLocalFile()) files << url.toLocalFile();
    return files;
}

}  // namespace

TTunesteadMainWnd::TTunesteadMainWnd(MainWindowOptions options)
    : options_(std::move(options)),
      songs_(database_),
      shown_(songs_),
      totals_(database_),
      commands_(database_, options_.Files),
      journal_(options_.Files.Journal()),
      progress_(database_, *this),
      installation_(options_.Setup, options_.Files, options_.SettingsFile),
      startup_(database_, commands_, installation_) {
    setWindowIcon(ProgramIcon());
    setAcceptDrops(true);
    SetUpDatabase();
    SetUpCentre();
    SetUpStatusBar();
    SetUpToolWindows();
    SetUpRemoteControl();
    SetUpMenu();
    LoadSettings();
    SetUpPlacement();
    SetUpStart();
    ListChanged();
    QTimer::singleShot(0, this, Guarded([this] { StartOnce(); }));
}

TTunesteadMainWnd::~TTunesteadMainWnd() {
    SetJournal(nullptr);
}

void TTunesteadMainWnd::SetUpDatabase() {
    progress_.OnRunning = [this](bool running) { RunningChanged(running); };
    commands_.OnIntake = &ReportIntake;
    commands_.OnOpened = [this] { journal_.BringUpToDate(database_); };
    journal_.OnTakenBack = &TellTakenBack;
    SetJournal(&journal_);
    const auto follow = [this] { ListChanged(); };
    connect(&songs_, &QAbstractItemModel::modelReset, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsInserted, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsRemoved, this, follow);
    connect(&songs_, &QAbstractItemModel::dataChanged, this, follow);
}

void TTunesteadMainWnd::SetUpCentre() {
    centre_ = new QStackedWidget(this);
    empty_ = new EmptyState(centre_);
    empty_->OnAddFolder = Guarded([this] { database_.ClickMenuItem(mcAddFolder); });
    empty_->OnAddSongs = Guarded([this] { database_.ClickMenuItem(mcAddSongs); });
    listPage_ = new QWidget(centre_);
    list_ = new SongListWidget(shown_, database_, listPage_);
    filter_ = new FilterField(shown_, listPage_);
    filter_->OnLeave = [this] { list_->Enter(); };
    listPage_->setFocusProxy(list_);
    auto* layout = new QVBoxLayout(listPage_);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(filter_);
    layout->addWidget(list_, 1);
    centre_->addWidget(empty_);
    centre_->addWidget(listPage_);
    setCentralWidget(centre_);
}

void TTunesteadMainWnd::SetUpStatusBar() {
    summary_ = new QLabel(this);
    summary_->setObjectName(u"summary"_s);
    marked_ = new QLabel(this);
    marked_->setObjectName(u"marked"_s);
    statusBar()->addPermanentWidget(marked_);
    statusBar()->addPermanentWidget(summary_);
    // What is too long for the bar can still be read.
    connect(statusBar(), &QStatusBar::messageChanged, statusBar(), &QWidget::setToolTip);
    // Marking with the keyboard changes the marks many times a second.
    constexpr int kMarkedDelay = 80;  // milliseconds
    markedTimer_.setSingleShot(true);
    markedTimer_.setInterval(kMarkedDelay);
    connect(&markedTimer_, &QTimer::timeout, this, [this] {
        ShowMarked();
        ShowChosenTags();
    });
    const auto later = [this] { markedTimer_.start(); };
    connect(list_->selectionModel(), &QItemSelectionModel::selectionChanged, &markedTimer_, later);
    connect(list_->selectionModel(), &QItemSelectionModel::currentRowChanged, &markedTimer_, later);
}

void TTunesteadMainWnd::SetUpMenu() {
    songCommands_ = std::make_unique<SongCommands>(database_, *list_, journal_);
    batchCommands_ = std::make_unique<BatchCommands>(database_, *list_);
    conversionCommands_ = std::make_unique<ConversionCommands>(database_, *list_);
    duplicateCommands_ = std::make_unique<DuplicateCommands>(database_, *list_, *playing_);
    correctionCommands_ = std::make_unique<CorrectionCommands>(database_, *list_);
    extraCommands_ = std::make_unique<ExtraCommands>(*this, database_);
    SetUpOtherPrograms();
    songCommands_->OnOpenDatabase = [this](const QString& path) { commands_.OpenFile(path); };
    songCommands_->OnDone = [this](const QString& sentence) { statusBar()->showMessage(sentence); };
    settingsCommands_ =
        std::make_unique<SettingsCommands>(*this, database_, kSettingsKey.toString(), options_.SettingsFile);
    settingsCommands_->OnApplied = [this] { database_.Commands().Changed.Tell(); };
    HandleCommands();
    ArrangeMenus();
    menu_ = std::make_unique<MainMenu>(*menuBar(), database_.Commands());
    menu_->BindTo(*list_);
    playing_->AddMenusTo(*menuBar());
    QMenu& windows = *menuBar()->addMenu(u"Fe&nster"_s);
    toolWindows_->AddTo(windows);
    playing_->AddTo(windows);
    duplicateCommands_->AddTo(windows);
    arrangement_ = std::make_unique<ArrangementCommands>(*this, *list_);
    arrangement_->AddTo(windows);
    AddAccessKeys(windows);
    AddHelpMenu(*menuBar(), *this);
    list_->OnContextMenu = [this](const QPoint& place) {
        if (QMenu* menu = menu_->SongMenu()) menu->popup(place);
    };
}

// When all commands are known.
void TTunesteadMainWnd::ArrangeMenus() {
    const QString folder = QFileInfo(options_.SettingsFile).path();
    menuFaults_ = {ArrangeMenu(database_.Commands(), folder, u"Database"_s),
                   ArrangeMenu(playing_->PlayList().Commands(), folder, u"PlayList"_s),
                   ArrangeMenu(playing_->Player().Commands(), folder, u"Player"_s)};
    menuFaults_.removeAll(QString());
}

void TTunesteadMainWnd::SetUpToolWindows() {
    toolWindows_ = std::make_unique<ToolWindows>(*this, database_);
    toolWindows_->OnSelectionChanged = [this](const GroupSelection& selection) {
        if (selection.IsEmpty()) return shown_.SetRestriction({});
        shown_.SetRestriction([selection](const TID3Tag& song) { return selection.Matches(song); });
    };
    connect(list_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex& song) { toolWindows_->ShowSong(shown_.SongAt(song.row())); });
    SetUpTagForm();
    playing_ = std::make_unique<Playing>(*this, database_, *list_,
                                         PlayingOptions{options_.Files.PlayList(), options_.Engines,
                                                        options_.Spectrum, options_.MakeExternalPlayer});
    toolWindows_->LieBehind(playing_->ListForm());
    playing_->OnDone = [this](const QString& sentence) { statusBar()->showMessage(sentence); };
}

// Without it everything else works.
void TTunesteadMainWnd::SetUpRemoteControl() {
    if (!options_.MakeRemoteChannel) return;
    try {
        remote_ = std::make_unique<TRemoteControl>(options_.MakeRemoteChannel());
    } catch (const ERemoteControlException& error) {
        statusBar()->showMessage(error.Message());
        return;
    }
    remote_->SetMusicDatabase(&database_);
    remote_->SetPlayList(&playing_->PlayList());
    remote_->SetPlaySound(&playing_->Player());
    remote_->OnTell = [this](const QString& text) { statusBar()->showMessage(text.simplified()); };
    remote_->OnCloseProgram = [this] { QTimer::singleShot(0, this, Guarded([this] { CloseForRemote(); })); };
}

// Like its user, another program cannot close a window that waits for an answer.
void TTunesteadMainWnd::CloseForRemote() {
    if (QApplication::activeModalWidget() == nullptr) close();
}

void TTunesteadMainWnd::SetUpTagForm() {
    TID3TagForm& form = toolWindows_->TagForm();
    form.OnDone = [this](const QString& sentence) { statusBar()->showMessage(sentence); };
    form.OnReturn = [this](const std::vector<SongHandle>& songs) {
        QStringList paths;
        for (const SongHandle song : songs)
            if (const TID3Tag* record = database_.Songs().Find(song)) paths << record->FileName;
        list_->MarkSongs(paths);
        return list_->ChosenInShownOrder(kMostEditedSongs);
    };
    form.OnAskOrder = [this] { return list_->ChosenInShownOrder(kMostEditedSongs); };
    form.OnStep = [this](int rows) { StepTags(rows); };
    commands_.OnLeave = [&form] { return form.MayLeave(); };
    // After the click, in whose middle the list would change.
    songs_.OnFlagClick = [this](SongHandle song, bool on) {
        const auto change = on ? FlagChange::Set : FlagChange::Remove;
        QTimer::singleShot(0, this, Guarded([this, song, change] { ChangeShownFlag(song, change); }));
    };
}

void TTunesteadMainWnd::SetUpOtherPrograms() {
    programCommands_ = std::make_unique<ProgramCommands>(database_, *list_, options_.SettingsFile);
    programCommands_->OnDone = [this](const QString& sentence) { statusBar()->showMessage(sentence); };
    onlineCommands_ = std::make_unique<OnlineCommands>(*this, database_, toolWindows_->TagForm());
    onlineCommands_->OnNotice = [this](const QString& sentence) { statusBar()->showMessage(sentence); };
    onlineCommands_->OnNeedChoice = [this] { ShowChosenTags(); };
}

void TTunesteadMainWnd::ChangeShownFlag(SongHandle song, FlagChange change) {
    const auto flag = static_cast<TSongFlag>(database_.ShownFlag());
    const BatchResult result = ChangeFlag(database_, OneSong(song), flag, change);
    if (!result.Failed.isEmpty()) ReportBatch(result);
}

void TTunesteadMainWnd::ShowChosenTags() {
    const auto by = list_->hasFocus() ? TID3TagForm::ChosenBy::User : TID3TagForm::ChosenBy::Program;
    toolWindows_->TagForm().ShowSongs(list_->ChosenInShownOrder(kMostEditedSongs), by);
}

// The neighbour is the one of before: what is applied may move the edited song to another place.
void TTunesteadMainWnd::StepTags(int rows) {
    TID3TagForm& form = toolWindows_->TagForm();
    const SongHandle next = list_->Neighbour(form.EditedSong(rows), rows);
    if (!form.MayLeave()) return;
    list_->FocusSong(database_.Songs().PositionOf(next), QAbstractItemView::EnsureVisible);
}

// Those that need the window itself; its parts handle theirs.
void TTunesteadMainWnd::HandleCommands() {
    CommandDispatcher& commands = database_.Commands();
    handlers_ += commands.Handle(mcFind, {.Run = [this] { filter_->Activate(); }});
    handlers_ += commands.Handle(mcFindNext, {.Run = [this] { FindNext(); }});
    handlers_ += commands.Add({.Id = scEditTags,
                               .Caption = u"ID3-Tag bearbeiten"_s,
                               .Letter = u't',
                               .Keys = u"F2"_s,
                               .Icon = u"document-edit"_s,
                               .Menu = u"Song"},
                              {.Run = [this] {
                                  ShowChosenTags();
                                  toolWindows_->TagForm().Edit();
                              }});
    handlers_ += commands.Add({.Id = scExit,
                               .Caption = u"Beenden"_s,
                               .Letter = u'b',
                               .Keys = u"Ctrl+Q"_s,
                               .Icon = u"application-exit"_s,
                               .Then = ShellCommand::DuringRuns::Stays},
                              {.Run = [this] { close(); }});
    handlers_ += commands.Changed.Subscribe([this] {
        const TMenuExItem* add = database_.Menu().Find(mcAddFolder);
        empty_->SetCommandsEnabled(add != nullptr && add->Enabled());
    });
}

void TTunesteadMainWnd::LoadSettings() {
    TRWReg settings(kSettingsKey.toString(), options_.SettingsFile);
    BeginInstallation(settings);
    UseRules(database_, Rules::Modern);
    LoadDatabaseSettings(database_, settings);
    linkPath_ = ReadSetting(settings, WindowSettings::kLinkPath).value_or(QString());
    // Absent counts as the first start; written back at once, so that a crash does not make it the first
    // again.
    firstTime_ = ReadSetting(settings, WindowSettings::kFirstTime).value_or(true);
    WriteSetting(settings, WindowSettings::kFirstTime, false);
    if (const auto columns = ReadSetting(settings, WindowSettings::kSongListColumns))
        list_->RestoreColumns(*columns);
    if (const int flag = ReadSetting(settings, WindowSettings::kSongListFlag).value_or(0);
        std::has_single_bit(static_cast<unsigned>(flag)))
        list_->ShowFlag(static_cast<quint32>(flag));
    database_.Commands().Changed.Tell();
}

void TTunesteadMainWnd::StoreSettings() {
    TRWReg settings(kSettingsKey.toString(), options_.SettingsFile);
    SaveDatabaseSettings(database_, settings);
    WriteSetting(settings, WindowSettings::kLinkPath, linkPath_);
    WriteSetting(settings, WindowSettings::kMainForm, saveGeometry());
    WriteSetting(settings, WindowSettings::kMainFormState, saveState());
    WriteSetting(settings, WindowSettings::kSongListColumns, list_->SaveColumns());
    WriteSetting(settings, WindowSettings::kSongListFlag, static_cast<int>(database_.ShownFlag()));
    settings.Flush();
}

void TTunesteadMainWnd::SetUpPlacement() {
    const TRWReg settings(kSettingsKey.toString(), options_.SettingsFile);
    if (!restoreGeometry(ReadSetting(settings, WindowSettings::kMainForm).value_or(QByteArray()))) {
        constexpr int kWidth = 190;  // average characters
        constexpr int kHeight = 42;  // lines
        const QSize wanted(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
        resize(wanted.boundedTo(screen()->availableSize() * 0.9));
    }
    dockState_ = ReadSetting(settings, WindowSettings::kMainFormState).value_or(QByteArray());
}

// The sizes of the docks are parts of the window's, and only a window that is shown keeps those it is given.
void TTunesteadMainWnd::showEvent(QShowEvent* event) {
    QMainWindow::showEvent(event);
    if (!dockState_.isEmpty()) restoreState(std::exchange(dockState_, {}));
}

// --- Starting ---

void TTunesteadMainWnd::SetUpStart() {
    startup_.LinkFolder = linkPath_;
    startup_.OpenStandardPlayList = [this] { playing_->OpenStandardList(); };
    startup_.OpenPlayList = [this](const QString& path) { playing_->OpenPlayList(path); };
    startup_.OpenSong = [this](const QString& path) { playing_->OpenSong(path); };
    startup_.OpenArrangement = [this](const QString& path) { arrangement_->Load(path); };
    requests_.IsReady = [this] {
        return started_ && !database_.ProgressRunning() && QApplication::activeModalWidget() == nullptr;
    };
    requests_.Act = [this](const QStringList& arguments) {
        if (!startup_.ActOn(arguments)) close();
    };
}

void TTunesteadMainWnd::StartOnce() {
    RunCommand([this] { TellTakenBack(journal_.TakeBackUnfinished()); });
    const bool goesOn = startup_.Run(options_.Arguments);
    RunCommand([this] { journal_.BringUpToDate(database_); });
    started_ = true;
    if (!goesOn) {
        close();
        return;
    }
    if (!menuFaults_.isEmpty()) statusBar()->showMessage(menuFaults_.join(u' '));
    if (firstTime_ && options_.OfferWizard) RunCommand([this] { settingsCommands_->OfferWizard(); });
}

bool TTunesteadMainWnd::TakeOver(const StartRequest& request) {
    if (!isVisible()) return false;
    RaiseWindow(*this, request.ActivationToken);
    if (!request.Arguments.isEmpty()) requests_.Add(request.Arguments);
    return true;
}

// --- What follows the database ---

void TTunesteadMainWnd::RunningChanged(bool running) {
    list_->SetSortingAllowed(!running);
    if (running) return;
    songs_.SyncViews();
    if (std::exchange(ending_, false)) QTimer::singleShot(0, this, Guarded([this] { End(); }));
}

void TTunesteadMainWnd::ListChanged() {
    summary_->setText(totals_.Text());
    QWidget* wanted = songs_.rowCount() > 0 ? listPage_ : empty_;
    if (centre_->currentWidget() == wanted) return;
    centre_->setCurrentWidget(wanted);
    wanted->setFocus();
}

void TTunesteadMainWnd::FindNext() {
    const QString text = filter_->SearchText();
    if (text.isEmpty()) return filter_->Activate();
    if (!list_->FocusNext(SongFilter::Parse(text)))
        statusBar()->showMessage(u"Kein Song passt zu „%1“."_s.arg(text));
}

void TTunesteadMainWnd::ShowMarked() {
    const auto songs = list_->MarkedSongs();
    qint64 seconds = 0;
    for (const SongIndex song : songs)
        seconds += database_.Song(song).Length;
    marked_->setText(songs.size() < 2
                         ? QString()
                         : u"Markiert: "_s + TotalsText(static_cast<qint64>(songs.size()), seconds));
}

// --- Files from other windows ---

void TTunesteadMainWnd::dragEnterEvent(QDragEnterEvent* event) {
    if (event->source() != nullptr || LocalFiles(*event->mimeData()).isEmpty()) return;
    event->setDropAction(Qt::CopyAction);  // the files stay where they are
    event->accept();
    empty_->SetDropMark(true);
}

void TTunesteadMainWnd::dragLeaveEvent(QDragLeaveEvent*) {
    empty_->SetDropMark(false);
}

void TTunesteadMainWnd::dropEvent(QDropEvent* event) {
    empty_->SetDropMark(false);
    const QStringList files = LocalFiles(*event->mimeData());
    if (files.isEmpty()) return;
    event->setDropAction(Qt::CopyAction);
    event->accept();
    // The other program waits until the drop is over, so the files are taken in after it.
    QTimer::singleShot(0, this, Guarded([this, files] { commands_.AddPaths(files); }));
}

// --- Closing ---

void TTunesteadMainWnd::closeEvent(QCloseEvent* event) {
    event->ignore();
    if (database_.ProgressRunning()) return OfferToStop();
    if (!commands_.MayClose()) return;
    if (!installation_.Removed().Settings) RunCommand([this] { StoreSettings(); });
    RunCommand([this] { playing_->Close(!installation_.Removed().Lists); });
    event->accept();
}

void TTunesteadMainWnd::End() {
    ending_ = database_.ProgressRunning();
    if (!ending_) {
        close();
        return;
    }
    database_.RequestAbort();
}

void TTunesteadMainWnd::OfferToStop() {
    const QString question =
        u"Es wird noch eine Aktion ausgeführt. Brechen Sie diese zuerst ab, bevor Sie das Programm beenden. "
        "Aktion jetzt abbrechen?"_s;
    if (UserDialogs().AskYesNo(question)) database_.RequestAbort();
}
