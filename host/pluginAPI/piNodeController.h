#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"

namespace Kv
{

class PiNode;

/// What stands behind a node and decides about it. It is held by strong pointers alone, and reached by weak ones.
class KV_API PiNodeController
{
public:
    PiNodeController() = default;
    PiNodeController(PiNodeController const&) = delete;
    PiNodeController& operator=(PiNodeController const&) = delete;
    virtual ~PiNodeController();

    virtual RCShdPtr<const PiNode> getNode() const = 0;
};

} // namespace Kv
