#pragma once

#include <QAbstractNativeEventFilter>

namespace Kv
{

/// Hears when the X server has destroyed one of our windows, for somebody else: Qt goes on as if it were there, and
/// nobody could close it any more. Our widget then goes too.
class QtLostWindows final : private QAbstractNativeEventFilter
{
public:
    /// From here on, for the application object that is there now.
    static void watch();

private:
    bool nativeEventFilter(QByteArray const& kind, void* message, qintptr* result) override;
};

} // namespace Kv
