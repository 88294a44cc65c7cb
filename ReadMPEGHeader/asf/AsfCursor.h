#pragma once

#include <QString>
#include <algorithm>
#include <array>
#include <cstdint>
#include <span>
#include <vector>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/FileSource.h"

// A cursor over one area of a file. Like ByteReader no read leaves the area: beyond its end there are zeros
// and Failed() is set. What is skipped is never read, so that cover pictures cost nothing.
class AsfCursor {
 public:
    // The area is cut to what the source holds.
    AsfCursor(ByteSource& source, std::int64_t begin, std::int64_t end)
        : source_(source), position_(begin), end_(std::max(begin, std::min(end, source.Size()))) {}

    bool Failed() const { return failed_; }
    std::uint64_t Remaining() const { return static_cast<std::uint64_t>(end_ - position_); }

    std::uint16_t U16() { return static_cast<std::uint16_t>(Little(2)); }
    std::uint32_t U32() { return static_cast<std::uint32_t>(Little(4)); }
    std::uint64_t U64() { return Little(8); }

    void Skip(std::uint64_t count) {
        if (count > Remaining()) return Fail();
        position_ += static_cast<std::int64_t>(count);
    }

    // The next `count` bytes; nothing, and Failed(), when the area has fewer.
    std::vector<std::uint8_t> Bytes(std::uint64_t count) {
        if (count > Remaining()) {
            Fail();
            return {};
        }
        std::vector<std::uint8_t> bytes(static_cast<std::size_t>(count));
        Fill(bytes);
        return bytes;
    }

    // UTF-16 text of `size` bytes, up to its first zero.
    QString Text(std::uint64_t size) {
        const QString text = CodePage::FromUtf16Le(Bytes(size));
        return text.left(text.indexOf(QChar(u'\0')));
    }

    // The next `size` bytes as an area of their own; this cursor moves behind them.
    AsfCursor Area(std::uint64_t size) {
        const auto begin = position_;
        Skip(size);
        return {source_, begin, position_};
    }

    template <std::size_t N>
    std::array<std::uint8_t, N> Block() {
        std::array<std::uint8_t, N> bytes{};
        if (N > Remaining())
            Fail();
        else
            Fill(bytes);
        return bytes;
    }

 private:
    void Fill(std::span<std::uint8_t> target) {
        const auto read = source_.ReadAt(position_, target);
        position_ += static_cast<std::int64_t>(target.size());
        if (read == target.size()) return;
        std::fill(target.begin(), target.end(), std::uint8_t{0});
        Fail();
    }

    std::uint64_t Little(std::size_t count) {
        std::array<std::uint8_t, 8> bytes{};
        if (count > Remaining()) {
            Fail();
            return 0;
        }
        Fill(std::span(bytes).first(count));
        std::uint64_t value = 0;
        for (std::size_t i = count; i > 0; --i)
            value = (value << 8) | bytes[i - 1];
        return value;
    }

    void Fail() {
        position_ = end_;
        failed_ = true;
    }

    ByteSource& source_;
    std::int64_t position_;
    std::int64_t end_;
    bool failed_ = false;
};
