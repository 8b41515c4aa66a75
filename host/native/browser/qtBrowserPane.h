#pragma once

#include "browser/qtBrowserSelection.h"
#include "browser/qtDirWorker.h"
#include "files/osPlace.h"
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
struct QtDirStamp;
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

    /// Goes where the user has typed, if the user has, and tells the listener that the path is taken. With `takesNew`,
    /// where nothing is there but its directory, stays and hands the path to the listener. In all other cases the user
    /// is told.
    void takeTypedPath(bool takesNew);

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    /// What a path leads to.
    struct Found
    {
        OsPlace place;
        /// The reason why there is no such place, in words; else empty.
        std::string fault;
        /// The path of what is not there yet, in a directory that is; else empty.
        std::string newPath;
    };

    static Found find(std::string const& path);

    void layOut();

    /// Has a place looked up, and goes on once it is: at once, if the file system answers within a moment. What was
    /// sought before, or the user has turned away from, is forgotten.
    void seek(std::string const& path, std::function<void(Found const&)> next);
    void seekTyped(std::function<void(Found const&)> const& next);
    void goToTyped();
    void walkToTyped(OsPlace const& place);

    void activate();
    void onActivated(Found const& found);
    void goUp();
    void walkTo(std::string const& directory, QtBrowserChoice const& choice);
    void toggleHidden();
    void reread();
    void look();
    void onLooked(QtDirStamp const& now);
    void leave(Found const& found, std::string const& nearest);

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
    QtDirWorker _looker;
    QtDirWorker _seeker;
    /// The number of looks at the directory that had to be left out, since the last one or a reading is under way.
    int _missedLooks = 0;
};

} // namespace Kv
