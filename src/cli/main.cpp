// SPDX-License-Identifier: MIT
#include <csignal>
#include <iostream>
#include <unistd.h>

#include "Batch.h"
#include "CliApp.h"
#include "LanguageServerCommand.h"

int main(int argc, char** argv)
{
    std::ios::sync_with_stdio(false);
    // A closed output is an error of the write that meets it, which ends the run between files.
    std::signal(SIGPIPE, SIG_IGN);
    HoldInterrupts();
    return RunCli(argc, argv, std::cout, std::cerr, ::isatty(STDERR_FILENO) == 1,
                  [](const std::string& ldconfig, bool limitDescription) {
                      return RunLanguageServer({ldconfig, limitDescription}, std::cerr);
                  });
}
