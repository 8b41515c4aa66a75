#include "browser/qtBrowserPane.h"
#include "ntBrowser.h"
#include "peers/qtPeer.h"

#include <utility>

namespace Kv
{

namespace
{

/// A directory to look at and to choose from.
class Browser final : public QtPeerOf<NtBrowser, QtBrowserPane>
{
public:
    Browser(QWidget* parent, std::string const& name, NtBrowserListener& listener) : QtPeerOf(parent, name, 0, listener)
    {
        if (QtBrowserPane* const pane = getNative())
            pane->nameParts();
    }

    void goTo(std::string const& directory, std::string const& focus, std::vector<std::string> const& selected) override
    {
        if (QtBrowserPane* const pane = getNative())
            pane->goTo(directory, {focus, selected});
    }

    void setCollapsing(std::function<bool(std::string const&)> collapses) override
    {
        if (QtBrowserPane* const pane = getNative())
            pane->setCollapsing(std::move(collapses));
    }

    void setMultiple(bool multiple) override
    {
        if (QtBrowserPane* const pane = getNative())
            pane->setMultiple(multiple);
    }

    void takeTypedPath(bool takesNew) override
    {
        if (QtBrowserPane* const pane = getNative())
            pane->takeTypedPath(takesNew);
    }
};

QtPeerKind<NtBrowser, Browser> registered;

} // namespace

} // namespace Kv
