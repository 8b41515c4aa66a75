#include "uiView.h"

namespace Kv
{

UiView::~UiView() = default;

} // namespace Kv
