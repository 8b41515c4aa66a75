#pragma once

#include "loop/qtDisposal.h"
#include "loop/qtInputDrop.h"
#include "ntWindow.h"
#include "peers/qtContainer.h"
#include "windows/qtContentArea.h"
#include "windows/qtFocusWalk.h"

#include <QPointer>
#include <QRect>
#include <QWidget>

#include <memory>
#include <string>
#include <vector>

namespace Kv
{

/// A window on the screen: says how much room the content has, walks the keyboard through the widgets, and
/// passes on Escape and what the window manager asks for.
class QtWindowWidget final : public QWidget, public QtWindowLike
{
public:
    explicit QtWindowWidget(QtListenerHandle<NtWindowListener> const& handle);
    ~QtWindowWidget() override;

    /// All that there are now, shown or not.
    static std::vector<QPointer<QtWindowWidget>> findAll();

    /// Shows the window, modal to all others, and activates it.
    void showModal();

    /// Nobody waits for this window any more, though it stays shown: with the next turn of a loop it lets the user
    /// reach the others again, unless it is shown anew or gone until then.
    void stopWaiting();

    /// Takes the content, which the window scrolls where it is larger.
    void setContent(QWidget* content) { _area->setWidget(content); }
    void setContentSize(int width, int height);

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool focusNextPrevChild(bool next) override { return _walk.step(next); }

private:
    /// Ahead of the first picture too: what is laid out before it is shown, costs Qt a fraction.
    void layOut();
    void blockOthers();
    /// Lets input through to a window that is shown above this one now.
    void unblock(QWidget const& window);
    void letOthersIn();
    void comeToFront();
    /// The same for a window that others were shown above meanwhile.
    void comeBack();

    QtListenerHandle<NtWindowListener> _handle;
    /// Natively a child, which others can delete.
    QPointer<QtContentArea> _area;
    QtFocusWalk _walk{*this};

    bool _awaited = false;

    /// Keep input from the windows that were open when this one was shown, while it is.
    std::vector<std::unique_ptr<QtInputDrop>> _blocked;
};

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
    /// Null when the window is gone.
    QtWindowWidget* getNative() const;

    QtListenerHandle<NtWindowListener> _handle;
    QPointer<QtWindowWidget> _widget;
    QPointer<QWidget> _owner;
    std::unique_ptr<QtContainer> _content;
};

} // namespace Kv
