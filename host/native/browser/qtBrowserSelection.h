#pragma once

#include <QObject>

#include <functional>
#include <string>
#include <vector>

namespace Kv
{

class QtBrowserList;
class QtDirModel;

/// Entries by their names: the one that has the keyboard, empty for none, and all that are selected, from top to
/// bottom.
struct QtBrowserChoice
{
    std::string focus;
    std::vector<std::string> selected;

    friend bool operator==(QtBrowserChoice const& a, QtBrowserChoice const& b)
    {
        return a.focus == b.focus && a.selected == b.selected;
    }
};

/// The selection in the list of a browser. It and the place of the list stay as they are while the rows are replaced.
class QtBrowserSelection final : public QObject
{
public:
    /// Belongs to the list, which has its model. `onChosen` is called when the user has selected other rows.
    QtBrowserSelection(QtBrowserList& list, QtDirModel& model, std::function<void()> onChosen);

    QtBrowserChoice get() const;

    /// Another directory is on its way: `choice` is selected as far as it is there.
    void await(QtBrowserChoice const& choice);

    /// Without a choice the keyboard is to be on this entry, which is not selected.
    void awaitCurrent(std::string const& name) { _view.current = name; }

    /// True until the rows of the other directory are there.
    bool isAwaiting() const { return _awaiting; }

    /// The rows are there: selects what is to be selected. True where they are those of another directory and have the
    /// one entry that was to be selected, maybe by the name of its sequence.
    bool settle();

private:
    /// The place of the list before its rows were replaced.
    struct View
    {
        /// The row that the keyboard was on, selected or not.
        std::string current;
        /// The uppermost row in sight, and how far it was out of sight.
        std::string top;
        int offset = 0;
        int scroll = 0;
    };

    void onRowsGo();
    void onChanged() const;
    void selectWanted();
    void restoreView();

    QtBrowserList& _list;
    QtDirModel& _model;
    std::function<void()> _onChosen;

    /// The choice and the place of the list that are to be restored once the rows are there.
    QtBrowserChoice _wanted;
    View _view;
    bool _awaiting = false;
    bool _replaced = false;
    bool _settling = false;
};

} // namespace Kv
