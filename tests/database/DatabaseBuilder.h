#pragma once

#include <zlib.h>

#include <QString>
#include <algorithm>
#include <cstdint>
#include <string>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"

using Bytes = std::vector<std::uint8_t>;

// Builds a database file piece by piece. The pieces of the body come in the order of the calls, so that a
// test can leave out, repeat or damage any of them.
class DatabaseBuilder {
 public:
    explicit DatabaseBuilder(int major = 2, int minor = 0) {
        header_.Raw("TSDB By RUK");
        header_.U8(static_cast<std::uint8_t>(major));
        header_.U8(static_cast<std::uint8_t>(minor));
    }

    DatabaseBuilder& SongCount(std::int64_t count) {
        count_ = count;
        return *this;
    }
    DatabaseBuilder& Number(std::int64_t number) {
        body_.U32Le(static_cast<std::uint32_t>(number));
        return *this;
    }
    DatabaseBuilder& Block(std::string_view text, std::size_t size) {
        body_.Block(text, size);
        return *this;
    }
    DatabaseBuilder& Raw(ByteSpan bytes) {
        body_.Raw(bytes);
        return *this;
    }
    DatabaseBuilder& Zeros(std::size_t count) {
        body_.Zeros(count);
        return *this;
    }
    // No folders; for versions with lists also empty lists and 20 genres without songs.
    DatabaseBuilder& EmptyLists() { return Zeros(5 * 4).Number(20).Zeros(20 * 4); }
    DatabaseBuilder& NoFolders() { return Zeros(4); }
    // A song of version 2.0 with the given texts (file name, title, artist, album, comment, format).
    DatabaseBuilder& Song(std::vector<std::string> texts, std::uint16_t year = 1984) {
        texts.resize(6);
        body_.U16Le(year);
        body_.Zeros(29);
        body_.F64Le(40'000.5);
        for (const std::string& text : texts)
            Number(static_cast<std::int64_t>(text.size())).Raw(AsBytes(text));
        return *this;
    }

    const Bytes& Body() const { return body_.Bytes(); }
    Bytes File() const { return File(Body()); }
    // The header before another body.
    Bytes File(ByteSpan body) const {
        ByteWriter file;
        file.Raw(header_.Bytes());
        file.U32Le(static_cast<std::uint32_t>(count_));
        file.Raw(Compressed(body));
        return file.Bytes();
    }

    static Bytes Compressed(ByteSpan bytes) {
        uLongf size = compressBound(static_cast<uLong>(bytes.size()));
        Bytes compressed(size);
        compress2(compressed.data(), &size, bytes.data(), static_cast<uLong>(bytes.size()), 1);
        compressed.resize(size);
        return compressed;
    }

 private:
    ByteWriter header_;
    ByteWriter body_;
    std::int64_t count_ = 0;
};

// The contents of a zlib stream that is known to hold fewer than `most` bytes.
inline Bytes Inflated(ByteSpan compressed, std::size_t most = 1 << 20) {
    Bytes bytes(most);
    auto size = static_cast<uLongf>(most);
    if (uncompress(bytes.data(), &size, compressed.data(), static_cast<uLong>(compressed.size())) != Z_OK)
        size = 0;
    bytes.resize(size);
    return bytes;
}
