#pragma once

#include <QtGlobal>

// The messages of the remote control. Numbers, parameters and answers are a protocol with other programs
// (docs/remote.md). P and L are the two parameters, 32 bits each.
enum RemoteMessage : quint32 {
    rmClose = 16,        // closes the program
    rmCopyData = 74,     // carries bytes and a code
    rmVersion = 1025,    // of this protocol
    rmEndRemote = 1026,  // takes the remote control away from other programs
    rmPlay = 2025,
    rmStop = 2026,
    rmPauseResume = 2027,
    rmSetPosition = 2125,  // P: ms
    rmPosition = 2126,     // ms
    rmLength = 2127,       // ms
    rmStatus = 2128,       // a TPSStatus
    rmForward = 2129,      // P: ms
    rmBack = 2130,         // P: ms
    rmWaitForEnd = 2225,   // is answered when the song is over
    rmUseMCI = 2226,       // P: 0 or 1
    rmUseEldoS = 2227,
    rmUseWinAmp = 2228,
    rmOpen = 2325,
    rmClosePlayer = 2326,
    rmFileName = 2327,    // P: the window that gets it, L: the code
    rmSongRecord = 3025,  // P: position in the collection or -1, L: the window that gets it
    rmSongFileName = 3026,
    rmSongTitle = 3027,
    rmSongArtist = 3028,
    rmSongAlbum = 3029,
    rmSongComment = 3030,
    rmNext = 4025,
    rmPrevious = 4026,
    rmPlayOrder = 4027,     // a TPlayOrder
    rmSetPlayOrder = 4028,  // P
    rmRepeatAll = 4029,     // 0 or 1
    rmSetRepeatAll = 4030,
    rmScan = 4031,
    rmSetScan = 4032,
    rmScanTime = 4033,     // ms
    rmSetScanTime = 4034,  // P: ms
};

inline constexpr qint32 kRemoteVersion = 6;
// The code of copied data that are the name of a file to play.
inline constexpr quint32 kRemoteOpenFile = 1025;

// Where copied data are sent to. The low 16 bits are the window's handle. The high ones say how texts are
// encoded: 0 the legacy code page, 1 UTF-8.
inline constexpr quint32 kWindowMask = 0xFFFF;
inline constexpr quint32 kUtf8Window = 0x1'0000;
// What the code of a song's text is higher by when it is in UTF-8.
inline constexpr quint32 kUtf8Code = 10'000;
