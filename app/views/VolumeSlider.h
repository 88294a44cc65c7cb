#pragma once

#include <QSlider>
#include <functional>

#include "MusicManagment/database/commands/Settings.h"

// How loud the program plays. Its value, 0 to 100 per cent, is kept with the settings.
class VolumeSlider : public QSlider, public SettingsClient {
 public:
    explicit VolumeSlider(QWidget* parent = nullptr);

    // Told the gain, 0 to 1 of the amplitude, now and at every change.
    void Follow(std::function<void(float gain)> follower);
    // The value as a part of 1.
    double Part() const { return static_cast<double>(value()) / maximum(); }
    void SetPart(double part) { setValue(qRound(part * maximum())); }

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void Tell();

    std::function<void(float)> follower_;
};
