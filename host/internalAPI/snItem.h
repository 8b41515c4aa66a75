#pragma once

#include "base/rcBase.h"
#include "internalAPI/kvInternalApiExport.h"

namespace Kv
{

/// Something that can be selected. What it is, those find out who know its kind, through `SnItemConvert`.
class KVINTERNALAPI_API SnItem : public RCBase<LkCounter<int>>
{
public:
    ~SnItem() override;
};

} // namespace Kv
