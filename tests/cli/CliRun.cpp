#include "CliRun.h"

#include <sstream>

#include "CliApp.h"

CliRun RunCliWith(std::vector<std::string> args)
{
    args.insert(args.begin(), "quillmark-cli");
    std::vector<const char*> argv;
    for (const auto& arg : args)
        argv.push_back(arg.c_str());
    std::ostringstream out, err;
    const int status = RunCli(static_cast<int>(argv.size()), argv.data(), out, err);
    return {status, out.str(), err.str()};
}
