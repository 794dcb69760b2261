#include "PartFile.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include "QmError.h"

namespace {

class FileDescriptor {
public:
    explicit FileDescriptor(int fd) : fd_(fd) {}
    ~FileDescriptor() { if (fd_ >= 0) ::close(fd_); }
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    int get() const { return fd_; }

private:
    int fd_;
};

std::string readAll(int fd, std::size_t expectedSize, const std::string& path)
{
    std::string content(expectedSize, '\0');
    std::size_t filled = 0;
    for (;;) {
        if (filled == content.size())
            content.resize(content.size() + 65536);
        const auto got = ::read(fd, content.data() + filled, content.size() - filled);
        if (got < 0) {
            if (errno == EINTR)
                continue;
            throw OsError(errno, path);
        }
        if (got == 0)
            break;
        filled += static_cast<std::size_t>(got);
    }
    content.resize(filled);
    return content;
}

} // namespace

FileBytes::FileBytes(const std::string& path)
{
    FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
    if (file.get() < 0)
        throw OsError(errno, path);
    struct stat info {};
    if (::fstat(file.get(), &info) != 0)
        throw OsError(errno, path);
    if (S_ISDIR(info.st_mode))
        throw OsError(EISDIR, path);
    const auto size = static_cast<std::size_t>(info.st_size);
    if (S_ISREG(info.st_mode) && size > 0) {
        void* mapping = ::mmap(nullptr, size, PROT_READ, MAP_PRIVATE | MAP_POPULATE, file.get(), 0);
        if (mapping != MAP_FAILED) {
            mapped_ = static_cast<const char*>(mapping);
            mappedSize_ = size;
            return;
        }
    }
    read_ = readAll(file.get(), size, path);
}

FileBytes::~FileBytes()
{
    if (mapped_ != nullptr)
        ::munmap(const_cast<char*>(mapped_), mappedSize_);
}
