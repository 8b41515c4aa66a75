#pragma once

namespace Kv
{

/// A colour by its parts, each from 0 to 1.
template <typename Number> struct CoRgbColorTyped
{
    Number red{};
    Number green{};
    Number blue{};
};

} // namespace Kv
