// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>

// quillmark-cli: the header core on the command line. Returns the exit status. A progress line
// is drawn on err only when it is a terminal.
int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err, bool errIsTerminal = false);
