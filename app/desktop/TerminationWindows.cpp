#include "app/desktop/Termination.h"

// Windows asks every window of the program to close by itself.
Termination::Termination(std::function<void()> end) : end_(std::move(end)) {}

Termination::~Termination() = default;
