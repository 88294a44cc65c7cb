#pragma once

#include <memory>
#include <optional>
#include <utility>

#include "ReadMPEGHeader/ID3Tag.h"

// The record of a listed song, or none: used like an optional one, but without a record it takes no more than
// a pointer. Lists of strangers can have millions of entries, most of them names alone.
class ListedRecord {
 public:
    ListedRecord() = default;
    ListedRecord(std::nullopt_t) {}
    ListedRecord(TID3Tag record) : record_(std::make_unique<TID3Tag>(std::move(record))) {}
    ListedRecord(std::optional<TID3Tag> record) {
        if (record) record_ = std::make_unique<TID3Tag>(*std::move(record));
    }
    ListedRecord(const ListedRecord& other) : record_(other ? std::make_unique<TID3Tag>(*other) : nullptr) {}
    ListedRecord(ListedRecord&&) noexcept = default;
    ListedRecord& operator=(ListedRecord other) noexcept {
        record_ = std::move(other.record_);
        return *this;
    }
    ~ListedRecord() = default;

    explicit operator bool() const { return record_ != nullptr; }
    bool has_value() const { return record_ != nullptr; }
    const TID3Tag& operator*() const { return *record_; }
    TID3Tag& operator*() { return *record_; }
    const TID3Tag* operator->() const { return record_.get(); }
    TID3Tag* operator->() { return record_.get(); }
    operator std::optional<TID3Tag>() const { return record_ ? std::optional(*record_) : std::nullopt; }

    bool operator==(const ListedRecord& other) const {
        return record_ && other.record_ ? *record_ == *other.record_ : !record_ && !other.record_;
    }

 private:
    std::unique_ptr<TID3Tag> record_;
};
