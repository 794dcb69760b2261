// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>

// How quillmark-cli lsp checks: as check --tracker with the same options.
struct LanguageServerOptions {
    std::string ldconfig;         // empty: the first LDConfig.ldr above each document
    bool limitDescription = true; // the description's 64 characters
};

// quillmark-cli lsp: a language server on standard input and output. Reads the lists and the
// colour list first (what cannot be read is said on err, exit status 2). The exit status: 0
// after shutdown, 1 without.
int RunLanguageServer(const LanguageServerOptions& options, std::ostream& err);
