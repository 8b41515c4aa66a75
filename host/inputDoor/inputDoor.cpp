#include "inputDoor.h"

#include "exBase.h"
#include "qtHand.h"
#include "qtStage.h"
#include "wsNative.h"

#include <QAbstractItemView>
#include <QAccessible>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QScopedValueRollback>
#include <QThread>
#include <QTimer>

#include <chrono>
#include <utility>

namespace Kv
{

namespace
{

/// The time between two turns.
constexpr std::chrono::milliseconds turnInterval(2);

int getLoopLevel()
{
    return QThread::currentThread()->loopLevel();
}

/// True where no dialog waits for a person: in a call that began at that level, or at the end of a run.
bool isBusy(int busyLevel)
{
    return getLoopLevel() <= busyLevel || WsNative::getPlatform().isLoopOver();
}

void act(std::function<void()> const& action)
{
    WsNative::getPlatform().actForScript(action);
}

QWidget& requireDialog()
{
    QWidget* const dialog = QtStage::findDialog();
    if (!dialog)
        throw ExBase(__FILE__, __LINE__, "No dialog takes input");
    return *dialog;
}

} // namespace

struct InputDoor::Parts
{
    std::function<void()> onTurn;
    std::unique_ptr<QTimer> timer;
    QtStage stage;
    /// The level of the loop that ran when the call began that is under way, or the door was opened.
    int busyLevel = 0;
    bool isTurnAsked = false;
    bool wasRead = false;
};

InputDoor& InputDoor::getInstance()
{
    // Never destroyed: it may be open to the end.
    static auto* const door = new InputDoor;
    return *door;
}

InputDoor::InputDoor() : _parts(std::make_unique<Parts>()) {}

InputDoor::~InputDoor() = default;

void InputDoor::open(std::function<void()> onTurn)
{
    if (_parts->timer)
        throw ExBase(__FILE__, __LINE__, "Another person answers the dialogs already");
    NtPlatform& platform = WsNative::getPlatform();
    platform.getScreenSize();
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        throw ExBase(__FILE__, __LINE__, "There is no QApplication, and none can be made");
    _parts->onTurn = std::move(onTurn);
    _parts->busyLevel = getLoopLevel();
    // What stands beside a widget is known once somebody reads it out.
    _parts->wasRead = QAccessible::isActive();
    QAccessible::setActive(true);
    _parts->timer = std::make_unique<QTimer>();
    QObject::connect(_parts->timer.get(), &QTimer::timeout, _parts->timer.get(),
                     [this, &platform]
                     {
                         if (_parts->isTurnAsked || isBusy(_parts->busyLevel))
                             return;
                         platform.callNextTurn([this] { turn(); });
                         _parts->isTurnAsked = true;
                     });
    _parts->timer->start(turnInterval);
}

void InputDoor::close()
{
    if (!_parts->timer)
        return;
    _parts->timer.reset();
    _parts->onTurn = nullptr;
    QAccessible::setActive(_parts->wasRead);
}

void InputDoor::turn()
{
    _parts->isTurnAsked = false;
    if (!_parts->onTurn || isBusy(_parts->busyLevel))
        return;
    QScopedValueRollback<int> const busy(_parts->busyLevel, getLoopLevel());
    // A turn that was asked for in a run that has ended comes ahead of what the window of this one has still to do.
    act([] { QCoreApplication::sendPostedEvents(nullptr, QEvent::MetaCall); });
    // The door may be closed meanwhile.
    std::function<void()> const onTurn = _parts->onTurn;
    onTurn();
}

std::optional<std::string> InputDoor::getTitle() const
{
    QWidget const* const dialog = QtStage::findDialog();
    if (!dialog)
        return {};
    return QtStage::getTitle(*dialog).toStdString();
}

std::vector<IdWidget> InputDoor::look()
{
    return _parts->stage.look();
}

std::string InputDoor::getObstacle(std::size_t widget)
{
    return QtHand::findObstacle(_parts->stage.get(widget)).toStdString();
}

void InputDoor::click(std::size_t widget)
{
    act([&] { QtHand::click(_parts->stage.get(widget)); });
}

std::vector<std::string> InputDoor::getEntries(std::size_t widget) const
{
    QWidget& native = _parts->stage.get(widget);
    std::vector<std::string> entries;
    if (auto const* const menu = qobject_cast<QComboBox*>(&native))
        for (int entry = 0; entry < menu->count(); ++entry)
            entries.push_back(menu->itemText(entry).toStdString());
    if (auto const* const list = qobject_cast<QAbstractItemView*>(&native))
        for (int row = 0; row < list->model()->rowCount(list->rootIndex()); ++row)
            entries.push_back(list->model()->index(row, 0, list->rootIndex()).data().toString().toStdString());
    return entries;
}

void InputDoor::pick(std::size_t widget, int entry, bool isMore)
{
    QWidget& native = _parts->stage.get(widget);
    if (auto* const menu = qobject_cast<QComboBox*>(&native))
        act([&] { QtHand::pick(*menu, entry); });
    else if (auto* const list = qobject_cast<QAbstractItemView*>(&native))
        act([&] { QtHand::pick(*list, entry, isMore); });
}

void InputDoor::type(std::string const& text)
{
    act([&] { QtHand::type(requireDialog(), QString::fromStdString(text)); });
}

bool InputDoor::press(std::string const& key)
{
    bool isKnown = false;
    act([&] { isKnown = QtHand::press(requireDialog(), QString::fromStdString(key)); });
    return isKnown;
}

bool InputDoor::takePicture(std::string const& path) const
{
    return requireDialog().grab().save(QString::fromStdString(path));
}

bool InputDoor::closeForeign()
{
    auto* const dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget());
    if (dialog)
        dialog->reject();
    return dialog;
}

} // namespace Kv
