#include "CommandLine.h"

std::vector<std::string> SplitCommandLine(const std::string& commandLine, std::size_t maxArguments)
{
    std::vector<std::string> arguments{std::string()};
    const bool quoted = commandLine.find('"') != std::string::npos;
    bool insideArgument = false;
    for (const char c : commandLine) {
        const bool separates = c == '"' || (c == ' ' && !quoted);
        if (separates) {
            insideArgument = false;
            continue;
        }
        if (!insideArgument) {
            if (arguments.size() - 1 == maxArguments)
                break;
            arguments.emplace_back();
            insideArgument = true;
        }
        arguments.back() += c;
    }
    return arguments;
}
