#include "app/models/SoundOutputs.h"

using namespace Qt::StringLiterals;

// Outside Windows its two stand for whatever sound server is there, and A3D and Xbox for nothing.
QStringList SoundOutputNames() {
#ifdef Q_OS_WIN
    return {u"kein Ton"_s, u"Windows Multimedia"_s, u"DirectSound"_s, u"A3D"_s, u"OSS"_s, u"ESD"_s, u"ALSA"_s,
            u"Xbox"_s};
#else
    return {u"kein Ton"_s,
            u"von selbst gewählt (1)"_s,
            u"von selbst gewählt"_s,
            u"A3D (nicht vorhanden)"_s,
            u"OSS"_s,
            u"PulseAudio"_s,
            u"ALSA"_s,
            u"Xbox (nicht vorhanden)"_s};
#endif
}
