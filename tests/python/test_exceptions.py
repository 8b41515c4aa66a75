"""What a callback raises comes out where the script can catch it, and leaves everything in working order."""

import gc
import sys
import traceback

import pytest

import stage
from forms import listen, make_dialog
from quorvane_velmora import ui
from user import click, close
from PyQt6.QtCore import QEventLoop, QObject, QTimer, Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QPushButton, QWidget

pytestmark = [pytest.mark.screen, pytest.mark.usefixtures('no_wait_is_endless')]

ACTIVATE, STATE = ui.EventType.ACTIVATE, ui.EventType.STATE


class Own(BaseException):
    pass


def raising(exception):
    def deep_inside():
        raise exception

    def callback(*_):
        deep_inside()

    return callback


def functions(exception):
    return [frame.name for frame in traceback.extract_tb(exception.__traceback__)]


def listen_to_reports(monkeypatch):
    """Gives the list into which goes from now on what is reported since nobody can catch it."""
    reported = []
    monkeypatch.setattr(sys, 'unraisablehook', lambda report: reported.append(report.exc_value))
    return reported


EXCEPTIONS = [ValueError('of the script'), SystemExit(3), KeyboardInterrupt(), Own(), ui.UiError('own words')]


@pytest.mark.parametrize('exception', EXCEPTIONS, ids=lambda exception: type(exception).__name__)
def test_an_exception_comes_out_of_launch_and_the_dialog_runs_again(user, exception):
    dialog = make_dialog()
    callback = raising(exception)
    dialog.addCallback('Button', ACTIVATE, callback)
    heard = listen(dialog, 'Button')
    cursor = QApplication.overrideCursor()
    for _ in range(2):
        user.plan(click('Button'))
        with pytest.raises(type(exception)) as caught:
            dialog.launch()
        assert caught.value is exception
        assert functions(exception)[-2:] == ['callback', 'deep_inside']
        assert heard == []
        assert QApplication.overrideCursor() is cursor
        exception.__traceback__ = None
    dialog.removeCallback('Button', ACTIVATE, callback)
    user.plan(click('Button'), close)
    assert dialog.launch() == 'CloseButton_OK'
    assert heard == [('Button', ACTIVATE)]


@pytest.mark.parametrize('exception', EXCEPTIONS, ids=lambda exception: type(exception).__name__)
@pytest.mark.parametrize('set_it', [lambda dialog: dialog.setValue('Toggle', True),
                                    lambda dialog: dialog.setValues({'Toggle': True})], ids=['setValue', 'setValues'])
def test_an_exception_comes_out_of_the_setter_that_raised_the_event(user, exception, set_it):
    dialog = make_dialog()
    dialog.addCallback('Toggle', STATE, raising(exception))
    caught = []

    def set_and_catch(_=None):
        try:
            set_it(dialog)
        except BaseException as error:
            caught.append((error, functions(error)[-2:], dialog.getValue('Toggle')))
            error.__traceback__ = None

    set_and_catch()
    user.plan(set_and_catch, close)
    assert dialog.launch() == 'CloseButton_OK'
    assert caught == [(exception, ['callback', 'deep_inside'], True)] * 2


@pytest.mark.parametrize('kept', [True, False], ids=['kept', 'dropped'])
def test_a_dialog_goes_on_when_it_catches_what_the_run_of_an_inner_one_raised(patient, kept):
    outer, inner = make_dialog('outer'), [make_dialog('inner')]
    inner[0].addCallback('Button', ACTIVATE, raising(ValueError('of the script')))
    seen = []

    def run_inner(*_):
        try:
            inner[0].launch()
        except ValueError as error:
            seen.append(str(error))
        if not kept:
            inner.clear()

    outer.addCallback('Button', ACTIVATE, run_inner)
    patient.plan(click('Button'), click('Button'), lambda user: seen.append(user.title()),
                 click('Toggle'), close)
    assert outer.launch() == 'CloseButton_OK'
    assert seen == ['of the script', 'outer']
    assert outer.getValue('Toggle') is True


def test_what_is_not_caught_between_comes_out_of_every_launch_in_turn(patient):
    outer, inner, other = (make_dialog(title) for title in ('outer', 'inner', 'other'))
    exception = ValueError('of the script')
    inner.addCallback('Button', ACTIVATE, raising(exception))
    outer.addCallback('Button', ACTIVATE, lambda *_: inner.launch())
    patient.plan(click('Button'), click('Button'))
    with pytest.raises(ValueError) as caught:
        outer.launch()
    assert caught.value is exception
    assert functions(exception)[1:] == ['<lambda>', 'callback', 'deep_inside']
    for dialog in (other, outer, inner):
        patient.plan(close)
        assert dialog.launch() == 'CloseButton_OK'


def press(name):
    QTest.mouseClick(stage.active().findChild(QPushButton, name), Qt.MouseButton.LeftButton)


def press_in_an_event_of_its_own(name, dispatch):
    QTimer.singleShot(0, lambda: press(name))
    dispatch()


DRIVERS = {
    'QTest': press,
    'processEvents': lambda name: press_in_an_event_of_its_own(name, QApplication.processEvents),
    'qWait': lambda name: press_in_an_event_of_its_own(name, lambda: QTest.qWait(20)),
    'event loop': lambda name: press_in_an_event_of_its_own(
        name, lambda: QEventLoop().processEvents(QEventLoop.ProcessEventsFlag.AllEvents)),
    'click': lambda name: stage.active().findChild(QPushButton, name).click(),
}


@pytest.mark.parametrize('drive', DRIVERS.values(), ids=DRIVERS.keys())
def test_exceptions_pass_a_callback_that_drives_qt_and_those_after_the_first_are_the_last_of_its_context(user, drive):
    dialog = make_dialog()
    first, second, third = ValueError('first'), KeyError('second'), Own('third')
    first.__context__ = OSError('what the first came from')
    waiting = [first, second]

    def earlier(*_):
        raise waiting.pop(0)

    def later(*_):
        drive('Other')
        assert sys.exc_info() == (None,) * 3
        drive('Other')
        raise third

    dialog.addCallback('Other', ACTIVATE, earlier)
    dialog.addCallback('Button', ACTIVATE, later)
    user.plan(click('Button'))
    with pytest.raises(ValueError) as caught:
        dialog.launch()
    assert caught.value is first
    chain = [first]
    while chain[-1].__context__:
        chain.append(chain[-1].__context__)
    assert [str(error) for error in chain] == ['first', 'what the first came from', "'second'", 'third']
    assert [functions(error)[-1] for error in (first, second, third)] == ['earlier', 'earlier', 'later']


@pytest.mark.parametrize('has_ring', [False, True])
def test_exceptions_that_came_from_one_another_make_no_ring(user, has_ring):
    """The dialog runs while another exception is handled: that is the context of each."""
    dialog = make_dialog()
    waiting = [ValueError('first'), KeyError('second'), Own('third')]
    first, second, third = waiting
    handled = OSError('handled')
    if has_ring:
        handled.__context__ = RuntimeError('ring')
        handled.__context__.__context__ = handled

    def fail(*_):
        raise waiting.pop(0)

    dialog.addCallback('Other', ACTIVATE, fail)
    dialog.addCallback('Button', ACTIVATE, lambda *_: (press('Other'), press('Other'), press('Other')))
    user.plan(click('Button'))
    try:
        raise handled
    except OSError:
        with pytest.raises(ValueError):
            dialog.launch()
    chain = [first]
    while len(chain) < 4:
        chain.append(chain[-1].__context__)
    assert chain == [first, second, third, handled]


def test_a_second_exception_that_cannot_be_its_context_is_reported(user, monkeypatch):
    unraisable = listen_to_reports(monkeypatch)
    dialog = make_dialog()
    first, second = ValueError('first'), KeyError('second')
    second.__context__ = first

    def later(*_):
        press('Other')
        raise second

    dialog.addCallback('Other', ACTIVATE, raising(first))
    dialog.addCallback('Button', ACTIVATE, later)
    user.plan(click('Button'))
    with pytest.raises(ValueError) as caught:
        dialog.launch()
    assert caught.value is first and first.__context__ is None
    assert unraisable == [second]
    assert functions(second) == ['later'] and functions(first)[-1] == 'deep_inside'


def leave_window(user, title):
    """Gives a dialog whose run has failed, and its window, which that leaves on the screen."""
    dialog, exception = make_dialog(title), ValueError('of the run')
    failing = raising(exception)
    dialog.addCallback('Button', ACTIVATE, failing)
    user.plan(click('Button'))
    with pytest.raises(ValueError):
        dialog.launch()
    dialog.removeCallback('Button', ACTIVATE, failing)
    exception.__traceback__ = None
    gc.collect()
    window, = (window for window in stage.dialogs() if stage.title_of(window) == title)
    return dialog, window


@pytest.mark.parametrize('exception', EXCEPTIONS, ids=lambda exception: type(exception).__name__)
def test_with_no_dialog_running_an_exception_is_reported_and_the_process_goes_on(user, monkeypatch, exception):
    unraisable = listen_to_reports(monkeypatch)
    dialog, window = leave_window(user, 'left by ' + type(exception).__name__)
    heard = []
    dialog.addCallback('Button', ACTIVATE, lambda *_: heard.append('heard'))
    dialog.addCallback('Button', ACTIVATE, raising(exception))
    button = window.findChild(QPushButton, 'Button')
    QTest.mouseClick(button, Qt.MouseButton.LeftButton)
    button.click()
    assert heard == ['heard'] * 2
    assert unraisable == [exception] * 2
    assert functions(exception)[-2:] == ['callback', 'deep_inside']
    exception.__traceback__ = None


@pytest.mark.parametrize('name', ['Button', 'CloseButton_OK'])
def test_the_last_reference_to_a_dialog_with_a_left_window_goes_while_its_other_callbacks_wait(user, name):
    dialog, window = leave_window(user, 'left')
    held, heard = [dialog], []
    del dialog
    held[0].addCallback(name, ACTIVATE, lambda *_: (heard.append('first'), held.clear()))
    held[0].addCallback(name, ACTIVATE, lambda *_: heard.append('second'))
    QTest.mouseClick(window.findChild(QPushButton, name), Qt.MouseButton.LeftButton)
    assert heard == ['first'] and not held


def test_a_left_window_that_goes_in_the_run_of_the_next_dialog_does_not_take_that_with_it(user):
    held = [leave_window(user, 'left')[0]]
    user.plan(lambda user: (held.clear(), gc.collect()), click('Toggle'), close)
    assert make_dialog().launch() == 'CloseButton_OK'


class Intruder(QObject):
    """Runs Python code, which fails, for whatever Qt does to anybody."""

    def __init__(self):
        super().__init__()
        self.calls = 0

    def fail(self, *_):
        self.calls += 1
        raise OSError('of others')

    def eventFilter(self, *_):
        self.fail()


def run_dialog(user, callback):
    held = [make_dialog()]
    held[0].addCallback('Button', ACTIVATE, callback)
    user.plan(click('Button'))
    held.pop().launch()  # goes with the exception


def run_browser(user, callback):
    user.plan(click('OK'))
    ui.showBrowser('Pick', '/', callback)


def build_with_a_bad_value(_, callback):
    class State(int):
        def __bool__(self):
            callback()

    ui.showSimpleDialog('t', [('ToggleButton', 'Toggle')], 400, False, {'Toggle': State()})


@pytest.mark.parametrize('exception', [KeyError('of the script'), SystemExit(3)], ids=lambda error: type(error).__name__)
@pytest.mark.parametrize('run', [run_dialog, *[pytest.param(run, marks=pytest.mark.inside)
                                               for run in (run_browser, build_with_a_bad_value)]])
def test_an_exception_survives_what_others_do_when_the_windows_go(user, monkeypatch, run, exception):
    monkeypatch.setattr(sys, 'excepthook', lambda *_: None)
    application, intruder = QApplication.instance(), Intruder()
    application.focusChanged.connect(intruder.fail)

    def callback(*given):
        del given  # which the traceback would keep
        for widget in [one for dialog in stage.dialogs() for one in dialog.findChildren(QWidget)]:
            widget.destroyed.connect(intruder.fail)
        application.installEventFilter(intruder)
        intruder.calls = 0
        raise exception

    try:
        with pytest.raises(type(exception)) as caught:
            run(user, callback)
    finally:
        application.removeEventFilter(intruder)
        application.focusChanged.disconnect(intruder.fail)
    assert caught.value is exception and functions(exception)[-1] == 'callback'
    exception.__traceback__ = None
    assert intruder.calls
