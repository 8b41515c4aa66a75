#pragma once

#include "geometry.h"
#include "piWidget.h"

namespace Kv
{

/// Something that the pointer does on a widget.
class EvPointerEvent : public EvEvent
{
public:
    /// The place of the pointer in the window, in pixels, y growing upward.
    GeVector2<int> const& getPosition() const { return _position; }

protected:
    EvPointerEvent(PiWidget::EventType type, GeVector2<int> const& position) : EvEvent(type), _position(position) {}

private:
    GeVector2<int> _position;
};

/// The pointer has moved, with a button down or without.
class EvPointerMoveEvent : public EvPointerEvent
{
public:
    EvPointerMoveEvent(GeVector2<int> const& position, bool isButtonDown)
        : EvPointerEvent(PiWidget::PointerMove, position), _buttonDown(isButtonDown)
    {
    }

    /// True while the left button is down.
    bool isButtonDown() const { return _buttonDown; }

private:
    bool _buttonDown;
};

/// The left button has been pressed.
class EvPointerButtonDownEvent : public EvPointerEvent
{
public:
    explicit EvPointerButtonDownEvent(GeVector2<int> const& position) : EvPointerEvent(PiWidget::PointerDown, position)
    {
    }
};

/// The left button has been let go.
class EvPointerButtonUpEvent : public EvPointerEvent
{
public:
    explicit EvPointerButtonUpEvent(GeVector2<int> const& position) : EvPointerEvent(PiWidget::PointerUp, position) {}
};

} // namespace Kv
