#include "cli/InfoSheet.h"

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"
#include "cli/Console.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype kLabelWidth = 16;

void AddRow(QString& sheet, const QString& label, const QString& text) {
    sheet += u"  "_s + (label + u':').leftJustified(kLabelWidth) + Printable(text) + u'\n';
}

// Rows whose value says nothing are left out.
void AddText(QString& sheet, const QString& label, const QString& text) {
    if (!text.isEmpty()) AddRow(sheet, label, text);
}

void AddNumber(QString& sheet, const QString& label, qint64 number) {
    if (number > 0) AddRow(sheet, label, QString::number(number));
}

void AddTags(QString& sheet, const TID3Tag& tag) {
    AddRow(sheet, u"Titel"_s, tag.Title);
    AddRow(sheet, u"Interpret"_s, tag.Artist);
    AddText(sheet, u"Album"_s, tag.Album);
    AddText(sheet, u"Jahr"_s, tag.Year == u"0000"_s ? QString() : tag.Year);
    AddNumber(sheet, u"Track"_s, tag.Track);
    AddRow(sheet, u"Genre"_s, GenreName(tag.Genre) + (tag.Remix ? u" (Remix)"_s : QString()));
    if (tag.MainGenre != 0) AddRow(sheet, u"Hauptgenre"_s, MainGenreLongName(tag.MainGenre));
    AddText(sheet, u"Kommentar"_s, tag.Comment);
}

void AddTechnicalData(QString& sheet, const SongReading& reading) {
    const TID3Tag& tag = reading.Tag;
    AddRow(sheet, u"Länge"_s, FormatLength(tag.Length, true));
    AddRow(sheet, u"Format"_s, tag.MPEGLayer);
    AddRow(sheet, u"Bitrate"_s,
           FormatBitRate(tag.BitRate) +
               (reading.Mpeg.VbrName.isEmpty() ? QString() : u" (VBR, "_s + reading.Mpeg.VbrName + u')'));
    AddRow(sheet, u"Abtastrate"_s, FormatSampleRate(tag.SampleRate));
    AddRow(sheet, u"Kanäle"_s, FormatChannelMode(tag.ChannelMode));
    AddRow(sheet, u"Emphasis"_s, FormatEmphasis(tag.Emphasis));
    AddText(sheet, u"Kennzeichen"_s, FormatHeaderFlags(tag));
    AddNumber(sheet, u"Framegröße"_s, tag.FrameSize);
    AddNumber(sheet, u"Frames"_s, reading.Mpeg.FrameCount);
}

void AddCollectionData(QString& sheet, const TID3Tag& tag) {
    AddNumber(sheet, u"Gespielt"_s, tag.PlayCount);
    if (tag.Flags != 0) AddRow(sheet, u"Songflags"_s, FormatSongFlags(tag.Flags));
}

void AddFrames(QString& sheet, const std::vector<FrameReport>& frames) {
    for (const auto& frame : frames) {
        const QString number = frame.Number ? u" ["_s + QString::number(*frame.Number) + u']' : QString();
        AddRow(sheet, frame.Id, frame.Text + number);
    }
}

}  // namespace

QString InfoSheet(const FileInfo& info, bool withFrames) {
    const SongReading& reading = info.Reading;
    QString sheet = Printable(reading.Tag.FileName) + u'\n';
    AddTags(sheet, reading.Tag);
    AddTechnicalData(sheet, reading);
    AddCollectionData(sheet, reading.Tag);
    AddText(sheet, u"Fehler"_s, reading.Failure());
    if (withFrames) AddFrames(sheet, info.Frames);
    return sheet + u'\n';
}
