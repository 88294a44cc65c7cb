#pragma once

#include <QtWidgets>
#include <algorithm>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <vector>
