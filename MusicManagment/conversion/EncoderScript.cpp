#include "MusicManagment/conversion/EncoderScript.h"

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QDir>
#include <QFileInfo>
#include <QProcess>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/conversion/platform/ProcessGroup.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPatience = 50;           // milliseconds between two looks
constexpr qsizetype kMostWords = 1000;  // bytes of what a script says
constexpr int kTimeToStart = 10'000;    // milliseconds
const QString kScriptName = u"tunestead-wma.sh"_s;

// The last of what the script says; a program that talks without end does not fill the memory.
class LastWords {
 public:
    void Listen(QProcess& script) {
        words_ += script.readAll();
        if (words_.size() > kMostWords) words_ = words_.last(kMostWords);
    }
    // As the end of a message.
    QString Text() const {
        const QString text = QString::fromLocal8Bit(words_).simplified();
        return text.isEmpty() ? u"."_s : u": "_s + text;
    }

 private:
    QByteArray words_;
};

// The program goes with the object.
class RunningScript {
 public:
    explicit RunningScript(const ScriptCall& call) {
        script_.setProcessChannelMode(QProcess::MergedChannels);
        script_.setStandardInputFile(QProcess::nullDevice());
        GiveOwnGroup(script_);
        script_.start(call.Program, call.Arguments, QIODevice::ReadOnly);
        if (!script_.waitForStarted(kTimeToStart))
            throw ERukException(u"Das Encoder-Skript lässt sich nicht starten. Ist es da und ausführbar? "_s +
                                call.Program);
    }
    ~RunningScript() {
        if (script_.state() == QProcess::NotRunning) return;
        KillGroup(script_);
        script_.waitForFinished(-1);
    }
    RunningScript(const RunningScript&) = delete;
    RunningScript& operator=(const RunningScript&) = delete;

    // False while it is at work.
    bool HasEnded() {
        const bool ended = script_.waitForFinished(kPatience) || script_.state() == QProcess::NotRunning;
        words_.Listen(script_);
        return ended;
    }
    bool Succeeded() const { return script_.exitStatus() == QProcess::NormalExit && script_.exitCode() == 0; }
    int ExitCode() const { return script_.exitCode(); }
    QString Words() const { return words_.Text(); }

 private:
    QProcess script_;
    LastWords words_;
};

QString Filled(QString argument, const QString& source, const QString& target, int rate) {
    // In one pass: a name may hold what looks like a place-holder.
    struct Placeholder {
        QString Name;
        QString Value;
    };
    const Placeholder placeholders[] = {{u"%SOURCE%"_s, QDir::toNativeSeparators(source)},
                                        {u"%TARGET%"_s, QDir::toNativeSeparators(target)},
                                        {u"%RATE%"_s, QString::number(rate)}};
    for (qsizetype at = argument.indexOf(u'%'); at >= 0; at = argument.indexOf(u'%', at)) {
        qsizetype skip = 1;
        for (const Placeholder& placeholder : placeholders) {
            if (!QStringView(argument).mid(at).startsWith(placeholder.Name)) continue;
            argument.replace(at, placeholder.Name.size(), placeholder.Value);
            skip = placeholder.Value.size();
            break;
        }
        at += skip;
    }
    return argument;
}

}  // namespace

QString StandardEncoderScript() {
    const QString program = QCoreApplication::applicationDirPath();
    for (const QString& folder : {program, QDir::cleanPath(program + u"/../lib/tunestead"_s)})
        if (const QFileInfo script(folder + u'/' + kScriptName); script.isFile()) return script.filePath();
    return {};
}

ScriptCall ScriptCallFor(const EncoderSettings& settings, const QString& source, const QString& target) {
    const QString script = settings.Script.isEmpty() ? StandardEncoderScript() : settings.Script;
    if (script.isEmpty())
        throw ERukException(
            u"Es gibt kein Encoder-Skript für WMA. Es wird in den Einstellungen unter \"Konvertierung\" "
            "festgelegt."_s);
    const QString arguments =
        settings.ScriptArguments.trimmed().isEmpty() ? kUsualScriptArguments : settings.ScriptArguments;
    ScriptCall call{.Program = script, .Arguments = {}, .TimeLimit = settings.Wma.TimeLimit};
    for (const QString& argument : QProcess::splitCommand(arguments))
        call.Arguments << Filled(argument, source, target, settings.Wma.BitRate);
    return call;
}

void RunScript(const ScriptCall& call, const std::function<bool()>& goOn) {
    const QDeadlineTimer end(call.TimeLimit);
    RunningScript script(call);
    while (!script.HasEnded()) {
        if (!goOn()) throw EAbort();
        if (end.hasExpired())
            throw ERukException(u"Das Encoder-Skript wurde nicht rechtzeitig fertig und deshalb beendet"_s +
                                script.Words());
    }
    if (!script.Succeeded())
        throw ERukException(u"Das Encoder-Skript ist gescheitert (Rückgabewert "_s +
                            QString::number(script.ExitCode()) + u')' + script.Words());
}
