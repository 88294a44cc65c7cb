#pragma once

#include "MusicManagment/database/sorting/Sorting.h"

// The order that a command makes of another one: mcSortFirst to mcSortLast, mcSubSortFirst to mcSubSortLast,
// mcReverse.
SongOrder OrderAfter(SongOrder order, int command);
