// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <ostream>
#include <string>

// Serves a language client on standard input and output, checking as check --tracker does with
// that --ldconfig and length limit; returns the exit status.
using LanguageServerStart = std::function<int(const std::string& ldconfig, bool limitDescription)>;

// quillmark-cli: the header core on the command line. Returns the exit status. A progress line
// is drawn on err only when it is a terminal. The lsp command runs languageServer (none: the
// command is not offered).
int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err, bool errIsTerminal = false,
           const LanguageServerStart& languageServer = {});
