#pragma once

#include <ostream>

// quillmark-cli: the header core on the command line. Returns the exit status.
int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err);
