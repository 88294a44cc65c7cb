#include "MusicManagment/database/duplicates/PairSearch.h"

#include <QThread>
#include <algorithm>
#include <memory>
#include <numeric>
#include <unordered_map>

#include "CommonRUKTools/WorkAhead.h"

namespace {

// The texts are packed anew after so many references, without those that are done: what is compared twice is
// then little. In groups fewer, since each group is packed for itself.
constexpr std::size_t kReferencesAtOnce = 4096;
constexpr std::size_t kReferencesOfGroups = 512;

using Matches = std::vector<TextBlocks::Match>;

class Search {
 public:
    explicit Search(const PairQuery& query) : query_(query), isReference_(query.Texts->Count(), false) {
        for (const std::uint32_t reference : query.References)
            isReference_[reference] = true;
        order_.resize(query.Texts->Count());
        std::iota(order_.begin(), order_.end(), 0);
        TextBlocks::OrderForBlocks(*query.Texts, order_);
        threads_ = query.Threads > 0 ? query.Threads : QThread::idealThreadCount();
    }

    bool Run(const PairsFound& found, const std::function<bool()>& goOn) {
        const std::size_t atOnce = query_.Groups.empty() ? kReferencesAtOnce : kReferencesOfGroups;
        for (std::span<const std::uint32_t> rest = query_.References; !rest.empty();) {
            const auto references = rest.first(std::min(atOnce, rest.size()));
            rest = rest.subspan(references.size());
            Pack(references);
            if (!Compare(references, found, goOn)) return false;
        }
        return true;
    }

 private:
    std::uint32_t GroupOf(std::uint32_t number) const {
        return query_.Groups.empty() ? 0 : query_.Groups[number];
    }

    // All that may be like one of these, group by group.
    void Pack(std::span<const std::uint32_t> references) {
        std::unordered_map<std::uint32_t, std::vector<std::uint32_t>> numbers;
        for (const std::uint32_t reference : references)
            numbers[GroupOf(reference)];
        for (const std::uint32_t number : order_) {
            const bool isDone = isReference_[number] && number < references.front();
            if (isDone) continue;
            if (const auto group = numbers.find(GroupOf(number)); group != numbers.end())
                group->second.push_back(number);
        }
        blocks_.clear();
        for (auto& [group, members] : numbers)
            blocks_.emplace(group,
                            std::make_unique<TextBlocks>(*query_.Texts, std::move(members), query_.Percent));
    }

    bool Compare(std::span<const std::uint32_t> references, const PairsFound& found,
                 const std::function<bool()>& goOn) const {
        const auto maker = [&](std::size_t place, auto) {
            return [this, reference = references[place]] { return MatchesOf(reference); };
        };
        WorkAhead<Matches> work(references.size(), threads_, maker);
        for (const std::uint32_t reference : references) {
            work.Next();
            const auto matches = work.Take(goOn);
            if (!matches || !found(reference, *matches)) return false;
        }
        return true;
    }

    Matches MatchesOf(std::uint32_t reference) const {
        thread_local TextBlocks::Workspace workspace;
        Matches matches = blocks_.at(GroupOf(reference))->MatchesOf(reference, workspace);
        std::erase_if(matches, [&](const TextBlocks::Match& match) {
            return match.Number == reference || (match.Number < reference && isReference_[match.Number]);
        });
        return matches;
    }

    const PairQuery& query_;
    std::vector<bool> isReference_;
    int threads_ = 1;
    std::vector<std::uint32_t> order_;  // all numbers
    std::unordered_map<std::uint32_t, std::unique_ptr<TextBlocks>> blocks_;
};

}  // namespace

bool SearchPairs(const PairQuery& query, const PairsFound& found, const std::function<bool()>& goOn) {
    return Search(query).Run(found, goOn);
}
