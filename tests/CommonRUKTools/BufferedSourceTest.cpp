#include "CommonRUKTools/BufferedSource.h"

#include <gtest/gtest.h>

#include <numeric>

#include "tests/CountingSource.h"

namespace {

std::vector<std::uint8_t> BytesThatTellTheirPlace(std::size_t size) {
    std::vector<std::uint8_t> bytes(size);
    std::iota(bytes.begin(), bytes.end(), std::uint8_t{0});
    return bytes;
}

}  // namespace

TEST(BufferedSource, AFileIsReadInFewPieces) {
    const auto contents = BytesThatTellTheirPlace(1'000'000);
    CountingSource file(contents);
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
    EXPECT_EQ(file.Reads, 3);
}

TEST(BufferedSource, ReadsEndWithTheSource) {
    const auto contents = BytesThatTellTheirPlace(20'000);
    MemorySource file(contents);
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
