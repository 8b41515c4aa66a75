#pragma once

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

} // namespace Kv::PyextInit
