"""What the tests share: a user who types and clicks, a screen of their own, and an eye on what goes wrong unseen."""

import contextlib
import os
import signal
import sys
import traceback

import pytest

import displays
import scripts
from desk import Desk, WaylandDesk

# There is PyQt6 for the distribution's interpreter alone. For others the user is one of the module's own.
if not scripts.HAS_PYQT:
    import absent

    absent.install()
    from door_user import DoorUser

import stage
from callback_tools import PatientUser
from user import User


def pytest_configure(config):
    if scripts.HAS_PYQT and stage.APPLICATION:
        stage.APPLICATION.resize(1180, 860)  # with room for the dialogs of the tests
    config.addinivalue_line('markers', 'standalone: about dialogs that have windows of their own')
    config.addinivalue_line('markers', 'inside: about the running application')
    config.addinivalue_line('markers', 'screen: on a real screen too, where the keyboard and windows are what matters')


def pytest_collection_modifyitems(config, items):
    """Each test belongs to both settings unless it is marked as one of a single setting. Of the groups that are to be
    short, each has its first case alone."""
    other = 'standalone' if scripts.INSIDE else 'inside'
    mine = [item for item in items if not item.get_closest_marker(other)]
    first = {item.function: item for item in reversed(mine)}
    short = os.environ.get('VELMORA_SHORT', '').split('|')
    kept = [item for item in mine if first[item.function] is item or item.path.stem[len('test_'):] not in short]
    config.hook.pytest_deselected(items=[item for item in items if item not in kept])
    items[:] = kept


@pytest.fixture
def user():
    someone = User() if scripts.HAS_PYQT else DoorUser()
    yield someone
    someone.judge()


@pytest.fixture
def patient():
    someone = PatientUser() if scripts.HAS_PYQT else DoorUser()
    yield someone
    someone.judge()


@pytest.fixture
def no_wait_is_endless():
    """A dialog that nobody closes any more fails its test."""
    def give_up(_, frame):
        # In the user's own slot it would be lost: again, until it comes in the loop of the dialog.
        if os.path.basename(frame.f_code.co_filename) in ('user.py', 'callback_tools.py'):
            signal.setitimer(signal.ITIMER_REAL, 0.007)
        else:
            raise TimeoutError('the dialog is still open')

    previous = signal.signal(signal.SIGALRM, give_up)
    signal.alarm(20)
    yield
    signal.alarm(0)
    signal.signal(signal.SIGALRM, previous)


@pytest.fixture(params=['xcb', 'wayland'])
def display(request):
    """The variables that lead to a display that nobody else uses."""
    with displays.display(request.param) as variables:
        yield variables


@pytest.fixture(params=['xcb', 'wayland'])
def desk(request):
    with displays.x_display() as keyboard, contextlib.ExitStack() as stack:
        if request.param == 'xcb':
            someone = Desk(keyboard, DISPLAY=keyboard)
        else:
            socket = stack.enter_context(displays.wayland_display(keyboard))
            someone = WaylandDesk(keyboard, WAYLAND_DISPLAY=socket)
        yield someone
        someone.close()


@pytest.fixture(autouse=True)
def exceptions_in_qt_slots_are_seen(monkeypatch):
    """An exception in a slot of the Qt binding would end the process unless there is a hook."""
    seen = []
    monkeypatch.setattr(sys, 'excepthook', lambda *exception: seen.append(exception))
    yield
    assert not seen, ''.join(traceback.format_exception(*seen[0]))
