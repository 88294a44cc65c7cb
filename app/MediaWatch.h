#pragma once

#include "CommonRUKTools/Listeners.h"

class TMusicDatabase;

// As long as it exists, the collection is told when a medium is plugged in or taken away: its songs look
// different then, and stand elsewhere in the order by the kind of cache.
class MediaWatch {
 public:
    explicit MediaWatch(TMusicDatabase& database);

 private:
    Subscription changes_;
};
