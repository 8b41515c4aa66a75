"""Callables on widget events: what raises them, with what they are called, and how they are taken back."""

import gc
import weakref
from unittest.mock import Mock

import pytest

from forms import UNKNOWN, listen, make_dialog
from quorvane_velmora import ui
from PyQt6.QtCore import Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QComboBox

pytestmark = [pytest.mark.screen, pytest.mark.usefixtures('no_wait_is_endless')]

ACTIVATE, STATE, VALUE_CHANGED = ui.EventType.ACTIVATE, ui.EventType.STATE, ui.EventType.VALUE_CHANGED


def click(name):
    return lambda user: user.click(name)


def keys(name, *pressed):
    def step(user):
        user.find(name).setFocus(Qt.FocusReason.TabFocusReason)
        for key in pressed:
            user.type(key) if isinstance(key, str) else user.press(key)
    return step


def pick(*pressed):
    """Opens the menu's list with the mouse and chooses in it with the keyboard."""
    def step(user):
        box = user.find('Menu')
        assert isinstance(box, QComboBox)
        user.click('Menu')
        for key in pressed:
            QTest.keyClick(box.view(), key)
    return step


Down, Return, Space, Backspace = Qt.Key.Key_Down, Qt.Key.Key_Return, Qt.Key.Key_Space, Qt.Key.Key_Backspace
Escape, End = Qt.Key.Key_Escape, Qt.Key.Key_End


@pytest.mark.parametrize('widget, action, events', [
    ('Button', click('Button'), [ACTIVATE]), ('Button', keys('Button', Space), [ACTIVATE]),
    ('Button', keys('Button', Return), [ACTIVATE]),
    ('Toggle', click('Toggle'), [STATE, ACTIVATE]), ('Toggle', keys('Toggle', Space), [STATE, ACTIVATE]),
    ('Text', click('Text'), [ACTIVATE]), ('Text', keys('Text', 'new', Return), [VALUE_CHANGED]),
    ('Text', keys('Text', 'new'), []), ('Text', keys('Text', Return), []),
    ('Text', keys('Text', 'n', Return, Return), [VALUE_CHANGED]),
    ('Text', keys('Text', End, 'n', Backspace, Return), []),
    ('Menu', pick(Down, Return), [VALUE_CHANGED, ACTIVATE]), ('Menu', keys('Menu', Down), [VALUE_CHANGED, ACTIVATE]),
    ('Menu', pick(Return), [ACTIVATE]), ('Menu', pick(Down, Escape), []),
], ids=lambda value: value if isinstance(value, str) else '')
def test_the_user_raises_events(user, widget, action, events):
    dialog = make_dialog()
    heard = listen(dialog, widget)
    user.run(dialog, action)
    assert heard == [(widget, event) for event in events]


SETTERS = [('Text', 'new', VALUE_CHANGED), ('Text', 'old', VALUE_CHANGED), ('Text', None, VALUE_CHANGED),
           ('Toggle', True, STATE), ('Toggle', False, STATE),
           ('Menu', (['a', 'b'], 1), VALUE_CHANGED), ('Menu', (['a', 'b'], 0), VALUE_CHANGED)]


@pytest.mark.parametrize('widget, value, event', SETTERS)
def test_a_setter_raises_the_event_of_a_change_unless_it_is_told_not_to(user, widget, value, event):
    dialog = make_dialog()
    heard = listen(dialog, widget)

    def set_in_every_way(_=None):
        for setter in (dialog.setValue, lambda name, *rest: dialog.setValues({name: rest[0]}, *rest[1:])):
            del heard[:]
            setter(widget, value, False)
            assert heard == []
            setter(widget, value)
            setter(widget, value, True)
            assert heard == [(widget, event)] * 2

    set_in_every_way()
    user.run(dialog, set_in_every_way)
    set_in_every_way()


def test_a_callable_gets_a_dialog_for_the_same_widgets_the_name_and_the_event(user):
    dialog = make_dialog()
    calls = []
    dialog.addCallback('Toggle', STATE, lambda *arguments: calls.append(arguments))
    dialog.addCallback('Toggle', STATE, lambda given, *_: given.setValue('Text', given.getValue('Text') + '!', False))
    user.run(dialog, click('Toggle'))
    (given, name, event), = calls
    assert type(given) is ui.Dialog and given is not dialog
    assert (name, type(name)) == ('Toggle', str)
    assert event is STATE
    assert given.getValues() == dialog.getValues() == {
        'Text': 'old!', 'Toggle': True, 'Menu': 'a', 'CloseButtonClicked': 'CloseButton_OK'}


def test_callables_of_one_event_run_in_order_of_registration_and_as_often_as_registered(user):
    dialog = make_dialog()
    calls = Mock()

    def take_back(_):
        dialog.removeCallback('Button', ACTIVATE, calls.first)

    for callable_ in (calls.first, calls.second, calls.first):
        dialog.addCallback('Button', ACTIVATE, callable_)
    user.run(dialog, click('Button'), take_back, click('Button'), take_back, click('Button'), take_back)
    assert [name for name, *_ in calls.mock_calls] == ['first', 'second', 'first', 'second', 'first', 'second']


class Equal:
    """Says of everything that it is the same."""

    heard = 0

    def __eq__(self, other):
        return True

    def __hash__(self):
        return 0

    def hear(self, *_):
        self.heard += 1


def test_a_callable_is_taken_back_by_identity():
    dialog = make_dialog()
    listener = Equal()
    kept = listener.hear
    dialog.addCallback('Toggle', STATE, kept)
    for other in (listener.hear, Equal(), Equal().hear, None):
        dialog.removeCallback('Toggle', STATE, other)
    dialog.removeCallback('Toggle', ACTIVATE, kept)
    dialog.removeCallback('Button', STATE, kept)
    dialog.setValue('Toggle', True)
    assert listener.heard == 1
    dialog.removeCallback('Toggle', STATE, kept)
    dialog.setValue('Toggle', True)
    assert listener.heard == 1


def test_a_callable_is_kept_for_as_long_as_it_is_registered():
    dialog = make_dialog()
    calls = []

    def hear(*_):
        calls.append('heard')

    gone = weakref.ref(hear)
    for _ in range(2):
        dialog.addCallback('Toggle', STATE, hear)
    dialog.removeCallback('Toggle', STATE, hear)
    del hear
    gc.collect()
    dialog.setValue('Toggle', True)
    assert calls == ['heard']
    dialog.removeCallback('Toggle', STATE, gone())
    assert gone() is None


def test_a_label_accepts_a_callable_and_never_calls_it(user):
    dialog = make_dialog()
    heard = listen(dialog, 'Note', 'MainContainer', 'UserDefinedWidgetsContainer')

    def never(*_):
        heard.append('never')

    gone = weakref.ref(never)
    dialog.addCallback('Note', ACTIVATE, never)

    def disturb(someone):
        someone.click('Note')
        for name in ('Note', 'UserDefinedWidgetsContainer'):
            dialog.enableWidget(name, False)
            dialog.setValue(name, 'text')

    user.run(dialog, disturb)
    dialog.removeCallback('Note', ACTIVATE, never)
    del never
    assert heard == [] and gone() is None


@pytest.mark.parametrize('operation', ['addCallback', 'removeCallback'])
def test_an_unknown_widget_is_refused_and_nothing_kept(operation):
    dialog = make_dialog()

    def callback(*_):
        pass

    gone = weakref.ref(callback)
    with pytest.raises(ui.UiError) as refused:
        getattr(dialog, operation)('Nobody', ACTIVATE, callback)
    assert str(refused.value) == UNKNOWN
    del callback, refused
    assert gone() is None


def test_a_callback_on_a_close_button_can_keep_the_dialog_open(user):
    dialog = make_dialog()
    seen = []

    def validate(given, name, _):
        if given.getValue('Text') != 'good':
            given.disableNextClose()
        seen.append(name)

    dialog.addCallback('CloseButton_OK', ACTIVATE, validate)
    assert user.run(dialog, click('CloseButton_OK'), lambda _: seen.append(dialog.getValues()['CloseButtonClicked']),
                    keys('Text', 'good')) == 'CloseButton_OK'
    assert seen == ['CloseButton_OK'] * 3
    assert dialog.getValue('Text') == 'good'


@pytest.mark.parametrize('times', [1, 2])
def test_one_close_is_suppressed_for_the_next_run_however_often_it_was_asked_for(user, times):
    dialog = make_dialog()
    user.run(dialog)
    for _ in range(times):
        dialog.disableNextClose()
    names = []
    assert user.run(dialog, click('CloseButton_Cancel'),
                    lambda _: names.append(dialog.getValues()['CloseButtonClicked'])) == 'CloseButton_OK'
    assert names == ['CloseButton_Cancel']


def test_callbacks_stay_from_run_to_run(user):
    dialog = make_dialog()
    heard = listen(dialog, 'Button', 'CloseButton_OK')
    for run in range(1, 4):
        user.run(dialog, click('Button'))
        assert heard == [('Button', ACTIVATE), ('CloseButton_OK', ACTIVATE)] * run


@pytest.mark.parametrize('unfit', [lambda dialog: None, lambda *_, must: None, 'text', None])
def test_what_cannot_be_called_so_fails_at_the_event(user, unfit):
    dialog = make_dialog()
    dialog.addCallback('Button', ACTIVATE, unfit)
    with pytest.raises(TypeError):
        user.run(dialog, click('Button'))
    dialog.removeCallback('Button', ACTIVATE, unfit)
    assert dialog.launch() == 'CloseButton_OK'
