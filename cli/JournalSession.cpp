#include "cli/JournalSession.h"

#include "CommonRUKTools/StandardFiles.h"

namespace {

QString JournalPath() {
    const StandardFiles files = LocateStandardFiles();
    files.MakeFolder();
    return files.Journal();
}

}  // namespace

JournalSession::JournalSession(Console& console) : journal_(JournalPath()) {
    journal_.OnTakenBack = [&console](const RecoveryResult& recovered) {
        if (const QString message = recovered.Message(); !message.isEmpty()) console.Message(message);
    };
    SetJournal(&journal_);
}

JournalSession::~JournalSession() {
    SetJournal(nullptr);
}
