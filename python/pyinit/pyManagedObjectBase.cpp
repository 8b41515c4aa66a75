#include "pyManagedObjectBase.h"

namespace Kv
{

PyManagedObjectBase::PyManagedObjectBase(Uuid const& interpreterId) : _interpreterId(interpreterId) {}

PyManagedObjectBase::~PyManagedObjectBase() = default;

} // namespace Kv
