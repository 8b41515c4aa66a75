#pragma once

#include "ntWindow.h"
#include "peers/qtListenerHandle.h"
#include "windows/qtAdoptedContainer.h"

#include <QObject>
#include <QPointer>

#include <functional>
#include <vector>

namespace Kv
{

/// The application's window as one of the host's.
class QtMainWindow final : public QObject, public NtMainWindow
{
public:
    /// The listener is borrowed. `enableOwn` enables and disables what is the application's own in the window.
    QtMainWindow(NtForeignWidget window, std::function<void(bool)> enableOwn, NtWindowListener& listener);
    ~QtMainWindow() override;

    NtContainer& getContent() override { return _content; }
    /// The content is as large as the window, always.
    void setContentSize(int, int) override {}
    void show() override;
    void hide() override;
    void redraw() override;
    void flushInput() override;
    void refuseInput() override;
    void admitInput() noexcept override;

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void tellSize() const;
    void onFocusChanged(QWidget* to);
    /// Gives the keyboard to the front-most place where Qt has taken it from a widget and given it to nobody.
    void restoreLostKeyboard() const;
    /// The float, or the widget of the application's own, that has the keyboard whenever the window has it.
    QWidget* findPlaceWithKeyboard() const;

    QtListenerHandle<NtWindowListener> _handle;
    QtAdoptedContainer _content;
    std::function<void(bool)> _enableOwn;

    /// The places that had the keyboard, one for each time that input was refused and not yet admitted again.
    std::vector<QPointer<QWidget>> _placesWithKeyboard;
};

} // namespace Kv
