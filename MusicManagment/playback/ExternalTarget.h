#pragma once

#include "MusicManagment/playback/ExternalLink.h"
#include "MusicManagment/playback/PlayTarget.h"

// Songs play in a separate player program. What its commands lead to it tells by feedback.
class ExternalTarget : public PlayTarget {
 public:
    // The receiver and the settings must outlive the object.
    ExternalTarget(std::unique_ptr<ExternalPlayer> player, FeedbackReceiver& receiver,
                   const EngineSettings& settings)
        : link_(std::move(player), receiver), settings_(settings) {}

    // Starts the program when it does not run.
    bool Reach(const QString& song) override;
    void Open(const QString& path) override { link_.SendText(ecOpenFile, path); }
    // These three, the questions and SetPosition do nothing while the program does not run.
    void Close() override;
    Carried Stop(StopMode mode) override;
    void CloseBeside() override;
    Carried Play() override;
    Carried PauseResume() override;
    void SetPosition(quint32 milliseconds) override;
    quint32 Position() override { return static_cast<quint32>(Ask(ecGetPosition)); }
    quint32 Length() override { return static_cast<quint32>(Ask(ecGetLength)); }
    TPSStatus Status() override;
    Carried CrossFadeTo(const QString& path) override;
    void PlayBeside(const QString& path) override;
    bool SoundsBeside() override { return link_.Runs(); }

    // `settings` are those that held until now.
    void TellChanges(const EngineSettings& before) { link_.SendChanges(before, settings_); }

 private:
    qint64 Ask(ExternalCommand question, qint64 parameter = 0) {
        return link_.Runs() ? link_.Send(question, parameter) : 0;
    }

    ExternalLink link_;
    const EngineSettings& settings_;
};
