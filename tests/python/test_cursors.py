"""A cursor is held for as long as an object lives; the names of what browsers show are there."""

import pytest

import scripts
from forms import make_dialog
from quorvane_velmora import ui
from PyQt6.QtCore import Qt
from PyQt6.QtWidgets import QApplication

pytestmark = pytest.mark.usefixtures('no_wait_is_endless')


def shown():
    """The cursor that stands over all widgets, as the user sees it; None where each has its own."""
    cursor = QApplication.overrideCursor()
    return cursor and cursor.shape()


def test_guards_hold_their_cursor_and_give_back_the_one_before_in_whatever_order_they_end(user):
    make_dialog()
    first = ui.CursorGuard('normal')
    outer = ui.CursorGuard('busy')
    assert shown() == Qt.CursorShape.WaitCursor
    inner = ui.CursorGuard('normal')
    assert shown() is None
    outer = None
    assert shown() is None
    inner = None
    assert shown() == Qt.CursorShape.WaitCursor
    first = None
    assert shown() is None and not (first or outer or inner)


@pytest.mark.parametrize('raises', [False, True])
def test_a_dialog_has_the_normal_cursor_and_the_guard_is_in_force_again_behind_it(user, raises):
    dialog = make_dialog()
    guard = ui.CursorGuard('busy')
    seen = []

    def look(*_):
        seen.append(shown())
        assert not raises

    dialog.addCallback('Button', ui.EventType.ACTIVATE, look)
    user.plan(lambda someone: someone.click('Button'))
    if raises:
        with pytest.raises(AssertionError):
            dialog.launch()
    else:
        user.plan(lambda someone: someone.close())
        dialog.launch()
    assert seen == [None] and shown() == Qt.CursorShape.WaitCursor
    del guard
    assert shown() is None


def test_an_unknown_cursor_is_refused_with_the_names_and_changes_nothing():
    with pytest.raises(RuntimeError, match='"nonsense".*"normal".*"busy"'):
        ui.CursorGuard('nonsense')
    for arguments in [(), (5,), ('busy', 'busy')]:
        with pytest.raises(TypeError):
            ui.CursorGuard(*arguments)
    assert shown() is None


@pytest.mark.standalone
def test_without_a_display_a_guard_is_harmless_and_loads_no_qt():
    assert scripts.run_script('''
from quorvane_velmora import ui
guard = ui.CursorGuard('busy')
del guard
print('libQt6' in open('/proc/self/maps').read())
''') == 'False\n'


def test_the_schemes_are_different_texts_of_a_class_without_instances():
    names = ['FILE_SYSTEM', 'GANTRY', 'TOOLS', 'VIEWS', 'PICK_LIST', 'BOOKMARKS']
    values = [getattr(ui.BrowserScheme, name) for name in names]
    assert all(type(value) is str and value for value in values) and len(set(values)) == 6
    with pytest.raises(RuntimeError):
        ui.BrowserScheme()
