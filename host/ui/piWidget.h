#pragma once

#include "cbHandler.h"
#include "kvExport.h"
#include "pointers/rcBase.h"

#include <vector>

namespace Kv
{

class EvEvent;

/// A widget's face to those who want to hear of its events.
class KV_API PiWidget : public RCBase<LkCounter<int>>
{
public:
    enum EventType
    {
        Enable = 1,
        Disable = 2,
        PointerMove = 11,
        PointerDown = 12,
        PointerUp = 13,
        State = 22,
        Activate = 23,
        ValueChanged = 24,
    };

    /// `handler`, borrowed, runs for events of that type from now on, behind those that were added before it.
    void addCallback(EventType type, CbHandler<EvEvent>* handler);

    /// Takes out the first entry of that type and handler. False if there is none.
    bool removeCallback(EventType type, CbHandler<EvEvent>* handler);

    /// Forgets all handlers. A dispatch under way runs none of them any more.
    void clear();

    /// Runs the handlers of that type, in order of registration. Handlers may add and remove handlers: one that is
    /// added waits for the next event, one that is removed does not run any more. What a handler throws passes through.
    void fire(EventType type);

private:
    struct Entry
    {
        EventType type;
        CbHandler<EvEvent>* handler;
    };

    class Dispatch;

    std::vector<Entry> _entries;
    int _dispatchDepth = 0;
};

/// One event of a widget.
class EvEvent
{
public:
    explicit EvEvent(PiWidget::EventType type) : _type(type) {}
    EvEvent(EvEvent const&) = delete;
    EvEvent& operator=(EvEvent const&) = delete;
    virtual ~EvEvent() = default;

    PiWidget::EventType getType() const { return _type; }

private:
    PiWidget::EventType _type;
};

/// Handler of widget events that calls a member function of an object, which it does not own.
template <typename Object> class UiEventCallback : public CbMethod<Object, EvEvent>
{
public:
    using CbMethod<Object, EvEvent>::CbMethod;
};

} // namespace Kv
