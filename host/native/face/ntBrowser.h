#pragma once

#include "ntPeer.h"

#include <functional>
#include <string>
#include <vector>

namespace Kv
{

/// Hears of the user of a browser. Names and paths are bytes of the file system.
class NtBrowserListener
{
public:
    virtual ~NtBrowserListener() = default;
    /// The user went to another directory, or the one that was shown is gone. Nothing is selected in it yet.
    virtual void onDirectoryChanged(std::string const& directory) = 0;
    /// Of the entries of the directory, `focus` has the keyboard and `selected`, as they stand on the screen, are
    /// selected; `focus` is one of them, or empty. Of a sequence it is the first file.
    virtual void onSelectionChanged(std::string const& focus, std::vector<std::string> const& selected) = 0;
    /// The user pressed Enter on a file or clicked it twice; it is in focus.
    virtual void onActivated() = 0;
    /// The browser is where the user has typed that it is to go; `newPath` is empty, or the path of what is not there
    /// yet.
    virtual void onTypedPathTaken(std::string const& newPath) = 0;
};

/// Shows a directory, and lets the user go from one to another.
class NtBrowser : public virtual NtPeer
{
public:
    using Listener = NtBrowserListener;

    /// Shows `directory`, an absolute path, with those of `selected` that are in it, and `focus`, selected.
    virtual void goTo(std::string const& directory, std::string const& focus,
                      std::vector<std::string> const& selected) = 0;

    /// Sets the function that says, of a file's name, if it may become part of a numbered sequence. Called for each
    /// file.
    virtual void setCollapsing(std::function<bool(std::string const&)> collapses) = 0;

    /// Lets the user select more than one entry.
    virtual void setMultiple(bool multiple) = 0;

    /// Goes where the user has typed without pressing Enter, as Enter would, if the user has; then the listener hears
    /// that it is there. With `takesNew`, where nothing is there but its directory, it stays, and the listener hears
    /// the typed path. In all other cases the user is told. All that is so at once, or when the file system has
    /// answered, unless the user has done something else by then.
    virtual void takeTypedPath(bool takesNew) = 0;
};

} // namespace Kv
