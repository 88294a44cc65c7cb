#pragma once

inline constexpr int kPatience = 30'000;  // ms; only a failing test waits so long
