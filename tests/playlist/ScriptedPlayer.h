#pragma once

#include <QFileInfo>
#include <QSet>
#include <functional>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/playlist/SongPlayer.h"

class EEngine : public ERukException {
 public:
    using ERukException::ERukException;
};

// Writes down what it is told to play, by the files' names without extension.
class ScriptedPlayer : public SongPlayer {
 public:
    bool CanFade = true;
    bool PlaysAtOnce = false;
    QSet<QString> Broken;  // songs that the engine refuses
    std::function<void()> OnOpen;

    QStringList Played;
    QStringList Files;
    QStringList Faded;
    int Plays = 0;
    int Redraws = 0;
    int AutoStop = -1;

    bool AutoPlay() const override { return PlaysAtOnce; }
    void SetAutoStop(int milliseconds) override { AutoStop = milliseconds; }
    void SetFileName(const QString& path) override { Played << Open(path); }
    void Play() override { ++Plays; }
    bool PlayWithCrossFade(const QString& path) override {
        if (!CanFade) return false;
        Faded << Open(path);
        return true;
    }
    void RedrawPanel() override { ++Redraws; }

 private:
    QString Open(const QString& path) {
        if (OnOpen) OnOpen();
        const QString song = QFileInfo(path).completeBaseName();
        if (Broken.contains(song)) throw EEngine(QStringLiteral("Engine: ") + song);
        Files << path;
        return song;
    }
};
