#include "MusicManagment/database/duplicates/TextBlocks.h"

#include <algorithm>
#include <bit>

#include "CommonRUKTools/CompStr.h"

namespace {

// Fewer texts than this are compared one by one; packing would cost more than it brings.
constexpr std::size_t kFewestPacked = 24;

template <typename Word>
void FillRows(std::vector<LaneRow<Word>>& rows, const std::uint8_t* classes, std::size_t length,
              std::size_t longest) {
    constexpr std::size_t kBits = 8 * sizeof(Word);
    constexpr auto kLastBit = static_cast<Word>(Word{1} << (kBits - 1));
    rows.resize(longest + kBits + 2);  // one more than is looked at, for kernels that read on
    rows.front() = {};
    for (std::size_t r = 1; r < rows.size(); ++r) {
        for (std::size_t letter = 0; letter < kLetterClasses; ++letter)
            rows[r].Places[letter] = static_cast<Word>(rows[r - 1].Places[letter] >> 1);
        if (r <= length) rows[r].Places[classes[r - 1]] |= kLastBit;
    }
}

// How wide a band each kernel can do.
constexpr int kShortBits = 16;
constexpr int kLongBits = 32;
constexpr int kWideBits = 64;

}  // namespace

TextBlocks::TextBlocks(const ComparedTexts& texts, std::vector<std::uint32_t> numbers, int percent,
                       const LaneKernels& kernels)
    : texts_(texts), numbers_(std::move(numbers)), percent_(percent), kernels_(kernels) {
    for (std::size_t first = 0; first < numbers_.size();) {
        Block block{.Length = texts_.Length(numbers_[first]), .First = first};
        while (first < numbers_.size() && block.Count < kLanes &&
               texts_.Length(numbers_[first]) == block.Length) {
            ++block.Count;
            ++first;
        }
        blocks_.push_back(block);
    }
    if (!numbers_.empty()) longest_ = texts_.Length(numbers_.back());
    if (numbers_.size() < kFewestPacked) return;
    for (Block& block : blocks_)
        Pack(block);
}

void TextBlocks::OrderForBlocks(const ComparedTexts& texts, std::vector<std::uint32_t>& numbers) {
    std::ranges::sort(numbers, [&texts](std::uint32_t a, std::uint32_t b) {
        if (texts.Length(a) != texts.Length(b)) return texts.Length(a) < texts.Length(b);
        const int order = texts.Text(a).compare(texts.Text(b));
        return order != 0 ? order < 0 : a < b;
    });
}

void TextBlocks::Pack(Block& block) {
    block.Columns = columns_.size();
    columns_.resize(columns_.size() + (block.Length + 1) / 2);
    for (std::size_t lane = 0; lane < block.Count; ++lane) {
        const std::uint8_t* classes = texts_.Classes(numbers_[block.First + lane]);
        for (std::size_t i = 0; i < block.Length; ++i)
            columns_[block.Columns + i / 2].Letters[lane] |=
                static_cast<std::uint16_t>(classes[i] << (i % 2 * 8));
    }
}

bool TextBlocks::MayBeAlike(std::size_t lengthA, std::size_t lengthB) const {
    const std::size_t longer = std::max(lengthA, lengthB);
    return longer - std::min(lengthA, lengthB) <= MostEdits(longer, percent_);
}

std::vector<TextBlocks::Match> TextBlocks::MatchesOf(std::uint32_t reference, Workspace& workspace) const {
    const std::size_t length = texts_.Length(reference);
    if (!columns_.empty()) Prepare(reference, workspace);
    std::vector<Match> matches;
    for (const Block& block : blocks_)
        if (MayBeAlike(block.Length, length)) CompareBlock(block, reference, workspace, matches);
    std::ranges::sort(matches, {}, &Match::Number);
    return matches;
}

void TextBlocks::Prepare(std::uint32_t reference, Workspace& workspace) const {
    const std::uint8_t* classes = texts_.Classes(reference);
    const std::size_t length = texts_.Length(reference);
    const std::size_t longest = std::min(longest_, 100 * length / static_cast<std::size_t>(percent_));
    const std::size_t widest = MostEdits(longest, percent_) + 1;
    if (kernels_.Short != nullptr) {
        FillRows(workspace.ShortRows, classes, length, longest);
        FillRows(workspace.LongRows, classes, length, longest);
    }
    if (kernels_.Short == nullptr || widest > kLongBits)
        FillRows(workspace.WideRows, classes, length, longest);
}

void TextBlocks::CompareBlock(const Block& block, std::uint32_t reference, Workspace& workspace,
                              std::vector<Match>& matches) const {
    const std::u32string_view text = texts_.Text(reference);
    const std::size_t most = MostEdits(std::max(block.Length, text.size()), percent_);
    const auto alike = LanesAlike(block, text.size(), workspace);
    std::uint64_t lanes = alike.value_or(~std::uint64_t{0});
    if (block.Count < kLanes) lanes &= (std::uint64_t{1} << block.Count) - 1;
    for (; lanes != 0; lanes &= lanes - 1) {
        const auto lane = static_cast<std::size_t>(std::countr_zero(lanes));
        const std::uint32_t number = numbers_[block.First + lane];
        const std::size_t distance = alike && texts_.AreTrueToClasses(reference, number)
                                         ? workspace.Distances[lane]
                                         : EditDistance(text, texts_.Text(number));
        if (distance <= most) matches.push_back({number, static_cast<std::uint32_t>(distance)});
    }
}

// Those whose classes are alike, with their distances; nothing where the vectors cannot tell.
std::optional<std::uint64_t> TextBlocks::LanesAlike(const Block& block, std::size_t referenceLength,
                                                    Workspace& workspace) const {
    if (columns_.empty() || block.Length == 0) return std::nullopt;
    const LaneTask task{
        .Columns = columns_.data() + block.Columns,
        .Count = static_cast<int>(block.Count),
        .Length = static_cast<int>(block.Length),
        .ReferenceLength = static_cast<int>(referenceLength),
        .Limit = static_cast<int>(MostEdits(std::max(block.Length, referenceLength), percent_)),
        .Distances = workspace.Distances.data()};
    const int width = BandOf(task).Width;
    if (width > kWideBits) return std::nullopt;
    if (kernels_.Short == nullptr || width > kLongBits) return WideLanes(task, workspace.WideRows.data());
    if (width > kShortBits) return kernels_.Long(task, workspace.LongRows.data());
    return kernels_.Short(task, workspace.ShortRows.data());
}
