#include "ReadMPEGHeader/Genres.h"
