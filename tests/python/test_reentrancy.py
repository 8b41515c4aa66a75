"""What callbacks may do to the dialog, to its other callbacks and to other dialogs while they run."""

import gc

import pytest

import stage
from callback_tools import run_script
from forms import listen, make_dialog
from quorvane_velmora import ui
from scripts import NO_SEARCH_FOR_LEAKS
from user import click, close
from PyQt6.QtCore import Qt
from PyQt6.QtWidgets import QApplication, QPushButton

pytestmark = [pytest.mark.screen, pytest.mark.usefixtures('no_wait_is_endless')]

ACTIVATE, STATE, VALUE_CHANGED = ui.EventType.ACTIVATE, ui.EventType.STATE, ui.EventType.VALUE_CHANGED


def test_a_callback_that_nobody_else_keeps_removes_itself(user):
    dialog = make_dialog()
    kept, order = [], []
    kept.append(lambda given, name, event: (given.removeCallback(name, event, kept.pop()), gc.collect(),
                                            order.append(name)))
    dialog.addCallback('Button', ACTIVATE, kept[0])
    dialog.addCallback('Button', ACTIVATE, lambda *_: order.append('always'))
    user.plan(click('Button'), click('Button'), close)
    dialog.launch()
    assert order == ['Button', 'always', 'always']


def test_a_removed_next_one_does_not_run_and_an_added_one_waits_for_the_next_event(user):
    dialog = make_dialog()
    order = []

    def removed(*_):
        order.append('removed')

    def added(*_):
        order.append('added')

    def change(given, name, event):
        order.append('change')
        given.removeCallback(name, event, removed)
        given.addCallback(name, event, added)

    for callback in (change, removed, lambda *_: order.append('last')):
        dialog.addCallback('Button', ACTIVATE, callback)
    user.plan(click('Button'), lambda _: order.append('|'), click('Button'), close)
    dialog.launch()
    assert order == ['change', 'last', '|', 'change', 'last', 'added']


def test_a_callback_that_adds_and_removes_in_a_nested_event_disturbs_neither(user):
    dialog = make_dialog()
    order = []

    def inner(*_):
        order.append('inner')

    def outer(given, name, event):
        order.append('outer')
        if len(order) == 1:
            given.setValue('Toggle', True)
            given.removeCallback(name, event, inner)

    dialog.addCallback('Toggle', STATE, outer)
    dialog.addCallback('Toggle', STATE, inner)
    user.plan(click('Toggle'), close)
    dialog.launch()
    assert order == ['outer', 'outer', 'inner']
    dialog.setValue('Toggle', True)
    assert order[3:] == ['outer']


def test_events_that_raise_events_end_with_the_recursion_error_of_python():
    printed = run_script('''
from callback_tools import PatientUser
from forms import make_dialog, ui
dialog, depth = make_dialog(), [0]
def again(given, name, event):
    depth[0] += 1
    given.setValue('Text' if name == 'Toggle' else 'Toggle', name == 'Text' or 'text')
dialog.addCallback('Text', ui.EventType.VALUE_CHANGED, again)
dialog.addCallback('Toggle', ui.EventType.STATE, again)
user = PatientUser()
for attempt in range(2):
    user.plan(lambda user: user.click('Toggle'))
    try:
        dialog.launch()
    except RecursionError:
        print('answered', depth[0] > 100)
try:
    dialog.setValue('Toggle', True)
except RecursionError:
    print('answered')
dialog.removeCallback('Toggle', ui.EventType.STATE, again)
user.plan(lambda user: user.click('Toggle'), lambda user: user.close())
print(dialog.launch())
user.stop()
assert not user.failures, user.failures
''')
    assert printed.split() == ['answered', 'True'] * 2 + ['answered', 'CloseButton_OK']


def test_launches_that_open_launches_end_with_the_recursion_error_of_python():
    # Who presses the button has no Python in it, which would come to the limit too and give up.
    printed = run_script('''
import sys
from callback_tools import PatientUser
from forms import make_dialog, ui
from PyQt6.QtCore import QTimer, Qt
from PyQt6.QtWidgets import QApplication
timer, user, dialog, depths = QTimer(), PatientUser(), make_dialog(), []
def deeper(given, *_):
    depths[-1] += 1
    make_dialog('inner').setValue('Toggle', True)
    given.launch()
def begin(user):
    button = user.find('Button')
    timer.timeout.connect(button.click, Qt.ConnectionType.QueuedConnection)
    timer.start(1)
usual = sys.getrecursionlimit()
for limit in range(194, 210):
    user.plan(begin)
    dialog.addCallback('Button', ui.EventType.ACTIVATE, deeper)
    depths.append(0)
    sys.setrecursionlimit(limit)
    try:
        dialog.launch()
    except RecursionError:
        sys.setrecursionlimit(usual)
        timer.timeout.disconnect()
        dialog.removeCallback('Button', ui.EventType.ACTIVATE, deeper)
        QApplication.processEvents()
        print('answered', depths[-1] > 10)
user.stop()
user.plan(lambda user: user.close())
assert not user.failures and dialog.launch() == 'CloseButton_OK'
''')
    assert printed.split() == ['answered', 'True'] * 16


def test_recursions_end_before_the_stack_does_however_high_the_limit_of_python_is():
    assert run_script('''
import sys
from forms import make_dialog, ui
dialog, depth = make_dialog(), 0
def go_on():
    global depth
    depth += 1
    return str(depth)
class Again(int):
    def __bool__(self):
        go_on()
        dialog.setValue('Toggle', self)
dialog.addCallback('Text', ui.EventType.VALUE_CHANGED, lambda given, name, event: given.setValues({name: go_on()}))
sys.setrecursionlimit(10**6)
for name, value in ('Text', ''), ('Toggle', Again()):
    try:
        dialog.setValue(name, value)
    except RecursionError:
        print('answered')
assert depth > 500
dialog.setValue('Toggle', True)
print(dialog.getValue('Toggle'))
''') == 'answered\nanswered\nTrue\n'


@pytest.mark.standalone
def test_launches_in_launches_end_before_a_small_stack_does():
    assert run_script('''
import resource, sys
resource.setrlimit(resource.RLIMIT_STACK, (2 << 20, resource.getrlimit(resource.RLIMIT_STACK)[1]))
from forms import make_dialog, ui
from quorvane_velmora import testing
dialog, depth = make_dialog(), 0
def deeper(given, *_):
    global depth
    depth += 1
    person.answer('Form', press='Button')
    given.launch()
dialog.addCallback('Button', ui.EventType.ACTIVATE, deeper)
sys.setrecursionlimit(10**6)
try:
    with testing.person() as person:
        person.answer('Form', press='Button')
        dialog.launch()
except RecursionError:
    print('answered', depth > 50)
''', **NO_SEARCH_FOR_LEAKS) == 'answered True\n'


@pytest.mark.parametrize('operation', ['hideWidget', 'disable'])
@pytest.mark.parametrize('name', ['Button', 'Toggle', 'Text', 'Menu'])
def test_a_callback_hides_or_disables_its_own_widget(user, operation, name):
    dialog = make_dialog()
    heard = listen(dialog, name)

    def vanish(given, widget, _):
        given.hideWidget(widget) if operation == 'hideWidget' else given.enableWidget(widget, False)

    event = VALUE_CHANGED if name in ('Menu', 'Text') else ACTIVATE
    dialog.addCallback(name, event, vanish)

    def act(someone):
        someone.find(name).setFocus()
        if name == 'Text':
            someone.type('new')
        someone.press({'Text': Qt.Key.Key_Return, 'Menu': Qt.Key.Key_Down}.get(name, Qt.Key.Key_Space))

    user.plan(act, lambda someone: heard.append('|'), click(name), close)
    assert dialog.launch() == 'CloseButton_OK'
    assert (name, event) in heard[:heard.index('|')]
    assert heard[-1] == '|'
    assert (dialog.isDisplayed(name), dialog.isEnabled(name)) == (operation != 'hideWidget', operation != 'disable')


def test_a_callback_launches_a_dialog_from_which_another_is_launched(patient):
    dialogs = [make_dialog(title) for title in ('one', 'two', 'three')]
    order = []

    def open_next(level):
        def callback(*_):
            dialogs[level].setValue('Text', 'from below')
            order.append((level, dialogs[level].launch()))
        return callback

    for level in (1, 2):
        dialogs[level - 1].addCallback('Button', ACTIVATE, open_next(level))
    patient.plan(click('Button'), click('Button'), lambda user: order.append(user.title()), click('CloseButton_Cancel'),
                 lambda user: order.append(user.title()), close, click('Toggle'), click('CloseButton_Cancel'))
    assert dialogs[0].launch() == 'CloseButton_Cancel'
    assert order == ['three', (2, 'CloseButton_Cancel'), 'two', (1, 'CloseButton_OK')]
    assert [dialog.getValue('Toggle') for dialog in dialogs] == [True, False, False]
    assert stage.titles() == []


def test_a_callback_launches_its_own_dialog_again(patient):
    dialog = make_dialog()
    order = []
    dialog.addCallback('Button', ACTIVATE, lambda given, *_: order.append(given.launch()))
    patient.plan(click('Button'), click('Toggle'), lambda user: user.close('Cancel'))
    assert dialog.launch() == 'CloseButton_Cancel'
    assert order == ['CloseButton_Cancel']
    patient.plan(click('Toggle'), close)
    assert dialog.launch() == 'CloseButton_OK'
    assert dialog.getValue('Toggle') is False


def test_a_dialog_that_is_launched_again_from_one_above_it_comes_to_the_front(patient):
    below, above = make_dialog('below'), make_dialog('above')
    fronts = []
    below.addCallback('Button', ACTIVATE, lambda *_: fronts.append(above.launch()))
    above.addCallback('Button', ACTIVATE, lambda *_: fronts.append(below.launch()))

    def close_front(user):
        fronts.append(user.title())
        user.close()

    patient.plan(click('Button'), click('Button'), close_front, close_front)
    assert below.launch() == 'CloseButton_OK'
    assert fronts == ['below', 'CloseButton_OK', 'above', 'CloseButton_OK']


@pytest.mark.parametrize('raises', [False, True])
@pytest.mark.parametrize('act, name, event', [
    (click('Button'), 'Button', ACTIVATE),
    (lambda user: user.press(Qt.Key.Key_Return), 'Text', VALUE_CHANGED),
    (click('Toggle'), 'Toggle', STATE),
    (lambda user: (user.find('Menu').setFocus(), user.press(Qt.Key.Key_Down)), 'Menu', VALUE_CHANGED),
    (click('CloseButton_OK'), 'CloseButton_OK', ACTIVATE),
], ids=['click', 'Enter', 'toggle', 'menu', 'close'])
def test_a_callback_drops_the_last_reference_to_the_dialog(patient, act, name, event, raises):
    before = len(QApplication.allWidgets())
    outer = make_dialog('outer')
    kept = [make_dialog('dropped')]

    def drop(*_):
        kept.clear()
        gc.collect()
        if raises:
            raise ValueError('after the drop')

    kept[0].addCallback(name, event, drop)
    outer.addCallback('Button', ACTIVATE, lambda *_: kept[0].launch())

    def edit(user):
        user.find('Text').setFocus()
        user.type('edited')

    patient.plan(click('Button'), edit, act, *([] if name.startswith('Close') or raises else [close]), close)
    if raises:
        with pytest.raises(ValueError, match='after the drop'):
            outer.launch()
    assert outer.launch() == 'CloseButton_OK'
    del outer, drop
    gc.collect()
    assert len(QApplication.allWidgets()) <= before


def test_close_buttons_of_one_name_close_every_run(user):
    dialog = ui.createDialog('Names', ui.makeXmlFromWidgetList(
        [('PushButton', 'CloseButton_OK'), ('PushButton', 'CloseButton_OK')], ['OK']), 400, 112)

    def press_one(place):
        def step(user):
            buttons = user.window().findChildren(QPushButton, 'CloseButton_OK')
            assert len(buttons) == 3
            buttons[place].click()
        return step

    for place in (0, 1, 2, 0):
        user.plan(press_one(place))
        assert dialog.launch() == 'CloseButton_OK'
    dialog.disableNextClose()
    user.plan(press_one(1), press_one(2))
    assert dialog.launch() == 'CloseButton_OK'
    namesake = ui.createDialog('Names', ui.makeXmlFromWidgetList(
        [('ToggleButton', 'CloseButton_X'), ('PushButton', 'CloseButton_X')], ['OK']), 400, 112)
    for _ in range(2):
        user.plan(lambda someone: someone.find('CloseButton_X', QPushButton).click())
        assert namesake.launch() == 'CloseButton_X'
