#include "uiEscapeButton.h"

#include "uiWidgetPredicate.h"

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

Iterator<RCShdPtr<UiWidget>> findButtons(UiContainer const& container)
{
    return container.findWidgets(UiWidgetPredicate::isType(RttiGenType1<UiPushButton, UiWidget>::getInstance()) &&
                                 PrdPredicate<UiWidget>(&isDisplayedThroughout));
}

bool holdsValues(UiContainer const& container)
{
    return container.findWidgets(PrdPredicate<UiWidget>(&UiWidget::holdsValue)).getCardinality() > 0;
}

} // namespace

RCShdPtr<UiPushButton> findEscapeButton(UiContainer const& container)
{
    Iterator<RCShdPtr<UiWidget>> buttons = findButtons(container);
    RCShdPtr<UiPushButton> button;
    for (buttons.first(); !buttons.atEnd(); buttons.next())
    {
        button = dynamicCast<UiPushButton>(buttons.item());
        if (button->getLabel().getString() == "Cancel")
            return button;
    }
    return buttons.getCardinality() == 1 && !holdsValues(container) ? button : nullptr;
}

bool needsAnswer(UiContainer const& container)
{
    return findButtons(container).getCardinality() > 1 && !holdsValues(container);
}

} // namespace Kv
