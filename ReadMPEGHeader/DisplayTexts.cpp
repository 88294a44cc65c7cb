#include "ReadMPEGHeader/DisplayTexts.h"
