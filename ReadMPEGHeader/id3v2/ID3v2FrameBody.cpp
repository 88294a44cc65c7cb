#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

#include <algorithm>
#include <limits>

#include "CommonRUKTools/CodePage.h"

namespace {

constexpr std::uint8_t kUtf16 = 1;
constexpr std::uint8_t kUtf16Be = 2;
constexpr std::uint8_t kUtf8 = 3;
constexpr std::size_t kLanguageSize = 3;
constexpr qsizetype kMostValues = 100;  // of a list; nobody reads on

bool StartsWithMark(ByteSpan bytes, std::uint8_t first, std::uint8_t second) {
    return bytes.size() >= 2 && bytes[0] == first && bytes[1] == second;
}

// 0x80 counts as a letter too: the bound has always been inclusive.
bool IsLanguageByte(std::uint8_t byte) {
    return byte >= 0x20 && byte <= 0x80;
}

}  // namespace

void FrameBody::ReadEncoding() {
    encoding_ = reader_.U8();
    bigEndian_ = rules_ != TextRules::Classic && encoding_ == kUtf16Be;
}

bool FrameBody::IsWide() const {
    if (rules_ == TextRules::Classic) return encoding_ != 0;
    return encoding_ == kUtf16 || encoding_ == kUtf16Be;
}

// Bytes before the next zero character, or all that is left.
std::size_t FrameBody::TextLength(bool wide) const {
    const auto rest = reader_.Rest();
    if (!wide) return static_cast<std::size_t>(std::ranges::find(rest, 0) - rest.begin());
    for (std::size_t i = 0; i + 1 < rest.size(); i += 2)
        if (rest[i] == 0 && rest[i + 1] == 0) return i;
    return rest.size();
}

QString FrameBody::DecodeWide(ByteSpan bytes) {
    const bool littleMark = StartsWithMark(bytes, 0xFF, 0xFE);
    // The classic rules know no other byte order; a mark that says otherwise changes nothing.
    const bool bigMark = rules_ != TextRules::Classic && StartsWithMark(bytes, 0xFE, 0xFF);
    if (littleMark || bigMark) {
        bigEndian_ = bigMark;
        bytes = bytes.subspan(2);
    }
    return bigEndian_ ? CodePage::FromUtf16Be(bytes) : CodePage::FromUtf16Le(bytes);
}

QString FrameBody::Decode(ByteSpan bytes) {
    if (IsWide()) return DecodeWide(bytes);
    if (rules_ == TextRules::Classic || encoding_ != kUtf8) return CodePage::FromLegacy(bytes);
    return CodePage::FromUtf8(StartsWith(bytes, "\xEF\xBB\xBF") ? bytes.subspan(3) : bytes);
}

std::uint32_t FrameBody::Number(std::size_t count) {
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < count; ++i)
        value = (value << 8) | U8();
    return value;
}

std::uint32_t FrameBody::Counter() {
    std::uint64_t value = 0;
    for (const std::uint8_t byte : Rest())
        value = std::min<std::uint64_t>((value << 8) | byte, std::numeric_limits<std::uint32_t>::max());
    return static_cast<std::uint32_t>(value);
}

QString FrameBody::Text() {
    const bool wide = IsWide();
    const auto bytes = reader_.Take(TextLength(wide));
    reader_.Skip(std::min<std::size_t>(reader_.Remaining(), wide ? 2 : 1));
    return Decode(bytes);
}

bool FrameBody::TextHasEnd() const {
    return TextLength(IsWide()) < reader_.Remaining();
}

QString FrameBody::Latin() {
    const auto bytes = reader_.Take(TextLength(false));
    reader_.Skip(std::min<std::size_t>(reader_.Remaining(), 1));
    return CodePage::FromLegacy(bytes);
}

QString FrameBody::Latin(std::size_t count) {
    return CodePage::FromLegacy(reader_.Take(std::min(count, reader_.Remaining())));
}

QStringList FrameBody::Values() {
    if (rules_ != TextRules::Id3v24) return {Text()};
    // A zero at the end makes no list, and an empty value says nothing.
    QStringList values;
    while (reader_.Remaining() > 0 && values.size() < kMostValues)
        if (const QString value = Text(); !value.isEmpty()) values += value;
    return values;
}

QString FrameBody::Language() {
    const auto next = reader_.Rest().first(std::min(kLanguageSize, reader_.Remaining()));
    const auto letters =
        next.first(static_cast<std::size_t>(std::ranges::find_if_not(next, IsLanguageByte) - next.begin()));
    // Three zeros are a language field that was left empty, as this program writes it. Any other bytes belong
    // to the text: there are taggers that leave the field out.
    const bool isEmptyField = std::ranges::all_of(next, [](std::uint8_t byte) { return byte == 0; });
    if (!letters.empty() || isEmptyField) reader_.Skip(next.size());
    return CodePage::FromLegacy(letters);
}
