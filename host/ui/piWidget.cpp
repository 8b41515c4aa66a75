#include "piWidget.h"

#include "pointers/rcShdPtr.h"

#include <algorithm>

namespace Kv
{

/// Keeps the places of the entries as they are while handlers run: what is removed meanwhile leaves a null behind.
class PiWidget::Dispatch
{
public:
    explicit Dispatch(PiWidget* widget) : _widget(widget) { ++_widget->_dispatchDepth; }
    Dispatch(Dispatch const&) = delete;
    Dispatch& operator=(Dispatch const&) = delete;

    ~Dispatch()
    {
        if (--_widget->_dispatchDepth > 0)
            return;
        std::vector<Entry>& entries = _widget->_entries;
        entries.erase(std::remove_if(entries.begin(), entries.end(), [](Entry const& entry) { return !entry.handler; }),
                      entries.end());
    }

private:
    RCShdPtr<PiWidget> _widget;
};

void PiWidget::addCallback(EventType type, CbHandler<EvEvent>* handler)
{
    _entries.push_back({type, handler});
}

bool PiWidget::removeCallback(EventType type, CbHandler<EvEvent>* handler)
{
    auto const entry =
        std::find_if(_entries.begin(), _entries.end(),
                     [&](Entry const& candidate) { return candidate.type == type && candidate.handler == handler; });
    if (entry == _entries.end())
        return false;
    if (_dispatchDepth > 0)
        entry->handler = nullptr;
    else
        _entries.erase(entry);
    return true;
}

void PiWidget::clear()
{
    if (_dispatchDepth == 0)
        _entries.clear();
    for (Entry& entry : _entries)
        entry.handler = nullptr;
}

void PiWidget::fire(EventType type)
{
    Dispatch const dispatch(this);
    EvEvent event(type);
    // By index: a handler can add entries.
    for (std::size_t i = 0, count = _entries.size(); i < count; ++i) // NOLINT(modernize-loop-convert)
        if (Entry const entry = _entries[i]; entry.handler && entry.type == type)
            entry.handler->call(event);
}

} // namespace Kv
