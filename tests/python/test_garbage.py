"""Dialogs and callables that refer to each other go when the script has let go of them, natively too."""

import gc
import itertools
import os
import weakref

import pytest

from callback_tools import run_script
from forms import make_dialog
from quorvane_velmora import ui
from user import click, close
from PyQt6.QtCore import QEvent
from PyQt6.QtWidgets import QApplication

pytestmark = pytest.mark.usefixtures('no_wait_is_endless')

ACTIVATE, STATE = ui.EventType.ACTIVATE, ui.EventType.STATE


class Keeper:
    """Keeps dialogs, and hears of their events."""

    def __init__(self, *kept):
        self.kept = list(kept)

    def hear(self, dialog, *_):
        pass

    def keep_given(self, dialog, *_):
        self.kept.append(dialog)


def closure(dialog):
    def callback(*_):
        return dialog
    dialog.addCallback('Toggle', STATE, callback)
    return [callback]


def bound_method(dialog):
    keeper = Keeper(dialog)
    dialog.addCallback('Toggle', STATE, keeper.hear)
    return [keeper]


def stores_given_in_itself(dialog):
    def callback(given, *_):
        callback.given = given
    dialog.addCallback('Toggle', STATE, callback)
    dialog.setValue('Toggle', True)
    return [callback]


def stores_every_given_in_a_list(dialog):
    given = []
    dialog.addCallback('Toggle', STATE, lambda *arguments: given.append(arguments))
    for _ in range(3):
        dialog.setValue('Toggle', True)
    return [given[0][0], given[2][0]]


def stores_given_beside_the_own(dialog):
    keeper = Keeper(dialog)
    dialog.addCallback('Toggle', STATE, keeper.keep_given)
    dialog.setValue('Toggle', True)
    assert keeper.kept[0] is not keeper.kept[1]
    return [keeper, keeper.kept[1]]


def attribute_of_the_dialog(dialog):
    dialog.callback = lambda *_: dialog
    dialog.addCallback('Toggle', STATE, dialog.callback)
    dialog.addCallback('Note', ACTIVATE, dialog.callback)
    return [dialog.callback]


def collects_while_it_runs(dialog):
    def callback(given, *_):
        gc.collect()
        assert given.getValue('Text') == 'old'
    callback.circle = callback, dialog
    dialog.addCallback('Toggle', STATE, callback)
    dialog.setValue('Toggle', True)
    return [callback]


def two_dialogs_crosswise(dialog):
    other = make_dialog()
    for one, two in ((dialog, other), (other, dialog)):
        one.addCallback('Toggle', STATE, Keeper(two).hear)
    return [other]


MADE_BY = [closure, bound_method, stores_given_in_itself, stores_every_given_in_a_list, stores_given_beside_the_own,
           attribute_of_the_dialog, collects_while_it_runs, two_dialogs_crosswise]


@pytest.mark.parametrize('launched', [False, True], ids=['never shown', 'launched'])
@pytest.mark.parametrize('make', MADE_BY, ids=lambda make: make.__name__)
def test_a_circle_through_the_callables_goes_in_every_order_of_letting_go(user, make, launched):
    ui.makeXmlFromWidgetList([('TextField', 'a', 'the application is there')])
    gc.collect()
    native = len(QApplication.allWidgets()) if QApplication.instance() else 0
    for order in itertools.permutations(range(3)):
        dialog = make_dialog()
        held = {place: thing for place, thing in enumerate([dialog] + make(dialog))}
        if launched:
            user.plan(click('Toggle'), close)
            dialog.launch()
            assert len(QApplication.allWidgets()) > native
        del dialog
        watched = [weakref.ref(thing) for thing in held.values()]
        for place in order:
            gc.collect()
            assert all(watched[other]() is thing for other, thing in held.items())
            held.pop(place, None)
            thing = None
        gc.collect()
        assert [one() for one in watched] == [None] * len(watched)
        assert (len(QApplication.allWidgets()) if QApplication.instance() else 0) == native


def test_a_second_object_of_the_dialog_keeps_its_callbacks_alive_and_at_work():
    dialog = make_dialog()
    heard, given = [], []
    dialog.addCallback('Toggle', STATE, lambda one, *_: (given.append(one), heard.append(one.getValue('Toggle'))))
    dialog.setValue('Toggle', True)
    gone = weakref.ref(dialog)
    del dialog
    gc.collect()
    assert gone() is None
    second = given.pop()
    assert given == []
    second.setValue('Toggle', False)
    gc.collect()
    given.pop().setValue('Toggle', True)
    assert heard == [True, False, True]


def test_a_callable_goes_with_its_dialog_at_once():
    dialog, keeper = make_dialog(), Keeper()
    dialog.addCallback('Toggle', STATE, keeper.hear)
    gone = weakref.ref(keeper)
    del keeper
    assert gone() is not None
    del dialog
    assert gone() is None


GROWTH = '''
import ctypes, gc, itertools
from forms import make_dialog, ui
from test_garbage import MADE_BY, Keeper

class Heap(ctypes.Structure):
    _fields_ = [(name, ctypes.c_size_t) for name in 'arena free fast mapped bytes unused1 unused2 used rest top'.split()]

library = ctypes.CDLL(None)
library.mallinfo2.restype = Heap

def bytes_in_use():
    heap = library.mallinfo2()
    return heap.used + heap.bytes

def measure(rounds, one_round):
    for number in range(rounds):
        one_round(number)
        if number + 1 in (rounds // 5, rounds // 2, rounds):
            gc.collect()
            print(len(gc.get_objects()), bytes_in_use())
'''

NEVER_SHOWN = GROWTH + '''
def one_round(number):
    dialog = make_dialog()
    held = [dialog] + MADE_BY[number % len(MADE_BY)](dialog)
    if number % 2:
        held.reverse()
    del dialog
    while held:
        held.pop()

measure(2100, one_round)
'''

LAUNCHED = GROWTH + '''
from PyQt6.QtCore import QTimer, Qt
from PyQt6.QtGui import QPixmapCache
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QPushButton

application = QApplication([])
QPixmapCache.setCacheLimit(0)  # it grows up to a bound of its own
widgets = len(QApplication.allWidgets())
clicks = []

def press():
    for name in ('Button', 'CloseButton_OK'):
        button = QApplication.activeModalWidget().findChild(QPushButton, name)
        QTest.mouseClick(button, Qt.MouseButton.LeftButton)

def one_round(number):
    dialog = ui.createDialog('Round', description, 400, 84)
    keeper = Keeper(dialog)
    dialog.addCallback('Button', ui.EventType.ACTIVATE, keeper.keep_given)
    dialog.addCallback('Button', ui.EventType.ACTIVATE, lambda *_: clicks.append(dialog) or clicks.clear())
    QTimer.singleShot(0, press)
    assert dialog.launch() == 'CloseButton_OK'
    assert len(keeper.kept) == 2

description = ui.makeXmlFromWidgetList([('PushButton', 'Button')])
measure(1400, one_round)
assert len(QApplication.allWidgets()) == widgets
'''


@pytest.mark.standalone
@pytest.mark.parametrize('script', [NEVER_SHOWN, LAUNCHED], ids=['never shown', 'launched'])
def test_many_rounds_leave_no_object_and_no_memory_behind(script):
    printed = run_script(script).split()
    objects, memory = ([int(number) for number in printed[start::2]] for start in (0, 1))
    assert objects[0] >= objects[1] >= objects[2]
    # The address sanitizer finds what is lost by itself, and keeps other books.
    if 'libasan' not in os.environ.get('LD_PRELOAD', ''):
        assert memory[2] - memory[1] < 64 << 10


def test_what_is_connected_to_a_native_widget_goes_with_it_and_not_before(user):
    dialog, wrappers, heard = [make_dialog()], [], []

    def connect(someone):
        field = someone.find('Text')
        field.destroyed.connect(lambda *_: heard.append(field))
        field.textChanged.connect(lambda *_: heard.append(field.text()))
        wrappers.append(weakref.ref(field))

    user.plan(connect, lambda someone: (gc.collect(), someone.find('Text').setText('new')), close)
    dialog.pop().launch()
    gc.collect()
    assert len(heard) == 2 and heard[0] == 'new' and heard[1] is wrappers[0]()
    heard.clear()
    QApplication.sendPostedEvents(None, QEvent.Type.MetaCall)  # those connections go
    QApplication.sendPostedEvents(None, QEvent.Type.DeferredDelete)
    gc.collect()
    assert wrappers[0]() is None


def test_windows_that_are_left_go_while_those_who_hear_of_it_have_all_their_names():
    printed = run_script('''
from callback_tools import PatientUser
from forms import make_dialog
from PyQt6.QtWidgets import QWidget
def hear(*_):
    print(name)
def connect(user):
    window = user.window()
    kept.extend([window, *window.findChildren(QWidget)])
    for widget in kept:
        widget.destroyed.connect(hear)
    user.close()
kept, user, dialog, name = [], PatientUser(), make_dialog(), 'heard'
user.plan(connect)
dialog.launch()
user.stop()
print(len(kept))
''').split()
    assert int(printed[0]) > 6 and printed[1:] == ['heard'] * int(printed[0])


def test_a_collection_that_begins_in_code_without_builtins_fails_nowhere(monkeypatch):
    unraisable = []
    monkeypatch.setattr('sys.unraisablehook', unraisable.append)
    eval('collect()', {'__builtins__': {}, 'collect': gc.collect})
    assert unraisable == []
