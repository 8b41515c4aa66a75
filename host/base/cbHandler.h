#pragma once

#include <utility>

namespace Kv
{

/// A handler that the host calls for an event. The host keeps plain pointers to handlers; who makes one owns it.
template <typename Event> class CbHandler
{
public:
    CbHandler() = default;
    CbHandler(CbHandler const&) = delete;
    CbHandler& operator=(CbHandler const&) = delete;
    virtual ~CbHandler() = default;

    /// Runs the handler. It may be taken out, and its owner may drop it, while it runs.
    virtual void call(Event& event) = 0;
};

/// Handler that calls a member function of an object, which it does not own.
template <typename Object, typename Event> class CbMethod : public CbHandler<Event>
{
public:
    using Method = void (Object::*)(Event&);

    CbMethod(Object* object, Method method) : _object(object), _method(method) {}

    void call(Event& event) override { (_object->*_method)(event); }

private:
    Object* _object;
    Method _method;
};

/// Handler that calls a member function of an object, which it does not own, with data that it does own.
template <typename Object, typename Event, typename Data> class CbDataMethod : public CbHandler<Event>
{
public:
    using Method = void (Object::*)(Event&, Data);

    CbDataMethod(Object* object, Method method, Data data) : _object(object), _method(method), _data(std::move(data)) {}

    /// The method gets a copy of the data: a call under way goes on with it when `releaseData` comes in between.
    void call(Event& event) override { (_object->*_method)(event, _data); }

    /// Lets the data go, which breaks a cycle of data that owns its handler.
    void releaseData() { _data = Data(); }

private:
    Object* _object;
    Method _method;
    Data _data;
};

} // namespace Kv
