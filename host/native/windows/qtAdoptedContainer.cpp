#include "windows/qtAdoptedContainer.h"

#include "windows/qtPlaceWatch.h"

namespace Kv
{

QtAdoptedContainer::QtAdoptedContainer(NtForeignWidget widget) : QtPeer(widget) {}

QtAdoptedContainer::QtAdoptedContainer(NtForeignWidget widget, NtPlaceListener& listener) : QtPeer(widget)
{
    if (QWidget* const native = getNative())
        _placeWatch = std::make_unique<QtPlaceWatch>(*native, listener);
}

QtAdoptedContainer::~QtAdoptedContainer() = default;

} // namespace Kv
