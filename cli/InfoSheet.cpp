#include "cli/InfoSheet.h"

#include "MusicManagment/database/SongFields.h"
#include "cli/Console.h"

using namespace Qt::StringLiterals;

namespace {

using Id = SongFieldId;

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

void AddFields(QString& sheet, const TID3Tag& tag, std::initializer_list<SongFieldId> ids) {
    for (const SongFieldId id : ids)
        AddText(sheet, QString::fromUtf16(FieldOf(id).Caption), FieldOf(id).Text(tag));
}

void AddTags(QString& sheet, const TID3Tag& tag) {
    AddFields(sheet, tag, {Id::Title, Id::Artist, Id::Album, Id::Year, Id::Track, Id::Genre});
    if (tag.MainGenre != 0) AddFields(sheet, tag, {Id::MainGenre});
    AddFields(sheet, tag, {Id::Comment});
}

void AddTechnicalData(QString& sheet, const SongReading& reading) {
    const TID3Tag& tag = reading.Tag;
    AddFields(sheet, tag, {Id::Length, Id::Format});
    AddText(sheet, QString::fromUtf16(FieldOf(Id::BitRate).Caption),
            FieldOf(Id::BitRate).Text(tag) +
                (reading.Mpeg.VbrName.isEmpty() ? QString() : u" (VBR, "_s + reading.Mpeg.VbrName + u')'));
    AddFields(sheet, tag, {Id::SampleRate, Id::Channels, Id::Emphasis, Id::HeaderFlags, Id::FrameSize});
    AddNumber(sheet, u"Frames"_s, reading.Mpeg.FrameCount);
}

void AddCollectionData(QString& sheet, const TID3Tag& tag) {
    if (tag.PlayCount > 0) AddFields(sheet, tag, {Id::PlayCount});
    AddFields(sheet, tag, {Id::Flags});
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
