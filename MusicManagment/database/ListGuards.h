#pragma once

#include "MusicManagment/database/MusicManagment.h"

// States of the song list that begin with an object and end with it, on every way out.

// Nothing may change the songs, also while the interface works between two of them.
class BusyGuard {
 public:
    explicit BusyGuard(TMusicDatabase& database) : database_(database) { database_.BeginBusy(); }
    ~BusyGuard() { database_.EndBusy(); }
    BusyGuard(const BusyGuard&) = delete;
    BusyGuard& operator=(const BusyGuard&) = delete;

 private:
    TMusicDatabase& database_;
};

// Songs come from a file and keep its order.
class LoadingGuard {
 public:
    explicit LoadingGuard(TMusicDatabase& database) : database_(database) { database_.BeginLoading(); }
    ~LoadingGuard() { database_.EndLoading(); }
    LoadingGuard(const LoadingGuard&) = delete;
    LoadingGuard& operator=(const LoadingGuard&) = delete;

 private:
    TMusicDatabase& database_;
};
