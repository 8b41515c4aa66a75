#include "windows/qtStage.h"

namespace Kv
{

QtGuard::Moment QtStage::findBirth(QWidget const& widget)
{
    for (QWidget const* around = &widget; around; around = around->parentWidget())
        if (auto const* const stage = dynamic_cast<QtStage const*>(around))
            return stage->_birth;
    return {};
}

} // namespace Kv
