#pragma once

#include <unistd.h>

namespace Kv
{

/// Owns a descriptor of the system and closes it.
class OsFileDescriptor
{
public:
    /// A negative descriptor stands for none.
    explicit OsFileDescriptor(int descriptor) : _descriptor(descriptor) {}
    OsFileDescriptor(OsFileDescriptor const&) = delete;
    OsFileDescriptor& operator=(OsFileDescriptor const&) = delete;
    ~OsFileDescriptor()
    {
        if (isOpen())
            ::close(_descriptor);
    }

    bool isOpen() const { return _descriptor >= 0; }
    int get() const { return _descriptor; }

private:
    int _descriptor;
};

} // namespace Kv
