#include "app/MainWindow.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDragEnterEvent>
#include <QLabel>
#include <QMenuBar>
#include <QMimeData>
#include <QScreen>
#include <QStackedWidget>
#include <QStatusBar>
#include <QTimer>
#include <QUrl>
#include <QVBoxLayout>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Intake.h"
#include "MusicManagment/database/IntakeReport.h"
#include "app/CommandRunner.h"
#include "app/MainMenu.h"
#include "app/Startup.h"
#include "app/desktop/Icons.h"
#include "app/desktop/WindowPlacement.h"
#include "app/views/EmptyState.h"
#include "app/views/FilterField.h"
#include "app/views/SongListWidget.h"

using namespace Qt::StringLiterals;

namespace {

constexpr auto kPlacement = u"MainForm";

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
      progress_(database_, *this) {
    setWindowIcon(ProgramIcon());
    setAcceptDrops(true);
    SetUpDatabase();
    SetUpCentre();
    SetUpStatusBar();
    menu_ = std::make_unique<MainMenu>(*menuBar(), commands_, [this] { close(); });
    SetUpPlacement();
    ListChanged();
    QTimer::singleShot(0, this, &TTunesteadMainWnd::StartOnce);
}

TTunesteadMainWnd::~TTunesteadMainWnd() = default;

void TTunesteadMainWnd::SetUpDatabase() {
    database_.SetModernTags(true);
    database_.OnChange = [this](TMusicDatabase&, SongIndex index, TChangeType change) {
        totals_.SongChanged(index, change);
    };
    progress_.OnRunning = [this](bool running) { RunningChanged(running); };
    commands_.OnIntake = [this](const IntakeResult& result) { ShowIntake(result); };
    const auto follow = [this] { ListChanged(); };
    connect(&songs_, &QAbstractItemModel::modelReset, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsInserted, this, follow);
    connect(&songs_, &QAbstractItemModel::rowsRemoved, this, follow);
    connect(&songs_, &QAbstractItemModel::dataChanged, this, follow);
}

void TTunesteadMainWnd::SetUpCentre() {
    centre_ = new QStackedWidget(this);
    empty_ = new EmptyState(centre_);
    empty_->OnAddFolder = [this] { RunCommand([this] { commands_.AddFolder(); }); };
    empty_->OnAddSongs = [this] { RunCommand([this] { commands_.AddSongs(); }); };
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
    statusBar()->addPermanentWidget(summary_);
}

void TTunesteadMainWnd::SetUpPlacement() {
    if (RestorePlacement(*this, options_.SettingsFile, QString::fromUtf16(kPlacement))) return;
    constexpr int kWidth = 190;  // average characters
    constexpr int kHeight = 42;  // lines
    const QSize wanted(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
    resize(wanted.boundedTo(screen()->availableSize() * 0.9));
}

void TTunesteadMainWnd::StartOnce() {
    if (!Startup(database_, commands_).Run(options_.Arguments)) close();
}

// --- What follows the database ---

void TTunesteadMainWnd::RunningChanged(bool running) {
    menu_->SetCommandsEnabled(!running);
    empty_->SetCommandsEnabled(!running);
    list_->SetSortingAllowed(!running);
    if (!running) songs_.SyncViews();
}

void TTunesteadMainWnd::ListChanged() {
    summary_->setText(totals_.Text());
    QWidget* wanted = songs_.rowCount() > 0 ? listPage_ : empty_;
    if (centre_->currentWidget() == wanted) return;
    centre_->setCurrentWidget(wanted);
    wanted->setFocus();
}

// A box only where there is something to worry about.
void TTunesteadMainWnd::ShowIntake(const IntakeResult& result) {
    statusBar()->showMessage(IntakeMessage(result));
    if (result.Unreadable > 0) ReportIntake(result);
}

// --- Finding and marking ---

void TTunesteadMainWnd::FocusFilter() {
    filter_->Activate();
}

void TTunesteadMainWnd::FindNext() {
    const QString text = filter_->SearchText();
    if (text.isEmpty()) return FocusFilter();
    if (!list_->FocusNext(SongFilter::Parse(text)))
        statusBar()->showMessage(u"Kein Song passt zu „%1“."_s.arg(text));
}

void TTunesteadMainWnd::MarkAll() {
    list_->MarkAll();
}

void TTunesteadMainWnd::InvertMarks() {
    list_->InvertMarks();
}

void TTunesteadMainWnd::MarkByFilter() {
    list_->MarkByFilter();
}

// --- Files from other windows ---

void TTunesteadMainWnd::dragEnterEvent(QDragEnterEvent* event) {
    if (LocalFiles(*event->mimeData()).isEmpty()) return;
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
    QTimer::singleShot(0, this, [this, files] { RunCommand([&] { commands_.AddPaths(files); }); });
}

// --- Closing ---

void TTunesteadMainWnd::closeEvent(QCloseEvent* event) {
    event->ignore();
    if (database_.ProgressRunning()) return OfferToStop();
    if (!commands_.MayClose()) return;
    StorePlacement(*this, options_.SettingsFile, QString::fromUtf16(kPlacement));
    event->accept();
}

void TTunesteadMainWnd::OfferToStop() {
    const int answer = UserDialogs().Ask(
        u"Es wird noch eine Aktion ausgeführt. Brechen Sie diese zuerst ab, bevor Sie das Programm beenden. "
        "Aktion jetzt abbrechen?"_s,
        {u"Ja"_s, u"Nein"_s}, 1);
    if (answer == 0) database_.RequestAbort();
}
