// SPDX-License-Identifier: MIT
#include "Processes.h"

#include <grp.h>
#include <sys/wait.h>
#include <unistd.h>

pid_t StartChild(bool asNobody, const std::function<void()>& act)
{
    const pid_t child = ::fork();
    if (child == 0) {
        if (asNobody && (::setgroups(0, nullptr) != 0 || ::setresgid(65534, 65534, 65534) != 0 ||
                         ::setresuid(65534, 65534, 65534) != 0))
            ::_exit(99);
        act();
        ::_exit(0);
    }
    return child;
}

int WaitFor(pid_t child)
{
    int status = 0;
    ::waitpid(child, &status, 0);
    return status;
}
