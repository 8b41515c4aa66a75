#pragma once

#include "cbHandler.h"
#include "piWidget.h"

namespace Kv
{

/// Handler of widget events that calls a member function of an object, which it does not own.
template <typename Object> class UiEventCallback : public CbMethod<Object, EvEvent>
{
public:
    using CbMethod<Object, EvEvent>::CbMethod;
};

} // namespace Kv
