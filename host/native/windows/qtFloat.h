#pragma once

#include "loop/qtDisposal.h"
#include "ntContainer.h"
#include "peers/qtListenerHandle.h"
#include "windows/qtContentArea.h"
#include "windows/qtFocusWalk.h"

#include <QPointer>
#include <QWidget>

namespace Kv
{

/// A floating container on the screen: has a ground and an edge of its own, walks the keyboard through the widgets in
/// it, remembers which of them had it, and passes on Escape.
class QtFloat final : public QWidget, public QtWindowLike
{
public:
    QtFloat(QWidget* parent, QtListenerHandle<NtFloatListener> const& handle);
    ~QtFloat() override;

    /// The innermost one that holds the widget, or is it; null if there is none.
    static QtFloat* findAround(QWidget& widget);

    /// The native parent of the widgets in it; scrolled where it is larger. Made when it is asked for first, and hidden
    /// until it has a size.
    QWidget* getContent();
    void setContentSize(int width, int height);

    /// The content is made again when it is asked for next.
    void startAnew() { _hasContent = false; }

    /// Keeps a widget of the content in place when that scrolls. A text in it becomes a title.
    void pin(QWidget& widget);

    /// Asks to be moved so that a widget in it is seen.
    void askIntoView(QWidget const& widget) const;

    /// Gives the keyboard to the widget in it that had it last, else to the one that has it first.
    void resumeKeyboard();

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void moveEvent(QMoveEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool focusNextPrevChild(bool next) override { return _walk.step(next); }

private:
    void makeContent();

    QtListenerHandle<NtFloatListener> _handle;
    bool _hasContent = false;
    /// Natively children, which others can delete.
    QPointer<QtContentArea> _area;
    QPointer<QWidget> _edge;
    QtFocusWalk _walk{*this};
};

} // namespace Kv
