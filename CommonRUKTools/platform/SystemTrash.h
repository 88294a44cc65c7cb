#pragma once

#include "CommonRUKTools/Trash.h"

// The bin of the desktop.
Trash& SystemTrash();
