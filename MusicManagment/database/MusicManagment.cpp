#include "MusicManagment/database/MusicManagment.h"
