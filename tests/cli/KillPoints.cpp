// SPDX-License-Identifier: MIT
// Preloaded into quillmark-cli by the killed-save tests: kills it on entry to the count-th call on a
// file or folder of one function (QUILLMARK_KILL_CALL=write QUILLMARK_KILL_AT=3), as kill -9 would.
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <sys/stat.h>

namespace {

std::atomic<long> calls{0};

bool onFile(int fd)
{
    struct stat info {};
    return ::fstat(fd, &info) == 0 && (S_ISREG(info.st_mode) || S_ISDIR(info.st_mode));
}

void count(const char* name, bool onAFile)
{
    const char* call = std::getenv("QUILLMARK_KILL_CALL");
    if (onAFile && call != nullptr && std::strcmp(call, name) == 0 &&
        ++calls == std::atol(std::getenv("QUILLMARK_KILL_AT")))
        ::raise(SIGKILL);
}

} // namespace

// Each function counts its call, then does what the system's own does.
#define KILL_POINT(Result, name, parameters, arguments, onAFile)                                                       \
    extern "C" Result name parameters                                                                                  \
    {                                                                                                                  \
        count(#name, onAFile);                                                                                         \
        return reinterpret_cast<Result(*) parameters>(::dlsym(RTLD_NEXT, #name)) arguments;                            \
    }

KILL_POINT(ssize_t, write, (int fd, const void* bytes, size_t size), (fd, bytes, size), onFile(fd))
KILL_POINT(int, fsync, (int fd), (fd), onFile(fd))
KILL_POINT(int, ftruncate, (int fd, off_t size), (fd, size), true)
KILL_POINT(int, link, (const char* from, const char* to), (from, to), true)
KILL_POINT(int, linkat, (int fromFolder, const char* from, int toFolder, const char* to, int flags),
           (fromFolder, from, toFolder, to, flags), true)
KILL_POINT(int, rename, (const char* from, const char* to), (from, to), true)
KILL_POINT(int, renameat, (int fromFolder, const char* from, int toFolder, const char* to),
           (fromFolder, from, toFolder, to), true)
KILL_POINT(int, unlinkat, (int folder, const char* path, int flags), (folder, path, flags), true)
KILL_POINT(int, unlink, (const char* path), (path), true)
