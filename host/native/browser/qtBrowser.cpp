#include "browser/qtBrowser.h"

#include <utility>

namespace Kv
{

QtBrowser::QtBrowser(QWidget* parent, std::string const& name, NtBrowserListener& listener)
    : QtBrowser(parent, name, QtListenerHandle<NtBrowserListener>(listener))
{
}

QtBrowser::QtBrowser(QWidget* parent, std::string const& name, QtListenerHandle<NtBrowserListener> const& handle)
    : QtPeer(makeNative<QtBrowserPane>(parent, name, handle), name, 0), _handle(handle)
{
}

QtBrowser::~QtBrowser()
{
    _handle.close();
}

void QtBrowser::goTo(std::string const& directory, std::string const& focus, std::vector<std::string> const& selected)
{
    if (QtBrowserPane* const pane = getNative())
        pane->goTo(directory, {focus, selected});
}

void QtBrowser::setCollapsing(std::function<bool(std::string const&)> collapses)
{
    if (QtBrowserPane* const pane = getNative())
        pane->setCollapsing(std::move(collapses));
}

void QtBrowser::setMultiple(bool multiple)
{
    if (QtBrowserPane* const pane = getNative())
        pane->setMultiple(multiple);
}

std::optional<std::string> QtBrowser::takeTypedPath(bool takesNew)
{
    QtBrowserPane* const pane = getNative();
    return pane ? pane->takeTypedPath(takesNew) : std::string();
}

} // namespace Kv
