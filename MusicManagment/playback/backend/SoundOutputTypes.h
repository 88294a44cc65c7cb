#pragma once

// Ways to the loudspeaker. The numbers stand in the settings.
enum TFSoundOutputTypes : int {
    FSOUND_OUTPUT_NOSOUND,
    FSOUND_OUTPUT_WINMM,
    FSOUND_OUTPUT_DSOUND,
    FSOUND_OUTPUT_A3D,
    FSOUND_OUTPUT_OSS,
    FSOUND_OUTPUT_ESD,
    FSOUND_OUTPUT_ALSA,
    FSOUND_OUTPUT_XBOX,
};
