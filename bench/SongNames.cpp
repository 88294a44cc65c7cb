#include "bench/SongNames.h"

#include <QStringView>
#include <array>
#include <cstdint>

using namespace Qt::StringLiterals;

namespace {

constexpr std::array<QStringView, 24> kAdjectives = {
    u"Blaue",  u"Wilde", u"Stille", u"Ferne",   u"Goldene", u"Silent", u"Electric", u"Broken",
    u"Velvet", u"Lost",  u"Golden", u"Rolling", u"Crystal", u"Hollow", u"Burning",  u"Endless",
    u"Kleine", u"Große", u"Süße",   u"Bright",  u"Secret",  u"Paper",  u"Northern", u"Neon"};
constexpr std::array<QStringView, 32> kNouns = {
    u"Vögel",  u"Straße",  u"Nacht",  u"Liebe",    u"Sommer",  u"Herzen", u"Wolken", u"Träume",
    u"Rivers", u"Foxes",   u"Lights", u"Mirrors",  u"Shadows", u"Wheels", u"Rooms",  u"Letters",
    u"Ocean",  u"Thieves", u"Garden", u"Machines", u"Trains",  u"Echoes", u"Stones", u"Winter",
    u"Sirens", u"Motel",   u"Cities", u"Horses",   u"Clocks",  u"Angels", u"Dust",   u"Radio"};
constexpr std::array<QStringView, 12> kPlaces = {
    u"in Berlin", u"am Meer",    u"of Tomorrow", u"in the Rain",   u"und du", u"for Sale",
    u"ohne Ende", u"on the Run", u"at Midnight", u"über dem Dach", u"(Live)", u"(Radio Edit)"};

// Neighbouring numbers give unlike results (SplitMix64, Steele, Lea and Flood 2014).
std::uint64_t Mixed(std::uint64_t number) {
    number += 0x9E3779B97F4A7C15u;
    number = (number ^ (number >> 30)) * 0xBF58476D1CE4E5B9u;
    number = (number ^ (number >> 27)) * 0x94D049BB133111EBu;
    return number ^ (number >> 31);
}

template <std::size_t Size>
QString Pick(const std::array<QStringView, Size>& words, std::uint64_t& bits) {
    const auto index = static_cast<std::size_t>(bits % Size);
    bits /= Size;
    return words[index].toString();
}

QString Phrase(std::uint64_t bits) {
    QString phrase = Pick(kAdjectives, bits) + u' ' + Pick(kNouns, bits);
    if (bits % 3 == 0) phrase += u' ' + Pick(kPlaces, bits);
    return phrase;
}

}  // namespace

namespace SongNames {

QString Artist(int number) {
    auto bits = Mixed(static_cast<std::uint64_t>(number) * 3 + 1);
    const QString name = Pick(kAdjectives, bits) + u' ' + Pick(kNouns, bits);
    // More artists than pairs of words.
    return (bits % 2 == 0 ? u"The "_s : QString()) + name + u' ' + QString::number(number);
}

QString Album(int artist, int number) {
    return Phrase(Mixed(static_cast<std::uint64_t>(artist) * 1000 + static_cast<std::uint64_t>(number) + 7));
}

QString Title(int number) {
    return Phrase(Mixed(static_cast<std::uint64_t>(number) * 5 + 2));
}

}  // namespace SongNames
