#include "ReadMPEGHeader/writing/TagFrame.h"

#include <algorithm>

void AppendFrame(ByteWriter& stream, const TagFrame& frame) {
    stream.Block(frame.Id, 4);
    stream.U32Be(static_cast<std::uint32_t>(frame.Stored.size()));
    stream.U8(frame.StatusFlags);
    stream.U8(frame.FormatFlags);
    stream.Raw(frame.Stored);
}

void MoveOddIdsBack(std::vector<TagFrame>& frames) {
    std::stable_partition(frames.begin(), frames.end(),
                          [](const TagFrame& frame) { return frame.Id.size() == 4; });
}
