#include "ReadMPEGHeader/id3v2/ID3v2Header.h"

std::optional<ID3v2Header> ID3v2Header::Read(ByteSource& stream, std::int64_t position) {
    const auto bytes = stream.ReadExactly(position, kId3v2HeaderSize);
    if (!StartsWith(bytes, "ID3")) return std::nullopt;
    ByteReader reader(bytes);
    reader.Skip(3);
    ID3v2Header header;
    header.Version = reader.U8();
    header.Revision = reader.U8();
    header.Flags = reader.U8();
    header.Size = reader.SynchSafe32();
    return header;
}
