#pragma once

#include "CommonRUKTools/Volumes.h"

// What the system has mounted.
VolumeSource& SystemVolumes();
