#include "cli/CommandLine.h"

#include <algorithm>
#include <array>

#include "cli/Commands.h"
#include "cli/Help.h"
#include "cli/TerminalDialogs.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::array kCommands = {
    &kInfoCommand,    &kScanCommand,       &kListCommand,           &kGroupsCommand,   &kSaveCommand,
    &kTagCommand,     &kRenameCommand,     &kBatchCommand,          &kBanCommand,      &kTrashCommand,
    &kUndoCommand,    &kDuplicatesCommand, &kSimilarArtistsCommand, &kPlaylistCommand, &kPlayCommand,
    &kConvertCommand, &kRemoteCommand};

bool IsHelp(const QString& word) {
    return word == u"--help"_s || word == u"-h"_s;
}

const CommandRow& FindCommand(const QString& name) {
    const auto found = std::ranges::find_if(
        kCommands, [&name](const CommandRow* command) { return name == QStringView(command->Name); });
    if (found == kCommands.end()) throw EUsageError(u"Unbekannter Befehl: "_s + name);
    return **found;
}

int ShowHelp(Console& console, const QString& text) {
    console.Write(text.toUtf8());
    return esDone;
}

int Run(const QStringList& words, Console& console) {
    if (words.isEmpty()) throw EUsageError(u"Es fehlt ein Befehl."_s);
    if (IsHelp(words.first())) return ShowHelp(console, ProgramHelp());
    const CommandRow& command = FindCommand(words.first());
    const Arguments arguments(words.mid(1), command.Options, command.Operands);
    if (arguments.WantsHelp()) return ShowHelp(console, CommandHelp(command));
    return command.Run(arguments, console);
}

// Where the help for what was asked stands.
QString HelpHint(const QStringList& words) {
    const bool known = !words.isEmpty() && std::ranges::any_of(kCommands, [&](const CommandRow* command) {
        return words.first() == QStringView(command->Name);
    });
    return u"Hilfe: tunestead-cli "_s + (known ? words.first() + u' ' : QString()) + u"--help"_s;
}

}  // namespace

std::span<const CommandRow* const> AllCommands() {
    return kCommands;
}

int RunCommand(const QStringList& words, const CommandStreams& streams) {
    Console console(streams.Out, streams.Err);
    TerminalDialogs dialogs(streams.Err, streams.Answers);
    const InstalledDialogs installed(dialogs);
    try {
        const int status = Run(words, console);
        console.Flush();
        return status;
    } catch (const EUsageError& error) {
        console.Message(error.Message() + u'\n' + HelpHint(words));
        return esWrongUsage;
    } catch (const EOutputClosed&) {
        return esDone;
    } catch (const EAbort&) {
        return esFailed;  // the user has been told
    } catch (const ERukException& error) {
        console.Message(error.Message());
        return esFailed;
    } catch (const std::bad_alloc&) {
        console.Message(u"Der Speicher reicht nicht aus."_s);
        return esFailed;
    }
}
