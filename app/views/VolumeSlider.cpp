#include "app/views/VolumeSlider.h"

#include "CommonRUKTools/RWReg.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kFull = 100;  // per cent
constexpr int kStep = 5;

}  // namespace

VolumeSlider::VolumeSlider(QWidget* parent) : QSlider(Qt::Horizontal, parent) {
    setObjectName(u"volume"_s);
    setAccessibleName(u"Lautstärke"_s);
    setRange(0, kFull);
    setSingleStep(kStep);
    setPageStep(4 * kStep);
    setValue(kFull);
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
    if (const auto volume = settings.ReadInteger(u"Volume"_s)) setValue(*volume);
}

void VolumeSlider::SaveSettings(TRWReg& settings) const {
    settings.WriteInteger(u"Volume"_s, value());
}
