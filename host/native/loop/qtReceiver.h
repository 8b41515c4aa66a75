#pragma once

#include <QObject>

namespace Kv
{

/// Prepares an object to be connected to others that outlive it. Where memory runs out in the first connection to a
/// receiver, Qt leaves what it has freed in the list of the sender: so the first one is one to itself.
inline void prepareReceiver(QObject& receiver)
{
    QObject::connect(&receiver, &QObject::destroyed, &receiver, [] {});
}

} // namespace Kv
