// Loaded ahead of a program, makes a folder hang as that of a network does in its bad hour: whoever looks at what
// KV_HANGING_FOLDER names, at anything in it, or at a link to that, waits for as long as the file KV_HANGING_WHILE is
// there.

#include <cerrno>
#include <cstdarg>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <dirent.h>
#include <dlfcn.h>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace
{

// The system's own calls are not among those that hang.

bool isOn()
{
    static char const* const gate = getenv("KV_HANGING_WHILE");
    return gate && syscall(SYS_access, gate, F_OK) == 0;
}

std::string readLink(std::string const& link)
{
    char target[4096];
    long const length = syscall(SYS_readlink, link.c_str(), target, sizeof target);
    return length < 0 ? std::string() : std::string(target, static_cast<std::size_t>(length));
}

std::string nameDescriptor(int descriptor)
{
    return readLink("/proc/self/fd/" + std::to_string(descriptor));
}

/// The path without links; where nothing is there, as it was given.
std::string resolve(int folder, char const* path, int flags)
{
    if (!*path)
        return nameDescriptor(folder);
    long const descriptor = syscall(SYS_openat, folder, path, O_PATH | O_CLOEXEC | flags);
    if (descriptor >= 0)
    {
        std::string const real = nameDescriptor(static_cast<int>(descriptor));
        syscall(SYS_close, descriptor);
        return real;
    }
    if (*path == '/')
        return path;
    return (folder == AT_FDCWD ? readLink("/proc/self/cwd") : nameDescriptor(folder)) + '/' + path;
}

void waitFor(std::string const& path)
{
    static char const* const folder = getenv("KV_HANGING_FOLDER");
    std::size_t const length = folder ? strlen(folder) : 0;
    bool const isIn = folder && path.compare(0, length, folder) == 0 && (path.size() == length || path[length] == '/');
    while (isIn && isOn())
    {
        timespec const pause{0, 2'000'000};
        nanosleep(&pause, nullptr);
    }
}

void wait(int folder, char const* path, int flags = 0)
{
    int const before = errno;
    if (isOn())
        waitFor(resolve(folder, path, flags));
    errno = before;
}

int noFollow(int flags)
{
    return flags & AT_SYMLINK_NOFOLLOW ? O_NOFOLLOW : 0;
}

template <typename Function> Function* next(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

#define KV_NEXT(name) static auto* const real = next<decltype(name)>(#name)

extern "C"
{

    int stat(char const* path, struct stat* status)
    {
        KV_NEXT(stat);
        wait(AT_FDCWD, path);
        return real(path, status);
    }

    int stat64(char const* path, struct stat64* status)
    {
        KV_NEXT(stat64);
        wait(AT_FDCWD, path);
        return real(path, status);
    }

    int lstat(char const* path, struct stat* status)
    {
        KV_NEXT(lstat);
        wait(AT_FDCWD, path, O_NOFOLLOW);
        return real(path, status);
    }

    int lstat64(char const* path, struct stat64* status)
    {
        KV_NEXT(lstat64);
        wait(AT_FDCWD, path, O_NOFOLLOW);
        return real(path, status);
    }

    int fstatat(int folder, char const* path, struct stat* status, int flags)
    {
        KV_NEXT(fstatat);
        wait(folder, path, noFollow(flags));
        return real(folder, path, status, flags);
    }

    int fstatat64(int folder, char const* path, struct stat64* status, int flags)
    {
        KV_NEXT(fstatat64);
        wait(folder, path, noFollow(flags));
        return real(folder, path, status, flags);
    }

    int statx(int folder, char const* path, int flags, unsigned mask, struct statx* status)
    {
        KV_NEXT(statx);
        wait(folder, path, noFollow(flags));
        return real(folder, path, flags, mask, status);
    }

    int access(char const* path, int mode)
    {
        KV_NEXT(access);
        wait(AT_FDCWD, path);
        return real(path, mode);
    }

    int faccessat(int folder, char const* path, int mode, int flags)
    {
        KV_NEXT(faccessat);
        wait(folder, path);
        return real(folder, path, mode, flags);
    }

    ssize_t readlink(char const* path, char* target, size_t size)
    {
        KV_NEXT(readlink);
        wait(AT_FDCWD, path, O_NOFOLLOW);
        return real(path, target, size);
    }

    char* realpath(char const* path, char* resolved)
    {
        KV_NEXT(realpath);
        wait(AT_FDCWD, path);
        return real(path, resolved);
    }

    DIR* opendir(char const* path)
    {
        KV_NEXT(opendir);
        wait(AT_FDCWD, path);
        return real(path);
    }

    dirent* readdir(DIR* stream)
    {
        KV_NEXT(readdir);
        wait(dirfd(stream), "");
        return real(stream);
    }

    dirent64* readdir64(DIR* stream)
    {
        KV_NEXT(readdir64);
        wait(dirfd(stream), "");
        return real(stream);
    }

    FILE* fopen(char const* path, char const* mode)
    {
        KV_NEXT(fopen);
        wait(AT_FDCWD, path);
        return real(path, mode);
    }

    FILE* fopen64(char const* path, char const* mode)
    {
        KV_NEXT(fopen64);
        wait(AT_FDCWD, path);
        return real(path, mode);
    }

#define KV_OPEN(name)                                                                                                  \
    int name(char const* path, int flags, ...)                                                                         \
    {                                                                                                                  \
        KV_NEXT(name);                                                                                                 \
        va_list arguments;                                                                                             \
        va_start(arguments, flags);                                                                                    \
        mode_t const mode = va_arg(arguments, mode_t);                                                                 \
        va_end(arguments);                                                                                             \
        wait(AT_FDCWD, path, flags& O_NOFOLLOW);                                                                       \
        return real(path, flags, mode);                                                                                \
    }

    KV_OPEN(open)
    KV_OPEN(open64)

} // extern "C"
