#include "tests/ReadMPEGHeader/Id3v2Builder.h"

#include "CommonRUKTools/Errors.h"

Id3v2Outcome ReadWith(Id3v2ReadFunction& read, ByteSpan bytes, std::int64_t position) {
    Id3v2Outcome outcome;
    MemorySource source(bytes);
    const auto listener = [&](const FrameReport& report) { outcome.Reports.push_back(report); };
    try {
        outcome.Read = read(source, position, outcome.End, outcome.Tag, listener, &outcome.Xruk);
    } catch (const EStreamError&) {
        outcome.Threw = true;
    }
    return outcome;
}

std::string XrukBody(std::string_view format) {
    std::string body(243, '\0');
    body.append(format);
    body.append(30, '\0');
    return body;
}
