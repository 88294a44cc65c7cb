#include <QDir>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/conversion/ConversionRun.h"
#include "MusicManagment/conversion/ConversionTargets.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JsonOutput.h"
#include "cli/TransientLine.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ChoiceRow<MusicFormat> kFormats[] = {
    {u"mp3", MusicFormat::Mp3}, {u"wav", MusicFormat::Wav}, {u"wma", MusicFormat::Wma}};

[[noreturn]] void ThrowBadQuality(const QString& text, const QString& possible) {
    throw EUsageError(u"Unbekannte Qualität: "_s + text + u". Möglich sind: "_s + possible);
}

// "V2" is a variable bit rate of that quality, "abr160" an average of so many kbit/s, "192" a constant one.
void SetMp3Quality(Mp3Settings& mp3, const QString& text) {
    const bool variable = text.startsWith(u'V', Qt::CaseInsensitive);
    const bool average = text.startsWith(u"abr"_s, Qt::CaseInsensitive);
    bool isNumber = false;
    const int number = text.mid(variable ? 1 : average ? 3 : 0).toInt(&isNumber);
    if (!isNumber || number < (variable ? 0 : 8) || number > (variable ? 9 : 320))
        ThrowBadQuality(text, u"V0 (beste) bis V9, abr8 bis abr320, 8 bis 320 (kbit/s)"_s);
    mp3.Bits = variable  ? Mp3Settings::Method::Variable
               : average ? Mp3Settings::Method::Average
                         : Mp3Settings::Method::Constant;
    (variable ? mp3.Quality : mp3.BitRate) = number;
}

void SetQuality(EncoderSettings& settings, MusicFormat format, const QString& text) {
    bool isNumber = false;
    const int number = text.toInt(&isNumber);
    switch (format) {
        case MusicFormat::Mp3:
            return SetMp3Quality(settings.Mp3, text);
        case MusicFormat::Wav:
            if (!isNumber || (number != 16 && number != 24)) ThrowBadQuality(text, u"16 oder 24 (Bit)"_s);
            settings.Wav.Bits = number;
            return;
        case MusicFormat::Wma:
            break;
    }
    if (!isNumber || number < 8 || number > 768) ThrowBadQuality(text, u"8 bis 768 (kbit/s)"_s);
    settings.Wma.BitRate = number;
}

std::vector<ConversionJob> JobsFor(const Arguments& arguments, MusicFormat format) {
    const QString folder = arguments.Has(u"--out") ? AbsolutePath(arguments.Value(u"--out")) : QString();
    ConversionTargets targets(format);
    ReadOptions reading;
    reading.Profile = ReadProfile::Modern;
    reading.DeriveMainGenre = true;
    std::vector<ConversionJob> jobs;
    for (const QString& operand : arguments.Operands()) {
        ConversionJob job{.Source = AbsolutePath(operand), .Format = format};
        job.Target = targets.For(job.Source, folder);
        // What cannot be read fails when it is its turn, with the decoder's reason.
        job.Record = ReadSong(job.Source, reading).Tag;
        jobs.push_back(std::move(job));
    }
    return jobs;
}

std::vector<ConversionOutcome> Convert(const std::vector<ConversionJob>& jobs,
                                       const EncoderSettings& settings, const Console& console) {
    const InterruptGuard guard;
    TransientLine line(IsTerminal(console.ErrorStream()) ? console.ErrorStream() : nullptr);
    return RunConversions(jobs, settings, [&](const ConversionState& state) {
        const QString percent = QString::number(static_cast<int>(100 * state.Part));
        if (line.IsWatched()) line.Show(u"Konvertiere: "_s + percent + u" %  "_s + jobs[state.Song].Source);
        return !InterruptRequested();
    });
}

void WriteOutcome(const ConversionJob& job, const QString& error, bool asJson, Console& console) {
    if (!asJson) {
        if (error.isEmpty()) console.WriteLine(job.Target);
        return;
    }
    JsonLine line;
    line.Begin();
    line.Text("source", job.Source);
    error.isEmpty() ? line.Text("target", job.Target) : line.Null("target");
    error.isEmpty() ? line.Null("error") : line.Text("error", error);
    console.Write(line.End());
}

int RunConvert(const Arguments& arguments, Console& console) {
    const MusicFormat format = ChoiceOf(arguments, u"--to", kFormats, MusicFormat::Mp3);
    EncoderSettings settings;
    if (arguments.Has(u"--quality")) SetQuality(settings, format, arguments.Value(u"--quality"));
    if (arguments.Has(u"--script")) settings.Script = AbsolutePath(arguments.Value(u"--script"));
    const std::vector<ConversionJob> jobs = JobsFor(arguments, format);
    const auto outcomes = Convert(jobs, settings, console);
    int status = esDone;
    for (std::size_t i = 0; i < jobs.size(); ++i) {
        const bool stopped = !outcomes[i].Done && outcomes[i].Error.isEmpty();
        const QString error = stopped ? u"Abgebrochen."_s : outcomes[i].Error;
        WriteOutcome(jobs[i], error, arguments.Has(u"--json"), console);
        if (error.isEmpty()) continue;
        console.Message(Printable(jobs[i].Source + u": "_s + error));
        status = esFailed;
    }
    return status;
}

constexpr OptionRow kOptions[] = {
    {u"--to", u"FORMAT", u"mp3, wav oder wma", true},
    {u"--quality", u"QUALITÄT",
     u"mp3: V0 (beste) bis V9 (variabel; Vorgabe V2), abr160 (im Mittel) oder\n"
     u"192 (konstant), in kbit/s; wav: 16 (Vorgabe) oder 24 Bit; wma: kbit/s (Vorgabe 192)"},
    {u"--out", u"ORDNER", u"schreibt die neuen Dateien in diesen Ordner statt neben ihre Quellen"},
    {u"--script", u"PROGRAMM", u"wma: das Programm, das kodiert, statt des mitgelieferten"},
    {u"--json", u"", u"ein JSON-Objekt je Datei und Zeile"},
};

}  // namespace

const CommandRow kConvertCommand = {
    u"convert",
    u"Wandelt Musikdateien in ein anderes Format um",
    u"Gelesen wird alles, was das Programm selbst dekodiert, auch Tracker-Songs und MIDI. Tags und Cover "
    u"gehen mit.\n"
    u"Eine Datei, die es schon gibt, wird nie ersetzt. Was nicht gelingt, hält die anderen nicht auf. Die "
    u"Quellen\n"
    u"bleiben, wie sie sind.\n"
    u"JSON-Format: {\"source\":...,\"target\":... oder null,\"error\":... oder null}\n",
    {u"DATEI", u"Musikdateien"},
    kOptions,
    RunConvert,
};
