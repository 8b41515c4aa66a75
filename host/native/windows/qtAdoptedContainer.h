#pragma once

#include "ntContainer.h"
#include "peers/qtPeer.h"

#include <memory>

namespace Kv
{

class QtPlaceWatch;

/// Widget of the application's that holds peers' widgets beside its own, and says where the application has it.
class QtAdoptedContainer final : public NtContainer, public QtPeer
{
public:
    /// A container whose place nobody asks for.
    explicit QtAdoptedContainer(NtForeignWidget widget);

    /// The listener is borrowed.
    QtAdoptedContainer(NtForeignWidget widget, NtPlaceListener& listener);
    ~QtAdoptedContainer() override;

    void focusFirst() override { focusFirstInContent(); }

private:
    std::unique_ptr<QtPlaceWatch> _placeWatch;
};

} // namespace Kv
