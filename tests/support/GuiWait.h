// Waiting in tests: the toolkit's events keep flowing until a condition holds
// or the deadline passes.
#pragma once

#include <functional>

bool WaitFor(const std::function<bool()>& condition, int timeoutMs = 10000);
