#pragma once

#include <algorithm>
#include <functional>
#include <memory>
#include <utility>
#include <vector>

// Who wants to hear of something, in the order in which they came. A listener may subscribe others, end any
// subscription (its own too) and destroy the list itself while it is being told.

// Keeps a listener in its list; leaving the list ends with this object. May outlive the list.
class Subscription {
 public:
    Subscription() = default;
    explicit Subscription(std::shared_ptr<void> listener) : listener_(std::move(listener)) {}

    void End() { listener_.reset(); }
    bool Active() const { return listener_ != nullptr; }

 private:
    std::shared_ptr<void> listener_;
};

// The subscriptions of one owner, which end with it.
class Subscriptions {
 public:
    Subscriptions& operator+=(Subscription subscription) {
        subscriptions_.push_back(std::move(subscription));
        return *this;
    }
    void End() { subscriptions_.clear(); }

 private:
    std::vector<Subscription> subscriptions_;
};

template <typename... Arguments>
class Listeners {
 public:
    using Listener = std::function<void(Arguments...)>;

    // `listener` is told from the next time on.
    [[nodiscard]] Subscription Subscribe(Listener listener) {
        auto kept = std::make_shared<Listener>(std::move(listener));
        // Whoever is being told just now goes on with the list as it was.
        auto list = std::make_shared<List>(*list_);
        std::erase_if(*list, [](const auto& gone) { return gone.expired(); });
        list->push_back(kept);
        list_ = std::move(list);
        return Subscription(kept);
    }

    void Tell(Arguments... arguments) const {
        const auto told = list_;
        for (const auto& each : *told)
            if (const auto listener = each.lock()) (*listener)(arguments...);
    }

    bool Empty() const {
        return std::all_of(list_->begin(), list_->end(), [](const auto& gone) { return gone.expired(); });
    }

 private:
    using List = std::vector<std::weak_ptr<Listener>>;
    std::shared_ptr<const List> list_ = std::make_shared<List>();
};
