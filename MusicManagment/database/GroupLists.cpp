#include "MusicManagment/database/GroupLists.h"
