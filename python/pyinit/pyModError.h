#pragma once

#include <Python.h>

#include "exBase.h"
#include "kvExport.h"

#include <string>

namespace Kv::PyextInit
{

/// Base of the exceptions that extension modules raise on their own account.
class KV_API Error : public ExBase
{
public:
    /// `modName` is the module as scripts call it. The reason stays as it is given.
    Error(char const* sourcePath, int line, char const* modName, char const* reason);
    Error(Error const&);
    Error& operator=(Error const&);
    ~Error() override;

    std::string const& getModName() const { return _modName; }

    ExBase* clone() const override;
    [[noreturn]] void raise() const override;

    /// The Python exception type `modName.className`, derived from `Exception`. The same names give the same type
    /// again; it lasts as long as the process. Within a module body the type becomes the module's attribute
    /// `className`.
    static void* newException(std::string const& modName, std::string const& className);

private:
    std::string _modName;
};

/// The one exception of an extension module, which `Tag` stands for. A module instantiates it once and exports it.
/// Scripts see it as the Python type that `initialize` makes, with the reason as its text.
template <typename Tag> class ModError : public Error
{
public:
    ModError(char const* sourcePath, int line, char const* reason) : Error(sourcePath, line, _modName.c_str(), reason)
    {
    }
    ModError(ModError const&);
    ModError& operator=(ModError const&);
    ~ModError() override;

    ExBase* clone() const override { return new ModError(*this); }
    [[noreturn]] void raise() const override { throw ModError(*this); }

    /// Makes the Python type. To be called once, in the module body, before the translator is registered. Throws
    /// `ExAssertionFailed` for an empty name.
    static void initialize(char const* modName, char const* className);

    /// Sets the Python error of the module's type; for Boost.Python.
    static void exceptionTranslator(ModError const& error);

    /// Does nothing: the type lasts as long as the process.
    static void finalize() {}

private:
    static std::string _modName;
    static std::string _className;
    static void* _pythonException;
};

template <typename Tag> std::string ModError<Tag>::_modName;
template <typename Tag> std::string ModError<Tag>::_className;
template <typename Tag> void* ModError<Tag>::_pythonException = nullptr;

// Not in the class, where the compiler would make them for each library anew.
template <typename Tag> ModError<Tag>::ModError(ModError const&) = default;
template <typename Tag> ModError<Tag>& ModError<Tag>::operator=(ModError const&) = default;
template <typename Tag> ModError<Tag>::~ModError() = default;

template <typename Tag> void ModError<Tag>::initialize(char const* modName, char const* className)
{
    _modName = modName;
    _className = className;
    if (_modName.empty())
        Assertions::throwAssertionFailed(__FILE__, __LINE__, "!_modName.empty()");
    if (_className.empty())
        Assertions::throwAssertionFailed(__FILE__, __LINE__, "!_className.empty()");
    _pythonException = newException(_modName, _className);
}

template <typename Tag> void ModError<Tag>::exceptionTranslator(ModError const& error)
{
    PyErr_SetString(static_cast<PyObject*>(_pythonException), error.getReason());
}

} // namespace Kv::PyextInit
