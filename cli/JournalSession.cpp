#include "cli/JournalSession.h"

#include "CommonRUKTools/StandardFiles.h"

namespace {

QString JournalPath() {
    const StandardFiles files = LocateStandardFiles();
    files.MakeFolder();
    return files.Journal();
}

// What was left half done is taken back now, or before the first batch.
void TakeBackUnfinished(Journal& journal, Console& console) {
    journal.OnTakenBack = [&console](const RecoveryResult& recovered) {
        if (!recovered.IsEmpty()) console.Message(recovered.Message());
    };
    journal.OnTakenBack(journal.TakeBackUnfinished());
}

}  // namespace

JournalSession::JournalSession(Console& console) : journal_(JournalPath()) {
    TakeBackUnfinished(journal_, console);
    SetJournal(&journal_);
}

JournalSession::~JournalSession() {
    SetJournal(nullptr);
}

int CatchUp(TMusicDatabase& database, Console& console) {
    Journal journal(LocateStandardFiles().Journal());
    TakeBackUnfinished(journal, console);
    return journal.BringUpToDate(database);
}
