#pragma once

namespace Kv
{

// The parts that Python takes in the host. Each is to be installed once, by `PiPythonUtils::takePart`.

/// Truths and paths between Python and C++.
void installConverters();

/// The interpreter's part in the native loop.
void installHook();

/// The end of recursions that would come to the end of the stack.
void installStackGuard();

/// The folder of the script, where resources are looked for.
void installScriptFolder();

/// The keeping of PyQt6's wrappers.
void installWrapperKeeper();

} // namespace Kv
