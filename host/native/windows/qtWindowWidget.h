#pragma once

#include "loop/qtInputDrop.h"
#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "windows/qtContentArea.h"
#include "windows/qtStage.h"

#include <QPointer>
#include <QWidget>

#include <memory>
#include <vector>

namespace Kv
{

/// The toolkit's side of a window: says how much room the content has, walks the keyboard through the widgets, and
/// passes on Escape and what the window manager asks for.
class QtWindowWidget final : public QWidget, public QtStage
{
public:
    explicit QtWindowWidget(QtListenerHandle<NtWindowListener> const& handle);

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
    bool focusNextPrevChild(bool next) override;

private:
    void blockOthers();
    /// Lets input through to a window that is shown above this one now.
    void unblock(QWidget const& window);
    void letOthersIn();

    QtListenerHandle<NtWindowListener> _handle;
    /// Natively a child, which others can delete.
    QPointer<QtContentArea> _area;

    bool _awaited = false;

    /// Keep input from the windows that were open when this one was shown, while it is.
    std::vector<std::unique_ptr<QtInputDrop>> _blocked;
};

} // namespace Kv
