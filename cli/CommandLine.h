#pragma once

#include <QStringList>
#include <cstdio>

enum ExitStatus {
    esDone = 0,
    esFailed = 1,      // a message says why
    esWrongUsage = 2,  // a message says what, and where the help is
};

// The streams of a run; the caller keeps ownership.
struct CommandStreams {
    std::FILE* Out;
    std::FILE* Err;
    std::FILE* Answers = nullptr;  // where the user's answers come from; nullptr: nobody answers
};

// Runs the program with the given words (its own name not among them) and returns its exit status. Throws
// nothing that a user can cause.
int RunCommand(const QStringList& words, const CommandStreams& streams);
