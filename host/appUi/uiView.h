#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"
#include "snSelection.h"

namespace Kv
{

/// What a widget that shows a collection lets others know of it. It is found among the widget's client data.
class KV_API UiView : public RCBase<LkCounter<int>>
{
public:
    ~UiView() override;

    /// What is selected in it now; null where it has no selection at all, as when its widget is gone.
    virtual RCShdPtr<SnSelection> getSelection() = 0;
};

} // namespace Kv
