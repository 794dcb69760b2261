#pragma once

#include <string>
#include <vector>

struct CliRun {
    int status;
    std::string out, err;
};

// Runs quillmark-cli in this process with the given arguments.
CliRun RunCliWith(std::vector<std::string> args);
