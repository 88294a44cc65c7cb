#include <QFileInfo>
#include <algorithm>
#include <limits>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/playback/backend/PlaySoundContainer.h"
#include "MusicManagmentRemoteControl/RemoteMessages.h"
#include "MusicManagmentRemoteControl/bus/RemoteClient.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"

using namespace Qt::StringLiterals;

namespace {

class ERemoteRefused : public ERukException {
 public:
    ERemoteRefused()
        : ERukException(u"Tunestead hat das nicht ausgeführt; seine Statuszeile nennt den Grund."_s) {}
};

// What a command has to work with.
struct RemoteRun {
    RemoteClient& Client;
    const QStringList& Words;  // behind the command
    bool AsJson;
    Console& Out;
};

// A command of the remote control: the words behind it, and what it does.
struct RemoteRow {
    QStringView Name;
    qsizetype Least;
    qsizetype Most;
    void (*Run)(const RemoteRun& run);
};

qint64 NumberOf(const QString& word, qint64 least, qint64 most) {
    bool isNumber = false;
    const qint64 number = word.toLongLong(&isNumber);
    if (!isNumber || number < least || number > most)
        throw EUsageError(u"Keine Zahl von %1 bis %2: %3"_s.arg(least).arg(most).arg(word));
    return number;
}

// A parameter of a message: 32 bits, with or without a sign.
quint32 ParameterOf(const QString& word) {
    return static_cast<quint32>(
        NumberOf(word, std::numeric_limits<qint32>::min(), std::numeric_limits<quint32>::max()));
}

void Show(const RemoteRun& run, qint32 answer) {
    if (!run.AsJson) return run.Out.WriteLine(QString::number(answer));
    JsonLine line;
    line.Begin();
    line.Number("answer", answer);
    run.Out.Write(line.End());
}

// Of a command that tells nothing but whether it was carried out.
void ShowDone(const RemoteRun& run, qint32 answer) {
    if (run.AsJson) Show(run, answer);
    if (answer == 0) throw ERemoteRefused();
}

template <quint32 message>
void Do(const RemoteRun& run) {
    ShowDone(run, run.Client.Send(message));
}

// Of a message that never tells whether it did anything.
template <quint32 message>
void DoQuietly(const RemoteRun& run) {
    const qint32 answer = run.Client.Send(message);
    if (run.AsJson) Show(run, answer);
}

template <quint32 message>
void Tell(const RemoteRun& run) {
    Show(run, run.Client.Send(message));
}

// Shows a setting or, with a number, changes it.
template <quint32 get, quint32 set, qint64 most>
void Setting(const RemoteRun& run) {
    if (run.Words.isEmpty()) return Tell<get>(run);
    run.Client.Send(set, static_cast<quint32>(NumberOf(run.Words.first(), 0, most)));
    if (run.AsJson) Tell<get>(run);
}

// Without a song it begins with the playlist, as the button in the window does.
void Play(const RemoteRun& run) {
    if (run.Client.Send(rmStatus) != psClosed) return Do<rmPlay>(run);
    run.Client.Send(rmNext);
    ShowDone(run, run.Client.Send(rmStatus) == psClosed ? 0 : 1);
}

void Seek(const RemoteRun& run) {
    constexpr qint64 kMost = std::numeric_limits<quint32>::max();
    ShowDone(run,
             run.Client.Send(rmSetPosition, static_cast<quint32>(NumberOf(run.Words.first(), 0, kMost))));
}

void ShowSong(const RemoteRun& run) {
    constexpr qint64 kMost = std::numeric_limits<qint32>::max();
    const qint64 index = run.Words.isEmpty() ? -1 : NumberOf(run.Words.first(), -1, kMost);
    const auto song = run.Client.Song(static_cast<qint32>(index));
    if (!song)
        throw ERukException(index < 0 ? u"Es ist kein Song der Sammlung offen."_s
                                      : u"Die Sammlung hat keinen Song mit der Nummer %1."_s.arg(index));
    if (run.AsJson) {
        JsonLine line;
        line.Begin();
        WriteSongFields(line, *song);
        return run.Out.Write(line.End());
    }
    QStringList texts{song->Artist, song->Title, song->Album, QString::number(song->Length), song->FileName};
    std::ranges::transform(texts, texts.begin(), &Printable);
    run.Out.WriteLine(texts.join(u'\t'));
}

// A name that is mistyped does not stop what plays.
void OpenFile(const RemoteRun& run) {
    const QString path = AbsolutePath(run.Words.first());
    if (!QFileInfo::exists(path)) throw ERukException(u"Datei nicht gefunden: "_s + run.Words.first());
    const qint32 answer = run.Client.OpenFile(path);
    if (answer == 0 || run.Client.Send(rmStatus) == psClosed)
        throw ERukException(u"Tunestead konnte die Datei nicht öffnen: "_s + run.Words.first());
    ShowDone(run, answer);
}

void SendMessage(const RemoteRun& run) {
    const auto parameter = [&](qsizetype i) { return run.Words.size() > i ? ParameterOf(run.Words[i]) : 0; };
    Show(run, run.Client.Send(ParameterOf(run.Words.first()), parameter(1), parameter(2)));
}

constexpr RemoteRow kRows[] = {
    {u"play", 0, 0, &Play},
    {u"pause", 0, 0, &Do<rmPauseResume>},
    {u"stop", 0, 0, &Do<rmStop>},
    {u"next", 0, 0, &DoQuietly<rmNext>},
    {u"previous", 0, 0, &DoQuietly<rmPrevious>},
    {u"seek", 1, 1, &Seek},
    {u"position", 0, 0, &Tell<rmPosition>},
    {u"length", 0, 0, &Tell<rmLength>},
    {u"status", 0, 0, &Tell<rmStatus>},
    {u"order", 0, 1, &Setting<rmPlayOrder, rmSetPlayOrder, 3>},
    {u"repeat", 0, 1, &Setting<rmRepeatAll, rmSetRepeatAll, 1>},
    {u"scan", 0, 1, &Setting<rmScan, rmSetScan, 1>},
    {u"song", 0, 1, &ShowSong},
    {u"open", 1, 1, &OpenFile},
    {u"version", 0, 0, &Tell<rmVersion>},
    {u"wait", 0, 0, &Do<rmWaitForEnd>},
    {u"message", 1, 3, &SendMessage},
};

int RunRemote(const Arguments& arguments, Console& console) {
    const QString name = arguments.Operands().first();
    const QStringList words = arguments.Operands().mid(1);
    const auto* row = std::ranges::find(kRows, QStringView(name), &RemoteRow::Name);
    if (row == std::end(kRows)) throw EUsageError(u"Unbekannter Befehl der Fernsteuerung: "_s + name);
    if (words.size() < row->Least) throw EUsageError(u"Hinter %1 fehlt etwas."_s.arg(name));
    if (words.size() > row->Most) throw EUsageError(u"Überzähliges Argument: "_s + words[row->Most]);
    RemoteClient client(QDBusConnection::sessionBus());
    // Every other answer is 0 then as well.
    if (row->Run != &SendMessage && client.Send(rmVersion) == 0)
        throw ERukException(u"Die Fernsteuerung ist in den Einstellungen von Tunestead ausgeschaltet."_s);
    row->Run({client, words, arguments.Has(u"--json"), console});
    return esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--json", u"", u"die Antwort als JSON-Objekt"},
};

}  // namespace

const CommandRow kRemoteCommand = {
    u"remote",
    u"Steuert das laufende Tunestead",
    u"Befehle:\n"
    u"  play, pause, stop, next, previous   wie die Knöpfe des Players\n"
    u"  seek MS                             springt an diese Stelle, in Millisekunden\n"
    u"  position, length                    Stelle und Länge in Millisekunden\n"
    u"  status                              0 kein Song, 1 angehalten, 2 spielt, 3 gestoppt, 4 öffnet,\n"
    u"                                      5 springt\n"
    u"  order [N]                           Reihenfolge: 0 abwärts, 1 aufwärts, 2 zufällig, 3 nach dem\n"
    u"                                      Song aufhören\n"
    u"  repeat [0|1], scan [0|1]            alles wiederholen; Songs nur anspielen\n"
    u"  song [INDEX]                        Song der Sammlung, ohne INDEX der offene: Interpret, Titel,\n"
    u"                                      Album, Sekunden und Datei\n"
    u"  open DATEI                          öffnet die Datei im Player\n"
    u"  wait                                wartet, bis der Song zu Ende ist oder gestoppt wurde\n"
    u"  version                             Version der Schnittstelle\n"
    u"  message NUMMER [P [L]]              jede Nachricht der Schnittstelle (negative Zahlen hinter --)\n\n"
    u"Mit --json antwortet er {\"answer\":N}, bei song mit den Feldern des Songs. Läuft kein Tunestead, so\n"
    u"ist der Rückgabewert 1.\n",
    {u"BEFEHL", u"was es tun soll, mit seinen Angaben"},
    kOptions,
    RunRemote,
};
