// SPDX-License-Identifier: MIT
#include "CliRun.h"

#include <algorithm>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

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

std::size_t lineCount(const std::string& text)
{
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
}

std::string readAll(int from)
{
    std::string text;
    char buffer[4096];
    for (ssize_t got; (got = ::read(from, buffer, sizeof buffer)) > 0;)
        text.append(buffer, static_cast<std::size_t>(got));
    ::close(from);
    return text;
}

CliRun RunCliInChild(const std::vector<std::string>& args, const std::function<void()>& prepare)
{
    int out[2], err[2];
    if (::pipe(out) != 0 || ::pipe(err) != 0)
        return {-1, "", "no pipe"};
    const pid_t child = ::fork();
    if (child == 0) { // it must never return into the tests, nor run their exit handlers
        try {
            prepare();
            const auto run = RunCliWith(args);
            for (const auto& [to, text] : {std::pair{out[1], &run.out}, std::pair{err[1], &run.err}})
                if (::write(to, text->data(), text->size()) < 0)
                    ::_exit(126);
            ::_exit(run.status);
        } catch (...) {
            ::_exit(127);
        }
    }
    ::close(out[1]);
    ::close(err[1]);
    CliRun run{-1, readAll(out[0]), readAll(err[0])};
    ::waitpid(child, &run.status, 0);
    run.status = WIFEXITED(run.status) ? WEXITSTATUS(run.status) : -1;
    return run;
}
