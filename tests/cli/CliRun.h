// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <string>
#include <vector>

struct CliRun {
    int status;
    std::string out, err;
};

// Runs quillmark-cli in this process with the given arguments.
CliRun RunCliWith(std::vector<std::string> args);

// Runs quillmark-cli in a child of this process, after prepare has set the child up (limits,
// another user, another working folder), so that nothing of it stays with the tests.
CliRun RunCliInChild(const std::vector<std::string>& args, const std::function<void()>& prepare);

std::size_t lineCount(const std::string& text);

// Everything that can be read from the descriptor, which is closed then.
std::string readAll(int from);
