#pragma once

#include "kvExport.h"
#include "piPythonUtils.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"

#include <boost/python/pointee.hpp>

#include <utility>

namespace Kv
{

/// Base of the objects that are handed to Python by reference. It knows the interpreter that it was handed to.
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

/// Counted wrapper around a value that is handed to Python, stamped with the interpreter that it is handed to. Python
/// objects keep the wrapper, the wrapper keeps the value.
template <typename T> class PyManagedObject : public PyManagedObjectBase
{
public:
    explicit PyManagedObject(T value)
        : PyManagedObjectBase(PiPythonUtils::getCurrentPythonInterpreterId()), _value(std::move(value))
    {
    }

    PyManagedObject(PyManagedObject const&) = delete;
    PyManagedObject& operator=(PyManagedObject const&) = delete;
    ~PyManagedObject() override;

    T const& getValue() const { return _value; }

private:
    T _value;
};

template <typename T> PyManagedObject<T>::~PyManagedObject() = default;

/// The object in a wrapper, for Boost.Python; null for a wrapper around none. A null pointer to a wrapper throws
/// `ExNullPtr`.
template <typename T> T* get_pointer(RCShdPtr<PyManagedObject<RCShdPtr<T>>> const& managed)
{
    return managed->getValue().get();
}

} // namespace Kv

namespace boost::python
{

template <typename T> struct pointee<Kv::RCShdPtr<Kv::PyManagedObject<Kv::RCShdPtr<T>>>>
{
    using type = T;
};

} // namespace boost::python
