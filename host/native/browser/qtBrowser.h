#pragma once

#include "browser/qtBrowserPane.h"
#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtPeer.h"

namespace Kv
{

/// A directory to look at and to choose from.
class QtBrowser final : public QtPeer<NtBrowser, QtBrowserPane>
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtBrowser(QWidget* parent, std::string const& name, NtBrowserListener& listener);
    ~QtBrowser() override;

    void goTo(std::string const& directory, std::string const& focus,
              std::vector<std::string> const& selected) override;
    void setCollapsing(std::function<bool(std::string const&)> collapses) override;
    void setMultiple(bool multiple) override;
    std::optional<std::string> takeTypedPath(bool takesNew) override;

private:
    QtBrowser(QWidget* parent, std::string const& name, QtListenerHandle<NtBrowserListener> const& handle);

    QtListenerHandle<NtBrowserListener> _handle;
};

} // namespace Kv
