#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"

namespace Kv
{

/// Something that can be selected. What it is, those find out who know its kind, through `SnItemConvert`.
class KV_API SnItem : public RCBase<LkCounter<int>>
{
public:
    ~SnItem() override;
};

} // namespace Kv
