#include <Python.h>

#include "piPythonUtils.h"

#include "pythonParts.h"

#include <boost/uuid/random_generator.hpp>

#include <cstdint>
#include <map>

namespace Kv
{

Uuid const& PiPythonUtils::getCurrentPythonInterpreterId()
{
    static std::map<std::int64_t, Uuid> ids;
    std::int64_t const interpreter = PyInterpreterState_GetID(PyInterpreterState_Get());
    auto const known = ids.find(interpreter);
    return known != ids.end() ? known->second
                              : ids.emplace(interpreter, boost::uuids::random_generator()()).first->second;
}

void PiPythonUtils::takePart()
{
    static bool const isDone = []
    {
        installHook();
        installConverters();
        installStackGuard();
        installScriptFolder();
        installWrapperKeeper();
        return true;
    }();
    static_cast<void>(isDone);
}

} // namespace Kv
