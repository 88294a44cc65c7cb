#include "ReadMPEGHeader/Asf.h"
