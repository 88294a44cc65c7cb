#include "MusicManagment/playlist/PlayList.h"

#include "ReadMPEGHeader/DisplayTexts.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"

using namespace Qt::StringLiterals;

namespace {

void WriteText(const TPlayList& list, Console& console) {
    for (int i = 0; i < list.Count(); ++i) {
        const auto& [name, record] = list.Entry(i);
        const QString song = record ? Printable(record->Artist) + u'\t' + Printable(record->Title) + u'\t' +
                                          FormatLength(record->Length, true)
                                    : u"\t\t"_s;
        console.WriteLine(QString::number(i) + u'\t' + song + u'\t' + Printable(name));
    }
}

void WriteJson(const TPlayList& list, Console& console) {
    JsonLine line;
    for (int i = 0; i < list.Count(); ++i) {
        const auto& [name, record] = list.Entry(i);
        line.Begin();
        line.Number("index", i);
        line.Text("name", name);
        if (record) WriteSongFields(line, *record);
        console.Write(line.End());
    }
}

int RunPlaylist(const Arguments& arguments, Console& console) {
    if (arguments.Has(u"--out") && arguments.Has(u"--json"))
        throw EUsageError(u"--out und --json schließen sich aus."_s);
    TPlayList list;
    list.UseRules(arguments.Has(u"--classic") ? Rules::Classic : Rules::Modern);
    list.SetPlayListFileName(arguments.Operands().first());
    if (arguments.Has(u"--out"))
        list.Save(arguments.Value(u"--out"));
    else
        arguments.Has(u"--json") ? WriteJson(list, console) : WriteText(list, console);
    return esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--classic", u"", u"liest die PlayList nach den ursprünglichen Regeln des Programms"},
    {u"--json", u"", u"ein JSON-Objekt je Eintrag und Zeile"},
    {u"--out", u"DATEI2", u"schreibt die PlayList in diese Datei, statt sie zu zeigen"},
};

}  // namespace

const CommandRow kPlaylistCommand = {
    u"playlist",
    u"Zeigt eine PlayList oder wandelt sie um",
    u"Das Format einer PlayList wird an ihrem Inhalt erkannt, das Format von DATEI2 richtet sich nach der\n"
    u"Endung: .rukpl und .rpl eigenes Format, .m3u, .m3u8 und .extpl M3U, .pls und .inipl PLS, alles\n"
    u"andere ein Pfad je Zeile. Relative Namen gelten vom Ordner der PlayList aus. Mit --classic gelten die\n"
    u"ursprünglichen Regeln: nur die ersten neun Bytes entscheiden, eine einfache Liste verliert sie,\n"
    u"relative Namen gelten vom aktuellen Ordner aus, und Titel werden nur im eigenen Format gelesen.\n"
    u"Eine Zeile je Eintrag: Nummer (ab 0), Interpret, Titel, Länge und Name,\n"
    u"durch Tabulatoren getrennt. Felder im JSON-Format: index, name und, wenn die PlayList sie enthält,\n"
    u"die Felder des Datensatzes, wie der Befehl info sie zeigt.\n",
    {.Name = u"DATEI", .Help = u"PlayList", .Several = false},
    kOptions,
    RunPlaylist,
};
