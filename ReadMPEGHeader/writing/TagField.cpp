#include "ReadMPEGHeader/writing/TagField.h"

#include <algorithm>

namespace {

constexpr std::array<std::string_view, kTagFields.size()> kIds = {
    "TIT2", "TPE1", "TALB", "TYER", "COMM", "PRIV", "WXXX", "TFLT", "TLEN", "TCON", "TRCK", "PCNT", "XRUK",
};

}  // namespace

std::string_view FrameIdOf(TagField field) {
    return kIds[static_cast<std::size_t>(field)];
}

std::optional<TagField> FieldOfFrame(std::string_view id) {
    if (id == "TDRC") return TagField::Year;
    const auto found = std::ranges::find(kIds, id);
    if (found == kIds.end()) return std::nullopt;
    return kTagFields[static_cast<std::size_t>(found - kIds.begin())];
}
