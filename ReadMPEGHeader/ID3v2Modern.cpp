#include "ReadMPEGHeader/ID3v2Reader.h"
