#include "pyUiError.h"

namespace Kv::PyextInit
{

template class ModError<PyextUi::Ui>;

} // namespace Kv::PyextInit
