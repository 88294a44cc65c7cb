#include <optional>
#include <vector>

#include "ReadMPEGHeader/SongReading.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/InfoSheet.h"
#include "cli/JsonOutput.h"

using namespace Qt::StringLiterals;

namespace {

FileInfo ReadInfo(const QString& path, ReadProfile profile) {
    FileInfo info;
    ReadOptions options;
    options.Profile = profile;
    options.DeriveMainGenre = profile == ReadProfile::Modern;
    options.OnFrame = [&info](const FrameReport& frame) { info.Frames.push_back(frame); };
    info.Reading = ReadSong(path, options);
    if (info.Reading.Tag.FileName.isEmpty()) info.Reading.Tag.FileName = path;
    return info;
}

void WriteFrames(JsonLine& line, const std::vector<FrameReport>& frames) {
    line.BeginArray("frames");
    for (const auto& frame : frames) {
        line.BeginItem();
        line.Text("id", frame.Id);
        line.Text("text", frame.Text);
        frame.Number ? line.Number("number", *frame.Number) : line.Null("number");
        line.EndItem();
    }
    line.EndArray();
}

QByteArrayView InfoLine(const FileInfo& info, bool withFrames, JsonLine& line) {
    line.Begin();
    WriteSongFields(line, info.Reading.Tag);
    info.Reading.Succeeded() ? line.Null("error") : line.Text("error", info.Reading.Failure());
    line.Text("vbr", info.Reading.Mpeg.VbrName);
    line.Number("frameCount", info.Reading.Mpeg.FrameCount);
    if (withFrames) WriteFrames(line, info.Frames);
    return line.End();
}

int RunInfo(const Arguments& arguments, Console& console) {
    const auto profile = arguments.Has(u"--classic") ? ReadProfile::Classic : ReadProfile::Modern;
    const bool withFrames = arguments.Has(u"--frames");
    const bool json = arguments.Has(u"--json");
    int status = esDone;
    JsonLine line;
    for (const QString& path : arguments.Operands()) {
        const FileInfo info = ReadInfo(path, profile);
        if (json)
            console.Write(InfoLine(info, withFrames, line));
        else
            console.Write(InfoSheet(info, withFrames).toUtf8());
        if (info.Reading.Succeeded()) continue;
        console.Message(path + u": "_s + info.Reading.Failure());
        status = esFailed;
    }
    return status;
}

constexpr OptionRow kOptions[] = {
    {u"--json", u"", u"ein JSON-Objekt je Datei und Zeile"},
    {u"--classic", u"", u"liest die Tags nach den ursprünglichen Regeln des Programms"},
    {u"--frames", u"", u"zeigt auch die einzelnen Frames des ID3v2-Tags"},
};

}  // namespace

const CommandRow kInfoCommand = {
    u"info",
    u"Zeigt Tags und technische Daten von Musikdateien",
    u"Felder im JSON-Format: fileName, title, artist, album, year, comment, format, length (Sekunden),\n"
    u"genre, bitRate (kbit/s), sampleRate (Hz), channelMode, emphasis, private, protected, copyrighted,\n"
    u"original, padding, frameSize, track, playCount, reserved, flags, mainGenre, remix, fileTime (Tage\n"
    u"seit dem 30.12.1899), error (Text oder null), vbr, frameCount; mit --frames auch frames.\n",
    {u"DATEI", u"Musikdateien"},
    kOptions,
    RunInfo,
};
