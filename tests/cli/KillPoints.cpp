// Preloaded into quillmark-cli by the killed-save tests: kills the process on entry to the
// count-th call of one file-changing function, counting only calls on files and folders
// (QUILLMARK_KILL_CALL=write QUILLMARK_KILL_AT=3), as a crash or kill -9 at that moment would.
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <sys/stat.h>
#include <sys/types.h>
#include <unistd.h>

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
    const char* at = std::getenv("QUILLMARK_KILL_AT");
    if (!onAFile || call == nullptr || at == nullptr || std::strcmp(call, name) != 0)
        return;
    if (++calls == std::atol(at))
        ::raise(SIGKILL);
}

template <typename Function>
Function* real(const char* name)
{
    return reinterpret_cast<Function*>(::dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C" {
ssize_t write(int fd, const void* bytes, size_t size)
{
    count("write", onFile(fd));
    return real<ssize_t(int, const void*, size_t)>("write")(fd, bytes, size);
}
int fsync(int fd)
{
    count("fsync", onFile(fd));
    return real<int(int)>("fsync")(fd);
}
int ftruncate(int fd, off_t size) noexcept
{
    count("ftruncate", true);
    return real<int(int, off_t)>("ftruncate")(fd, size);
}
int fchmod(int fd, mode_t mode) noexcept
{
    count("fchmod", true);
    return real<int(int, mode_t)>("fchmod")(fd, mode);
}
int fchown(int fd, uid_t owner, gid_t group) noexcept
{
    count("fchown", true);
    return real<int(int, uid_t, gid_t)>("fchown")(fd, owner, group);
}
int fsetxattr(int fd, const char* name, const void* value, size_t size, int flags) noexcept
{
    count("fsetxattr", true);
    return real<int(int, const char*, const void*, size_t, int)>("fsetxattr")(fd, name, value, size, flags);
}
int link(const char* from, const char* to) noexcept
{
    count("link", true);
    return real<int(const char*, const char*)>("link")(from, to);
}
int linkat(int fromFolder, const char* from, int toFolder, const char* to, int flags) noexcept
{
    count("linkat", true);
    return real<int(int, const char*, int, const char*, int)>("linkat")(fromFolder, from, toFolder, to, flags);
}
int rename(const char* from, const char* to) noexcept
{
    count("rename", true);
    return real<int(const char*, const char*)>("rename")(from, to);
}
int unlink(const char* path) noexcept
{
    count("unlink", true);
    return real<int(const char*)>("unlink")(path);
}
}
