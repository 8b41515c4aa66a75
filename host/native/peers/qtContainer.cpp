#include "peers/qtContainer.h"

namespace Kv
{

namespace
{

QtPeerKind<NtContainer, QtContainer> const registered;

} // namespace

} // namespace Kv
