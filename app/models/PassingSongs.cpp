#include "app/models/PassingSongs.h"

#include <algorithm>
#include <future>
#include <span>
#include <thread>

namespace {

using Test = std::function<bool(const TID3Tag&)>;

struct Candidate {
    const TID3Tag* Song;
    std::size_t Place;  // among the songs to be tested
};

// Songs lie in memory in the order in which they came. To go through them in that order is several times
// faster than to jump from one to the next of the list.
std::vector<Candidate> InOrderOfMemory(const std::vector<const TID3Tag*>& songs) {
    std::vector<Candidate> candidates;
    candidates.reserve(songs.size());
    for (const TID3Tag* song : songs)
        candidates.push_back({song, candidates.size()});
    const std::less<const TID3Tag*> isBefore;
    if (!std::ranges::is_sorted(candidates, isBefore, &Candidate::Song))
        std::ranges::sort(candidates, isBefore, &Candidate::Song);
    return candidates;
}

// A thread of its own pays from some thousand songs on.
std::size_t PartCount(std::size_t songs) {
    constexpr std::size_t kSongsPerPart = 8'192;
    constexpr std::size_t kMostParts = 8;
    const std::size_t processors = std::max(1U, std::thread::hardware_concurrency());
    return std::clamp(songs / kSongsPerPart, std::size_t{1}, std::min(processors, kMostParts));
}

}  // namespace

std::vector<char> TestSongs(const std::vector<const TID3Tag*>& songs, const Test& passes) {
    std::vector<char> passed(songs.size());
    const std::vector<Candidate> candidates = InOrderOfMemory(songs);
    const std::size_t parts = PartCount(songs.size());
    const auto testPart = [&](std::size_t part) {
        const std::size_t from = songs.size() * part / parts;
        const std::size_t to = songs.size() * (part + 1) / parts;
        for (const auto& [song, place] : std::span(candidates).subspan(from, to - from))
            passed[place] = passes(*song);
    };
    std::vector<std::future<void>> others;
    for (std::size_t part = 1; part < parts; ++part)
        others.push_back(std::async(std::launch::async, testPart, part));
    testPart(0);
    for (std::future<void>& other : others)
        other.get();
    return passed;
}
