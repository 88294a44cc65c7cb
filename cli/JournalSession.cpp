#include "cli/JournalSession.h"

#include "CommonRUKTools/StandardFiles.h"

namespace {

QString JournalPath() {
    const StandardFiles files = LocateStandardFiles();
    files.MakeFolder();
    return files.Journal();
}

}  // namespace

JournalSession::JournalSession(Console& console, TMusicDatabase* database) : journal_(JournalPath()) {
    journal_.OnTakenBack = [&console](const RecoveryResult& recovered) {
        if (!recovered.IsEmpty()) console.Message(recovered.Message());
    };
    journal_.OnTakenBack(journal_.TakeBackUnfinished());
    if (database != nullptr) journal_.BringUpToDate(*database);
    SetJournal(&journal_);
}

JournalSession::~JournalSession() {
    SetJournal(nullptr);
}
