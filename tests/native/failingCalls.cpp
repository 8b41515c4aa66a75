// A library that is loaded ahead of all others: has a chosen call for memory or to the disk fail, and says where the
// process dies of that. It reaches the interpreter that it is loaded into, and nothing of the project.

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdarg>
#include <cstddef>
#include <cstring>
#include <dlfcn.h>
#include <execinfo.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <unwind.h>

// Behind the system's headers: ahead of them it gives other names to the calls that are named here.
#include <Python.h>

// NOLINTBEGIN(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp,readability-inconsistent-declaration-parameter-name)
extern "C" void* __libc_malloc(std::size_t size);
extern "C" void* __libc_calloc(std::size_t count, std::size_t size);
extern "C" void* __libc_realloc(void* block, std::size_t size);
extern "C" void* __libc_memalign(std::size_t alignment, std::size_t size);

namespace
{

constexpr int maxFrames = 64;

struct Trace
{
    std::array<void*, maxFrames> frames;
    int count;
};

enum class Kind
{
    Memory,
    Disk,
};

/// What is to fail, and what has.
struct Plan
{
    Kind getKind() const { return diskError == 0 ? Kind::Memory : Kind::Disk; }

    long first = 0;
    long last = 0;
    bool isOursAlone = false;
    /// What calls to the disk give; 0 where those for memory fail.
    int diskError = 0;
    long calls = 0;
    long failures = 0;
    Trace firstFailure{};
};

Plan plan;
int reportFile = -1;

// Other threads have memory. The model needs none of it for itself.
#define KV_OF_THREAD __attribute__((tls_model("initial-exec"))) thread_local
KV_OF_THREAD bool isArmed = false;
KV_OF_THREAD bool isAsking = false;
/// The function that an exception has come to, while the runtime decides what to do with it there.
KV_OF_THREAD void* reached = nullptr;

bool contains(char const* text, char const* part)
{
    return std::strstr(text, part) != nullptr;
}

bool isOurs(char const* library)
{
    return contains(library, "/libKV") || contains(library, "/velmora");
}

/// Those that others make such calls through.
bool isBetween(char const* library)
{
    return contains(library, "failingCalls") || contains(library, "/libstdc++") || contains(library, "/libc.so");
}

/// True if the project's own code makes the call.
bool isMadeByUs()
{
    std::array<void*, 12> frames{};
    auto const count = static_cast<std::size_t>(backtrace(frames.data(), static_cast<int>(frames.size())));
    for (std::size_t i = 0; i < count; ++i)
        if (Dl_info info; dladdr(frames.at(i), &info) != 0 && !isBetween(info.dli_fname))
            return isOurs(info.dli_fname);
    return false;
}

bool isToFail(Kind kind)
{
    if (!isArmed || isAsking || kind != plan.getKind())
        return false;
    isAsking = true;
    bool isFailing = false;
    if (!plan.isOursAlone || isMadeByUs())
    {
        ++plan.calls;
        isFailing = plan.calls >= plan.first && plan.calls <= plan.last;
    }
    if (isFailing && ++plan.failures == 1)
        plan.firstFailure.count = backtrace(plan.firstFailure.frames.data(), maxFrames);
    isAsking = false;
    return isFailing;
}

bool isDiskToFail()
{
    bool const isFailing = isToFail(Kind::Disk);
    if (isFailing)
        errno = plan.diskError;
    return isFailing;
}

void* fail()
{
    errno = ENOMEM;
    return nullptr;
}

void say(char const* words)
{
    static_cast<void>(write(reportFile, words, std::strlen(words)));
}

void say(char const* words, Trace const& trace)
{
    say(words);
    backtrace_symbols_fd(trace.frames.data(), trace.count, reportFile);
}

/// Writes where the process is, and lets the signal end it.
void onSignal(int number)
{
    isArmed = false;
    static_cast<void>(std::signal(number, SIG_DFL));
    if (reached)
        say("reached\n", {{reached}, 1});
    say("failed\n", plan.firstFailure);
    // Last: there is no way back from where there is no code.
    Trace here{};
    here.count = backtrace(here.frames.data(), maxFrames);
    say("died\n", here);
    static_cast<void>(std::raise(number));
}

void watch()
{
    static std::array<char, 1 << 16> stack;
    stack_t alternative{};
    alternative.ss_sp = stack.data();
    alternative.ss_size = stack.size();
    sigaltstack(&alternative, nullptr);
    struct sigaction action
    {
    };
    action.sa_handler = &onSignal;
    action.sa_flags = SA_ONSTACK | SA_NODEFER;
    for (int const number : {SIGSEGV, SIGBUS, SIGABRT, SIGFPE, SIGILL, SIGTRAP, SIGALRM})
        sigaction(number, &action, nullptr);
    // The first one loads what it needs.
    Trace warm{};
    backtrace(warm.frames.data(), maxFrames);
}

} // namespace

#define KV_SHOWN extern "C" __attribute__((visibility("default")))

KV_SHOWN void* malloc(std::size_t size)
{
    return isToFail(Kind::Memory) ? fail() : __libc_malloc(size);
}

KV_SHOWN void* calloc(std::size_t count, std::size_t size)
{
    return isToFail(Kind::Memory) ? fail() : __libc_calloc(count, size);
}

KV_SHOWN void* realloc(void* block, std::size_t size)
{
    return isToFail(Kind::Memory) ? fail() : __libc_realloc(block, size);
}

KV_SHOWN void* memalign(std::size_t alignment, std::size_t size)
{
    return isToFail(Kind::Memory) ? fail() : __libc_memalign(alignment, size);
}

KV_SHOWN void* aligned_alloc(std::size_t alignment, std::size_t size)
{
    return memalign(alignment, size);
}

KV_SHOWN int posix_memalign(void** block, std::size_t alignment, std::size_t size)
{
    void* const made = memalign(alignment, size);
    if (made)
        *block = made;
    return made ? 0 : ENOMEM;
}

#define KV_DISK_CALL(type, name, parameters, arguments)                                                                \
    KV_SHOWN type name parameters                                                                                      \
    {                                                                                                                  \
        static auto const real = reinterpret_cast<decltype(&(name))>(dlsym(RTLD_NEXT, #name));                         \
        return isDiskToFail() ? -1 : real arguments;                                                                   \
    }

KV_DISK_CALL(ssize_t, read, (int file, void* buffer, std::size_t size), (file, buffer, size))
KV_DISK_CALL(ssize_t, write, (int file, void const* buffer, std::size_t size), (file, buffer, size))
KV_DISK_CALL(int, stat, (char const* path, struct stat* status), (path, status))
KV_DISK_CALL(int, lstat, (char const* path, struct stat* status), (path, status))
KV_DISK_CALL(int, fstat, (int file, struct stat* status), (file, status))
KV_DISK_CALL(int, faccessat, (int folder, char const* path, int mode, int flags), (folder, path, mode, flags))
KV_DISK_CALL(ssize_t, readlink, (char const* path, char* buffer, std::size_t size), (path, buffer, size))
KV_DISK_CALL(int, fchown, (int file, uid_t owner, gid_t group), (file, owner, group))
KV_DISK_CALL(int, fchmod, (int file, mode_t mode), (file, mode))
KV_DISK_CALL(int, fsync, (int file), (file))
KV_DISK_CALL(int, rename, (char const* path, char const* target), (path, target))

KV_SHOWN int open(char const* path, int flags, ...)
{
    static auto const real = reinterpret_cast<int (*)(char const*, int, ...)>(dlsym(RTLD_NEXT, "open"));
    va_list rest;
    va_start(rest, flags);
    mode_t const mode = (flags & O_CREAT) != 0 ? va_arg(rest, mode_t) : 0;
    va_end(rest);
    return isDiskToFail() ? -1 : real(path, flags, mode);
}

/// Where an exception may not pass a function, the process ends in here.
KV_SHOWN _Unwind_Reason_Code __gxx_personality_v0(int version, _Unwind_Action actions, _Unwind_Exception_Class kind,
                                                  _Unwind_Exception* exception, _Unwind_Context* context)
{
    using Personality = decltype(&__gxx_personality_v0);
    static auto const real = reinterpret_cast<Personality>(dlsym(RTLD_NEXT, "__gxx_personality_v0"));
    void* const outer = reached;
    reached = reinterpret_cast<void*>(_Unwind_GetIP(context)); // NOLINT(performance-no-int-to-ptr)
    _Unwind_Reason_Code const code = real(version, actions, kind, exception, context);
    reached = outer;
    return code;
}

/// Calls `life`, in which the calls from `first` to `last` fail, counted from 1: those for memory where `diskError` is
/// 0, else those to the disk. With `isOursAlone` only the calls of the project's own code count. A signal that ends the
/// process is written down in `file`.
KV_SHOWN PyObject* runFailing(PyObject* life, long first, long last, int isOursAlone, int diskError, int file)
{
    reportFile = file;
    watch();
    plan = {};
    plan.first = first;
    plan.last = last;
    plan.isOursAlone = isOursAlone != 0;
    plan.diskError = diskError;
    isArmed = true;
    PyObject* const result = PyObject_CallNoArgs(life);
    isArmed = false;
    return result;
}

/// The calls of the last run, as far as they counted.
KV_SHOWN long getCalls()
{
    return plan.calls;
}

/// Those of them that failed.
KV_SHOWN long getFailures()
{
    return plan.failures;
}

/// Writes who asked for what failed first.
KV_SHOWN void sayFailure()
{
    say("failed\n", plan.firstFailure);
}
// NOLINTEND(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp,readability-inconsistent-declaration-parameter-name)
