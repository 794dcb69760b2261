#include <iostream>
#include <unistd.h>

#include "CliApp.h"

int main(int argc, char** argv)
{
    std::ios::sync_with_stdio(false);
    return RunCli(argc, argv, std::cout, std::cerr, ::isatty(STDERR_FILENO) == 1);
}
