"""What the application's window does for scripts: the log, the stop, what is remembered, and where the keyboard is."""

import subprocess
import sys
import textwrap

import pytest
from scripts import needs_pyqt

from test_application import COMPOSITION, PROGRAM, WATCHING, run, run_inside, write

pytestmark = [pytest.mark.standalone, needs_pyqt]

TOOLS = '''
import sys, time, stage, watching
from watching import QApplication, QTimer, trigger
from PyQt6.QtCore import Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import (QLabel, QLineEdit, QListWidget, QMenu, QPlainTextEdit, QToolButton, QTreeView, QTreeWidget,
                             QWidget)

window = stage.APPLICATION
log = window.findChild(QPlainTextEdit, 'log')
files = window.findChild(QTreeView, 'Browser.list')

def lines():
    stage.dialogs()  # lets the loop come around
    return log.toPlainText().splitlines()

def wait_for(what):
    end = time.monotonic() + 20
    while not what():
        assert time.monotonic() < end
        QTest.qWait(5)

def said():
    return window.findChild(QLabel, 'message').text()

def pick(name):
    """Goes to a row of the browser."""
    def find():
        rows = (files.model().index(row, 0) for row in range(files.model().rowCount()))
        return next((row for row in rows if row.data() == name), None)
    wait_for(find)
    files.setFocus()
    files.setCurrentIndex(find())

def recent():
    """The menu of recent scripts as it is now."""
    menu, = (one for one in window.findChildren(QMenu) if one.title().replace('&', '') == 'Recent Scripts')
    menu.aboutToShow.emit()
    return [one for one in menu.actions() if one.isEnabled() and not one.isSeparator()]

def recent_names():
    return [one.text().split()[1] for one in recent() if '.py' in one.text()]
'''


def run_with_tools(folder, script, *options, plan='', **changes):
    status, printed, errors = run_inside(folder, TOOLS + textwrap.dedent(script), *options, plan=plan, **changes)
    assert status == 0, errors
    return printed, errors


def test_the_log_shows_what_scripts_print_with_errors_told_apart_and_the_terminal_gets_it_too(tmp_path):
    printed, errors = run_with_tools(tmp_path, r'''
        import threading
        from forms import make_dialog, ui
        print('to the \x1b[1mterminal\x1b[0m')
        print('to the other', file=sys.stderr)
        sys.stdout.buffer.write('bytes \u00fc\n'.encode())
        print('half', end='', flush=True)
        print('amid', file=sys.stderr)
        print('10 %', end='\r')
        print('20 %')
        thread = threading.Thread(target=print, args=['in a thread'])
        thread.start()
        thread.join()
        dialog = make_dialog()
        dialog.addCallback('Button', ui.EventType.ACTIVATE, lambda *_: print('in a callback') or 1 / 0)
        stage.dialogs()[0].findChild(QWidget, 'Button').click()
        shown = lines()
        assert shown[:8] == ['script.py is running', 'to the terminal', 'to the other', 'bytes \u00fc', 'half', 'amid',
                             '20 %', 'in a thread'], shown
        assert shown[8] == 'in a callback' and shown[-1].startswith('ZeroDivisionError')

        def colour_of(line):
            cursor = log.textCursor()
            cursor.setPosition(log.document().findBlockByNumber(line).position() + 1)
            return cursor.charFormat().foreground().color().name()

        assert colour_of(2) == colour_of(5) == colour_of(len(shown) - 1)
        assert len({colour_of(0), colour_of(1), colour_of(2)}) == 3
        ''', '--exit')
    assert printed == ['to the \x1b[1mterminal\x1b[0m', 'bytes \u00fc', 'half10 %', '20 %', 'in a thread',
                       'in a callback']
    assert errors.startswith('to the other\namid\nTraceback') and 'ZeroDivisionError' in errors


STREAMS = r'''
import io, os, subprocess, sys
for stream in sys.stdout, sys.stderr:
    print(isinstance(stream, io.TextIOWrapper), stream, stream.name, stream.mode, stream.encoding, stream.errors,
          stream.line_buffering, stream.newlines, stream.fileno(), stream.isatty(), stream.closed, stream.writable(),
          isinstance(stream.buffer, io.BufferedWriter), stream.buffer.fileno())
print(sys.__stdout__ is sys.stdout, sys.__stderr__ is sys.stderr)
sys.stdout.flush()
subprocess.run(['echo', 'a child'])
print('not flushed')
os.write(1, b'ahead where there is a buffer\n')
sys.stdout.flush()
sys.stdout.buffer.write(b'bytes\n')
sys.stdout.reconfigure(line_buffering=True)
sys.stdout.writelines(['gr\u00fcn', '\n'])
for wrong in 'text', None:
    try:
        sys.stdout.buffer.write(wrong)
    except TypeError as error:
        print(error)
'''


@pytest.mark.parametrize('changes, line', [
    ({}, 'gr\u00fcn'), ({'PYTHONIOENCODING': 'latin-1'}, 'gr\u00fcn'), ({'PYTHONUNBUFFERED': '1'}, 'gr\u00fcn'),
    ({'PYTHONIOENCODING': 'ascii:backslashreplace'}, 'gr\\xfcn'),
], ids=str)
def test_the_streams_remain_what_scripts_expect_in_every_encoding(tmp_path, changes, line):
    write(tmp_path, streams=STREAMS)
    assert run(tmp_path, PROGRAM, '--exit', 'streams.py', **changes) == run(tmp_path, sys.executable, 'streams.py',
                                                                            **changes)
    run_with_tools(tmp_path, "print('gr\u00fcn')\nassert %r in lines()" % line, '--exit', **changes)


def test_much_output_is_quick_and_bounded_and_the_log_follows_it_unless_the_user_looks_at_something(tmp_path):
    printed, _ = run_with_tools(tmp_path, '''
        bar = log.verticalScrollBar()
        began = time.monotonic()
        for number in range(100000):
            print('line', number)
        assert lines()[-1] == 'line 99999' and time.monotonic() - began < 10
        assert log.blockCount() == 10000 and bar.value() == bar.maximum()

        def top():
            return log.cursorForPosition(log.viewport().rect().topLeft()).block().text()

        bar.setValue(5000)
        looked_at = top()
        for number in range(3000):
            print('more')
        assert lines()[-1] == 'more' and top() == looked_at != ''
        bar.setValue(bar.maximum())
        print('x' * 100000)
        assert [len(line) for line in lines()[-25:]] == [4000] * 25 and bar.value() == bar.maximum()
        ''', '--exit')
    assert len(printed) == 103001


def test_what_a_busy_script_prints_is_seen_at_once(tmp_path):
    run_with_tools(tmp_path, '''
        QTest.qWait(100)
        end = time.monotonic() + 20
        while 'at once' not in log.toPlainText():
            assert time.monotonic() < end
            print('at once')
        ''', '--exit')


def test_the_log_is_searched_copied_and_cleared_by_keys_and_buttons(tmp_path):
    run_with_tools(tmp_path, '''
        print('alpha', 'beta', 'Alphabet', 'gamma', sep='\\n')
        field = window.findChild(QLineEdit, 'logSearch')
        lines()
        files.setFocus()
        QTest.keyClick(window, Qt.Key.Key_F, Qt.KeyboardModifier.ControlModifier)
        assert QApplication.focusWidget() is field
        QTest.keyClicks(field, 'alpha')
        def place():
            return log.textCursor().selectedText(), log.textCursor().blockNumber()
        places = [place()]
        none, shift = Qt.KeyboardModifier.NoModifier, Qt.KeyboardModifier.ShiftModifier
        for modifier in none, none, shift:
            QTest.keyClick(field, Qt.Key.Key_Return, modifier)
            places.append(place())
        assert places == [('alpha', 1), ('Alpha', 3), ('alpha', 1), ('Alpha', 3)], places
        assert any(one.text() == '2 found' for one in window.findChildren(QLabel))
        buttons = {one.text(): one for one in window.findChildren(QToolButton)}
        def press(label):
            QTest.mouseClick(buttons[label], Qt.MouseButton.LeftButton)
            return QApplication.clipboard().text()
        assert press('Copy') == 'Alpha'
        QTest.keyClicks(field, 'none')
        assert any(one.text() == 'nothing found' for one in window.findChildren(QLabel))
        cursor = log.textCursor()
        cursor.clearSelection()
        log.setTextCursor(cursor)
        assert press('Copy').splitlines() == ['script.py is running', 'alpha', 'beta', 'Alphabet', 'gamma']
        press('Clear')
        assert lines() == []
        print('new')
        assert lines() == ['new']
        QTest.keyClick(window, Qt.Key.Key_L, Qt.KeyboardModifier.AltModifier)
        assert QApplication.focusWidget() is log
        ''', '--exit')


def test_a_script_is_stopped_by_a_key_while_its_dialog_runs_and_no_other_command_can_be_used(desk, tmp_path):
    write(tmp_path, watching=WATCHING + textwrap.dedent('''
        plan += [(1, 'script.py was stopped', run_again), (2, 'script.py has ended', stage.APPLICATION.close)]
        '''), script=TOOLS + textwrap.dedent('''
        from forms import make_dialog, ui

        def can_be_used(action):
            menus = [one for one in action.associatedObjects() if isinstance(one, QMenu)]
            return action.isEnabled() and not action.menu() and any(one.menuAction().isEnabled() for one in menus)

        def look():
            usable = [one.text() for one in window.findChildren(watching.QAction) if one.text() and can_be_used(one)]
            print(usable, flush=True)

        watching.runs += 1
        if watching.runs == 1:
            QTimer.singleShot(50, look)
            make_dialog().launch()
        print('second', flush=True)
        '''))
    application = desk.start(PROGRAM, 'script.py', cwd=tmp_path, stderr=subprocess.PIPE)
    assert application.stdout.readline() == "['&Stop Script']\n"
    desk.wait_for_window('Velmora')
    desk.run('key', 'ctrl+period')
    printed, errors = application.communicate()
    assert printed == 'second\n' and errors.endswith('KeyboardInterrupt\n') and application.returncode == 0


def test_a_script_that_keeps_the_window_from_answering_is_stopped_in_a_window_of_its_own(desk, tmp_path):
    write(tmp_path, watching=WATCHING + textwrap.dedent('''
        def press():
            button, = (one for one in stage.APPLICATION.findChildren(QPushButton) if one.text() == 'Button')
            button.click()
            print('over', flush=True)
            stage.APPLICATION.close()

        plan += [(1, 'was stopped', run_again), (2, 'was stopped', run_again), (3, 'has ended', press)]
        '''), script='''
        import time, watching
        from forms import make_dialog, ui

        def hang(*_):
            print('busy', flush=True)
            while watching.runs != 2:
                pass
            time.sleep(1000)

        watching.runs += 1
        if watching.runs < 3:
            hang()
        dialog = make_dialog()
        dialog.addCallback('Button', ui.EventType.ACTIVATE, hang)
        ''')
    application = desk.start(PROGRAM, 'script.py', cwd=tmp_path, stderr=subprocess.DEVNULL)
    for _ in range(3):
        assert application.stdout.readline() == 'busy\n'
        window = desk.find_window('Script Is Busy')
        desk.click_in(window, 350, 28)
        desk.wait_until_gone('Script Is Busy')
    assert application.communicate()[0] == 'over\n' and application.returncode == 0


def test_scripts_and_the_look_of_the_window_are_remembered_from_one_run_to_the_next(tmp_path):
    home = tmp_path / 'home'
    write(tmp_path, other='')

    def session(name, script, *options):
        """What a script prints that closes the window, unless that closes by itself."""
        end = '' if options else '\nQTimer.singleShot(0, window.close)\n'
        write(tmp_path, watching=WATCHING, **{name: TOOLS + textwrap.dedent(script) + end})
        status, printed, errors = run(tmp_path, PROGRAM, *options, name + '.py', XDG_CONFIG_HOME=str(home))
        assert status == 0, errors
        return printed.splitlines()

    session('alone', 'window.resize(900, 500)', '--exit')
    assert not home.exists()
    session('first', 'window.resize(900, 500); trigger("Show Log")')
    assert session('second', '''
        print(window.width(), window.height(), log.isVisible())
        print(recent_names())
        trigger('Show Log')
        ''') == ['900 500 False', "['second.py', 'first.py']"]
    (tmp_path / 'first.py').unlink()
    assert session('gone', '''
        assert log.isVisible()
        def choose(label):
            next(one for one in recent() if label in one.text()).trigger()
        choose('first.py')
        print(said().endswith('first.py is not there any more'), recent_names())
        choose('Clear')
        print(recent_names(), recent())
        ''') == ["True ['gone.py', 'second.py']", '[] []']
    settings, = home.rglob('*.ini')
    settings.write_bytes(b'[General\n\xff=\x00@ByteArray(\nwindow=@Variant(\0\0)\nscripts=@Invalid()\nrows=7\n')
    assert session('broken', '''
        print(window.isVisible() and window.width() > 500 and log.height() > 50)
        print(recent_names())
        ''') == ['True', "['broken.py']"]


def test_enter_and_a_double_click_in_the_browser_do_what_the_entry_is_for(tmp_path):
    (tmp_path / 'folder').mkdir()
    (tmp_path / 'shot.vmcomposition').write_text(COMPOSITION)
    (tmp_path / 'notes.txt').write_text('')
    write(tmp_path, step01='print("step 1")', step02='import sys; print("step 2"); sys.argv[1:] and print(sys.argv)')
    printed, _ = run_with_tools(tmp_path, '''
        import os
        def enter(name):
            pick(name)
            QTest.keyClick(files, Qt.Key.Key_Return)

        def click(name):
            pick(name)
            place = files.visualRect(files.currentIndex()).center()
            for act in QTest.mouseClick, QTest.mouseDClick:
                act(files.viewport(), Qt.MouseButton.LeftButton, Qt.KeyboardModifier.NoModifier, place)

        def use():
            for act in enter, click:
                for name in 'step02.py', 'step01.py':
                    act(name)
                    wait_for(lambda: said() == name + ' has ended')
                act('notes.txt')
                wait_for(lambda: said() == 'notes.txt is neither a composition nor a script')
                act('folder')
                wait_for(lambda: window.findChild(QLineEdit, 'Browser.path').text() == os.getcwd() + '/folder')
                QTest.keyClick(files, Qt.Key.Key_Backspace)
            enter('shot.vmcomposition')
            wait_for(lambda: window.findChild(QListWidget, 'compositions').count() == 1)
            print(window.windowTitle()[:4])
            window.close()

        QTimer.singleShot(0, use)
        ''')
    assert printed == ['step 2', 'step 1'] * 2 + ['shot']


def test_a_key_leads_to_each_pane_and_only_the_one_that_has_the_keyboard_has_a_bright_selection(tmp_path):
    for name in 'one', 'two':
        (tmp_path / (name + '.vmcomposition')).write_text(COMPOSITION)
    printed, _ = run_with_tools(tmp_path, '''
        from forms import make_dialog
        nodes = window.findChild(QTreeWidget, 'nodes')
        compositions = window.findChild(QListWidget, 'compositions')
        dialog = make_dialog()
        text = stage.dialogs()[0].findChild(QLineEdit, 'Text')
        text.setFocus()
        pick('one.vmcomposition')
        nodes.setCurrentItem(nodes.topLevelItem(0))
        log.selectAll()
        panes = {Qt.Key.Key_B: files, Qt.Key.Key_P: compositions, Qt.Key.Key_N: nodes, Qt.Key.Key_L: log}
        bright = window.palette().color(window.palette().ColorGroup.Active, window.palette().ColorRole.Highlight).rgb()

        def count(pane):
            image = pane.grab().toImage()
            return sum(image.pixel(x, y) == bright for x in range(image.width()) for y in range(0, image.height(), 3))

        for key, pane in panes.items():
            QTest.keyClick(window, key, Qt.KeyboardModifier.AltModifier)
            assert QApplication.focusWidget() is pane, pane.objectName()
            print(*(one.objectName() for one in panes.values() if count(one) > 0))
        QTest.keyClick(window, Qt.Key.Key_D, Qt.KeyboardModifier.AltModifier)
        assert QApplication.focusWidget() is text
        assert not any(count(one) for one in panes.values())
        ''', '--open', 'one.vmcomposition', '--open', 'two.vmcomposition', '--exit')
    assert printed == ['Browser.list', 'compositions', 'nodes', 'log']


def test_cells_show_a_part_of_a_huge_text(tmp_path):
    (tmp_path / 'huge.vmcomposition').write_text(
        '<composition version="1"><node name="%s" type="T"><value name="v" text="%s"/></node></composition>'
        % ('n' * 5000, 'v' * 1000000))
    printed, _ = run_with_tools(tmp_path, '''
        node = window.findChild(QTreeWidget, 'nodes').topLevelItem(0)
        for cell in node.text(0), node.child(0).text(1):
            print(len(cell), cell[-2:])
        ''', '--open', 'huge.vmcomposition', '--exit')
    assert printed == ['4097 n…', '4097 v…']
