"""A script does to the native widgets of a running dialog what only their owner should."""

import gc
import signal

import pytest
from PyQt6 import sip
from PyQt6.QtCore import QTimer
from PyQt6.QtWidgets import QWidget

import scripts
import stage
from quorvane_velmora import ui

pytestmark = [scripts.needs_pyqt, pytest.mark.screen]

XML = ui.makeXmlFromWidgetList([('TextField', 'a', 'A', 'kept'), ('ToggleButton', 't', 'T', True),
                                ('Menu', 'm', 'M', (['x', 'y'], 1)), ('PushButton', 'p', 'P'), ('Label', 'l', 'L', 'text')],
                               ['OK'])
NAMES = ['a', 't', 'm', 'p', 'l', 'CloseButton_OK'] + (['titleBar'] if scripts.INSIDE else ['panel'])


ACTS = {
    'delete': sip.delete,
    'delete later': QWidget.deleteLater,
    'take out': lambda widget: widget.setParent(None),
    'give away': lambda widget: widget.setParent(QWidget()),
    'close': QWidget.close,
    'rename': lambda widget: widget.setObjectName('other'),
}


class End(Exception):
    pass


def use(dialog):
    """Every operation on every widget, whatever has become of its native one."""
    for name in 'atmpl':
        dialog.getValue(name), dialog.isDisplayed(name), dialog.isEnabled(name)
        for on in False, True:
            dialog.displayWidget(name, on)
            dialog.enableWidget(name, on)
        dialog.setWidgetResourceName(name, 'votes')
    for name, value in ('a', 'new'), ('t', False), ('m', (['q', 'r'], 0)):
        dialog.setValue(name, value, False)
    assert dialog.getValues() == {'a': 'new', 't': False, 'm': 'q'}


@pytest.fixture
def give_up():
    """Ends the run that is under way when it has gone on for a moment."""
    def end(*_):
        raise End

    previous = signal.signal(signal.SIGALRM, end)
    yield lambda: signal.setitimer(signal.ITIMER_REAL, 0.1)
    signal.signal(signal.SIGALRM, previous)


@pytest.mark.parametrize('act', ACTS)
@pytest.mark.parametrize('name', [*NAMES, 'the dialog'])
def test_a_dialog_outlives_what_is_done_to_its_widgets_and_the_next_one_works(user, give_up, act, name):
    def interfere():
        shown = stage.active()
        ACTS[act](shown if name == 'the dialog' else shown.findChild(QWidget, name))

    dialog = ui.createDialog('Foreign', XML, 300, 220)
    QTimer.singleShot(0, interfere)
    for _ in range(2):
        give_up()
        try:
            dialog.launch()
        except (End, RuntimeError):
            pass
        signal.setitimer(signal.ITIMER_REAL, 0)
        use(dialog)
    del dialog
    gc.collect()
    user.plan(lambda user: user.close())
    assert ui.showSimpleDialog('Next', [('TextField', 'a', '', 'x')], 300)['a'] == 'x'
