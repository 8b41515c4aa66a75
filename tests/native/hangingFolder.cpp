// Loaded ahead of a program, makes a folder hang as that of a network does in its bad hour: whoever looks at what
// KV_HANGING_FOLDER names, at anything in it, or at a link to that, waits for as long as the file KV_HANGING_WHILE is
// there.

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdarg>
#include <cstdio>
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
    std::string target(PATH_MAX, '\0');
    long const length = syscall(SYS_readlink, link.c_str(), target.data(), target.size());
    target.resize(static_cast<std::size_t>(std::max(length, 0L)));
    return target;
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
        std::string real = nameDescriptor(static_cast<int>(descriptor));
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

void wait(int folder, char const* path, int flags)
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

// A call of the system's library that waits for what it asks for.
#define KV_HANGS(result, name, parameters, folder, path, flags, arguments)                                             \
    extern "C" result name parameters                                                                                  \
    {                                                                                                                  \
        static auto* const real = next<decltype(name)>(#name);                                                         \
        wait(folder, path, flags);                                                                                     \
        return real arguments;                                                                                         \
    }

KV_HANGS(int, stat, (char const* path, struct stat* status), AT_FDCWD, path, 0, (path, status))
KV_HANGS(int, stat64, (char const* path, struct stat64* status), AT_FDCWD, path, 0, (path, status))
KV_HANGS(int, lstat, (char const* path, struct stat* status), AT_FDCWD, path, O_NOFOLLOW, (path, status))
KV_HANGS(int, lstat64, (char const* path, struct stat64* status), AT_FDCWD, path, O_NOFOLLOW, (path, status))
KV_HANGS(int, fstatat, (int folder, char const* path, struct stat* status, int flags), folder, path, noFollow(flags),
         (folder, path, status, flags))
KV_HANGS(int, fstatat64, (int folder, char const* path, struct stat64* status, int flags), folder, path,
         noFollow(flags), (folder, path, status, flags))
KV_HANGS(int, statx, (int folder, char const* path, int flags, unsigned mask, struct statx* status), folder, path,
         noFollow(flags), (folder, path, flags, mask, status))
KV_HANGS(int, access, (char const* path, int mode), AT_FDCWD, path, 0, (path, mode))
KV_HANGS(int, faccessat, (int folder, char const* path, int mode, int flags), folder, path, 0,
         (folder, path, mode, flags))
KV_HANGS(ssize_t, readlink, (char const* path, char* target, size_t size), AT_FDCWD, path, O_NOFOLLOW,
         (path, target, size))
KV_HANGS(int, rename, (char const* path, char const* target), AT_FDCWD, path, O_NOFOLLOW, (path, target))
KV_HANGS(int, unlink, (char const* path), AT_FDCWD, path, O_NOFOLLOW, (path))
KV_HANGS(char*, realpath, (char const* path, char* resolved), AT_FDCWD, path, 0, (path, resolved))
KV_HANGS(DIR*, opendir, (char const* path), AT_FDCWD, path, 0, (path))
KV_HANGS(dirent*, readdir, (DIR * stream), dirfd(stream), "", 0, (stream))
KV_HANGS(dirent64*, readdir64, (DIR * stream), dirfd(stream), "", 0, (stream))
KV_HANGS(FILE*, fopen, (char const* path, char const* mode), AT_FDCWD, path, 0, (path, mode))
KV_HANGS(FILE*, fopen64, (char const* path, char const* mode), AT_FDCWD, path, 0, (path, mode))

#define KV_OPENS(name)                                                                                                 \
    extern "C" int name(char const* path, int flags, ...)                                                              \
    {                                                                                                                  \
        static auto* const real = next<decltype(name)>(#name);                                                         \
        va_list arguments;                                                                                             \
        va_start(arguments, flags);                                                                                    \
        mode_t const mode = va_arg(arguments, mode_t);                                                                 \
        va_end(arguments);                                                                                             \
        wait(AT_FDCWD, path, flags& O_NOFOLLOW);                                                                       \
        return real(path, flags, mode);                                                                                \
    }

KV_OPENS(open)
KV_OPENS(open64)
