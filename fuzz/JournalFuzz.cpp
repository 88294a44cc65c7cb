// Journals, as they come. An input is a file as it is, or, where it begins with 'B', frames whose sums are
// put right first, so that the search is not held up by them:
//   'B', then for each frame: kind (8 bit), length of the head (8 bit), length of the body (8 bit), head,
//   body
// What is read must be in itself consistent, and its steps survive being written and read again.

#include <zlib.h>

#include <cstdlib>

#include "MusicManagment/database/journal/JournalLists.h"

namespace {

quint32 SumOf(ByteSpan bytes, quint32 before = 0) {
    return static_cast<quint32>(crc32_z(before, bytes.data(), bytes.size()));
}

std::vector<std::uint8_t> FileAround(ByteSpan input) {
    ByteReader reader(input);
    reader.Skip(1);
    ByteWriter file;
    file.Raw(std::string_view("TSJRNL\x01\x00", 8));
    while (!reader.AtEnd()) {
        const std::uint8_t kind = reader.U8();
        const std::size_t headSize = reader.U8();
        const std::size_t bodySize = reader.U8();
        const ByteSpan head = reader.Take(std::min(headSize, reader.Remaining()));
        const ByteSpan body = reader.Take(std::min(bodySize, reader.Remaining()));
        ByteWriter header;
        header.U8(kind);
        header.Zeros(3);
        header.U32Le(static_cast<quint32>(head.size()));
        header.U64Le(body.size());
        header.U32Le(SumOf(body));
        header.U32Le(SumOf(head, SumOf(header.Bytes())));
        file.Raw(header.Bytes());
        file.Raw(head);
        file.Raw(body);
    }
    return file.Bytes();
}

void CheckStep(const JournalStep& step) {
    ByteWriter head;
    ByteWriter body;
    WriteHead(head, step);
    WriteBody(body, step);
    ByteReader headReader(head.Bytes());
    auto again = ReadHead(headReader);
    ByteReader bodyReader(body.Bytes());
    if (!again || !ReadBody(bodyReader, *again)) std::abort();
    ByteWriter second;
    WriteHead(second, *again);
    WriteBody(second, *again);
    head.Raw(body.Bytes());
    if (second.Bytes() != head.Bytes()) std::abort();
}

void Check(ByteSpan file) {
    MemorySource source(file);
    const JournalContents contents = ReadJournal(source);
    if (contents.End > source.Size()) std::abort();
    const JournalLists lists = ListsOf(contents);
    for (const auto* list : {&lists.ToUndo, &lists.ToRedo})
        for (const RestOfBatch& rest : *list)
            for (const quint32 number : rest.Steps)
                if (const auto step = LoadStep(source, rest.Batch->Steps.at(number))) CheckStep(*step);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const ByteSpan input(data, size);
    if (StartsWith(input, "B"))
        Check(FileAround(input));
    else
        Check(input);
    return 0;
}
