#pragma once

#include "kvExport.h"
#include "uuid.h"

namespace Kv
{

/// What native code asks of the running Python.
class KV_API PiPythonUtils
{
public:
    /// Identity of the interpreter that runs on this thread; stays the same for as long as that interpreter lives.
    static Uuid const& getCurrentPythonInterpreterId();
};

} // namespace Kv
