#include "CommonRUKTools/AbsolutePath.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/PlaySession.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ChoiceRow<TPlayOrder> kOrders[] = {
    {u"down", poDownwards},
    {u"up", poUpwards},
    {u"random", poRandom},
};

constexpr ChoiceRow<TCrossover> kModes[] = {
    {u"none", coNone},
    {u"auto", coAutoChange},
    {u"all", coAllChanges},
    {u"always", coAlways},
};

enum class EngineWord { Usual, Fmod, EldoS, Mci, WinAmp };

constexpr ChoiceRow<EngineWord> kEngines[] = {
    {u"fmod", EngineWord::Fmod},
    {u"eldos", EngineWord::EldoS},
    {u"mci", EngineWord::Mci},
    {u"winamp", EngineWord::WinAmp},
};

// Milliseconds; nothing when the option is not given.
std::optional<int> TimeOf(const Arguments& arguments, QStringView option) {
    if (!arguments.Has(option)) return std::nullopt;
    bool isNumber = false;
    const int value = arguments.Value(option).toInt(&isNumber);
    if (!isNumber || value < 0)
        throw EUsageError(option.toString() + u" braucht eine Zahl in Millisekunden: "_s +
                          arguments.Value(option));
    return value;
}

void ChooseEngines(EngineSettings& settings, EngineWord word) {
    const bool usual = word == EngineWord::Usual;
    settings.UseFMOD = usual || word == EngineWord::Fmod;
    settings.UseMCI = usual || word == EngineWord::Mci;
    settings.UseEldoS = word == EngineWord::EldoS;
    settings.UseWinAmp = word == EngineWord::WinAmp;
}

// "null", "file:FILE", "sdl:NAME", or one of SDL's names alone.
OutputChoice OutputOf(const QString& text) {
    auto choice = ParseOutputChoice(text);
    if (!choice && !text.contains(u':')) choice = ParseOutputChoice(u"sdl:"_s + text);
    if (!choice) throw EUsageError(u"Unbekannte Ausgabe: "_s + text);
    if (choice->kind == OutputChoice::Kind::WavFile) choice->name = AbsolutePath(choice->name);
    return *choice;
}

bool WaitsForSound(const OutputChoice& output) {
    return output.kind == OutputChoice::Kind::WavFile || output.kind == OutputChoice::Kind::Null;
}

// Only the first engine's sound can be sent where one likes; the others have their own ways.
void ChooseOutput(PlaySessionOptions& options, const Arguments& arguments, EngineWord word) {
    if (arguments.Has(u"--output")) options.Output = OutputOf(arguments.Value(u"--output"));
    const bool silent = options.Output && options.Output->kind == OutputChoice::Kind::Null;
    const bool own = word != EngineWord::Usual && word != EngineWord::Fmod;
    if (options.Output && own && !(silent && word == EngineWord::Mci))
        throw EUsageError(u"Diese Engine hat ihre eigene Ausgabe, --output gilt nicht für sie."_s);
    options.Fast = arguments.Has(u"--fast");
    if (options.Fast && (own || !options.Output || !WaitsForSound(*options.Output)))
        throw EUsageError(u"--fast braucht --output file:DATEI oder --output null."_s);
    if (!options.Output) return;
    options.Output->unpaced = options.Fast;
    if (options.Fast || !silent) options.Engines.UseMCI = false;
}

int RunPlay(const Arguments& arguments, Console& console) {
    PlaySessionOptions options;
    options.Paths = arguments.Operands();
    options.Order = ChoiceOf(arguments, u"--order", kOrders, options.Order);
    options.Classic = arguments.Has(u"--classic");
    options.Repeat = arguments.Has(u"--repeat");
    options.ScanTime = TimeOf(arguments, u"--scan");
    options.Mode = ChoiceOf(arguments, u"--mode", kModes, options.Mode);
    if (const auto time = TimeOf(arguments, u"--crossfade"))
        options.Engines.FMODCrossoverTime = static_cast<quint32>(*time);
    const EngineWord word = ChoiceOf(arguments, u"--engine", kEngines, EngineWord::Usual);
    ChooseEngines(options.Engines, word);
    ChooseOutput(options, arguments, word);
    return PlaySongs(options, console);
}

constexpr OptionRow kOptions[] = {
    {u"--order", u"FOLGE", u"down (Vorgabe), up oder random"},
    {u"--repeat", u"", u"beginnt nach dem letzten Song von vorn"},
    {u"--scan", u"MS", u"spielt jeden Song nur so viele Millisekunden an"},
    {u"--crossfade", u"MS", u"Dauer der Überblendung (Vorgabe 10000); unter 3000 wird nicht überblendet"},
    {u"--mode", u"ART",
     u"wann überblendet wird: none, auto (am Ende eines Songs; Vorgabe),\n"
     u"all (auch bei n und p) oder always"},
    {u"--classic", u"",
     u"liest PlayLists nach den ursprünglichen Regeln und blendet auch zwischen\n"
     u"aufeinander folgenden Songs eines Albums über"},
    {u"--engine", u"ENGINE", u"nur diese: fmod, eldos, mci oder winamp (Vorgabe: fmod, ersatzweise mci)"},
    {u"--output", u"AUSGABE",
     u"null, file:DATEI.wav oder ein Treiber wie pulseaudio, pipewire\n"
     u"oder alsa; sonst sucht das Programm selbst"},
    {u"--fast", u"", u"so schnell wie möglich; nur mit --output file:DATEI oder null"},
};

}  // namespace

const CommandRow kPlayCommand = {
    u"play",
    u"Spielt Songs, Ordner und PlayLists ab",
    u"Jeder Song, der beginnt, steht mit seinem Pfad auf der Standardausgabe. Am Terminal: Leertaste\n"
    u"hält an und setzt fort, n und p spielen den nächsten und vorherigen Song, q und Strg-C beenden.\n",
    {u"PFAD", u"Musikdatei, Ordner oder PlayList"},
    kOptions,
    RunPlay,
};
