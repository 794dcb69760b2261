// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <string>
#include <vector>

struct CliRun {
    int status;
    std::string out, err;
};

// Reads from until its end and closes it.
std::string ReadAllFrom(int from);

// Runs quillmark-cli in this process with the given arguments.
CliRun RunCliWith(std::vector<std::string> args);

// Runs quillmark-cli in a child of this process, after prepare has set the child up (limits,
// another user, another working folder), so that nothing of it stays with the tests.
CliRun RunCliInChild(const std::vector<std::string>& args, const std::function<void()>& prepare);
