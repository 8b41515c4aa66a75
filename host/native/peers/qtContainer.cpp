#include "peers/qtContainer.h"

namespace Kv
{

QtContainer::QtContainer(QWidget* parent, std::string const& name) : QtPeer(makeNative<QWidget>(parent), name, 0) {}

} // namespace Kv
