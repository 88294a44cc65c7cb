#include "MusicManagment/playback/mci/GstMci.h"

#include <gst/gst.h>

#include <QDir>
#include <QThread>
#include <utility>

#include "MusicManagment/playback/mci/GstPlayer.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kLookAtLeavingEvery = 20;  // ms

}  // namespace

MciSound MciSoundOfEnvironment() {
    return qEnvironmentVariable("TUNESTEAD_AUDIO") == u"null"_s ? MciSound::Silent : MciSound::Audible;
}

GstMci::GstMci(MciSound sound) : GstMci(sound == MciSound::Silent ? MakeSilentSink : MakeAudibleSink) {}

GstMci::GstMci(MciSinkMaker makeSink) : makeSink_(std::move(makeSink)) {
    timer_.setInterval(kLookAtLeavingEvery);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { DropSilent(); });
}

GstMci::~GstMci() {
    while (!devices_.empty())
        Close(devices_.begin()->first);
    AwaitSilence();
}

quint32 GstMci::Close(quint32 device) {
    leaving_.push_back(std::move(devices_.extract(device).mapped()));
    leaving_.back()->Leave();
    timer_.start();
    DropSilent();
    return 0;
}

void GstMci::DropSilent() {
    std::erase_if(leaving_, [](const auto& player) { return player->IsSilent(); });
    if (leaving_.empty()) timer_.stop();
}

// Each of them ends by itself.
void GstMci::AwaitSilence() {
    for (DropSilent(); !leaving_.empty(); DropSilent())
        QThread::msleep(1);
}

bool GstMci::HasPart(const char* name) {
    if (!gst_init_check(nullptr, nullptr, nullptr)) return false;
    GstElementFactory* factory = gst_element_factory_find(name);
    if (factory != nullptr) gst_object_unref(factory);
    return factory != nullptr;
}

quint32 GstMci::Result(const QString& text, quint32 error) {
    if (text.isEmpty()) return 0;
    lastErrorText_ = text;
    lastError_ = error;
    return error;
}

QString GstMci::ErrorString(quint32 error) {
    return error == lastError_ ? lastErrorText_ : u"Unbekannter Fehler %1"_s.arg(error);
}

quint32 GstMci::Open(MciParameters& parameters) {
    GError* error = nullptr;
    if (!gst_init_check(nullptr, nullptr, &error)) {
        const QString text = error != nullptr ? QString::fromUtf8(error->message) : u"GStreamer"_s;
        g_clear_error(&error);
        return Result(text);
    }
    auto device =
        std::make_unique<GstPlayer>(QDir::current().absoluteFilePath(parameters.Element), makeSink_);
    QString text = device->Open();
    // Some devices belong to one sound only, and the one before may still be leaving.
    if (device->OutputLost() && !leaving_.empty()) {
        AwaitSilence();
        text = device->Open();
    }
    if (!text.isEmpty()) return Result(text, ErrorOf(*device));
    parameters.Device = ++lastDevice_;
    devices_[parameters.Device] = std::move(device);
    return 0;
}

quint32 GstMci::ErrorOf(const GstPlayer& device) {
    return device.OutputLost() ? kMciErrorNoOutput : kMciErrorInternal;
}

// Returns the text of an error, empty for none.
QString GstMci::Carry(GstPlayer& device, MciCommand command, quint32 flags, MciParameters& parameters) {
    switch (command) {
        case MciCommand::Play:
            return device.Play();
        case MciCommand::Stop:
            return device.Stop();
        case MciCommand::Pause:
            return device.Pause();
        case MciCommand::Seek:
            return device.Seek(flags == kMciSeekToStart ? 0 : parameters.To);
        case MciCommand::Status:
            return device.Status(parameters.Item, parameters.Value);
        case MciCommand::SetAudio:
            return device.SetAudio(parameters.Item, parameters.Value);
        case MciCommand::Set:  // times are milliseconds anyway
        case MciCommand::Open:
        case MciCommand::Close:
            return {};
    }
    return u"Unbekanntes Kommando."_s;
}

quint32 GstMci::SendCommand(quint32 device, MciCommand command, quint32 flags, MciParameters& parameters) {
    if (command == MciCommand::Open) return Open(parameters);
    const auto found = devices_.find(device);
    if (found == devices_.end()) return Result(u"Es ist kein Gerät geöffnet."_s);
    if (command == MciCommand::Close) return Close(device);
    const QString text = Carry(*found->second, command, flags, parameters);
    return Result(text, ErrorOf(*found->second));
}
