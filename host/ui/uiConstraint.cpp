#include "uiConstraint.h"

#include <cmath>
#include <utility>

namespace Kv
{

namespace
{

constexpr float unitPixels = 7;

} // namespace

float UiConstraint::Edge::getPixels() const
{
    return type == Pixels ? value : value * unitPixels;
}

UiConstraint::UiConstraint(float x1, float y1, float x2, float y2, Type typeX1, Type typeY1, Type typeX2, Type typeY2,
                           Target targetX1, Target targetY1, Target targetX2, Target targetY2,
                           LiString const& siblingX1, LiString const& siblingY1, LiString const& siblingX2,
                           LiString const& siblingY2)
    : _edges{Edge{x1, typeX1, targetX1, siblingX1}, Edge{y1, typeY1, targetY1, siblingY1},
             Edge{x2, typeX2, targetX2, siblingX2}, Edge{y2, typeY2, targetY2, siblingY2}}
{
}

UiConstraint::UiConstraint(std::array<Edge, EdgeCount> edges) : _edges(std::move(edges)) {}

UiConstraint::UiConstraint(UiConstraint const&) = default;

UiConstraint::UiConstraint(UiConstraint&&) noexcept = default;

UiConstraint& UiConstraint::operator=(UiConstraint const&) = default;

UiConstraint& UiConstraint::operator=(UiConstraint&&) noexcept = default;

UiConstraint::~UiConstraint() = default;

GeVector2<float> UiConstraint::getUIGrid()
{
    return {unitPixels, unitPixels};
}

GeVector2<float> UiConstraint::pixelsToUIUnits(GeVector2<float> const& pixels)
{
    return {std::ceil(pixels.x / unitPixels), std::ceil(pixels.y / unitPixels)};
}

} // namespace Kv
