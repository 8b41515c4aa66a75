#pragma once

#include "ntPeers.h"
#include "peers/qtContainer.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtNative.h"

#include <QRect>

#include <memory>
#include <string>

namespace Kv
{

class QtWindowWidget;

/// Top-level window without a close box. Its one widget scrolls the content where that is larger. Owned by the host's
/// window; natively it goes with it, or with the application, whichever is first.
class QtWindow final : public NtWindow
{
public:
    /// `frame` is where the content goes, in device-independent pixels, y growing downward. `owner` can be null. The
    /// listener is borrowed.
    QtWindow(std::string const& name, std::string const& title, std::string const& contentName, QRect const& frame,
             QtWindow const* owner, NtWindowListener& listener);
    ~QtWindow() override;

    NtContainer& getContent() override { return *_content; }
    void setContentSize(int width, int height) override;
    void show() override;
    void hide() override;
    void redraw() override;
    void flushInput() override;

    /// Takes down the windows that are left, while they still can be destroyed.
    static void destroyLeft();

private:
    QtWindowWidget* getNative() const;

    QtListenerHandle<NtWindowListener> _handle;
    QtNative _native;
    QPointer<QWidget> _owner;
    std::unique_ptr<QtContainer> _content;
};

} // namespace Kv
