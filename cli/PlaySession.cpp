#include "cli/PlaySession.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <QFileInfo>
#include <QTimer>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/playback/Engines.h"
#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/mci/GstMci.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "cli/CommandLine.h"
#include "cli/TerminalDialogs.h"
#include "cli/TransientLine.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kLookEvery = 50;  // ms, for keys and the wish to stop

// The player's messages on lines of their own; remembers whether there was an error.
class SessionDialogs : public TerminalDialogs {
 public:
    SessionDialogs(std::FILE* err, TransientLine& line)
        : TerminalDialogs(err, nullptr), line_(line), former_(UserDialogs()) {
        SetUserDialogs(this);
    }
    ~SessionDialogs() override { SetUserDialogs(&former_); }

    void ShowMessage(MessageKind kind, const QString& text) override {
        failed_ = failed_ || kind == MessageKind::Error;
        line_.Erase();
        TerminalDialogs::ShowMessage(kind, text);
    }
    bool Failed() const { return failed_; }

 private:
    TransientLine& line_;
    Dialogs& former_;
    bool failed_ = false;
};

// The player's panel in one line.
class StatusLine : public PlayerPanel {
 public:
    StatusLine(const TPlayList& list, TransientLine& line, TCrossover mode)
        : list_(list), line_(line), mode_(mode) {}

    void SetPlayer(TPlaySound* player) { player_ = player; }

    void ShowSong(const QString& fileName) override {
        title_ = TitleOf(fileName);
        times_.clear();
    }
    void Clear() override {
        title_.clear();
        times_.clear();
    }
    void ShowPosition(quint32 position, quint32 length) override {
        times_ = FormatLength(static_cast<int>(position / 1000), true) + u" / "_s +
                 FormatLength(static_cast<int>(length / 1000), true);
        Redraw();
    }
    void Redraw() override {
        if (!line_.IsWatched()) return;
        const bool paused = player_ != nullptr && player_->GetStatus() == psPaused;
        line_.Show((paused ? u"Pause  "_s : QString()) + times_ + (times_.isEmpty() ? QString() : u"  "_s) +
                   title_);
    }
    TCrossover Crossover() const override { return mode_; }
    void SetCrossover(TCrossover mode) override { mode_ = mode; }

 private:
    QString TitleOf(const QString& fileName) const {
        const int index = list_.IndexOf();
        const auto record = index >= 0 ? list_.Entry(index).Record : std::nullopt;
        if (!record || record->Title.isEmpty()) return QFileInfo(fileName).fileName();
        return TitleBehindArtist(record->Artist, record->Title);
    }

    const TPlayList& list_;
    TransientLine& line_;
    TPlaySound* player_ = nullptr;
    TCrossover mode_;
    QString title_;
    QString times_;
};

// The time of a mix that is not played but written: it passes with the sound.
class MixClock : public Clock {
 public:
    MixClock() : ticks_(CurrentClock().Ticks()) { SetClock(this); }
    ~MixClock() override { SetClock(nullptr); }
    MixClock(const MixClock&) = delete;
    MixClock& operator=(const MixClock&) = delete;

    qint64 Ticks() const override { return ticks_; }
    double Now() const override { return ToDayCount(QDateTime::currentDateTime()); }
    void Pass(qint64 milliseconds) { ticks_ += milliseconds; }

 private:
    qint64 ticks_;
};

std::shared_ptr<SoundLibrary> LibraryFor(const PlaySessionOptions& options) {
    return std::make_shared<SoundLibrary>(options.Output ? OutputsFor(*options.Output)
                                                         : OutputsOfEnvironment());
}

std::shared_ptr<GstMci> MciFor(const PlaySessionOptions& options) {
    const bool silent = options.Output && options.Output->kind == OutputChoice::Kind::Null;
    return std::make_shared<GstMci>(silent ? MciSound::Silent : MciSoundOfEnvironment());
}

class Session {
 public:
    Session(const PlaySessionOptions& options, Console& console)
        : options_(options),
          console_(console),
          line_(IsTerminal(console.ErrorStream()) ? console.ErrorStream() : nullptr),
          dialogs_(console.ErrorStream(), line_),
          library_(LibraryFor(options)),
          panel_(list_, line_, options.Mode),
          player_(MakeEngines(library_, MciFor(options))) {
        panel_.SetPlayer(&player_);
        player_.SetPanel(&panel_);
        player_.SetPlayList(&list_);
        player_.SetEngines(options.Engines);
        const Rules rules = options.Classic ? Rules::Classic : Rules::Modern;
        player_.UseRules(rules);
        // The terminal is no row of boxes, and a script wants to know of every song.
        player_.SetQuietFailures(false);
        // The end of the list needs no message here.
        list_.OnAllFilesPlayed = [](TPlayList&, bool&) {};
        player_.OnPlayingStarted = [this](TPlaySound&) {
            begun_ << list_.CurrentSong();
            heard_ = true;
        };
        list_.UseRules(rules);
        list_.SetPlayOrder(options.Order);
        list_.SetRepeatAll(options.Repeat);
        if (options.ScanTime) list_.SetScanTime(*options.ScanTime);
        list_.SetScan(options.ScanTime.has_value());
    }

    int Run() {
        const bool complete = FillList();
        RefuseToOverwrite();
        const InterruptGuard guard;
        if (list_.Count() > 0) list_.PlayNext();
        options_.Fast ? WriteMix() : Listen();
        WriteBegun();
        if (library_->OutputLost()) TellOutputLost();
        player_.SetFileName(QString());
        return complete && !dialogs_.Failed() ? esDone : esFailed;
    }

 private:
    // False when a path or an entry of a playlist leads to nothing.
    bool FillList() {
        bool complete = true;
        const auto tell = [&](const QString& text) {
            console_.Message(text);
            complete = false;
        };
        for (const QString& path : options_.Paths)
            if (list_.InsertFiles(list_.Count(), {path}) == 0)
                tell(u"Nichts zum Abspielen gefunden: "_s + path);
        // Playing passes over them without a word.
        for (int i = 0; i < list_.Count(); ++i)
            if (!QFileInfo(list_.Entry(i).Name).isFile())
                tell(u"Die Datei ist nicht verfügbar: "_s + list_.Entry(i).Name);
        return complete;
    }

    // The output begins as an empty file.
    void RefuseToOverwrite() const {
        if (!options_.Output || options_.Output->kind != OutputChoice::Kind::WavFile) return;
        const QFileInfo output(options_.Output->name);
        QStringList played = options_.Paths;
        for (int i = 0; i < list_.Count(); ++i)
            played << list_.Entry(i).Name;
        if (output.exists() && std::ranges::find(played, output, [](const QString& path) {
                                   return QFileInfo(path);
                               }) != played.end())
            throw EStreamError(u"Die Ausgabe würde überschreiben, was gespielt werden soll: "_s +
                               options_.Output->name);
    }

    // The sound stands still then, and no song would ever end.
    void TellOutputLost() {
        dialogs_.ShowMessage(
            MessageKind::Error,
            u"Die Ausgabe ist nicht vollständig, weil der Datenträger voll ist oder die Datei 4 GiB hat: "_s +
                options_.Output->name);
    }

    bool GoesOn() { return !Over() && !InterruptRequested() && !library_->OutputLost(); }

    // A device that is plugged in again is worth waiting for when it has been there, or when somebody sits
    // before the terminal; a file does not come back, and a script would hang.
    bool WaitsForOutput() const {
        const bool device = !options_.Output || (options_.Output->kind != OutputChoice::Kind::WavFile &&
                                                 options_.Output->kind != OutputChoice::Kind::Null);
        return player_.AwaitsOutput() && device && (heard_ || line_.IsWatched());
    }

    bool Over() {
        if (WaitsForOutput()) return false;
        if (player_.AwaitsOutput()) return true;
        const PlayTimers& timers = player_.Timers();
        return !timers.Ticking() && !timers.EndPending() && player_.GetStatus() != psPaused;
    }

    // An error of the output must not be thrown through the player.
    void WriteBegun() {
        if (begun_.isEmpty()) return;
        line_.Erase();
        for (const QString& song : std::exchange(begun_, {}))
            console_.WriteLine(Printable(song));
        console_.Flush();
    }

    void WriteMix() {
        MixClock clock;
        const auto frames = static_cast<std::size_t>(options_.Engines.FMODMixRate) * kLookEvery / 1000;
        while (GoesOn()) {
            WriteBegun();
            library_->Advance(frames);
            clock.Pass(kLookEvery);
            player_.RunDueTimers();
        }
    }

    void Listen() {
        std::optional<KeyReader> keys;
        if (line_.IsWatched()) keys.emplace();
        QTimer wake;
        wake.start(kLookEvery);
        while (GoesOn()) {
            WriteBegun();
            QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents);
            const auto key = keys ? keys->Read() : std::nullopt;
            if (key && !Obey(*key)) return;
        }
    }

    // False when the user wants to quit.
    bool Obey(char key) {
        switch (key) {
            case ' ':
                player_.PauseResume();
                return true;
            case 'n':
                list_.PlayNext(player_.ChangeOnDemand());
                return true;
            case 'p':
                list_.PlayPrevious(player_.ChangeOnDemand());
                return true;
            case 'q':
                return false;
            default:
                return true;
        }
    }

    const PlaySessionOptions& options_;
    Console& console_;
    TransientLine line_;
    SessionDialogs dialogs_;
    std::shared_ptr<SoundLibrary> library_;
    TPlayList list_;
    StatusLine panel_;
    TPlaySound player_;
    QStringList begun_;   // songs whose line is still to be written
    bool heard_ = false;  // a song has begun
};

}  // namespace

int PlaySongs(const PlaySessionOptions& options, Console& console) {
    return Session(options, console).Run();
}
