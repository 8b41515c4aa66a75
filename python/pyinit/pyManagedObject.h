#pragma once

#include "piPythonUtils.h"
#include "pyManagedObjectBase.h"

#include <utility>

namespace Kv
{

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

} // namespace Kv
