#pragma once

#include "CommonRUKTools/CommandRunner.h"
