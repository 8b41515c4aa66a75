"""Random programs: every operation of a dialog, with right and wrong values, callbacks that raise and act on the dialog, and
runs that a person ends. Each result is compared with a model of what the pages say.

A failing program names its seed; C{VELMORA_SEED} replays that one alone."""

import os
import random

import pytest

from forms import EVENTS
from quorvane_velmora import testing, ui

PROGRAMS = 3000
ALONE = os.environ.get('VELMORA_SEED')
TEXTS = ['', 'a', 'Grün \U0001f600', '1 <&> "', ' two  words ', 'x' * 300]
UNKNOWN = 'nobody'


class Widget:
    """A widget of the model. C{write} gives the exception that a value is refused with, or None."""

    def __init__(self, name):
        self.name = name
        self.isEnabled = self.isDisplayed = True

    # What a change raises for callbacks.
    event = ui.EventType.VALUE_CHANGED

    def read(self):
        return None


class TextField(Widget):
    def __init__(self, name, value):
        super().__init__(name)
        self.value = value

    def row(self):
        return 'TextField', self.name, 'C ' + self.name, self.value

    def read(self):
        return self.value

    def write(self, value, adds):
        if value is not None and not isinstance(value, str):
            return TypeError
        self.value = value

    def make(self, randomly):
        return randomly.choice([*TEXTS, None])

    def wrong(self, randomly):
        return randomly.choice([5, 1.5, ['a'], (['a'], 0)])

    def fill(self, randomly):
        typed = randomly.choice(TEXTS)
        # Who types nothing into no text leaves none.
        self.value = typed if typed or self.value is not None else None
        return typed


class Toggle(Widget):
    event = ui.EventType.STATE

    def __init__(self, name, value):
        super().__init__(name)
        self.value = value

    def row(self):
        return 'ToggleButton', self.name, 'C ' + self.name, self.value

    def read(self):
        return self.value

    def write(self, value, adds):
        if value is not None and not isinstance(value, int):
            return TypeError
        self.value = bool(value)

    def make(self, randomly):
        return randomly.choice([True, False, 0, 1, 7, None])

    def wrong(self, randomly):
        return randomly.choice(['on', 1.5, [True]])

    def fill(self, randomly):
        self.value = randomly.random() < 0.5
        return self.value


class Menu(Widget):
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
        if not index or not isinstance(index[0], int):
            self.index = -1
            return TypeError if index else IndexError
        self.index = index[0] if 0 <= index[0] < len(self.entries) else -1

    def make(self, randomly):
        return [randomly.choice(TEXTS) for _ in range(randomly.randrange(4))], randomly.randrange(-1, 6)

    def wrong(self, randomly):
        return randomly.choice(['a', None, (), (['a'],), ('a', 0), (['a'], 'b')])

    def fill(self, randomly):
        if not self.entries:
            return None
        self.index = randomly.randrange(len(self.entries))
        return self.index


class Program:
    """One dialog, its model, and what both are asked to do."""

    def __init__(self, seed):
        self.randomly = random.Random(seed)
        kinds = [self.randomly.choice('TBM') for _ in range(self.randomly.randrange(1, 6))]
        self.widgets = {}
        for place, kind in enumerate(kinds):
            name = '%s%d' % (kind, place)
            entries = [self.randomly.choice(TEXTS) for _ in range(self.randomly.randrange(1, 4))]
            self.widgets[name] = (TextField(name, self.randomly.choice(TEXTS)) if kind == 'T' else
                                  Toggle(name, self.randomly.random() < 0.5) if kind == 'B' else
                                  Menu(name, entries, self.randomly.randrange(len(entries))))
        rows = [widget.row() for widget in self.widgets.values()]
        self.dialog = ui.createDialog('Random', ui.makeXmlFromWidgetList(rows, ['OK', 'Cancel']), 400,
                                      28 * (len(rows) + 2))
        self.callbacks = []  # of (name, event, callable), in their order
        self.heard = []
        self.clicked = None

    def run(self):
        operations = [self.set_value, self.set_values, self.read, self.set_wrong, self.add_callback, self.remove_callback,
                      self.change_state, self.ask_unknown]
        for _ in range(self.randomly.randrange(5, 40)):
            self.randomly.choice(operations)()
            self.check()
        if self.randomly.random() < 0.1:
            self.launch()
            self.check()

    def pick(self):
        return self.randomly.choice(list(self.widgets.values()))

    def expect(self, changed):
        """What the callbacks of changes hear, up to the one that raises; and its exception, or None."""
        expected = []
        for widget in changed:
            for name, event, callback in self.callbacks:
                if (name, event) == (widget.name, widget.event):
                    expected.append((name, event))
                    if callback.raises:
                        return expected, callback.raises, widget
        return expected, None, None

    def call(self, expected, raises, function, *arguments):
        """The call ends as the model says, and the callbacks hear what it says."""
        self.heard.clear()
        if raises is None:
            assert function(*arguments) is None
        else:
            with pytest.raises(raises):
                function(*arguments)
        assert self.heard == expected, (self.heard, expected)

    def set_value(self):
        widget = self.pick()
        value = widget.make(self.randomly)
        notify = self.randomly.random() < 0.7
        assert widget.write(value, False) is None
        expected, raises, _ = self.expect([widget] if notify else [])
        arguments = [widget.name, value] if notify and self.randomly.random() < 0.5 else [widget.name, value, notify]
        self.call(expected, raises, self.dialog.setValue, *arguments)

    def set_values(self):
        chosen = [widget for widget in self.widgets.values() if self.randomly.random() < 0.5]
        values = {widget.name: widget.make(self.randomly) for widget in chosen}
        notify = self.randomly.random() < 0.7
        expected, raises, last = self.expect(chosen if notify else [])
        for widget in chosen:
            widget.write(values[widget.name], True)
            if widget is last:
                break
        self.call(expected, raises, self.dialog.setValues, values, notify)

    def set_wrong(self):
        widget = self.pick()
        value = widget.wrong(self.randomly)
        refusal = widget.write(value, False)
        assert refusal, 'the model takes what it should not'
        self.call([], refusal, self.dialog.setValue, widget.name, value)

    def read(self):
        widget = self.pick()
        assert self.dialog.getValue(widget.name) == widget.read()

    def add_callback(self):
        widget, event = self.pick(), self.randomly.choice(EVENTS)

        def callback(dialog, name, what):
            self.heard.append((name, what))
            # Reading and writing without a word is allowed at any time.
            dialog.setValues({}, True)
            assert dialog.getValue(UNKNOWN) is None
            if callback.raises:
                raise callback.raises('of a callback')

        callback.raises = self.randomly.choice([None, None, None, ValueError, KeyError])
        self.callbacks.append((widget.name, event, callback))
        self.call([], None, self.dialog.addCallback, widget.name, event, callback)

    def remove_callback(self):
        if self.callbacks:
            name, event, callback = self.callbacks.pop(self.randomly.randrange(len(self.callbacks)))
            self.call([], None, self.dialog.removeCallback, name, event, callback)

    def change_state(self):
        widget = self.pick()
        isOn = self.randomly.random() < 0.5
        if self.randomly.random() < 0.5:
            widget.isDisplayed = isOn
            self.call([], None, self.dialog.displayWidget, widget.name, isOn)
            return
        event = ui.EventType.ENABLE if isOn else ui.EventType.DISABLE
        expected, raises = [], None
        for name, what, callback in self.callbacks if widget.isEnabled != isOn else []:
            if (name, what) == (widget.name, event) and raises is None:
                expected.append((name, what))
                raises = callback.raises
        widget.isEnabled = isOn
        self.call(expected, raises, self.dialog.enableWidget, widget.name, isOn)

    def ask_unknown(self):
        self.call([], None, self.dialog.setValue, UNKNOWN, 'x')
        operation = self.randomly.choice([lambda: self.dialog.hideWidget(UNKNOWN), lambda: self.dialog.isEnabled(UNKNOWN),
                                          lambda: self.dialog.addCallback(UNKNOWN, EVENTS[0], print)])
        with pytest.raises(ui.UiError):
            operation()

    def launch(self):
        """A person fills in what takes input. Callbacks that raise would end the run: they are taken back before."""
        for name, event, callback in self.callbacks:
            self.dialog.removeCallback(name, event, callback)
        self.callbacks.clear()
        values = {}
        for widget in self.widgets.values():
            if widget.isEnabled and widget.isDisplayed and self.randomly.random() < 0.7:
                value = widget.fill(self.randomly)
                if value is not None:
                    values[widget.name] = value
        label = self.randomly.choice(['OK', 'Cancel'])
        with testing.person() as person:
            person.answer('Random', values, label)
            self.clicked = 'CloseButton_' + label
            assert self.dialog.launch() == self.clicked

    def check(self):
        """All that can be read is as the model has it."""
        expected = {name: widget.read() for name, widget in self.widgets.items()}
        if self.clicked:
            expected['CloseButtonClicked'] = self.clicked
        assert self.dialog.getValues() == expected
        for name, widget in self.widgets.items():
            assert self.dialog.isEnabled(name) is widget.isEnabled
            assert self.dialog.isDisplayed(name) is widget.isDisplayed


def test_random_programs_do_what_the_pages_say():
    for seed in [int(ALONE)] if ALONE else range(PROGRAMS):
        try:
            Program(seed).run()
        except BaseException as failure:
            raise AssertionError('VELMORA_SEED=%d replays it' % seed) from failure
