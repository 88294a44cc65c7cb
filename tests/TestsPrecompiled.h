#pragma once

#include <gtest/gtest.h>

#include "cmake/EnginePrecompiled.h"
