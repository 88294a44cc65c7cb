#pragma once

#include <QString>
#include <chrono>

#include "MusicManagment/database/ConversionSettings.h"

// What the user can choose for each format that songs are converted into.

// The numbers are those of "LastMusicFormat".
enum class MusicFormat : quint8 { Mp3, Wav, Wma };
inline constexpr MusicFormat kMusicFormats[] = {MusicFormat::Mp3, MusicFormat::Wav, MusicFormat::Wma};

// That of a number; MP3 for a number that is none.
MusicFormat FormatOf(int number);
// "MP3", and as the end of a file's name: ".mp3".
QString NameOf(MusicFormat format);
QString ExtensionOf(MusicFormat format);

// Sample rates are in Hz; 0: that of the source, or where the format does not have it the next one.

struct WavSettings {
    enum class Channels : quint8 { AsSource, Stereo, Mono };

    int Bits = 16;  // a sample: 16 or 24
    Channels Sides = Channels::AsSource;
    int Rate = 0;
    bool Dither = true;  // where samples are cut to 16 bits
    bool operator==(const WavSettings&) const = default;
};

struct Mp3Settings {
    enum class Method : quint8 { Variable, Constant, Average };
    enum class Channels : quint8 { AsSource, Stereo, Joint, Mono };

    Method Bits = Method::Variable;
    int Quality = 2;    // of the variable bit rate: 0 (best) to 9
    int BitRate = 192;  // kbit/s, 8 to 320; of the other two methods
    int Effort = 3;     // 0 (slowest and best) to 9
    Channels Sides = Channels::AsSource;
    int Rate = 0;
    bool operator==(const Mp3Settings&) const = default;
};

struct WmaSettings {
    int BitRate = 192;  // kbit/s, 8 to 768
    int Rate = 0;
    std::chrono::milliseconds TimeLimit = std::chrono::minutes(10);  // of the script; whole seconds are kept
    bool operator==(const WmaSettings&) const = default;
};

struct EncoderSettings {
    Mp3Settings Mp3{};
    WavSettings Wav{};
    WmaSettings Wma{};
    QString Script{};  // a program that makes WMA; the one that comes with Tunestead where it is empty
    QString ScriptArguments{};
    bool operator==(const EncoderSettings&) const = default;
};

inline constexpr int kRatesToChoose[] = {8000, 11025, 12000, 16000, 22050, 24000, 32000, 44100, 48000};
inline constexpr int kBitRatesToChoose[] = {32, 48, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320};

// The stored records and what they say; docs/formats.md describes them. A record that says nothing, or what
// is out of its range, stands for the defaults.
EncoderSettings ReadEncoderSettings(const ConversionSettings& stored);
void StoreEncoderSettings(const EncoderSettings& settings, ConversionSettings& stored);

// The rate of the target for a source of this rate.
int TargetRate(MusicFormat format, const EncoderSettings& settings, int sourceRate);
