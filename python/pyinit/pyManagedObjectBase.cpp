#include "pyinit/pyManagedObjectBase.h"

namespace Kv
{

PyManagedObjectBase::~PyManagedObjectBase() = default;

} // namespace Kv
