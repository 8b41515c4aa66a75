"""Scripts ask the user for a path, and the user walks through the files to it."""

import itertools
import os
from unittest.mock import Mock, call

import pytest

import stage
from quorvane_velmora import ui
from PyQt6.QtCore import Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QLabel, QLineEdit, QTreeView

pytestmark = pytest.mark.inside


@pytest.fixture
def files(tmp_path):
    """A folder with a folder and files in it, one of which has a name that is no text."""
    (tmp_path / 'sub').mkdir()
    for name in 'frame.0001.exr', 'frame.0002.exr', 'frame.0003.exr', 'notes.txt', '\udcff.txt':
        (tmp_path / name).touch()
    return str(tmp_path)


def rows(user):
    model = user.find('Browser.list', QTreeView).model()
    return [model.index(row, 0).data() for row in range(model.rowCount())]


def read(user):
    """The listing, once it is there."""
    while not rows(user):
        QApplication.processEvents()
    return rows(user)


def browse(user, *steps, title='Pick', **keywords):
    user.plan(read, *steps)
    return ui.showBrowser(title, **keywords)


def ok(user):
    user.click('OK')


def cancel(user):
    user.click('Cancel')


def enter(text):
    def typed(user):
        user.press(Qt.Key.Key_L, Qt.KeyboardModifier.ControlModifier)
        user.type(text)
    return typed


def pick(text, then=None):
    """Types ahead in the list."""
    def picked(user):
        read(user)
        user.type(text)
        if then:
            user.press(then)
    return picked


def last(user):
    """Selects the file at the end, whose name cannot be typed."""
    read(user)
    user.find('Browser.list').setFocus()
    user.press(Qt.Key.Key_End)


def test_it_floats_with_its_title_shows_sequences_as_one_and_has_the_keyboard_in_the_list(user, files):
    def look(user):
        assert (user.title(), user.focus()) == ('A <title>', 'Browser.list')
        assert rows(user) == ['sub', 'frame.####.exr  1-3', 'notes.txt', '\ufffd.txt']

    assert browse(user, look, ok, title='A <title>', initialPath=files) == files


@pytest.mark.parametrize('steps, path', [
    ([ok], ''), ([pick('notes'), ok], 'notes.txt'), ([pick('frame', Qt.Key.Key_Return)], 'frame.0001.exr'),
    ([last, ok], '\udcff.txt'), ([pick('sub'), ok], 'sub'), ([pick('sub', Qt.Key.Key_Return), ok], 'sub'),
    ([enter('notes.txt'), ok], 'notes.txt'), ([enter('sub'), ok], 'sub'),
])
def test_ok_gives_what_is_in_focus_else_the_directory(user, files, steps, path):
    assert browse(user, *steps, initialPath=files) == os.path.join(files, path).rstrip('/')


def test_it_begins_at_the_path_if_there_is_one_else_at_the_root(user, files):
    assert browse(user, ok, initialPath=files + '/frame.0002.exr') == files + '/frame.0002.exr'
    assert browse(user, ok, initialPath=files + '/nothing') == '/'
    assert browse(user, ok) == '/'


@pytest.mark.parametrize('end', [cancel, lambda user: user.press(Qt.Key.Key_Escape)])
def test_cancel_gives_nothing_and_asks_nobody(user, files, end):
    refuse = Mock(return_value='')
    assert browse(user, pick('notes'), end, initialPath=files, pathValidationCb=refuse) == '' and not refuse.called
    assert browse(user, ok, end, initialPath=files, pathValidationCb=refuse) == '' and refuse.call_count == 1


def test_a_path_that_is_refused_keeps_it_open_and_one_that_is_given_comes_back_as_it_is(user, files):
    validate = Mock(side_effect=['', '/no/such \udcff'])
    assert browse(user, ok, last, ok, initialPath=files, pathValidationCb=validate) == '/no/such \udcff'
    assert validate.mock_calls == [call('', files), call(files + '/\udcff.txt', files)]
    assert all(browse(user, ok, initialPath=files, pathValidationCb=no) == files for no in (5, 'text'))


def test_the_last_of_very_many_files_is_picked_with_keys(user, tmp_path):
    for letters in itertools.product('abcdefghij', repeat=4):
        (tmp_path / ''.join(letters)).touch()

    def count(user):
        assert len(rows(user)) == 10000

    assert browse(user, count, last, ok, initialPath=str(tmp_path)) == str(tmp_path / 'jjjj')


def test_what_the_callback_does_wrong_comes_out_and_leaves_nothing_behind(user, files):
    with pytest.raises(KeyError, match='mine'):
        browse(user, ok, initialPath=files, pathValidationCb=Mock(side_effect=KeyError('mine')))
    for no_path in 5, None:
        with pytest.raises(TypeError):
            browse(user, ok, initialPath=files, pathValidationCb=lambda *_: no_path)
    assert user.window() is None and browse(user, ok, initialPath=files) == files


def test_a_callback_can_open_a_browser_and_a_dialog_of_its_own(user, files):
    def ask(*_):
        with user.meanwhile(lambda inner: inner.close()):
            ui.showMessageBox('Sure?', ['?'])
        with user.meanwhile(read, pick('notes', Qt.Key.Key_Return)):
            return ui.showBrowser('Inner', files)

    assert browse(user, ok, initialPath='/', pathValidationCb=ask) == files + '/notes.txt'


def test_the_keyboard_is_in_the_list_again_after_the_callback_has_asked(user, files):
    calls = []

    def refuse(focus, _):
        calls.append(os.path.basename(focus))
        with user.meanwhile(lambda inner: inner.press(Qt.Key.Key_Return)):
            ui.showMessageBox('Not that one', ['?'])
        return ''

    def press(key):
        def pressed(user):
            assert user.focus() == 'Browser.list'
            user.press(key)
        return pressed

    assert browse(user, pick('frame', Qt.Key.Key_Return), press(Qt.Key.Key_Down), press(Qt.Key.Key_Return),
                  press(Qt.Key.Key_Escape), initialPath=files, pathValidationCb=refuse) == ''
    assert calls == ['frame.0001.exr', 'notes.txt']


def test_what_the_callback_opens_is_seen_above_it_and_then_goes(user, files):
    seen = []

    def uppermost(user, name):
        widget, window = user.find(name), stage.APPLICATION
        return window.childAt(widget.mapTo(window, widget.rect().center())) is widget

    def look(inner):
        seen.append(uppermost(inner, 'CloseButton_OK'))
        inner.close()

    def ask(*_):
        with user.meanwhile(look):
            dialog.launch()
        return ''

    dialog = ui.createDialog('Why', ui.makeXmlFromWidgetList([('Label', 'Why', '', 'Not that one')]), 300, 84)
    browse(user, ok, lambda user: seen.append(uppermost(user, 'OK')), cancel, initialPath=files, pathValidationCb=ask)
    assert seen == [True, True]


def test_a_typed_path_that_leads_nowhere_is_told_and_given_to_nobody(user, files):
    told, validate = [], Mock(return_value='x')

    def look(user):
        told.append(user.find('Browser.message', QLabel).text().replace('\u200b', ''))
        told.append(user.find('Browser.path', QLineEdit).text())

    assert browse(user, enter('no/where'), ok, look, cancel, initialPath=files, pathValidationCb=validate) == ''
    assert told == ["There is no '%s/no/where'" % files, 'no/where'] and not validate.called


def test_the_path_of_a_file_to_be_written_is_typed_judged_and_typed_again(user, files):
    calls = []

    def validate(*paths):
        calls.append((*paths, ui.Workspace.getBrowserSelection()))
        return paths[0] if paths[0].endswith('.exr') else ''

    def correct(user):
        user.click('Browser.path')
        user.press(Qt.Key.Key_End)
        user.type('.exr')

    assert browse(user, pick('notes'), enter('sub/new'), ok, correct, ok, initialPath=files,
                  pathValidationCb=validate) == files + '/sub/new.exr'
    assert calls == [(files + '/sub/new', files, []), (files + '/sub/new.exr', files, [])]
    assert browse(user, enter('new'), ok, initialPath=files) == files + '/new'
    assert browse(user, enter('new'), last, ok, initialPath=files) == files + '/\udcff.txt'


def test_a_path_leads_where_the_system_says_it_does(user, files):
    os.makedirs(files + '/sub/deep/er')
    os.symlink(files + '/sub/deep', files + '/link')
    assert browse(user, ok, initialPath=files + '/link/..') == files + '/sub'
    assert browse(user, enter('link/../deep'), ok, initialPath=files) == files + '/sub/deep'
    assert browse(user, ok, initialPath=files + '/link') == files + '/link'


def test_the_workspace_knows_what_is_selected_in_it(user, files):
    seen = []

    def look(*_):
        seen.append(ui.Workspace.getBrowserSelection())
        return files

    def press_ok_by_key(user):
        user.find('OK').setFocus()
        user.press(Qt.Key.Key_Space)

    def click_twice(user):
        view = user.find('Browser.list', QTreeView)
        place = view.visualRect(view.currentIndex()).center()
        for click in QTest.mouseClick, QTest.mouseDClick:
            click(view.viewport(), Qt.MouseButton.LeftButton, Qt.KeyboardModifier.NoModifier, place)

    for how in ok, press_ok_by_key, click_twice, lambda user: user.press(Qt.Key.Key_Return):
        browse(user, pick('notes'), how, initialPath=files, pathValidationCb=look)
    assert seen == [[files + '/notes.txt']] * 4
    browse(user, lambda user: user.find('Browser.list').setFocus(), lambda user: look(), ok, initialPath=files)
    assert seen[4:] == [[]]


def test_the_workspace_knows_of_no_selection_where_a_field_has_the_keyboard(user, files):
    dialog = ui.createDialog('Form', ui.makeXmlFromWidgetList([('TextField', 'Text')]), 300, 200)
    seen = []
    dialog.addCallback('Text', ui.EventType.VALUE_CHANGED, lambda *_: seen.append(
        (user.focus(), ui.Workspace.getBrowserSelection())))

    def end_edit(user):
        user.type('typed')
        user.press(Qt.Key.Key_Return)

    user.run(dialog, end_edit)
    assert seen == [('Text', [])]
