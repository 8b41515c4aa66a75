#pragma once

#include "browser/qtBrowserSelection.h"
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

/// A browser's widget: a field with the path, the list of the entries, and a line that says what went wrong. While it
/// is visible it follows what becomes of the directory.
class QtBrowserPane final : public QWidget
{
public:
    QtBrowserPane(QWidget* parent, QtListenerHandle<NtBrowserListener> const& handle);

    /// Names the widgets in it after it.
    void nameParts();

    /// Shows a directory, an absolute path, and selects what is in it of a choice. The listener hears nothing.
    void goTo(std::string const& directory, QtBrowserChoice const& choice);

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
    void layOut();

    void activate();
    void goUp();
    void walkTo(std::string const& directory, QtBrowserChoice const& choice);
    void toggleHidden();
    void look();
    void leave(std::string const& reason);

    void onRead();
    void onChosen();
    /// The user has turned to the list: what stands in the field counts no more.
    void forgetTyped();
    void tellChoice();
    void say(std::string const& words);
    void showState();

    QtListenerHandle<NtBrowserListener> _handle;
    std::string _directory;

    /// The choice that the listener knows.
    QtBrowserChoice _told;

    /// Words about what the user did in vain, or about what happened to the directory.
    std::string _notice;

    // Owned by this one natively.
    QToolButton* _up;
    QtPathField* _path;
    QtDirModel* _model;
    QtBrowserList* _list;
    QtBrowserSelection* _selection = nullptr;
    QLabel* _message;
    QTimer _looking;
    QTimer _patience;
};

} // namespace Kv
