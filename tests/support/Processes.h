// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <sys/types.h>

// Starts act in a child process, as the user nobody when asked (for tests run as root); the child
// ends when act returns.
pid_t StartChild(bool asNobody, const std::function<void()>& act);

// Waits for the child to end; its wait status.
int WaitFor(pid_t child);
