#include "MusicManagment/database/SongList.h"
