#pragma once

#include "brTypes.h"
#include "cbHandler.h"
#include "kvExport.h"
#include "ntBrowser.h"
#include "snSelection.h"
#include "text/liString.h"
#include "uiPeeredWidget.h"
#include "uiWorkspace.h"

#include <functional>
#include <string>
#include <vector>

namespace Kv
{

/// Shows a directory of the file system and what is selected in it, first the root. The user goes from one directory to
/// another in it. It raises `Activate` when the user presses Enter on a file or clicks it twice. Among its client data
/// is a `UiView`, whose selection are the selected entries that still exist, as `BrBrowsable`.
///
/// Paths are bytes of the file system, absolute, and those of a collapsed sequence are that of its first file. All of
/// it works without a window too: directory, focus and selection are the widget's own.
class KV_API BrBrowser : public UiPeeredWidget<NtBrowser>
{
public:
    /// A browser at the end of `parent`. There are no resource tables for it: pass null.
    static RCShdPtr<BrBrowser> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// True for the name of a file that is a composition, which it is by its extension.
    static bool isComposition(std::string const& name);

    /// The same for a script.
    static bool isScript(std::string const& name);

    ~BrBrowser() override;

    /// Sets where folders are shown.
    void setFolderOption(PaneEnum);

    /// Sets how entries are shown.
    void setViewType(BrTypes::ViewType);

    /// Makes numbered files, as "frame.0001.exr" and those after it, one entry, as at first, or an entry each. Scripts
    /// always have one each: each is one to be run.
    void setSequencesCollapsed(bool collapsed);

    /// The same for numbered compositions, which are never part of another sequence; at first each is an entry.
    void setCompositionsCollapsed(bool collapsed);

    /// Makes a composition that the user activates a file like any other. Where it is not, as at first, the handler of
    /// `setLoadCb` runs for it, if there is one, and `Activate` is not raised.
    void setDontLoadCompositions(bool dontLoad);

    /// `handler`, borrowed, loads the composition in focus. Null takes it away.
    void setLoadCb(CbHandler<EvEvent>* handler);

    /// Lets the user select more than one entry; at first only one can be.
    void setMultiple(bool multiple);

    /// Goes to a directory, or to that of a file, which then is in focus. `url` is a path; one that is relative begins
    /// in the current directory of the process. False, with everything as it was, if nothing is there. Where the file
    /// system does not answer in time, it goes there as to a directory, which it shows once there is an answer.
    bool setURL(LiString const& url, HistoryEnum, UpdateEnum);

    /// Selects the browsables of the selection that are in the current directory. Where none is, or the selection is
    /// null, all stays as it was.
    void select(RCShdPtr<SnSelection> const& selection);

    /// The path of the entry that has the keyboard in it, or the one that `takeTypedPath` took; empty if none is
    /// selected, or it is gone. Where the file system does not answer in time, what was there is.
    LiString getInputFocusPath() const;

    /// The current directory.
    LiString getPath() const;

    /// The view of its entries, the one among its client data. Never null.
    RCShdPtr<UiView> getView() const;

    /// Lets the user type the path of an entry that is not there yet, as at first, or keeps the user from it.
    void setTakesNew(bool takesNew);

    /// Goes where the user has typed in its field without pressing Enter, if the user has, and calls `taken` then: at
    /// once, or when the file system has answered, unless the user has done something else by then. What is not there
    /// yet, in a directory that is, is in focus, and nothing is selected. Where nothing can be there the user is told.
    void takeTypedPath(std::function<void()> taken);

protected:
    explicit BrBrowser(std::string name);

private:
    class View;

    void showState(NtBrowser& peer) override;
    void onDirectoryChanged(std::string const& directory) override;
    void onSelectionChanged(std::string const& focus, std::vector<std::string> const& selected) override;
    void onActivated() override;
    void onTypedPathTaken(std::string const& newPath) override;

    void showCollapsing(NtBrowser& peer) const;
    RCShdPtr<SnSelection> makeSelection() const;

    std::string _directory = "/";
    /// Names of entries of the directory.
    std::string _focus;
    std::vector<std::string> _selected;
    /// The whole path of what is not there yet.
    std::string _newPath;
    std::function<void()> _taken;
    bool _takesNew = true;
    bool _sequencesCollapsed = true;
    bool _compositionsCollapsed = false;
    bool _dontLoadCompositions = false;
    bool _multiple = false;
    CbHandler<EvEvent>* _loadCb = nullptr;
    RCShdPtr<View> _view;
};

} // namespace Kv
