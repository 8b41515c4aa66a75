"""Random programs: every operation of a dialog, with right and wrong values, callbacks that raise and act on the dialog, and
runs that a person ends. Each result is compared with a model of what the pages say. Objects whose special methods raise, lie
or come back into the module are handed over too; what becomes of them is left open, but nothing may break.

A failing program names its seed; C{VELMORA_SEED} replays that one alone. C{VELMORA_PROGRAMS} says how many there are, and
C{VELMORA_FIRST} the seed of the first."""

import contextlib
import functools
import gc
import os
import random
import sys

import pytest

from forms import EVENTS
from quorvane_velmora import testing, ui

PROGRAMS = int(os.environ.get('VELMORA_PROGRAMS', 1500))
FIRST = int(os.environ.get('VELMORA_FIRST', 0))
ALONE = os.environ.get('VELMORA_SEED')
TEXTS = ['', 'a', 'Grün \U0001f600', '1 <&> "', ' two  words ', 'x' * 300]
UNKNOWN = 'nobody'


class Widget:
    """A widget of the model, without a value. C{fill} is what a person does to it: on the model, with the steps of the
    person added to the program's."""

    # What a change raises for callbacks; None where there is no value.
    event = None
    # Whether it raises events at all.
    isHeard = False

    def __init__(self, name):
        self.name = name
        self.isEnabled = self.isDisplayed = True
        # Whether it was hidden or disabled, and has lost the keyboard.
        self.wasAway = False

    def read(self):
        return None

    def write(self, value, adds):
        """Gives the exception that a value is refused with, or None."""

    def make(self, randomly):
        return randomly.choice([None, 'a', 5, (['a'], 0)])

    wrong = make

    def fill(self, program):
        pass


class Label(Widget):
    def row(self):
        return 'Label', self.name, 'C ' + self.name, 'text of ' + self.name


class Button(Widget):
    isHeard = True

    def row(self):
        return 'PushButton', self.name, 'C ' + self.name

    def fill(self, program):
        program.steps.append(lambda person: person.press(self.name))
        program.fire(self, ui.EventType.ACTIVATE)


class Simple(Widget):
    """One whose value is of one type, or None."""

    isHeard = True

    def __init__(self, name, value):
        super().__init__(name)
        self.value = value

    def row(self):
        return self.kind, self.name, 'C ' + self.name, self.value

    def read(self):
        return self.value

    def write(self, value, adds):
        if value is not None and not isinstance(value, self.taken):
            return TypeError
        self.value = value

    def make(self, randomly):
        return randomly.choice(self.right)

    def wrong(self, randomly):
        return randomly.choice(self.refused)


class TextField(Simple):
    kind, taken, event = 'TextField', str, ui.EventType.VALUE_CHANGED
    right, refused = [*TEXTS, None], [5, 1.5, ['a'], (['a'], 0)]

    def __init__(self, name, value):
        super().__init__(name, value)
        self.before = value  # the edit that is under way

    def write(self, value, adds):
        refusal = super().write(value, adds)
        if not refusal:
            self.before = value
        return refusal

    def fill(self, program):
        typed, ends = program.randomly.choice(TEXTS), program.randomly.random() < 0.4
        program.steps.append(lambda person: click(self.name))
        self.wasAway = False
        program.fire(self, ui.EventType.ACTIVATE)
        if self.wasAway:
            return
        # Its click is that of the step before.
        program.steps[-1] = lambda person: person.fill({self.name: typed + '\n' * ends})
        # Who types nothing into no text leaves none.
        self.value = typed if typed or self.value is not None else None
        if ends and (self.value or '') != (self.before or ''):
            self.before = self.value
            program.fire(self, ui.EventType.VALUE_CHANGED)


class Toggle(Simple):
    kind, taken, event = 'ToggleButton', int, ui.EventType.STATE
    right, refused = [True, False, 0, 1, 7, None], ['on', 1.5, [True]]

    def read(self):
        return bool(self.value)

    def fill(self, program):
        self.value = not self.value
        state = self.value
        program.steps.append(lambda person: person.fill({self.name: state}))
        program.fire(self, ui.EventType.STATE)
        program.fire(self, ui.EventType.ACTIVATE)


class Menu(Widget):
    isHeard, event = True, ui.EventType.VALUE_CHANGED

    def __init__(self, name, entries, index):
        super().__init__(name)
        self.entries = list(entries)
        self.index = index

    def row(self):
        return 'Menu', self.name, 'C ' + self.name, (list(self.entries), self.index)

    def read(self):
        return self.entries[self.index] if 0 <= self.index < len(self.entries) else None

    def write(self, value, adds):
        if not isinstance(value, tuple):
            return TypeError
        if not value:
            return IndexError
        entries, *index = value
        if not isinstance(entries, list):
            return TypeError
        self.entries = self.entries + entries if adds else list(entries)
        self.index = self.index if adds else -1
        if not index or not isinstance(index[0], int):
            return TypeError if index else IndexError
        self.index = index[0] if 0 <= index[0] < len(self.entries) else -1

    def make(self, randomly):
        return [randomly.choice(TEXTS) for _ in range(randomly.randrange(4))], randomly.randrange(-1, 6)

    def wrong(self, randomly):
        return randomly.choice(['a', None, (), (['a'],), ('a', 0), (['a'], 'b')])

    def fill(self, program):
        if not self.entries:
            return
        index = program.randomly.randrange(len(self.entries))
        program.steps.append(lambda person: person.fill({self.name: index}))
        entry = self.entries[index]
        if entry and entry == self.read() and self.entries.count(entry) == 1:
            return  # the person leaves it alone
        isNew, self.index = index != self.index, index
        if isNew:
            program.fire(self, ui.EventType.VALUE_CHANGED)
        program.fire(self, ui.EventType.ACTIVATE)


def click(name):
    """What a person does first who fills in a text field."""
    door = testing._door
    door.click([widget.name for widget in door.look()].index(name))


class Callback:
    """Takes down what it hears; the first time it acts on the dialog, and each time it may raise. C{model} and C{act} are
    that act, on the model and in the script."""

    def __init__(self, heard, raises, model, act):
        self.heard, self.raises, self.model, self.act = heard, raises, model, act

    def __call__(self, dialog, name, what):
        self.heard.append((name, what))
        act, self.act = self.act, None
        if act:
            act(dialog)
        if self.raises:
            raise self.raises('of a callback')


# The special methods that hostile objects have, and the classes that they derive from, with what an object is made of.
SPECIAL = ('__bool__ __index__ __int__ __float__ __str__ __repr__ __format__ __eq__ __lt__ __hash__ __iter__ __next__ __len__ '
           '__getitem__ __contains__ __call__ __getattribute__ __getattr__ __class__ __get__ __del__ keys items get').split()
BASES = [(object,), (str, 'text'), (int, 1), (float, 1.5), (bytes, b'text'), (list, ['a', 'b']), (tuple, (['a'], 0)),
         (dict, {'T0': 'x'}), (LookupError, 'text')]


class Lie(Exception):
    """What hostile objects raise."""


def make_hostile(randomly, poke):
    """An object of which some special methods raise, make one of the calls of C{poke}, or give what nobody expects. All is
    settled when it is made: nobody knows when a destructor runs."""
    def make_method(name):
        call = poke(randomly) if randomly.random() < 0.3 else None
        answer = randomly.choice([Lie, Lie, None, -1, 2, 'text', 1.5, [], (), True, b'x', object()])

        def method(self, *given):
            if call:
                Program.attempt(*call)
            if answer is Lie:
                raise Lie(name)
            return answer
        return randomly.choice([property(method), str, list, tuple, dict]) if name == '__class__' else method

    base, *made_of = randomly.choice(BASES)
    methods = {name: make_method(name) for name in randomly.sample(SPECIAL, randomly.randrange(1, 5))}
    return type('Hostile', (base,), methods)(*made_of)


class Program:
    """One dialog, its model, and what both are asked to do."""

    def __init__(self, seed):
        self.randomly = random.Random(seed)
        self.person = None
        self.heard, self.expected = [], []
        self.build()

    def build(self):
        kinds = [self.randomly.choice('TTBBMML') for _ in range(self.randomly.randrange(1, 6))]
        self.rows = []
        for place, kind in enumerate(kinds):
            name = '%s%d' % (kind, place)
            entries = [self.randomly.choice(TEXTS) for _ in range(self.randomly.randrange(1, 4))]
            self.rows.append(TextField(name, self.randomly.choice(TEXTS)) if kind == 'T' else
                             Toggle(name, self.randomly.random() < 0.5) if kind == 'B' else
                             Menu(name, entries, self.randomly.randrange(len(entries))) if kind == 'M' else Label(name))
        self.rows.append(Button('P'))
        self.ok, self.cancel = Button('CloseButton_OK'), Button('CloseButton_Cancel')
        self.container = Widget('UserDefinedWidgetsContainer')
        # The button "Cancel" stays within reach, so that each run can be ended.
        self.everything = [*self.rows, Label('Label_C P'), self.container, self.ok]
        rows = [widget.row() for widget in self.rows]
        self.dialog = ui.createDialog('Random', ui.makeXmlFromWidgetList(rows, ['OK', 'Cancel']), 400,
                                      28 * (len(rows) + 2))
        self.callbacks = []  # of (name, event, callable), in their order
        self.clicked = None
        self.isKeptOpen = False

    def run(self):
        operations = [self.set_value, self.set_values, self.read, self.set_wrong, self.add_callback, self.remove_callback,
                      self.change_state, self.ask_unknown]
        for _ in range(self.randomly.randrange(5, 40)):
            self.randomly.choice(operations)()
            if self.dialog is None:  # dropped by a callback
                return
            self.check()
        if self.randomly.random() < 0.1:
            self.launch()
            if self.dialog is None:
                return
            self.check()
        if self.randomly.random() < 0.3:
            self.be_hostile()

    def pick(self):
        return self.randomly.choice(self.rows)

    # The model's side. What raises here is what must come out of the call.

    def fire(self, widget, event):
        if not widget.isHeard:
            return
        for entry in [entry for entry in self.callbacks if entry[:2] == (widget.name, event)]:
            if not any(entry is other for other in self.callbacks):
                continue  # taken back by one before it
            self.expected.append(entry[:2])
            callback = entry[2]
            model, callback.model = callback.model, None
            if model:
                model()
            if callback.raises:
                raise callback.raises('of a callback')

    def write(self, widget, value, adds, notify):
        refusal = widget.write(value, adds)
        if refusal:
            raise refusal('of a value')
        if notify and widget.event is not None:
            self.fire(widget, widget.event)

    def enable(self, widget, isOn):
        if widget.isEnabled != isOn:
            widget.isEnabled = isOn
            self.lose_keyboard(widget)
            self.fire(widget, ui.EventType.ENABLE if isOn else ui.EventType.DISABLE)

    def display(self, widget, isOn):
        widget.isDisplayed = isOn
        self.lose_keyboard(widget)

    def lose_keyboard(self, widget):
        for lost in self.rows if widget is self.container else [widget]:
            lost.wasAway = True

    def is_reached(self, widget):
        around = [] if widget in (self.ok, self.cancel) else [self.container]
        return all(one.isEnabled and one.isDisplayed for one in [widget, *around])

    def keep_open(self):
        self.isKeptOpen = True

    def forget(self, entry):
        self.callbacks[:] = [other for other in self.callbacks if other is not entry]

    # Both sides.

    def call(self, model, function, *arguments, gives=None):
        """The call ends as the model does, and the callbacks hear what they hear in the model."""
        self.heard.clear()
        self.expected.clear()
        try:
            model()
        except Exception as refusal:
            with pytest.raises(type(refusal)):
                function(*arguments)
        else:
            assert function(*arguments) == gives
        assert self.heard == self.expected, (self.heard, self.expected)

    def set_value(self):
        widget = self.pick()
        value = widget.make(self.randomly)
        notify = self.randomly.random() < 0.7
        arguments = [widget.name, value] if notify and self.randomly.random() < 0.5 else [widget.name, value, notify]
        self.call(lambda: self.write(widget, value, False, notify), self.dialog.setValue, *arguments)

    def set_values(self):
        chosen = [widget for widget in self.rows if self.randomly.random() < 0.5]
        values = {widget.name: (widget.wrong if self.randomly.random() < 0.1 else widget.make)(self.randomly)
                  for widget in chosen}
        notify = self.randomly.random() < 0.7

        def model():
            for widget in chosen:
                self.write(widget, values[widget.name], True, notify)

        shuffled = dict(self.randomly.sample(list(values.items()), len(values)))
        self.call(model, self.dialog.setValues, shuffled, notify)

    def set_wrong(self):
        widget = self.pick()
        value = widget.wrong(self.randomly)
        self.call(lambda: self.write(widget, value, False, True), self.dialog.setValue, widget.name, value)

    def read(self):
        widget = self.pick()
        assert self.dialog.getValue(widget.name) == widget.read()

    def make_act(self):
        """What a callback does to the dialog: on the model, and in the script."""
        widget = self.randomly.choice(self.everything)
        written = self.pick()
        value = written.make(self.randomly)
        isOn = self.randomly.random() < 0.5
        notify = self.randomly.random() < 0.5
        entry = self.randomly.choice(self.callbacks) if self.callbacks else None
        return self.randomly.choice([
            (lambda: self.write(written, value, False, notify), lambda dialog: dialog.setValue(written.name, value, notify)),
            (lambda: self.enable(widget, isOn), lambda dialog: dialog.enableWidget(widget.name, isOn)),
            (lambda: self.display(widget, isOn), lambda dialog: dialog.displayWidget(widget.name, isOn)),
            (lambda: self.forget(entry), lambda dialog: entry and dialog.removeCallback(*entry)),
            (self.keep_open, lambda dialog: dialog.disableNextClose()),
            (lambda: None, lambda dialog: self.launch_another()),
            (lambda: None, lambda dialog: self.drop())])

    def launch_another(self):
        with contextlib.nullcontext(self.person) if self.person else testing.person() as person:
            person.answer('Another', press=self.randomly.choice(['Yes', 'Cancel', 'Escape']))
            ui.showMessageBox('Another', ['Go on?'], ['Yes', 'Cancel'])

    def drop(self):
        self.dialog = None
        gc.collect()

    def add_callback(self):
        widget = self.randomly.choice([*self.everything, *self.rows, self.cancel])
        often = ui.EventType.ACTIVATE if widget.event is None else widget.event
        event = self.randomly.choice([*EVENTS, ui.EventType.ACTIVATE, often, often, often])
        act = self.make_act() if self.randomly.random() < 0.5 else (None, None)
        callback = Callback(self.heard, self.randomly.choice([None, None, None, ValueError, KeyError]), *act)
        self.callbacks.append((widget.name, event, callback))
        self.call(lambda: None, self.dialog.addCallback, widget.name, event, callback)

    def remove_callback(self):
        if self.callbacks:
            entry = self.callbacks.pop(self.randomly.randrange(len(self.callbacks)))
            self.call(lambda: None, self.dialog.removeCallback, *entry)

    def change_state(self):
        widget = self.randomly.choice(self.everything)
        isOn = self.randomly.random() < 0.5
        if self.randomly.random() < 0.5:
            operation = self.dialog.showWidget if isOn else self.dialog.hideWidget
            self.call(lambda: self.display(widget, isOn), *self.randomly.choice([
                (operation, widget.name), (self.dialog.displayWidget, widget.name, isOn)]))
        else:
            self.call(lambda: self.enable(widget, isOn), self.dialog.enableWidget, widget.name, isOn)

    def ask_unknown(self):
        self.call(lambda: None, self.dialog.setValue, UNKNOWN, 'x')
        operation = self.randomly.choice([lambda: self.dialog.hideWidget(UNKNOWN), lambda: self.dialog.isEnabled(UNKNOWN),
                                          lambda: self.dialog.addCallback(UNKNOWN, EVENTS[0], print)])
        with pytest.raises(ui.UiError):
            operation()

    def launch(self):
        """A person fills in what takes input, presses the button, and closes by clicks or keys, until a callback raises. The
        model goes ahead, and takes down the person's steps."""
        self.steps = []

        def model():
            for widget in self.rows:
                if self.is_reached(widget) and self.randomly.random() < 0.7:
                    widget.fill(self)
            isOpen = True
            while isOpen:
                button, key = self.randomly.choice([(self.ok, None), (self.cancel, None), (self.cancel, 'Escape'),
                                                    (self.ok, 'Return'), (self.cancel, 'Space')])
                if not self.is_reached(button):
                    button, key = self.cancel, None
                self.steps.append(functools.partial(self.close, label=button.name[len('CloseButton_'):], key=key))
                self.fire(button, ui.EventType.ACTIVATE)
                isOpen, self.isKeptOpen = self.isKeptOpen, False
            self.clicked = button.name

        def act(person):
            for step in self.steps:
                step(person)

        with testing.person() as self.person:
            self.person.answer('Random', do=act)
            self.call(model, lambda: self.dialog.launch() == self.clicked, gives=True)
        self.person = None

    def close(self, person, label, key):
        if key in ('Return', 'Space'):
            for _ in range(3 + len(self.everything)):
                if '[%s] (focused)' % label not in person.see():
                    person.press('Tab')
        person.press(key or label)

    def be_hostile(self):
        """Hands over what is wrong in worse ways. The dialog is another one from then on."""
        dialog, name, event = self.dialog, self.pick().name, self.randomly.choice(EVENTS)
        value = self.pick().make(self.randomly)

        def poke(randomly):
            return randomly.choice([
                (dialog.getValues,), (dialog.setValue, name, value), (dialog.setValues, {name: value}), (gc.collect,),
                (dialog.addCallback, name, event, self.heard.append), (dialog.removeCallback, name, event, print),
                (dialog.hideWidget, name), (dialog.enableWidget, name, False), (ui.makeXmlFromWidgetList, [(name, name)])])

        def throw(*_):
            raise hostile

        for _ in range(self.randomly.randrange(1, 8)):
            hostile = make_hostile(self.randomly, poke)
            self.attempt(*self.randomly.choice([
                (dialog.setValue, name, hostile), (dialog.setValue, hostile, value), (dialog.setValue, name, value, hostile),
                (dialog.setValue, name, (hostile, 0)), (dialog.setValue, name, ([hostile], 0)), (dialog.setValue, name, (['a'], hostile)),
                (dialog.setValues, hostile), (dialog.setValues, {name: hostile}), (lambda: dialog.setValues({hostile: value}),),
                (dialog.getValue, hostile), (dialog.addCallback, hostile, event, print), (dialog.addCallback, name, hostile, print),
                (dialog.addCallback, name, event, hostile), (dialog.removeCallback, name, event, hostile),
                (dialog.addCallback, name, event, throw), (dialog.setValue, name, value), (dialog.enableWidget, name, hostile),
                (dialog.displayWidget, name, hostile), (dialog.setWidgetResourceName, name, hostile), (dialog.isEnabled, hostile),
                (dialog.addCallback, 'CloseButton_Cancel', ui.EventType.ACTIVATE, hostile),
                (ui.makeXmlFromWidgetList, hostile), (ui.makeXmlFromWidgetList, [hostile], hostile),
                (ui.makeXmlFromWidgetList, [('TextField', 'a', 'b', hostile), ('Menu', 'c', 'd', hostile)]),
                (ui.createDialog, hostile, hostile), (ui.createDialog, 'a', 'b', hostile), (self.show, ui.showSimpleDialog, 'a', hostile),
                (self.show, ui.showMessageBox, hostile, hostile), (ui.CursorGuard, hostile), (ui.EventType, hostile)]))
        mayStay = self.isKeptOpen or any(name == self.cancel.name for name, *_ in self.callbacks)
        if not mayStay and self.randomly.random() < 0.2:
            with testing.person() as person:
                person.answer('Random', press='Escape')
                self.attempt(dialog.launch)
        del dialog, hostile
        gc.collect()
        self.build()
        self.check()

    @staticmethod
    def show(function, *arguments):
        """What opens a dialog all the same has it ended by a person who waits in vain."""
        with contextlib.suppress(testing.Failure), testing.person(0.02, os.devnull):
            function(*arguments)

    @staticmethod
    def attempt(function, *arguments):
        """Any exception of Python may come out, but for the one that says that Python itself was misused."""
        try:
            function(*arguments)
        except SystemError:
            raise
        except Exception:
            pass

    def check(self):
        """All that can be read is as the model has it."""
        expected = {widget.name: widget.read() for widget in self.rows if widget.event is not None}
        if self.clicked:
            expected['CloseButtonClicked'] = self.clicked
        assert self.dialog.getValues() == expected
        for widget in self.everything:
            assert self.dialog.isEnabled(widget.name) is widget.isEnabled
            assert self.dialog.isDisplayed(widget.name) is widget.isDisplayed


def test_random_programs_do_what_the_pages_say(monkeypatch):
    # What is raised where nobody can be told, as by a destructor.
    monkeypatch.setattr(sys, 'unraisablehook', lambda _: None)
    for seed in [int(ALONE)] if ALONE else range(FIRST, FIRST + PROGRAMS):
        try:
            Program(seed).run()
        except BaseException as failure:
            raise AssertionError('VELMORA_SEED=%d replays it' % seed) from failure
