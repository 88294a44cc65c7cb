#include "MusicManagment/database/commands/ConversionSettings.h"

#include "CommonRUKTools/RWReg.h"

using namespace Qt::StringLiterals;

namespace {

void LoadRecord(const TRWReg& settings, const QString& name, QByteArray& record) {
    const auto stored = settings.ReadBinary(name);
    if (stored && stored->size() == record.size()) record = *stored;
}

}  // namespace

void ConversionSettings::Load(const TRWReg& settings) {
    LoadRecord(settings, u"WAVEncoderSettings"_s, Wav);
    LoadRecord(settings, u"MP3EncoderSettings"_s, Mp3);
    LoadRecord(settings, u"WMAEncoderSettings"_s, Wma);
    if (const auto format = settings.ReadInteger(u"LastMusicFormat"_s))
        LastMusicFormat = static_cast<quint8>(*format);
}

void ConversionSettings::Save(TRWReg& settings) const {
    settings.WriteBinary(u"WAVEncoderSettings"_s, Wav);
    settings.WriteBinary(u"MP3EncoderSettings"_s, Mp3);
    settings.WriteBinary(u"WMAEncoderSettings"_s, Wma);
    settings.WriteInteger(u"LastMusicFormat"_s, LastMusicFormat);
}
