#pragma once

#include <QString>
#include <functional>
#include <optional>

// One ID3v2 frame as it is shown to the user.
struct FrameReport {
    QString Id;                      // four characters as in the tag (three in version 2.2)
    QString Text;                    // decoded value or description
    std::optional<qint64> Number{};  // where the frame has one: track, genre, counter, size
};

// Told every frame of a tag in the order in which they stand; may be unset.
using FrameListener = std::function<void(const FrameReport&)>;
