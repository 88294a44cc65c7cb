#include "MusicManagment/playback/ExternalTarget.h"

bool ExternalTarget::Reach(const QString& song) {
    const auto reached = link_.FindOrStart(settings_);
    if (reached == ExternalLink::Reached::New && !song.isEmpty()) Open(song);
    return reached != ExternalLink::Reached::No;
}

void ExternalTarget::Close() {
    Ask(ecClose);
    Ask(ecCloseFading);
}

Carried ExternalTarget::Play() {
    link_.Send(ecPlay);
    return Carried::OnItsWay;
}

Carried ExternalTarget::Stop(StopMode mode) {
    Ask(ecStop, mode == StopMode::Fade);
    return Carried::OnItsWay;
}

Carried ExternalTarget::PauseResume() {
    link_.Send(ecPauseResume);
    return Carried::OnItsWay;
}

void ExternalTarget::SetPosition(quint32 milliseconds) {
    Ask(ecSetPosition, milliseconds);
}

TPSStatus ExternalTarget::Status() {
    const qint64 answer = Ask(ecGetStatus);
    return answer >= psClosed && answer <= psSeeking ? static_cast<TPSStatus>(answer) : psClosed;
}

Carried ExternalTarget::CrossFadeTo(const QString& path) {
    return link_.SendText(ecPlayWithCrossFade, path) != 0 ? Carried::OnItsWay : Carried::Not;
}

void ExternalTarget::CloseBeside() {
    Ask(ecCloseFading);
}

void ExternalTarget::PlayBeside(const QString& path) {
    link_.Send(ecNewFading);
    link_.SendText(ecFadingFileName, path);
    link_.Send(ecOpenFading);
    link_.Send(ecFadingTime, settings_.FMODCrossoverTime);
    link_.Send(ecStartFading, 1);
    link_.Send(ecPlayFading);
}
