#pragma once

#include "ntBrowser.h"
#include "peers/qtListenerHandle.h"

#include <QLabel>
#include <QTimer>
#include <QToolButton>
#include <QWidget>

#include <functional>
#include <string>
#include <vector>

namespace Kv
{

class QtBrowserList;
class QtDirModel;
class QtPathField;

/// The toolkit's side of a browser: a field with the path, the list of the entries, and a line that says what went
/// wrong. While it is visible it follows what becomes of the directory.
class QtBrowserPane final : public QWidget
{
public:
    /// Entries by their names: the one that has the keyboard, empty for none, and all that are selected, from top to
    /// bottom.
    struct Choice
    {
        std::string focus;
        std::vector<std::string> selected;

        friend bool operator==(Choice const& a, Choice const& b)
        {
            return a.focus == b.focus && a.selected == b.selected;
        }
    };

    QtBrowserPane(QWidget* parent, QtListenerHandle<NtBrowserListener> const& handle);

    /// Names the widgets in it after it.
    void nameParts();

    /// Shows a directory, an absolute path, and selects what is in it of a choice. The listener hears nothing.
    void goTo(std::string const& directory, Choice const& choice);

    void setCollapsing(std::function<bool(std::string const&)> collapses);
    void setMultiple(bool multiple);

    /// Goes where the user has typed, and tells the listener; gives an empty path. With `takesNew`, where nothing is
    /// there but its directory, stays and gives the typed path. Nothing in all other cases, which the user is told.
    std::optional<std::string> takeTypedPath(bool takesNew);

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    /// Where the list was before its rows were replaced.
    struct View
    {
        /// The row that the keyboard was on, selected or not.
        std::string current;
        /// The uppermost row in sight, and how far it was out of sight.
        std::string top;
        int offset = 0;
        int scroll = 0;
    };

    void layOut();

    void activate();
    void goUp();
    void walkTo(std::string const& directory, Choice const& choice);
    void toggleHidden();
    void look();
    void leave(std::string const& reason);

    void keepView();
    void onRead();
    void choose();
    void restoreView();
    Choice getChoice() const;
    void onChosen();
    /// The user has turned to the list: what stands in the field counts no more.
    void forgetTyped();
    void tellChoice();
    void say(std::string const& words);
    void showState();

    QtListenerHandle<NtBrowserListener> _handle;
    std::string _directory;

    /// What is to be selected once the rows are there, and where the list is to stand then.
    Choice _wanted;
    View _wantedView;
    bool _arriving = false;
    bool _replaced = false;

    /// What the listener knows.
    Choice _told;
    bool _choosing = false;

    /// What the user did in vain, or what happened to the directory.
    std::string _notice;

    // Owned by this one natively.
    QToolButton* _up;
    QtPathField* _path;
    QtDirModel* _model;
    QtBrowserList* _list;
    QLabel* _message;
    QTimer _looking;
    QTimer _patience;
};

} // namespace Kv
