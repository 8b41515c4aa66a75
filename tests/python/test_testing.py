"""Tests of dialogs in the words of a user."""

import contextlib
import os
import signal
import subprocess
import sys
import time
import traceback

import pytest
import scripts
import stage
from forms import listen, make_dialog
from quorvane_velmora import testing, ui
from PyQt6.QtCore import QEvent, QObject, QTimer, Qt
from PyQt6.QtGui import QFocusEvent
from PyQt6.QtWidgets import QApplication, QDialog, QWidget

pytestmark = pytest.mark.screen

FORM = [('TextField', 'shot', 'Shot'), ('Menu', 'step', 'Step', (['comp', 'grade', 'paint'], 0)),
        ('ToggleButton', 'farm', 'On the farm', False), ('PushButton', 'more', 'More')]


def publish():
    """Asks until the shot is well named."""
    shot = ''
    while True:
        form = [('TextField', 'shot', 'Shot', shot), *FORM[1:]]
        values = ui.showSimpleDialog('Publish', form, 400, True)
        shot = values['shot']
        if values.get('CloseButtonClicked') != 'CloseButton_OK':
            return None
        if shot.startswith('sh_'):
            return shot, values['step'], values['farm']
        ui.showMessageBox('Publish', ['Shot must look like sh_010', 'It does not.'])


def show():
    return ui.showSimpleDialog('Publish', FORM, 400, True)


@pytest.fixture
def fail(tmp_path):
    """Gives what a test fails with whose person plans at most one answer."""
    def give(act=show, deadline=0.2, **answer):
        with pytest.raises(BaseException) as failed, testing.person(deadline, tmp_path) as person:
            if answer:
                person.answer('Publish', **answer)
            act()
        return failed.value

    return give


def test_dialogs_are_answered_in_their_order_by_names_and_by_what_stands_beside_the_widgets(person):
    person.answer('Publish', {'shot': 'bad'}, 'OK')
    person.answer('Publish', says='Shot must look', press='OK')
    person.answer('Publish', {'Shot': 'sh_010 é\U0001f600', 'Step': 'paint', 'On the farm': 1}, 'OK')
    assert publish() == ('sh_010 é\U0001f600', 'paint', True)
    person.answer('Publish', {'step': 1, 'farm': False, 'shot': 'sh_1'})
    person.answer('Publish', {'step': (['comp', 'grade', 'paint'], 0)}, 'CloseButton_OK')
    assert publish() == ('sh_1', 'comp', False)
    person.answer('Publish', press='Escape')
    assert publish() is None


def test_keys_and_clicks_are_heard_as_those_of_a_user(person):
    dialog = make_dialog()
    heard = listen(dialog, 'Text', 'Toggle', 'Menu', 'Button')
    person.answer('Form', {'Text': 'new\n', 'Toggle': True, 'Menu': 'b'}, 'Button')
    person.answer('Form', {'Toggle': True, 'Menu': 1}, 'OK')  # as they are already
    assert dialog.launch() == 'CloseButton_OK'
    event = ui.EventType
    assert heard == [('Text', event.ACTIVATE), ('Text', event.VALUE_CHANGED), ('Toggle', event.STATE),
                     ('Toggle', event.ACTIVATE), ('Menu', event.VALUE_CHANGED), ('Menu', event.ACTIVATE),
                     ('Button', event.ACTIVATE)]


def test_a_dialog_that_a_callback_opens_is_answered_meanwhile(person):
    dialog = make_dialog()
    said = []
    dialog.addCallback('Button', ui.EventType.ACTIVATE,
                       lambda *_: said.append(ui.showMessageBox('Sure', ['Sure?'], ['Yes', 'No'])))
    person.answer('Form', do=lambda person: (person.press('Button'), said.append('back')))
    person.answer('Sure', press='No')
    person.answer('Form', press='OK')
    dialog.launch()
    assert said == ['No', 'back']


def test_what_is_seen_is_told_as_text_and_as_a_picture(person, tmp_path):
    dialog = make_dialog()
    dialog.enableWidget('Toggle', False)
    dialog.hideWidget('Menu')
    seen = []

    def look(person):
        seen.append(person.see())
        person.press('Tab')
        person.type('x')
        seen.append(person.see())
        person.picture(tmp_path / 'form.png')
        with pytest.raises(OSError, match='no/form.png'):
            person.picture(tmp_path / 'no/form.png')

    person.answer('Form', do=look, press='Cancel')
    dialog.launch()
    assert seen[0].splitlines() == ['Form', '  Caption: "old" (focused)', '  (Toggle): off (disabled)', '  [Button]',
                                    '  [Other]', '  note', '  [OK]', '  [Cancel]']
    assert '  Caption: "old"\n' in seen[1] and '  [Button] (focused)' in seen[1]
    assert (tmp_path / 'form.png').read_bytes().startswith(b'\x89PNG')
    assert person.see() == ''
    with pytest.raises(testing.Failure, match='No dialog takes input'):
        person.press('OK')


def test_far_rows_and_entries_are_scrolled_to(person):
    rows = [('TextField', 'field%d' % row, 'Field %d' % row) for row in range(300)]
    person.answer('Long', {'field299': 'z', 'Menu': 'entry 277', 'field0': 'a'}, 'OK')
    values = ui.showSimpleDialog('Long', [*rows, ('Menu', 'Menu', '', (['entry %d' % entry for entry in range(300)], 0))],
                                 400, False)
    assert (values['field299'], values['Menu'], values['field0']) == ('z', 'entry 277', 'a')


def test_what_stands_beside_the_widgets_is_known_at_once_after_a_run_that_failed(fail):
    class End(BaseException):
        pass

    def end(_):
        raise End

    for _ in range(3):
        assert isinstance(fail(do=end), End)
        assert '"shot" (Shot)' in str(fail(values={'shto': ''}))


class Thief(QObject):
    """Takes the keyboard's focus from a button that is pressed, as the late news of a popup does; once."""

    def eventFilter(self, button, event):
        if event.type() == QEvent.Type.MouseButtonPress:
            button.removeEventFilter(self)
            focusOut = QFocusEvent(QEvent.Type.FocusOut, Qt.FocusReason.ActiveWindowFocusReason)
            QTimer.singleShot(0, lambda: QApplication.sendEvent(button, focusOut))
        return False


def test_a_press_that_the_window_system_takes_away_is_repeated(person):
    thief = Thief()
    person.answer('Publish', {'shot': 'a'}, 'OK',
                  do=lambda _: stage.active().findChild(QWidget, 'CloseButton_OK').installEventFilter(thief))
    assert show()['CloseButtonClicked'] == 'CloseButton_OK'


def cover(person):
    dialog = stage.active()
    field = dialog.findChild(QWidget, 'shot')
    other = QWidget(field.parentWidget(), objectName='veil')
    other.setGeometry(field.geometry())
    other.show()
    person.fill({'shot': 'x'})


@pytest.mark.parametrize('answer, words', [
    ({'values': {'shto': ''}}, 'no widget "shto". There are: "shot" (Shot), "step" (Step), "farm" (On the farm).'),
    ({'values': {'step': 'cmp'}}, 'no entry "cmp". There are: "comp", "grade", "paint".'),
    ({'values': {'step': 3}}, 'no entry 3'),
    ({'values': {'step': (['a'], 0)}}, 'has other entries: "comp", "grade", "paint"'),
    ({'press': 'Okay'}, 'no button "Okay". There are: "more" (more), "CloseButton_OK" (OK)'),
    pytest.param({'do': cover}, '"shot" of the dialog "Publish" cannot be filled: it is covered by "veil"',
                 marks=scripts.needs_pyqt),
])
def test_what_a_user_cannot_do_fails_at_once_and_says_what_is_there(fail, answer, words):
    failure = fail(deadline=60, **answer)
    assert isinstance(failure, testing.Failure) and words in str(failure)
    picture = str(failure).splitlines()[-1].split(': ')[1]
    assert os.path.basename(picture) == 'Publish.png' and os.path.getsize(picture) > 0


@pytest.mark.parametrize('operation, arguments, word', [
    ('hideWidget', [], 'hidden'), ('enableWidget', [False], 'disabled'), ('setValue', ['x' * 100001], 'read-only')])
def test_widgets_that_take_no_input_are_not_touched(fail, operation, arguments, word):
    dialog = make_dialog('Publish')
    getattr(dialog, operation)('Text', *arguments)
    before = dialog.getValue('Text')
    assert 'cannot be filled: it is ' + word in str(fail(dialog.launch, values={'Text': 'x'}))
    assert dialog.getValue('Text') == before


def test_a_wrong_value_and_an_exception_of_the_test_come_out_of_the_dialog_with_their_traceback(fail):
    assert isinstance(fail(values={'shot': 5}), TypeError)
    raised = KeyError('mine')

    def break_off(person):
        raise raised

    assert fail(do=break_off) is raised
    names = [frame.name for frame in traceback.extract_tb(raised.__traceback__)]
    assert names.index('show') < names.index('break_off')


def test_a_dialog_that_nobody_answers_fails_with_what_it_shows_and_what_was_expected(fail):
    words = str(fail(deadline=1))  # the keyboard can come late
    assert 'The dialog "Publish" is open, and nobody answers it. It shows:\nPublish\n  Shot: "" (focused)\n' in words
    assert 'Expected next: no dialog.' in words
    assert 'Expected next: "Publish", which says "must".' in str(fail(says='must'))

    words = str(fail(print, values={'Path': '/'}, says='Which?'))
    assert words == 'Expected, and never came: "Publish", which says "Which?", to fill in "Path".'


def test_a_script_that_catches_everything_and_asks_again_comes_to_an_end(fail):
    def shrug():
        with contextlib.suppress(Exception):
            show()

    def insist():
        while True:
            shrug()

    for act in insist, shrug:
        assert 'nobody answers' in str(fail(act))


@scripts.needs_pyqt
def test_a_dialog_that_the_script_runs_by_other_means_is_closed(fail):
    def show_foreign():
        dialog = QDialog()
        dialog.setWindowTitle('Theirs')
        assert dialog.exec() == QDialog.DialogCode.Rejected

    assert 'The dialog "Theirs" is open' in str(fail(show_foreign))


def test_afterwards_all_is_as_it_was(fail):
    before = sys.excepthook, signal.getsignal(signal.SIGINT), dict(os.environ)
    with testing.person() as person:
        with pytest.raises(RuntimeError, match='Another person'):
            testing.person().__enter__()
        person.answer('Publish', press='OK')
        show()
    assert (sys.excepthook, signal.getsignal(signal.SIGINT), dict(os.environ)) == before
    fail()
    with testing.person() as person:
        person.answer('Publish', press='Cancel')
        assert show()['CloseButtonClicked'] == 'CloseButton_Cancel'


@scripts.needs_pyqt
def test_nobody_acts_at_a_dialog_that_has_just_ended(fail):
    slow = QTimer()
    slow.timeout.connect(lambda: time.sleep(0.003))
    slow.start(1)
    for _ in range(5):
        assert fail(values={'shto': 'a'}).__context__ is None


@pytest.mark.inside
def test_the_browser_is_answered_in_the_same_words(person, tmp_path):
    (tmp_path / 'plates').mkdir()
    (tmp_path / 'notes.txt').touch()
    seen = []
    person.answer('Pick', {'Files': 'notes.txt'}, 'OK', do=lambda person: seen.append(person.see()))
    assert ui.showBrowser('Pick', str(tmp_path)).endswith('notes.txt')
    assert 'Files: "plates", "notes.txt"' in seen[0] and '[Cancel]' in seen[0]
    person.answer('Pick', {'Folder': str(tmp_path / 'plates')}, 'OK')
    assert ui.showBrowser('Pick', '/').endswith('/plates')


@pytest.mark.inside
def test_a_row_that_the_browser_does_not_have_fails_with_those_that_it_has(tmp_path):
    (tmp_path / 'notes.txt').touch()
    with pytest.raises(testing.Failure, match='Files: "notes.txt"'), testing.person(0.2, tmp_path) as person:
        person.answer('Pick', {'Files': 'missing'}, 'OK')
        ui.showBrowser('Pick', str(tmp_path))


TESTS = '''
from quorvane_velmora import ui
form = [('TextField', 'shot', 'Shot')]
def test_good(person):
    person.answer('Publish', {'shot': 'a'}, 'OK')
    assert ui.showSimpleDialog('Publish', form, 400)['shot'] == 'a'
def test_misspelt(person):
    person.answer('Publish', {'shto': 'a'}, 'OK')
    ui.showSimpleDialog('Publish', form, 400)
def test_never(person):
    person.answer('Publish', {'shot': 'a'}, 'OK')
def test_swallowed(person):
    try:
        person.answer('Publish', press='Okay')
        ui.showSimpleDialog('Publish', form, 400)
    except Exception:
        pass
def test_nothing_else_is_loaded():
    import sys
    assert not [name for name in sys.modules if name.startswith('PyQt')]
'''


@pytest.mark.standalone
def test_pytest_has_the_person_by_itself_and_no_binding_of_qt_is_needed(tmp_path):
    tests = tmp_path / 'test_mine.py'
    tests.write_text(TESTS)
    done = subprocess.run([sys.executable, '-m', 'pytest', '-q', '-p', 'no:cacheprovider', str(tests)], cwd=tmp_path,
                          env=scripts.environment(), capture_output=True, text=True, timeout=120)
    assert '3 failed, 2 passed' in done.stdout and 'error' not in done.stdout, done.stdout
    for name in 'misspelt', 'never', 'swallowed':
        assert 'FAILED test_mine.py::test_%s' % name in done.stdout
    assert 'testing.py' not in done.stdout, 'the report shows the test, not its tools'


@pytest.mark.standalone
def test_its_library_is_loaded_by_it_alone():
    script = '''
import sys
from quorvane_velmora import ui
def is_loaded():
    with open('/proc/self/maps') as maps:
        return 'libKVinputDoor' in maps.read()
ui.makeXmlFromWidgetList([('PushButton', 'b')])
print(is_loaded())
from quorvane_velmora import testing
print(is_loaded())
'''
    assert scripts.run_script(script).split() == ['False', 'True']
