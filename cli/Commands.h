#pragma once

#include <span>

#include "cli/Arguments.h"
#include "cli/Console.h"

// A command of the program: what the help says about it, what it takes, and what it does.
struct CommandRow {
    const char16_t* Name;
    const char16_t* Summary;
    const char16_t* Details;  // paragraphs of its help; lines are broken as they stand
    OperandRow Operands;
    std::span<const OptionRow> Options;
    // Returns an ExitStatus. Throws EUsageError, or ERukException with the reason why the command failed.
    int (*Run)(const Arguments& arguments, Console& console);
};

// One file a command.
extern const CommandRow kInfoCommand;
extern const CommandRow kScanCommand;
extern const CommandRow kListCommand;
extern const CommandRow kGroupsCommand;
extern const CommandRow kSaveCommand;
extern const CommandRow kPlaylistCommand;
extern const CommandRow kPlayCommand;
extern const CommandRow kRemoteCommand;
extern const CommandRow kTagCommand;
extern const CommandRow kRenameCommand;
extern const CommandRow kBatchCommand;
extern const CommandRow kBanCommand;
extern const CommandRow kTrashCommand;
extern const CommandRow kUndoCommand;
extern const CommandRow kDuplicatesCommand;
extern const CommandRow kSimilarArtistsCommand;
extern const CommandRow kConvertCommand;

// All of them, in the order of the help.
std::span<const CommandRow* const> AllCommands();
