#pragma once

#include "kvExport.h"
#include "piPythonUtils.h"
#include "pointers/rcBase.h"

namespace Kv
{

/// Base of what is handed to Python by reference: knows the interpreter that it was handed to.
class KV_API PyManagedObjectBase : public RCBase<LkCounter<int>>
{
public:
    ~PyManagedObjectBase() override;

    /// The interpreter that the object was made for; never changes.
    Uuid const& getInterpreterId() const { return _interpreterId; }

protected:
    explicit PyManagedObjectBase(Uuid const& interpreterId);

private:
    Uuid _interpreterId;
};

} // namespace Kv
