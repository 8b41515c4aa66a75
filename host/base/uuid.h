#pragma once

#include <boost/uuid/uuid.hpp>

namespace Kv
{

/// Identity that is unique without a registry.
using Uuid = boost::uuids::uuid;

} // namespace Kv
