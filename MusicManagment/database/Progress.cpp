#include "MusicManagment/database/Progress.h"
