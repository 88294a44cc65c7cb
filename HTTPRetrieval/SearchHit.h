#pragma once

#include <QString>
#include <functional>
#include <optional>

// A song that a search service knows. Texts are empty and numbers 0 where it does not say them.
struct SearchHit {
    QString Artist{};
    QString Title{};
    QString Album{};
    QString Year{};
    int Track = 0;
    int Length = 0;     // seconds
    QString Release{};  // number of the album at the service, for its cover

    bool operator==(const SearchHit&) const = default;
};

// Gives one hit after the other; nothing behind the last. A large answer need not be read in one go.
using HitSource = std::function<std::optional<SearchHit>()>;
