#pragma once

#include <QString>
#include <QtGlobal>

// The system's media control interface as the back end sees it: commands to numbered devices. A test puts its
// own in place; GstMci is the real one where the system has none.

// The numbers are those of the interface.
enum class MciCommand : quint32 {
    Open = 2051,
    Close = 2052,
    Play = 2054,
    Seek = 2055,
    Stop = 2056,
    Pause = 2057,
    Set = 2061,
    Status = 2068,
    SetAudio = 2163,
};

inline constexpr quint32 kMciNotify = 1;                 // Play: without a window to notify
inline constexpr quint32 kMciTo = 8;                     // Seek
inline constexpr quint32 kMciSeekToStart = 256;          // Seek
inline constexpr quint32 kMciStatusItem = 256;           // Status
inline constexpr quint32 kMciSetTimeFormat = 1024;       // Set
inline constexpr quint32 kMciOpenTypeElement = 8704;     // Open: both are given
inline constexpr quint32 kMciSetAudioItem = 0x180'0000;  // SetAudio: item and value are given
inline constexpr quint32 kMciAudioVolume = 0x4002;       // item of SetAudio
inline constexpr quint32 kMciFullVolume = 1000;
inline constexpr quint32 kMciFormatMilliseconds = 0;  // Set
inline constexpr quint32 kMciStatusLength = 1;        // items of Status
inline constexpr quint32 kMciStatusPosition = 2;
inline constexpr quint32 kMciStatusMode = 4;

// Answers to kMciStatusMode.
inline constexpr quint32 kMciModeNotReady = 524;
inline constexpr quint32 kMciModeStop = 525;
inline constexpr quint32 kMciModePlay = 526;
inline constexpr quint32 kMciModeSeek = 528;
inline constexpr quint32 kMciModePause = 529;
inline constexpr quint32 kMciModeOpen = 530;

// What SendCommand can answer beside 0.
inline constexpr quint32 kMciErrorInternal = 277;
inline constexpr quint32 kMciErrorFirstOutput = 320;  // to kMciErrorLastOutput: the way to the loudspeaker
inline constexpr quint32 kMciErrorNoOutput = 326;     // no device will do
inline constexpr quint32 kMciErrorLastOutput = 327;

// What a command takes and gives; each uses a part of it.
struct MciParameters {
    QString DeviceType{};    // Open
    QString Element{};       // Open: the name of a file in the current directory
    quint32 TimeFormat = 0;  // Set
    quint32 Item = 0;        // Status, SetAudio
    quint32 To = 0;          // Seek, ms
    quint32 Device = 0;      // the answer of Open
    quint32 Value = 0;       // SetAudio; the answer of Status
};

class MciInterface {
 public:
    virtual ~MciInterface() = default;
    // 0, or the number of an error. No device has the number 0.
    virtual quint32 SendCommand(quint32 device, MciCommand command, quint32 flags,
                                MciParameters& parameters) = 0;
    virtual QString ErrorString(quint32 error) = 0;
};
