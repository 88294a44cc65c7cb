#include "ReadMPEGHeader/ID3v1.h"
