#pragma once

#include <string>
#include <vector>

// Splits a command line given as one text. Entry 0 is always empty; the arguments follow. A
// double quote separates arguments and is never part of one; once the line holds a double quote
// anywhere, blanks no longer separate arguments. Scanning stops when maxArguments are found.
std::vector<std::string> SplitCommandLine(const std::string& commandLine, std::size_t maxArguments = 100);
