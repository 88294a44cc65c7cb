#include "CommonRUKTools/BufferedSource.h"

#include <gtest/gtest.h>

#include <numeric>

namespace {

// Counts how often it is asked.
class CountingSource : public ByteSource {
 public:
    explicit CountingSource(std::size_t size) : bytes_(size) {
        std::iota(bytes_.begin(), bytes_.end(), std::uint8_t{0});
    }
    std::int64_t Size() const override { return static_cast<std::int64_t>(bytes_.size()); }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override {
        ++reads;
        MemorySource source(bytes_);
        return source.ReadAt(position, target);
    }
    int reads = 0;

 private:
    std::vector<std::uint8_t> bytes_;
};

}  // namespace

TEST(BufferedSource, AFileIsReadInFewPieces) {
    CountingSource file(1'000'000);
    BufferedSource source(file);
    std::array<std::uint8_t, 10> bytes{};
    const auto lookAt = [&](std::int64_t position) {
        ASSERT_EQ(source.ReadAt(position, bytes), bytes.size());
        EXPECT_EQ(bytes[0], static_cast<std::uint8_t>(position));
    };
    lookAt(0);
    lookAt(999'990);  // trailer
    lookAt(999'872);  // tag
    lookAt(500'000);  // sound behind a picture
    for (std::int64_t position = 0; position < 8000; position += 100)
        lookAt(position);
    lookAt(500'700);
    lookAt(999'900);
    EXPECT_EQ(file.reads, 3);
}

TEST(BufferedSource, ReadsEndWithTheSource) {
    CountingSource file(20'000);
    BufferedSource source(file);
    std::vector<std::uint8_t> bytes(30'000);
    EXPECT_EQ(source.ReadAt(0, bytes), 20'000u);  // larger than a window
    EXPECT_EQ(source.ReadAt(19'990, bytes), 10u);
    EXPECT_EQ(bytes[9], static_cast<std::uint8_t>(19'999));
    EXPECT_EQ(source.ReadAt(20'000, bytes), 0u);
    EXPECT_EQ(source.ReadAt(-1, bytes), 0u);
    EXPECT_EQ(source.ReadAt(0, {}), 0u);
    MemorySource nothing({});
    BufferedSource empty(nothing);
    EXPECT_EQ(empty.ReadAt(0, bytes), 0u);
}
