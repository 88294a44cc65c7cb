#include "cli/Help.h"

#include <algorithm>
#include <vector>

using namespace Qt::StringLiterals;

namespace {

struct HelpRow {
    QString term;
    QString text;
};

// Terms in one column, texts in the next; further lines of a text stand below its first.
QString Columns(const std::vector<HelpRow>& rows) {
    qsizetype width = 0;
    for (const auto& row : rows)
        width = std::max(width, row.term.size());
    const QString indent = u"\n"_s + QString(width + 4, u' ');
    QString text;
    for (const auto& row : rows)
        text +=
            u"  "_s + row.term.leftJustified(width + 2) + QString(row.text).replace(u"\n"_s, indent) + u'\n';
    return text;
}

QString Word(const OptionRow& option) {
    const QString value = QString::fromUtf16(option.Value);
    return QString::fromUtf16(option.Name) + (value.isEmpty() ? QString() : u' ' + value);
}

QString Synopsis(const CommandRow& command) {
    QString line = u"tunestead-cli "_s + QString::fromUtf16(command.Name);
    for (const auto& option : command.Options)
        line += option.Required ? u' ' + Word(option) : u" ["_s + Word(option) + u']';
    const QString operands = QString::fromUtf16(command.Operands.Name);
    if (operands.isEmpty()) return line;
    const QString several = operands + (command.Operands.Several ? u"…"_s : QString());
    return line + u' ' + (command.Operands.Required ? several : u'[' + several + u']');
}

}  // namespace

QString ProgramHelp() {
    std::vector<HelpRow> rows;
    for (const CommandRow* command : AllCommands())
        rows.push_back({QString::fromUtf16(command->Name), QString::fromUtf16(command->Summary)});
    return u"Aufruf: tunestead-cli BEFEHL [Optionen]\n\n"
           "Verwaltet die Musiksammlung von Tunestead auf der Kommandozeile.\n\nBefehle:\n"_s +
           Columns(rows) +
           u"\n\"tunestead-cli BEFEHL --help\" beschreibt einen Befehl.\n\n"
           "Rückgabewert: 0 erledigt, 1 fehlgeschlagen (eine Meldung nennt den Grund), 2 falscher Aufruf.\n"
           "Daten gehen auf die Standardausgabe, Meldungen auf die Fehlerausgabe. Hinter \"--\" ist jedes\n"
           "weitere Wort ein Dateiname.\n"_s;
}

QString CommandHelp(const CommandRow& command) {
    std::vector<HelpRow> rows;
    if (!QStringView(command.Operands.Name).isEmpty())
        rows.push_back(
            {QString::fromUtf16(command.Operands.Name), QString::fromUtf16(command.Operands.Help)});
    for (const auto& option : command.Options)
        rows.push_back({Word(option), QString::fromUtf16(option.Help)});
    rows.push_back({u"--help"_s, u"zeigt diese Hilfe"_s});
    return u"Aufruf: "_s + Synopsis(command) + u"\n\n"_s + QString::fromUtf16(command.Summary) + u".\n\n"_s +
           Columns(rows) + u'\n' + QString::fromUtf16(command.Details);
}
