#pragma once

#include <QSlider>
#include <functional>

#include "MusicManagment/database/Settings.h"

// How loud the program plays. Its value, 0 to 100 per cent, is kept with the settings.
class VolumeSlider : public QSlider, public SettingsClient {
 public:
    explicit VolumeSlider(QWidget* parent = nullptr);

    // Told the gain, 0 to 1, now and at every change; the slider is hidden until somebody listens.
    void Follow(std::function<void(float gain)> follower);

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void Tell();

    std::function<void(float)> follower_;
};
