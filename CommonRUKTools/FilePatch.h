#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/FileSource.h"

// How a new version of a file comes out of the old one: ranges of the old file and new bytes, in the order of
// the new file. It is a description only; FileChange.h carries it out.
class FilePatch {
 public:
    struct Piece {
        std::int64_t From = 0;  // in the old file, where Bytes is empty
        std::int64_t Length = 0;
        std::vector<std::uint8_t> Bytes{};  // Length of them, or none for a range that is kept

        bool IsKept() const { return Bytes.empty(); }
        bool operator==(const Piece&) const = default;
    };

    // Ranges and bytes of no length are left out; neighbours that belong together become one piece.
    void Keep(std::int64_t from, std::int64_t length);
    void Insert(ByteSpan bytes);

    const std::vector<Piece>& Pieces() const { return pieces_; }
    std::int64_t NewSize() const { return newSize_; }
    std::int64_t InsertedBytes() const { return insertedBytes_; }
    // Whether the new file is the old one, of this size.
    bool ChangesNothing(std::int64_t oldSize) const;
    // Whether a file of this size has every range that is kept.
    bool IsFor(std::int64_t oldSize) const;
    // Whether every kept range lies where it lay, so that the file can be written over in its place.
    bool FitsInPlace() const;
    // What makes the old version out of the new one again. Reads the bytes that go from `old`. Throws
    // EStreamError when a range lies outside of it.
    FilePatch Inverse(ByteSource& old) const;
    // The same change without kept ranges: all bytes of the new file. Throws like Inverse.
    FilePatch Whole(ByteSource& old) const;

    // As bytes of a file; docs/formats.md describes them. Nothing comes back from bytes that are no patch.
    void Write(ByteWriter& writer) const;
    static std::optional<FilePatch> Read(ByteReader& reader);

    bool operator==(const FilePatch&) const = default;

 private:
    std::vector<Piece> pieces_;
    std::int64_t newSize_ = 0;
    std::int64_t insertedBytes_ = 0;
};
