// Database files. An input is a file as it is, or, where it begins with 'B', a body that is put behind a
// header and compressed first, so that the search is not held up by zlib's own checks:
//   'B', version (index), song count (8 bit), body
// make_database_seeds.py writes inputs to start from.

#include <zlib.h>

#include <array>
#include <cstdlib>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "tests/ScriptedDialogs.h"

namespace {

std::vector<std::uint8_t> FileAround(ByteSpan input) {
    constexpr std::array<std::uint16_t, 4> kVersions = {0x0200, 0x0102, 0x0101, 0x0100};
    ByteReader reader(input);
    reader.Skip(1);
    ByteWriter file;
    file.Raw("TSDB By RUK");
    file.U16Be(kVersions[reader.U8() % kVersions.size()]);
    file.U32Le(reader.U8());
    const ByteSpan body = reader.Rest();
    uLongf size = compressBound(static_cast<uLong>(body.size()));
    std::vector<std::uint8_t> compressed(size);
    compress2(compressed.data(), &size, body.data(), static_cast<uLong>(body.size()), Z_BEST_SPEED);
    file.Raw(ByteSpan(compressed).first(size));
    return file.Bytes();
}

// What must hold after any load.
void Check(const TMusicDatabase& database, bool failed) {
    if (database.Loading() || database.ProgressRunning() || database.Modified()) std::abort();
    int counted = 0;
    for (const auto& row : database.Artists())
        counted += row.Number;
    if (failed && counted != database.Count()) std::abort();
}

void Load(ByteSpan file) {
    const ScriptedDialogs silent;
    MemorySource source(file);
    TMusicDatabase database;
    bool failed = false;
    try {
        ReadDatabase(database, source);
    } catch (const EMusicDatabaseException&) {
        failed = true;
    }
    Check(database, failed);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const ByteSpan input(data, size);
    if (StartsWith(input, "B"))
        Load(FileAround(input));
    else
        Load(input);
    return 0;
}
