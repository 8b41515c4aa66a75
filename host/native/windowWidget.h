#pragma once

#include "native/ntPeers.h"
#include "native/qtInputDrop.h"
#include "native/qtListenerHandle.h"

#include <QPointer>
#include <QScrollArea>
#include <QWidget>

#include <memory>
#include <vector>

namespace Kv
{

/// The toolkit's side of a window: says how much room the content has, walks the keyboard through the widgets, and
/// passes on Escape and what the window manager asks for.
class WindowWidget final : public QWidget
{
public:
    explicit WindowWidget(QtListenerHandle<NtWindowListener> const& handle);

    /// All that there are now, shown or not.
    static std::vector<QPointer<WindowWidget>> findAll();

    /// Shows the window, modal to all others, and activates it.
    void showModal();

    /// Nobody waits for this window any more, though it stays shown: with the next turn of a loop it lets the user
    /// reach the others again, unless it is shown anew or gone until then.
    void stopWaiting();

    /// What scrolls the content. Natively a child of this.
    QScrollArea& getArea() { return *_area; }

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool focusNextPrevChild(bool next) override;

private:
    void tellRoom();
    void blockOthers();
    void letOthersIn();

    QtListenerHandle<NtWindowListener> _handle;
    QScrollArea* _area;

    /// The room as it was told last; none is told to a hidden window.
    QSize _told;
    bool _telling = false;
    bool _awaited = false;

    /// Keep input from the windows that were open when this one was shown, while it is.
    std::vector<std::unique_ptr<QtInputDrop>> _blocked;
};

} // namespace Kv
