#include "peers/qtContainer.h"

namespace Kv
{

namespace
{

QtPeerKind<NtContainer, QtContainer> registered;

} // namespace

} // namespace Kv
