#include "uiLayout.h"

#include <algorithm>
#include <cmath>

namespace Kv
{

namespace
{

constexpr std::size_t edgeCount = UiConstraint::EdgeCount;

/// X1 and X2, Y1 and Y2 face each other: across a widget, and across the gap between two.
constexpr UiConstraint::EdgeName opposite(UiConstraint::EdgeName edge)
{
    return static_cast<UiConstraint::EdgeName>((edge + 2) % edgeCount);
}

UiConstraint::EdgeName nameOf(std::size_t edge)
{
    return static_cast<UiConstraint::EdgeName>(edge % edgeCount);
}

bool isLow(UiConstraint::EdgeName edge)
{
    return edge == UiConstraint::X1 || edge == UiConstraint::Y1;
}

bool isHorizontal(UiConstraint::EdgeName edge)
{
    return edge == UiConstraint::X1 || edge == UiConstraint::X2;
}

char const* wordFor(UiConstraint::EdgeName edge)
{
    constexpr std::array<char const*, edgeCount> words{"X1", "Y1", "X2", "Y2"};
    return words.at(edge);
}

} // namespace

GeVector2<int> UiLayout::measureOverflow(UiContainer const& container)
{
    GeRectangle<int> const frame = container.getFrame();
    GeVector2<int> most;
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        GeRectangle<int> const& rect = child->getRect();
        most.x = std::max({most.x, rect.xMax - frame.xMax, frame.xMin - rect.xMin});
        most.y = std::max({most.y, rect.yMax - frame.yMax, frame.yMin - rect.yMin});
        if (auto const* const inner = dynamic_cast<UiContainer const*>(child.get()))
        {
            GeVector2<int> const within = measureOverflow(*inner);
            most.x = std::max(most.x, within.x);
            most.y = std::max(most.y, within.y);
        }
        else if (std::optional<UiConstraint> const& constraint = child->getConstraint();
                 constraint && constraint->getEdge(UiConstraint::X1).target != UiConstraint::OwnOpposite &&
                 constraint->getEdge(UiConstraint::X2).target != UiConstraint::OwnOpposite)
            most.x = std::max(most.x, child->getLeastWidth() - rect.getWidth());
    }
    return most;
}

UiLayout::UiLayout(UiContainer const& container)
    : _frame(container.getFrame()), _children(container.getChildren()), _positions(_children.size() * edgeCount),
      _progress(_positions.size(), Progress::Untouched)
{
    for (std::size_t child = 0; child < _children.size(); ++child)
    {
        _places.emplace(_children[child]->getName(), child);
        if (!_children[child]->getConstraint())
            keepInPlace(child);
    }
}

std::optional<UiLayout::Fault> UiLayout::findFault()
{
    for (EdgeIndex edge = 0; edge < _positions.size(); ++edge)
        if (std::optional<Fault> fault = settle(edge))
            return fault;
    return std::nullopt;
}

void UiLayout::apply()
{
    findFault();
    auto const at = [this](std::size_t child, UiConstraint::EdgeName edge)
    { return static_cast<int>(std::lround(_positions[child * edgeCount + edge])); };
    for (std::size_t child = 0; child < _children.size(); ++child)
        if (_children[child]->getConstraint())
        {
            GeRectangle<int> const rect{at(child, UiConstraint::X1), at(child, UiConstraint::X2),
                                        at(child, UiConstraint::Y1), at(child, UiConstraint::Y2)};
            _children[child]->takeRect(rect, true);
        }
}

void UiLayout::keepInPlace(std::size_t child)
{
    GeRectangle<int> const& rect = _children[child]->getRect();
    EdgeIndex const first = child * edgeCount;
    _positions[first + UiConstraint::X1] = static_cast<float>(rect.xMin);
    _positions[first + UiConstraint::Y1] = static_cast<float>(rect.yMin);
    _positions[first + UiConstraint::X2] = static_cast<float>(rect.xMax);
    _positions[first + UiConstraint::Y2] = static_cast<float>(rect.yMax);
    std::fill_n(_progress.begin() + static_cast<std::ptrdiff_t>(first), edgeCount, Progress::Settled);
}

UiConstraint::Edge const& UiLayout::getEdge(EdgeIndex edge) const
{
    return _children[edge / edgeCount]->getConstraint()->getEdge(nameOf(edge));
}

/// The edge of a widget that `edge` is measured from; nowhere if that is the parent's, or a sibling that is not there.
UiLayout::EdgeIndex UiLayout::findBase(EdgeIndex edge) const
{
    UiConstraint::Edge const& constraint = getEdge(edge);
    UiConstraint::EdgeName const facing = opposite(nameOf(edge));
    if (constraint.target == UiConstraint::OwnOpposite)
        return edge / edgeCount * edgeCount + facing;
    if (constraint.target != UiConstraint::SiblingEdge)
        return nowhere;
    auto const sibling = _places.find(constraint.sibling.toString());
    return sibling == _places.end() ? nowhere : sibling->second * edgeCount + facing;
}

/// Finds the position of an edge, and first those of the edges that it hangs on.
std::optional<UiLayout::Fault> UiLayout::settle(EdgeIndex edge)
{
    _chain.clear();
    EdgeIndex base = nowhere;
    for (EdgeIndex next = edge; next != nowhere && _progress[next] != Progress::Settled; next = base)
    {
        std::size_t const child = next / edgeCount;
        if (_progress[next] == Progress::UnderWay)
            return Fault{child, std::string(wordFor(nameOf(next))) + " of \"" + _children[child]->getName() +
                                    "\" hangs on itself"};
        _progress[next] = Progress::UnderWay;
        base = findBase(next);
        _chain.emplace_back(next, base);
        UiConstraint::Edge const& constraint = getEdge(next);
        if (constraint.target == UiConstraint::SiblingEdge && base == nowhere)
            return Fault{child, std::string(wordFor(nameOf(next))) + " of \"" + _children[child]->getName() +
                                    "\" names the sibling \"" + constraint.sibling.toString() +
                                    "\", which is not there"};
    }
    for (auto link = _chain.rbegin(); link != _chain.rend(); ++link)
    {
        _positions[link->first] = place(link->first, link->second);
        _progress[link->first] = Progress::Settled;
    }
    return std::nullopt;
}

float UiLayout::place(EdgeIndex edge, EdgeIndex base) const
{
    // Far beyond any screen, and still exact for whole pixels.
    constexpr float limit = 1 << 23;
    UiConstraint::Edge const& constraint = getEdge(edge);
    UiConstraint::EdgeName const name = nameOf(edge);
    float position = 0;
    switch (constraint.target)
    {
    case UiConstraint::ParentLow:
        position = static_cast<float>(isHorizontal(name) ? _frame.xMin : _frame.yMin) + constraint.getPixels();
        break;
    case UiConstraint::ParentHigh:
        position = static_cast<float>(isHorizontal(name) ? _frame.xMax : _frame.yMax) + constraint.getPixels();
        break;
    case UiConstraint::OwnOpposite:
        position = _positions[base] + (isLow(name) ? -constraint.getPixels() : constraint.getPixels());
        break;
    case UiConstraint::SiblingEdge:
        position = _positions[base] + constraint.getPixels();
        break;
    }
    return std::fmax(-limit, std::fmin(limit, position));
}

} // namespace Kv
