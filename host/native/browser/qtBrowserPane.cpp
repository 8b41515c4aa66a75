#include "browser/qtBrowserPane.h"

#include "browser/qtBrowserList.h"
#include "browser/qtDirModel.h"
#include "browser/qtPathField.h"
#include "exBase.h"
#include "files/osPlace.h"
#include "peers/qtText.h"
#include "windows/qtFocusOrder.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QStyle>
#include <QVBoxLayout>

#include <chrono>
#include <filesystem>
#include <initializer_list>
#include <utility>

namespace Kv
{

namespace
{

/// The time between two looks at the directory.
constexpr std::chrono::seconds lookInterval(1);

/// The time that a reading may take before the list says so.
constexpr std::chrono::milliseconds patience(250);

/// The looks that have to be left out before the user is told.
constexpr int toldLooks = 3;

/// The path of an entry that is not there yet, in a directory that is; empty for any other.
std::string findNewPath(std::string const& path)
{
    try
    {
        OsPlace const place = OsPlace::findNew(path);
        return OsPlace::join(place.directory, place.name);
    }
    catch (ExBase const&)
    {
        return "";
    }
}

std::string tellSilence(std::string const& who)
{
    return who + " has not answered yet";
}

/// Lets a path be wrapped at its slashes.
QString makeWrappable(QString text)
{
    return text.replace(QLatin1Char('/'), QStringLiteral("/\u200b"));
}

} // namespace

QtBrowserPane::QtBrowserPane(QWidget* parent, QtListenerHandle<NtBrowserListener> const& handle)
    : QWidget(parent), _handle(handle), _up(new QToolButton(this)),
      _path(new QtPathField(this, [this] { goToTyped(); })), _model(new QtDirModel(this, [this] { onRead(); })),
      _list(new QtBrowserList(this, {[this] { activate(); }, [this] { goUp(); }})), _message(new QLabel(this))
{
    _up->setIcon(style()->standardIcon(QStyle::SP_FileDialogToParent));
    _up->setAutoRaise(true);
    _up->setFocusPolicy(Qt::TabFocus);
    _up->setToolTip(QStringLiteral("Up (Alt+Up)"));
    _list->setModel(_model);
    _list->setSortingEnabled(true);
    _selection = new QtBrowserSelection(*_list, *_model, [this] { onChosen(); });
    _message->setTextFormat(Qt::PlainText);
    _message->setWordWrap(true);
    _message->hide();
    // Whoever gives the keyboard to the browser gives it to the list.
    setFocusProxy(_list);
    _up->setAccessibleName(QStringLiteral("Up"));
    _path->setAccessibleName(QStringLiteral("Folder"));
    _list->setAccessibleName(QStringLiteral("Files"));
    layOut();
    connect(_up, &QToolButton::clicked, this, [this] { goUp(); });
    connect(&_looking, &QTimer::timeout, this, [this] { look(); });
    _patience.setSingleShot(true);
    connect(&_patience, &QTimer::timeout, this,
            [this]
            {
                _model->showNames();
                showState();
            });
}

void QtBrowserPane::nameParts()
{
    for (auto const& [widget, part] : std::initializer_list<std::pair<QWidget*, char const*>>{
             {_up, ".up"}, {_path, ".path"}, {_list, ".list"}, {_message, ".message"}})
        widget->setObjectName(objectName() + QLatin1String(part));
}

void QtBrowserPane::layOut()
{
    constexpr int gap = 4;
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(gap, gap, gap, gap);
    column->setSpacing(gap);
    auto* const row = new QHBoxLayout;
    row->setSpacing(gap);
    row->addWidget(_up);
    row->addWidget(_path);
    column->addLayout(row);
    column->addWidget(_list);
    column->addWidget(_message);
    // As narrow as the cell says.
    _message->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
}

void QtBrowserPane::goTo(std::string const& directory, QtBrowserChoice const& choice)
{
    _directory = directory;
    _notice.clear();
    _missedLooks = 0;
    _looker.cancel();
    _seeker.cancel();
    _selection->await(choice);
    _told = choice;
    _path->setDirectory(directory);
    _up->setEnabled(directory != "/");
    _patience.start(patience);
    _model->open(directory, choice.focus);
    showState();
}

void QtBrowserPane::setCollapsing(std::function<bool(std::string const&)> collapses)
{
    _model->setCollapsing(std::move(collapses));
    if (!_directory.empty())
        reread();
}

void QtBrowserPane::setMultiple(bool multiple)
{
    _list->setSelectionMode(multiple ? QAbstractItemView::ExtendedSelection : QAbstractItemView::SingleSelection);
}

void QtBrowserPane::takeTypedPath(bool takesNew)
{
    if (!_path->isEdited() || !isVisible())
    {
        _handle.tell(&NtBrowserListener::onTypedPathTaken, std::string());
        return;
    }
    seekTyped(
        [this, takesNew](Found const& found)
        {
            bool const isNew = takesNew && !found.newPath.empty();
            if (found.fault.empty())
                walkToTyped(found.place);
            else if (!isNew)
                say(found.fault);
            if (found.fault.empty() || isNew)
                _handle.tell(&NtBrowserListener::onTypedPathTaken, found.newPath);
        });
}

void QtBrowserPane::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    _looking.start(lookInterval);
    tellChoice();
}

void QtBrowserPane::hideEvent(QHideEvent* event)
{
    QWidget::hideEvent(event);
    _looking.stop();
    _seeker.cancel();
}

void QtBrowserPane::keyPressEvent(QKeyEvent* event)
{
    if (event->key() == Qt::Key_Up && event->modifiers() & Qt::AltModifier)
        goUp();
    else if (event->key() == Qt::Key_F5)
        reread();
    else if (event->key() == Qt::Key_H && event->modifiers() & Qt::ControlModifier)
        toggleHidden();
    else if (event->key() == Qt::Key_L && event->modifiers() & Qt::ControlModifier)
        QtFocusOrder::give(*_path, Qt::ShortcutFocusReason);
    else
        QWidget::keyPressEvent(event);
}

QtBrowserPane::Found QtBrowserPane::find(std::string const& path)
{
    try
    {
        return {OsPlace::find(path), "", ""};
    }
    catch (ExBase const& error)
    {
        return {{}, error.getReason(), findNewPath(path)};
    }
    catch (std::exception const& error)
    {
        return {{}, error.what(), ""};
    }
}

void QtBrowserPane::seek(std::string const& path, std::function<void(Found const&)> next)
{
    auto const work = [this, path, next = std::move(next)](std::atomic<bool> const&)
    {
        return [this, next, found = find(path)]
        {
            say("");
            next(found);
        };
    };
    _seeker.startAndWait(path, work);
    if (_seeker.isBusy())
        say(tellSilence(OsPlace::quote(path)));
}

void QtBrowserPane::seekTyped(std::function<void(Found const&)> const& next)
{
    std::string const typed = _path->getTypedPath();
    seek(typed.empty() ? _directory : OsPlace::complete(typed, _directory), next);
}

void QtBrowserPane::goToTyped()
{
    if (!_path->isEdited() || !isVisible())
        return;
    seekTyped(
        [this](Found const& found)
        {
            if (found.fault.empty())
                walkToTyped(found.place);
            else
                say(found.fault);
        });
}

void QtBrowserPane::walkToTyped(OsPlace const& place)
{
    if (_path->hasFocus())
        _list->setFocus(Qt::OtherFocusReason);
    walkTo(place.directory, {place.name, {}});
}

void QtBrowserPane::activate()
{
    QModelIndex const current = _list->currentIndex();
    if (current.isValid() && isVisible())
        seek(OsPlace::join(_directory, _model->getEntry(current.row()).name),
             [this](Found const& found) { onActivated(found); });
}

void QtBrowserPane::onActivated(Found const& found)
{
    if (!found.fault.empty())
    {
        say(found.fault);
        reread();
        return;
    }
    if (found.place.name.empty())
    {
        walkTo(found.place.directory, {});
        return;
    }
    // The rows can be others meanwhile.
    QModelIndex const current = _list->currentIndex();
    if (!current.isValid() || _model->getEntry(current.row()).name != found.place.name)
        return;
    _list->selectionModel()->select(current, QItemSelectionModel::Select | QItemSelectionModel::Rows);
    forgetTyped();
    _handle.tell(&NtBrowserListener::onActivated);
}

void QtBrowserPane::goUp()
{
    std::filesystem::path const path = _directory;
    if (!path.has_relative_path() || !isVisible())
        return;
    walkTo(path.parent_path().native(), {});
    _selection->awaitCurrent(path.filename().native());
}

void QtBrowserPane::walkTo(std::string const& directory, QtBrowserChoice const& choice)
{
    goTo(directory, choice);
    _handle.tell(&NtBrowserListener::onDirectoryChanged, directory);
    if (!choice.focus.empty())
        _handle.tell(&NtBrowserListener::onSelectionChanged, choice.focus, std::vector<std::string>{choice.focus});
}

void QtBrowserPane::toggleHidden()
{
    _model->setShowsHidden(!_model->showsHidden());
    reread();
}

void QtBrowserPane::reread()
{
    _patience.start(patience);
    _model->reread();
}

void QtBrowserPane::look()
{
    // Rows that change between two clicks would be missed by the second.
    if (QApplication::mouseButtons() != Qt::NoButton)
        return;
    if (_model->isReading() || _looker.isBusy())
    {
        if (++_missedLooks == toldLooks)
            showState();
        return;
    }
    _missedLooks = 0;
    _looker.start(_directory,
                  [this, directory = _directory](std::atomic<bool> const&) -> std::function<void()>
                  {
                      Found const found = find(directory);
                      if (!found.fault.empty() || !found.place.name.empty())
                          return [this, found, nearest = OsPlace::findNearest(directory)] { leave(found, nearest); };
                      try
                      {
                          return [this, now = QtDirStamp::take(directory)] { onLooked(now); };
                      }
                      catch (ExBase const&)
                      {
                          // It went this very moment; the next look finds it gone.
                          return [] {};
                      }
                  });
}

void QtBrowserPane::onLooked(QtDirStamp const& now)
{
    _missedLooks = 0;
    showState();
    if (QApplication::mouseButtons() == Qt::NoButton)
        _model->rereadIfChanged(now);
}

void QtBrowserPane::leave(Found const& found, std::string const& nearest)
{
    std::string const directory = _directory;
    walkTo(nearest, {found.place.name, {}});
    say((found.fault.empty() ? OsPlace::quote(directory) + " is no folder" : found.fault) + ". This is " +
        OsPlace::quote(nearest));
}

void QtBrowserPane::onRead()
{
    _patience.stop();
    // A file of a sequence stays in focus as it was asked for, though the sequence goes by its first.
    if (_selection->settle())
        _told = _selection->get();
    tellChoice();
    showState();
}

void QtBrowserPane::onChosen()
{
    _seeker.cancel();
    forgetTyped();
    tellChoice();
}

void QtBrowserPane::forgetTyped()
{
    _notice.clear();
    if (_path->isEdited())
        _path->setDirectory(_directory);
    showState();
}

void QtBrowserPane::tellChoice()
{
    if (_selection->isAwaiting() || !isVisible())
        return;
    QtBrowserChoice const choice = _selection->get();
    if (choice == _told)
        return;
    _told = choice;
    _handle.tell(&NtBrowserListener::onSelectionChanged, choice.focus, choice.selected);
}

void QtBrowserPane::say(std::string const& words)
{
    _notice = words;
    showState();
}

void QtBrowserPane::showState()
{
    std::string const& error = _model->getError();
    bool const isSilent = _missedLooks >= toldLooks && (_model->isReading() || _looker.isBusy());
    std::string const who = (_model->hasNamesOnly() ? "Something in " : "") + OsPlace::quote(_directory);
    std::string const silence = isSilent && _notice.empty() ? tellSilence(who) : "";
    _message->setText(makeWrappable(toShownPath(!error.empty() ? error : _notice + silence)));
    _message->setVisible(!_message->text().isEmpty());
    bool const isLate = _model->isReading() && !_patience.isActive();
    bool const isEmpty = !_model->isReading() && error.empty();
    _list->setPlaceholder(isLate ? QStringLiteral("Reading\u2026")
                                 : (isEmpty ? QStringLiteral("This folder is empty") : QString()));
}

} // namespace Kv
