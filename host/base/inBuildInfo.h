#pragma once

#include "base/kvExport.h"

namespace Kv
{

/// What a package says of the build that it comes from. The texts last as long as this.
class KV_API InBuildInfo
{
public:
    InBuildInfo();
    InBuildInfo(InBuildInfo const&) = delete;
    InBuildInfo& operator=(InBuildInfo const&) = delete;
    virtual ~InBuildInfo();

    virtual char const* getProductName() const = 0;
    virtual char const* getLibraryName() const = 0;
    virtual char const* getReleaseYear() const = 0;

    /// Major and minor version, joined by a dot; the suffix goes behind it.
    virtual char const* getVersionString() const = 0;
    virtual char const* getVersionSuffix() const = 0;
    virtual int getMajorVersion() const = 0;
    virtual int getMinorVersion() const = 0;

    /// How far the release has come; 3 is under development.
    virtual int getReleaseStage() const = 0;
    virtual char const* getBuildNumber() const = 0;

    /// As the compiler writes dates: "Feb 15 2012".
    virtual char const* getBuildDate() const = 0;

    /// Configuration, processor and compiler, joined by dots.
    virtual char const* getBuildFlavour() const = 0;
};

} // namespace Kv
