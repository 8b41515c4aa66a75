"""A person who answers the dialogs of a script under test, without a screen: the keys and the mouse are real, the script
is as it is. In plain Python C{with testing.person() as person:}, under pytest the fixture C{person}."""

import os
import re
import tempfile
import time

# The loop that runs the script's dialogs knows the interpreter from here on.
from quorvane_velmora import ui as _ui  # noqa: F401
from quorvane_velmora.libs import libKVpyextTesting as _door

# Reports of pytest show the test and its script, not this.
__tracebackhide__ = True

_PLATFORM = 'QT_QPA_PLATFORM'
_VALUES = (_door.Kind.FIELD, _door.Kind.TOGGLE, _door.Kind.MENU, _door.Kind.LIST)


class Failure(AssertionError):
    """A dialog was not as the test expects it. The words tell what stands on the screen."""


class NeverCame(Failure):
    """A dialog that was expected did not come."""


class Abandoned(BaseException):
    """Ends the dialogs that a script goes on to show when its test has failed already. Not an C{Exception}, so that a
    script that tries again does not catch it."""


def person(deadline=5.0, pictures=None):
    """Makes somebody who answers the dialogs that are shown inside a C{with} statement.

    @param deadline: How long a dialog that nobody answers may stand on the screen, in seconds. Defaults to 5.
    @type deadline: C{float}
    @param pictures: The folder for the picture of the dialog at which a test fails. Defaults to a new folder among the
    system's temporary ones.
    @type pictures: C{str} or C{os.PathLike}
    @return: The person.
    @rtype: L{Person}
    """
    return Person(deadline, pictures)


class Person:
    """Answers dialogs, in the order of the calls of L{answer}. The other methods act at once, on the dialog that takes
    input: they are for the functions that C{answer} is given, and for callbacks. Made by L{testing.person}.

    A failure ends the dialog that it was met at, and comes out of the call that shows it: the test fails there. What is
    caught on its way comes again at the end of the C{with} statement."""

    def __init__(self, deadline, pictures):
        self._deadline = deadline
        self._pictures = pictures
        self._expected = []
        self._failure = None
        self._scene = None
        self._since = 0.0

    def __enter__(self):
        # Read once, when the user interface starts.
        asked = os.environ.get(_PLATFORM)
        os.environ[_PLATFORM] = asked or 'offscreen'
        try:
            _door.open(self._turn)
        finally:
            if asked is None:
                del os.environ[_PLATFORM]
            else:
                os.environ[_PLATFORM] = asked
        return self

    def __exit__(self, kind, error, traceback):
        _door.close()
        expected, self._expected = self._expected, []
        failure, self._failure = self._failure, None
        if failure is None and error is None and expected:
            failure = NeverCame('Expected, and never came: %s.' % '; '.join(map(str, expected)))
        if failure is not None and failure is not error:
            raise failure

    def answer(self, title, values=None, press=None, *, says=None, do=None):
        """Plans what to do at the next dialog that nothing is planned for yet. It is done once that dialog takes input:
        the values are filled in, the function is called, the button is pressed. A dialog that this leaves open is there
        for the next answer.

        @param title: The title of the dialog.
        @type title: C{str}
        @param values: What to fill in, see L{fill}. Defaults to nothing.
        @type values: C{dict}
        @param press: The button or key to press in the end, see L{press}. Defaults to none.
        @type press: C{str}
        @param says: A text that must stand in the dialog. Defaults to any.
        @type says: C{str}
        @param do: Called with the person when the values are filled in. What it raises fails the test. Defaults to none.
        @type do: callable
        """
        self._expected.append(_Answer(title, values or {}, press, says, do))

    def fill(self, values):
        """Fills in widgets of the dialog, by clicks and keys.

        @param values: By the name of a widget, or by the words beside it, a value in the form of C{Dialog.setValue}. A
        menu also takes the text of an entry, or its index; a list, as the browser has it, the text of a row, or a
        C{list} of several. A line break in a text is Enter.
        @type values: C{dict}
        @raise Failure: If there is no such widget, more than one, or one that a user cannot click on.
        @raise TypeError: If a value is of the wrong form.
        """
        for key, value in values.items():
            self._require_dialog()
            widgets = _door.look()
            place = _find(key, widgets, _VALUES, 'widget')
            _FILL[widgets[place].kind](key, place, widgets[place], value)

    def press(self, what):
        """Presses a button of the dialog, or a key.

        @param what: The words on a button, its name, or the name of a key: C{'Escape'}, C{'Shift+Tab'}, C{'Ctrl+A'}.
        @type what: C{str}
        @raise Failure: If there is neither a button nor a key of that name, or a user cannot click on it.
        """
        self._require_dialog()
        widgets = _door.look()
        if _places(what, widgets, (_door.Kind.BUTTON,)) or not _door.press(what):
            place = _find(what, widgets, (_door.Kind.BUTTON,), 'button')
            _reach(what, place, 'pressed')
            _door.click(place)

    def type(self, text):
        """Types a text where the keyboard is.

        @param text: The text, in which a line break is Enter and a tabulator Tab.
        @type text: C{str}
        @raise Failure: If no dialog takes input.
        """
        self._require_dialog()
        _door.type(text)

    def see(self):
        """Tells what stands in the dialog, for an assertion or to compare it with an earlier text: the title, and in a
        line for each what is shown, from top to bottom.

        @return: The text, C{''} where no dialog takes input.
        @rtype: C{str}
        """
        title = _door.getTitle()
        if title is None:
            return ''
        widgets = [(place, widget) for place, widget in enumerate(_door.look()) if widget.isShown]
        captions = {widget.caption for _, widget in widgets if widget.kind in _VALUES}
        lines = [_line(place, widget) for place, widget in widgets
                 if widget.kind != _door.Kind.LABEL or (widget.text and widget.text not in captions)]
        return '\n'.join([title, *('  ' + line.replace('\n', '\n  ') for line in lines)])

    def picture(self, path):
        """Saves a picture of the dialog.

        @param path: The path of the file; its suffix says which kind, such as C{.png}.
        @type path: C{str} or C{os.PathLike}
        @raise Failure: If no dialog takes input.
        @raise OSError: If the file cannot be written.
        """
        self._require_dialog()
        if not _door.takePicture(os.fspath(path)):
            raise OSError('Cannot save a picture as "%s"' % os.fspath(path))

    @staticmethod
    def _require_dialog():
        if _door.getTitle() is None:
            raise Failure('No dialog takes input.')

    def _turn(self):
        """Called while a dialog runs and nothing is under way."""
        if self._failure is not None:
            if not _door.closeForeign():
                raise Abandoned('The test has failed already: %s' % self._failure)
            return
        try:
            self._act()
        except BaseException as failure:
            if self._failure is not None:  # it came from a dialog inside this one, and is on its way
                return
            self._failure = failure
            self._keep_picture(failure)
            # Who runs the dialog, if not this module, does not let an exception through.
            if not _door.closeForeign():
                raise

    def _act(self):
        title = _door.getTitle()
        answer = self._expected[0] if self._expected else None
        if answer and answer.title == title and answer.is_ready(_door.look()):
            del self._expected[0]
            try:
                answer.give(self)
            finally:
                self._scene = None
            return
        now = time.monotonic()
        if self._scene != (title,):
            self._scene = (title,)
            self._since = now
        elif now - self._since > self._deadline:
            raise Failure(self._complain(title, answer))

    def _complain(self, title, answer):
        if title is None:
            shown = 'A dialog runs, but none is on the screen.'
        else:
            shown = 'The dialog "%s" is open, and nobody answers it. It shows:\n%s' % (title, self.see())
        return '%s\nExpected next: %s.' % (shown, answer or 'no dialog')

    def _keep_picture(self, failure):
        title = _door.getTitle()
        if title is None:
            return
        folder = self._pictures or tempfile.mkdtemp(prefix='velmora-')
        path = os.path.join(os.fspath(folder), (re.sub(r'\W+', '-', title).strip('-') or 'dialog') + '.png')
        if not _door.takePicture(path):
            return
        note = 'A picture of the dialog: %s' % path
        if isinstance(failure, Failure):
            failure.args = ('%s\n%s' % (failure, note),)
        elif hasattr(failure, 'add_note'):  # from Python 3.11 on
            failure.add_note(note)


class _Answer:
    """What is planned for a dialog."""

    def __init__(self, title, values, press, says, do):
        self.title = title
        self._values = values
        self._press = press
        self._says = says
        self._do = do

    def __str__(self):
        return ('"%s"' % self.title + (', which says "%s"' % self._says if self._says else '')
                + (', to fill in %s' % _quote(self._values) if self._values else ''))

    def is_ready(self, widgets):
        """True if the dialog says what it must, and the rows are there that a list still reads."""
        if self._says and not any(widget.isShown and self._says in widget.text for widget in widgets):
            return False
        return all(set(_rows(value)) <= set(_door.getEntries(place)) for key, value in self._values.items()
                   for place in _places(key, widgets, (_door.Kind.LIST,)))

    def give(self, someone):
        someone.fill(self._values)
        if self._do is not None:
            self._do(someone)
        if self._press is not None:
            someone.press(self._press)


def _places(key, widgets, kinds):
    """The widgets of a name; where there are none, those that show these words."""
    ours = [(place, widget) for place, widget in enumerate(widgets) if widget.kind in kinds]
    return ([place for place, widget in ours if widget.name == key]
            or [place for place, widget in ours if widget.isShown and widget.caption == key])


def _find(key, widgets, kinds, what):
    found = _places(key, widgets, kinds)
    if len(found) == 1:
        return found[0]
    if found:
        raise Failure('The dialog "%s" has %d %ss "%s".' % (_door.getTitle(), len(found), what, key))
    there = ['"%s" (%s)' % (widget.name, widget.caption or 'nothing beside it')
             for widget in widgets if widget.kind in kinds]
    raise Failure('The dialog "%s" has no %s "%s". There are: %s.'
                  % (_door.getTitle(), what, key, ', '.join(there) or 'none'))


def _reach(key, place, done):
    obstacle = _door.getObstacle(place)
    if obstacle:
        raise Failure('"%s" of the dialog "%s" cannot be %s: it %s.' % (key, _door.getTitle(), done, obstacle))


def _refuse(key, takes, value):
    raise TypeError('"%s" takes %s, not %s' % (key, takes, type(value).__name__))


def _fill_field(key, place, widget, value):
    if not isinstance(value, (str, type(None))):
        _refuse(key, 'a str or None', value)
    _reach(key, place, 'filled')
    _door.click(place)
    _door.press('Ctrl+A')
    _door.press('Delete')
    _door.type(value or '')


def _fill_toggle(key, place, widget, value):
    if not isinstance(value, (int, type(None))):
        _refuse(key, 'a bool, an int or None', value)
    _reach(key, place, 'filled')
    if widget.isOn != bool(value):
        _door.click(place)


def _fill_menu(key, place, widget, value):
    entries = _door.getEntries(place)
    if isinstance(value, tuple):
        wanted, value = value
        if list(wanted) != entries:
            raise Failure('The menu "%s" has other entries: %s.' % (key, _quote(entries)))
    if isinstance(value, str):
        if value not in entries:
            raise Failure('The menu "%s" has no entry "%s". There are: %s.' % (key, value, _quote(entries)))
        value = entries.index(value)
    if not isinstance(value, int):
        _refuse(key, 'an entry, its index, or a tuple of a list of str and an int', value)
    if not 0 <= value < len(entries):
        raise Failure('The menu "%s" has no entry %d. There are %d.' % (key, value, len(entries)))
    _reach(key, place, 'filled')
    # An empty text can also be that of no selection, and one that is there twice that of the other entry.
    if not widget.text or widget.text != entries[value] or entries.count(widget.text) > 1:
        _door.pick(place, value, False)


def _fill_list(key, place, widget, value):
    entries = _door.getEntries(place)
    _reach(key, place, 'filled')
    for count, row in enumerate(_rows(value)):
        if row not in entries:
            raise Failure('The list "%s" has no row "%s". There are: %s.' % (key, row, _quote(entries)))
        _door.pick(place, entries.index(row), count > 0)


_FILL = {_door.Kind.FIELD: _fill_field, _door.Kind.TOGGLE: _fill_toggle, _door.Kind.MENU: _fill_menu,
         _door.Kind.LIST: _fill_list}


def _rows(value):
    return [value] if isinstance(value, str) else list(value)


def _quote(texts):
    return ', '.join('"%s"' % text for text in texts) or 'none'


def _line(place, widget):
    """A widget as L{Person.see} tells of it."""
    caption = widget.caption or '(%s)' % widget.name
    marks = [mark for mark, holds in (('disabled', not widget.isEnabled), ('focused', widget.hasKeyboard)) if holds]
    words = {_door.Kind.LABEL: lambda: widget.text,
             _door.Kind.BUTTON: lambda: '[%s]' % caption,
             _door.Kind.TOGGLE: lambda: '%s: %s' % (caption, 'on' if widget.isOn else 'off'),
             _door.Kind.LIST: lambda: '%s: %s' % (caption, _quote(_door.getEntries(place)))}
    line = words.get(widget.kind, lambda: '%s: "%s"' % (caption, widget.text))()
    return line + (' (%s)' % ', '.join(marks) if marks else '')
