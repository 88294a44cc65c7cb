#pragma once

#include <QString>
#include <atomic>
#include <optional>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/SongTypes.h"

// One progress point of a long operation. A maximum of -1 means unknown.
struct ProgressPoint {
    qint64 Cur = -1;
    qint64 Max = -1;
    qint64 CurSub = -1;
    qint64 MaxSub = -1;
    TProgressType Type = ptOther;
    QString Description{};
};

// The long operation of a component: whether one goes, what it is called, how far it is, whether it is to
// stop. It works in slices on the interface's thread, or on other threads that it waits for in slices; only
// StopRequested is for those.
class Operation {
 public:
    enum class Commands { Stay, Rest };  // meanwhile
    enum class Point { Told, Kept };

    // --- For what runs ---
    // Throws EAbort, after telling the user, when another one goes.
    void Start(const QString& title, Commands commands = Commands::Rest);
    // After each slice: keeps and tells how far it is, and lets the interface work. True when the user asked
    // to stop.
    bool Reach(const ProgressPoint& point, Point told = Point::Told);
    void ForgetStop() { stopRequested_ = false; }
    void End(Commands commands = Commands::Stay);
    // Whether Reach lets the interface work.
    bool LetsInterfaceWork() const { return letsInterfaceWork_; }
    void SetLetsInterfaceWork(bool value) { letsInterfaceWork_ = value; }

    // --- For who watches ---
    void RequestStop() { stopRequested_ = true; }
    bool StopRequested() const { return stopRequested_; }
    bool Running() const { return running_; }
    bool CommandsRest() const { return commandsRest_; }
    // Nothing when none goes.
    const std::optional<QString>& Title() const { return title_; }
    // With the unknown made 0 of 0, or something of 100.
    const ProgressPoint& LastPoint() const { return lastPoint_; }
    int MainPercent() const { return mainPercent_; }  // -1 unknown
    int SubPercent() const { return subPercent_; }

    Listeners<> Starting;  // it has its title, but does not count as running yet
    Listeners<> TitleChanged;
    Listeners<> Started;  // it runs
    Listeners<const ProgressPoint&> Advanced;
    Listeners<> Reset;   // nothing is known of how far it is
    Listeners<> Ending;  // it does not run any more; what it showed is still there
    Listeners<> Ended;

 private:
    void Tell();
    void ResetPoint();

    std::optional<QString> title_;
    ProgressPoint lastPoint_;
    int mainPercent_ = -1;
    int subPercent_ = -1;
    bool letsInterfaceWork_ = true;
    bool running_ = false;
    bool commandsRest_ = false;
    std::atomic<bool> stopRequested_ = false;
};
