#pragma once

#include <QString>
#include <QtGlobal>

#include "MusicManagment/playback/PlayerPanel.h"

// What a playing program reports to the one that drives it. The numbers are part of the protocol.
enum FeedbackCode : int {
    fbEndOfSong = 1,
    fbPlaying = 2,  // with the position
    fbStopped = 3,
    fbPosition = 4,      // with the position, for the panel
    fbStateChanged = 5,  // with 1
    fbCrossover = 6,
    fbSongCounted = 7,  // with 1
    fbStarted = 8,
    fbPaused = 9,
    fbResumed = 10,
    fbFileName = 11,        // a text: the file that plays now
    fbCrossoverQuery = 12,  // a question: the answer is a TCrossover
};

// A program that drives this player from outside and wants to know what it does.
class PlayController {
 public:
    virtual ~PlayController() = default;
    virtual void Feedback(FeedbackCode code, quint32 parameter) = 0;
    virtual void FeedbackFileName(const QString& fileName) = 0;
    virtual TCrossover AskCrossover() = 0;
};
