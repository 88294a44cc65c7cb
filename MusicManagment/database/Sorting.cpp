#include "MusicManagment/database/Sorting.h"
