#include "ReadMPEGHeader/AudioFile.h"
