#pragma once

#include <QString>
#include <functional>
#include <vector>

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/database/SongList.h"
#include "MusicManagment/database/songfiles/UndoList.h"

class SongListWidget;
class TMusicDatabase;

// What the user can do with the songs of the list: handles the commands that are about them. Each may throw
// what the database throws. Songs are held by their handles wherever a question is open: positions may be
// other ones when it is answered.
class SongCommands {
 public:
    SongCommands(TMusicDatabase& database, SongListWidget& list, Journal& journal);

    // Told what came of a command, in a sentence for the status bar.
    std::function<void(const QString&)> OnDone;
    // Opens another collection, whose last step is to be taken back; the user may refuse.
    std::function<void(const QString& path)> OnOpenDatabase;

 private:
    void HandleCommands();
    void AddUndo();
    // A command of the list of steps.
    void AddStep(ShellCommand command, const QString& name, const std::function<UndoStep()>& last,
                 const std::function<void()>& run);
    void OfferToOpen(const UndoStep& step) const;
    void Show(const UndoResult& result, const QString& done);
    void RemoveChosen();
    void CopyChosen();
    QString RemovalQuestion(const std::vector<SongHandle>& songs) const;
    void Tell(const QString& sentence) const;

    TMusicDatabase& database_;
    SongListWidget& list_;
    Journal& journal_;
    UndoList undo_;
    Subscription undoChanges_;
    Subscriptions handlers_;
};
