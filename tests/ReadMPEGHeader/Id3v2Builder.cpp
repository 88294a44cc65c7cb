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

std::string XrukBody(const TID3Tag& tag) {
    ByteWriter body;
    body.Block("=====", 242);
    body.U8(0);
    body.Raw(tag.MPEGLayer.toStdString());
    body.U8(0);
    body.U16Le(tag.BitRate);
    body.U16Le(tag.SampleRate);
    for (const int value : {int{tag.ChannelMode}, int{tag.Emphasis}, int{tag.Private}, int{tag.Protected},
                            int{tag.Copyrighted}, int{tag.Original}, int{tag.Padding}})
        body.U8(static_cast<std::uint8_t>(value));
    body.U16Le(tag.FrameSize);
    body.U16Le(tag.Reserved);
    body.U32Le(tag.Flags);
    body.U8(tag.MainGenre);
    body.U8(tag.Remix ? 1 : 0);
    body.F64Le(tag.AddTime);
    return std::string(AsText(body.Bytes()));
}

TID3Tag WaveRecord() {
    TID3Tag tag;
    tag.MPEGLayer = QStringLiteral("Wave");
    return tag;
}
