#pragma once

#include "kvExport.h"

#include <boost/uuid/uuid.hpp>

namespace Kv
{

/// Identity that is unique without a registry.
using Uuid = boost::uuids::uuid;

/// What native code asks of the running Python.
class KV_API PiPythonUtils
{
public:
    /// Identity of the interpreter that runs on this thread; stays the same for as long as that interpreter lives.
    static Uuid const& getCurrentPythonInterpreterId();
};

} // namespace Kv
