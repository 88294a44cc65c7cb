// make_songs FOLDER COUNT [ARTISTS]: writes a collection of generated songs, for trying out and measuring.

#include <QString>
#include <cstdio>

#include "CommonRUKTools/Errors.h"
#include "bench/SongGenerator.h"

int main(int argc, char** argv) {
    SongGenerator generator;
    if (argc >= 3) generator.Songs = QString::fromLocal8Bit(argv[2]).toInt();
    if (argc >= 4) generator.Artists = QString::fromLocal8Bit(argv[3]).toInt();
    if (argc < 3 || argc > 4 || generator.Songs <= 0 || generator.Artists < 0) {
        std::fprintf(stderr, "usage: %s FOLDER COUNT [ARTISTS]\n", argv[0]);
        return 2;
    }
    try {
        generator.Write(QString::fromLocal8Bit(argv[1]));
    } catch (const ERukException& error) {
        std::fprintf(stderr, "%s\n", error.what());
        return 1;
    }
    return 0;
}
