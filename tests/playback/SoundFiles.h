#pragma once

#include <QString>
#include <vector>

// Sound for the tests, and files with it, made when they are needed.

using Samples = std::vector<float>;  // left, right, left, ...

struct Tone {
    double frequency = 440;  // Hz
    double amplitude = 0.4;
};

// A sine on both sides, from phase 0.
Samples Sine(Tone tone, double seconds, int rate = 44100);
// A tone whose frequency tells the time: 200 Hz at the start, 100 Hz more each second.
Samples Sweep(double seconds, int rate = 44100);

void WriteBytes(const QString& path, const QByteArray& bytes);
QByteArray ReadBytes(const QString& path);
// 16 bit PCM.
void WriteWav(const QString& path, const Samples& samples, int rate = 44100, int channels = 2);
// 16 bit stereo without any header.
void WriteRaw(const QString& path, const Samples& samples);

// How a file is encoded by the FFmpeg libraries.
struct Encoding {
    const char* codec;      // an encoder's name
    const char* format;     // a muxer's name
    int bitRate = 128'000;  // bit/s; 0 = variable, by quality
    bool header = true;     // of MP3: a frame with length and seek table
    bool pictures = false;  // ten a second beside the sound
};
void Encode(const QString& path, const Samples& samples, const Encoding& encoding, int rate = 44100);
// As files with this extension usually are: mp3, mp2, wma, asf, ogg, wav, raw, and avi with grey pictures.
void WriteSound(const QString& path, const Samples& samples);

// Amplitude of a tone within one side of a piece of sound.
double AmplitudeOf(double frequency, const Samples& heard, std::size_t from, std::size_t frames, int side = 0,
                   int rate = 44100);
// The largest difference between two neighbours of one side. A tone of `frequency` that gets no louder has at
// most SteepestStep; whatever is cut off has more.
double LargestStep(const Samples& heard, std::size_t from = 0, int side = 0);
double SteepestStep(Tone tone, int rate = 44100);
