#include "ReadMPEGHeader/XrukFrame.h"
