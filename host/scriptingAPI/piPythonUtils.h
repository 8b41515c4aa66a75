#pragma once

#include "kvExport.h"

#include <boost/uuid/uuid.hpp>

namespace Kv
{

/// Identity that is unique without a registry.
using Uuid = boost::uuids::uuid;

/// The questions of native code to the running Python.
class KV_API PiPythonUtils
{
public:
    /// Identity of the interpreter that runs on this thread; stays the same for as long as that interpreter lives.
    static Uuid const& getCurrentPythonInterpreterId();

    /// Has the running interpreter take its part in the host: in the native loop, in the conversion of values, in the
    /// search for resources. Each module that is built on the host calls it when it is imported; only the first call
    /// does something. Throws `error_already_set` of Boost.Python with the Python error set.
    static void takePart();
};

} // namespace Kv
