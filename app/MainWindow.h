#pragma once

#include <QMainWindow>
#include <QStringList>
#include <QTimer>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/playback/EngineChoice.h"
#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/spectrum/SpectrumFeed.h"
#include "app/CollectionCommands.h"
#include "app/MediaWatch.h"
#include "app/Startup.h"
#include "app/desktop/InstallationSteps.h"
#include "app/desktop/ProgressDisplay.h"
#include "app/desktop/StartRequests.h"
#include "app/models/CollectionTotals.h"
#include "app/models/FilteredSongs.h"
#include "app/models/SongListModel.h"

class ArrangementCommands;
class ConversionCommands;
class EmptyState;
class ExtraCommands;
class FilterField;
class MainMenu;
class OnlineCommands;
class Playing;
class ProgramCommands;
class RemoteChannel;
class QLabel;
class QStackedWidget;
class SettingsCommands;
class BatchCommands;
class CorrectionCommands;
class DuplicateCommands;
class SongCommands;
class SongListWidget;
class TRemoteControl;
class ToolWindows;
enum class FlagChange;
struct StartRequest;

// What the main window is started with.
struct MainWindowOptions {
    StandardFiles Files{};
    QString SettingsFile{};
    QStringList Arguments{};        // of the command line, without the program's name
    Installation* Setup = nullptr;  // none where the program cannot install itself
    bool OfferWizard = false;       // at the first start
    EngineTable Engines{};          // that songs are played with
    SpectrumSource Spectrum{};      // of what they play
    // Makes the way to a separate player program; none where it is empty.
    std::function<std::unique_ptr<ExternalPlayer>()> MakeExternalPlayer{};
    // Makes the way on which other programs reach this one; none where it is empty.
    std::function<std::unique_ptr<RemoteChannel>()> MakeRemoteChannel{};
};

// The program's main window: owns the collection and brings together what shows it and what works on it.
class TTunesteadMainWnd : public QMainWindow {
 public:
    explicit TTunesteadMainWnd(MainWindowOptions options);
    ~TTunesteadMainWnd() override;

    TMusicDatabase& Database() { return database_; }
    // Closes the window; a long operation is stopped first, without a question.
    void End();

    // Comes to the front for a later start of the program and acts on it as soon as possible. False when this
    // window has been closed.
    bool TakeOver(const StartRequest& request);

 protected:
    void showEvent(QShowEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dragLeaveEvent(QDragLeaveEvent* event) override;
    void dropEvent(QDropEvent* event) override;

 private:
    void SetUpDatabase();
    void SetUpCentre();
    void SetUpStatusBar();
    void SetUpPlacement();
    void SetUpMenu();
    void SetUpToolWindows();
    void SetUpTagForm();
    void SetUpOtherPrograms();
    void ArrangeMenus();
    void SetUpRemoteControl();
    void CloseForRemote();
    void ShowChosenTags();
    void ChangeShownFlag(SongHandle song, FlagChange change);
    void StepTags(int rows);
    void FindNext();
    void ShowMarked();
    void LoadSettings();
    void StoreSettings();
    void HandleCommands();
    void SetUpStart();
    void StartOnce();
    void RunningChanged(bool running);
    void ListChanged();
    void OfferToStop();

    const MainWindowOptions options_;
    TMusicDatabase database_;
    SongListModel songs_;
    FilteredSongs shown_;
    CollectionTotals totals_;
    CollectionCommands commands_;
    Journal journal_;
    MediaWatch media_{database_};
    ProgressDisplay progress_;
    InstallationSteps installation_;
    Startup startup_;
    StartRequests requests_;
    std::unique_ptr<ArrangementCommands> arrangement_;
    std::unique_ptr<SongCommands> songCommands_;
    std::unique_ptr<BatchCommands> batchCommands_;
    std::unique_ptr<CorrectionCommands> correctionCommands_;
    std::unique_ptr<ConversionCommands> conversionCommands_;
    std::unique_ptr<ExtraCommands> extraCommands_;
    std::unique_ptr<OnlineCommands> onlineCommands_;
    std::unique_ptr<ProgramCommands> programCommands_;
    std::unique_ptr<SettingsCommands> settingsCommands_;
    std::unique_ptr<MainMenu> menu_;
    std::unique_ptr<ToolWindows> toolWindows_;
    std::unique_ptr<Playing> playing_;
    std::unique_ptr<TRemoteControl> remote_;
    std::unique_ptr<DuplicateCommands> duplicateCommands_;
    QStackedWidget* centre_ = nullptr;
    QWidget* listPage_ = nullptr;
    FilterField* filter_ = nullptr;
    SongListWidget* list_ = nullptr;
    EmptyState* empty_ = nullptr;
    QLabel* summary_ = nullptr;
    QLabel* marked_ = nullptr;
    QTimer markedTimer_;
    bool ending_ = false;     // as soon as the long operation has stopped
    QByteArray dockState_;    // of the last run, until the window is shown
    QString linkPath_;        // folder of the program's shortcuts
    QStringList menuFaults_;  // of the user's menu files
    bool firstTime_ = false;  // this is the program's first start
    bool started_ = false;    // the standard files are open and the command line is done
    Subscriptions handlers_;
};
