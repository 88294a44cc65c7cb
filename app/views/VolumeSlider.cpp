#include "app/views/VolumeSlider.h"

#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kStep = 5;  // per cent

}  // namespace

VolumeSlider::VolumeSlider(QWidget* parent) : QSlider(Qt::Horizontal, parent) {
    setObjectName(u"volume"_s);
    setAccessibleName(u"Lautstärke"_s);
    setRange(WindowSettings::kVolume.Least, WindowSettings::kVolume.Most);
    setSingleStep(kStep);
    setPageStep(4 * kStep);
    setValue(WindowSettings::kVolume.Default);
    setFixedWidth(12 * fontMetrics().averageCharWidth());
    connect(this, &QSlider::valueChanged, this, [this] { Tell(); });
}

void VolumeSlider::Follow(std::function<void(float)> follower) {
    follower_ = std::move(follower);
    Tell();
}

// The ear hears half as loud where the sound has about a quarter of its amplitude.
void VolumeSlider::Tell() {
    setToolTip(u"Lautstärke %1 %"_s.arg(value()));
    if (follower_) follower_(static_cast<float>(Part() * Part()));
}

void VolumeSlider::LoadSettings(const TRWReg& settings) {
    if (const auto volume = ReadSetting(settings, WindowSettings::kVolume)) setValue(*volume);
}

void VolumeSlider::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kVolume, value());
}
