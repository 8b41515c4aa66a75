#include "ui/uiEscapeButton.h"

#include "ui/uiWidgetPredicate.h"

namespace Kv
{

namespace
{

/// True if neither the widget nor what holds it is hidden.
bool isDisplayedThroughout(UiWidget const& widget)
{
    RCShdPtr<UiContainer> const parent = widget.getParent();
    return widget.isDisplayed() && (!parent || isDisplayedThroughout(*parent));
}

} // namespace

RCShdPtr<UiPushButton> findEscapeButton(UiContainer const& container)
{
    PrdPredicate<UiWidget> const isReachable(&isDisplayedThroughout);
    Iterator<RCShdPtr<UiWidget>> buttons =
        container.findWidgets(UiWidgetPredicate::isType(UiPushButton::getClassType()) && isReachable);
    RCShdPtr<UiPushButton> button;
    for (buttons.first(); !buttons.atEnd(); buttons.next())
    {
        button = dynamicCast<UiPushButton>(buttons.item());
        if (button->getLabel().getString() == "Cancel")
            return button;
    }
    return buttons.getCardinality() == 1 ? button : nullptr;
}

} // namespace Kv
