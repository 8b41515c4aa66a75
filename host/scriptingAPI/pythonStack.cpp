#include <boost/python.hpp>
#include <boost/python/detail/exception_handler.hpp>

#include "pythonParts.h"

#include <algorithm>
#include <cstdint>
#include <pthread.h>

namespace bp = boost::python;

namespace Kv
{

namespace
{

/// The lowest address at which a call may begin in this thread, so that what a dialog and Qt need has its place below.
/// 0 where the system does not tell, as without file handles.
std::uintptr_t findLowest()
{
    pthread_attr_t attributes;
    if (pthread_getattr_np(pthread_self(), &attributes) != 0)
        return 0;
    void* begin = nullptr;
    std::size_t size = 0;
    pthread_attr_getstack(&attributes, &begin, &size);
    pthread_attr_destroy(&attributes);
    constexpr std::size_t mostReserved = 1 << 20;
    return reinterpret_cast<std::uintptr_t>(begin) + std::min(mostReserved, size / 8);
}

/// The same, remembered for the thread that asked last: for the main thread the system reads a file.
std::uintptr_t getLowest()
{
    static pthread_t thread;
    static std::uintptr_t lowest = 0;
    if (lowest == 0 || pthread_equal(thread, pthread_self()) == 0)
    {
        thread = pthread_self();
        lowest = findLowest();
    }
    return lowest;
}

/// A limit of Python's own that was raised can lie beyond the stack, whose end ends the process.
void requireStack()
{
    if (reinterpret_cast<std::uintptr_t>(__builtin_frame_address(0)) >= getLowest())
        return;
    PyErr_SetString(PyExc_RecursionError, "maximum recursion depth exceeded: the stack of the thread is used up");
    bp::throw_error_already_set();
}

} // namespace

void installStackGuard()
{
    // Around each call of a script into one of the modules.
    bp::detail::register_exception_handler(
        [](bp::detail::exception_handler const& next, boost::function0<void> const& call)
        {
            requireStack();
            return next(call);
        });
}

} // namespace Kv
