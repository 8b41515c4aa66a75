"""Dialogs on the screen: where they stand, how they open and close, and what the keyboard does."""

import gc
import os
import tempfile
from concurrent.futures import ThreadPoolExecutor

import pytest

import stage
from forms import make_dialog
from descriptions import close_button, container, text, widget
from quorvane_velmora import ui
from scripts import run_script
from user import click, close, look_at
from PyQt6 import sip
from PyQt6.QtCore import QRect, Qt
from PyQt6.QtGui import QFontMetrics, QGuiApplication, QTextLayout
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QLabel, QScrollBar, QWidget

FORM = [('TextField', 'Show', 'Show'), ('ToggleButton', 'Win', 'Win'), ('Menu', 'Prize', 'Prize', (['a', 'b'], 0)),
        ('PushButton', 'Vote'), ('Label', 'Hint', '', 'hint')]


def make(*close_buttons, widgets=FORM, width=400, height=196):
    return ui.createDialog('Launched', ui.makeXmlFromWidgetList(widgets, list(close_buttons)), width, height)


def launch(user, dialog, look):
    return look_at(user, dialog.launch, look, lambda user: user.dismiss())


@pytest.mark.standalone
@pytest.mark.parametrize('size, content', [
    ({'width': 400, 'height': 300}, (400, 300)), ({'width': 401, 'height': 301}, (401, 301)), ({}, (640, 640)),
    ({'width': 400}, (400, 640)), ({'width': -1, 'height': 300}, (640, 300)), ({'width': 0, 'height': 0}, (640, 640)),
    ({'width': 1, 'height': 1}, (1, 1)),
])
def test_a_window_is_centred_by_its_content_and_has_24_pixels_more(user, size, content):
    dialog = ui.createDialog('t', container('c', close_button('OK')), **size)
    frame = launch(user, dialog, lambda user: user.window().geometry())
    screen = QGuiApplication.primaryScreen().size()
    assert (screen.width(), screen.height()) == (800, 800)
    width, height = content
    bottom = (800 - height) // 2
    assert frame == QRect((800 - width) // 2, 800 - bottom - height - 24, width, height + 24)


@pytest.mark.standalone
def test_a_window_is_cut_to_the_screen_bears_its_title_and_keeps_the_others_from_input(user):
    def look(user):
        window = user.window()
        assert window.windowTitle() == window.objectName() == 'Launched'
        assert window.windowModality() == Qt.WindowModality.ApplicationModal
        return window.size()

    size = launch(user, make('OK', width=5000, height=4000), look)
    assert size.width() == 800
    assert 700 < size.height() < 800, 'there is room for a title bar'


def test_a_window_has_an_icon_down_to_the_size_of_a_title_bar(user):
    icon = launch(user, make('OK', 'Cancel'), lambda user: user.window().window().windowIcon())
    assert {16, 32, 256} <= {size.width() for size in icon.availableSizes()}
    picture = icon.pixmap(16, 16).toImage()
    ground, sign = picture.pixelColor(8, 2), picture.pixelColor(4, 4)
    assert picture.width() == 16 and ground.alpha() == sign.alpha() == 255 and sign.lightness() > ground.lightness() + 60


@pytest.mark.standalone
def test_in_an_application_of_the_scripts_a_dialog_has_our_icon_or_its():
    assert run_script('''
from PyQt6.QtCore import QTimer
from PyQt6.QtGui import QIcon, QPixmap
from PyQt6.QtWidgets import QApplication, QWidget
application = QApplication([])
from quorvane_velmora import ui
def look():
    window = QApplication.activeModalWidget()
    print(len(window.windowIcon().availableSizes()), application.windowIcon().isNull())
    window.close()
for icon in QIcon(), QIcon(QPixmap(7, 7)):
    application.setWindowIcon(icon)
    QTimer.singleShot(0, look)
    ui.showMessageBox('Box', ['text'])
''', QT_QPA_PLATFORM='offscreen') == '7 True\n1 False\n'


def test_an_emoji_is_drawn_by_a_font_that_has_it(user):
    def glyphs(user):
        label = user.find('Hint', QLabel)
        layout = QTextLayout(label.text(), label.font())
        layout.beginLayout()
        layout.createLine()
        layout.endLayout()
        return [glyph for run in layout.glyphRuns() for glyph in run.glyphIndexes()]

    # Of the second one the fonts for letters have a sign too.
    found = launch(user, make('OK', widgets=[('Label', 'Hint', '', '\U0001f3ac\U0001f600')]), glyphs)
    assert len(found) == 2 and all(found)


@pytest.mark.parametrize('lines, buttons, width, height', [
    ([], [], 14, 56), ([], ['OK', 'Cancel'], 28, 56), (['a', '', 'c'], [], 14, 140), ([], ['A', 'B', 'C'], 42, 56),
])
def test_a_message_box_is_as_large_as_its_buttons_and_lines(user, lines, buttons, width, height):
    frames = []
    user.plan(lambda user: frames.append(user.window().size()), lambda user: user.close((buttons or ['OK'])[-1]))
    assert ui.showMessageBox('Box', lines, buttons) == buttons[-1]
    assert [(frame.width(), frame.height()) for frame in frames] == [(7 * width, height + stage.TITLE_HEIGHT)]


@pytest.mark.parametrize('line', ['W' * 30, 'i' * 61, 'fj' * 20, 'é𝄞ñ' * 9, '\ttab\tbed\t out',
                                  'two\nlines of which this one is the longer'])
def test_the_longest_line_of_a_message_box_is_whole(user, line):
    def look(user):
        label = next(label for label in user.window().findChildren(QLabel) if label.text() == line)
        assert label.sizeHint().width() <= label.width()
        assert QFontMetrics(label.font()).size(Qt.TextFlag.TextExpandTabs, line).width() <= label.width()
        assert user.window().width() - label.width() <= 14 + 6 + 7
        assert label.visibleRegion().boundingRect().width() == label.width()

    look_at(user, lambda: ui.showMessageBox('Box', ['short', line]), look)


CONTROLS = {'\x1b[31mred\x1b[0m': '␛[31mred␛[0m', 'a\0' + 'b' * 60: 'a␀' + 'b' * 60, '\x01\b\f\x1f\x7f': '␁␈␌␟␡',
            '10%\r20%\r\ndone\r': '10%␍20%\r\ndone\r', '\ttab\nline': '\ttab\nline', '\xa0é\x85': '\xa0é\x85'}


def test_a_message_box_shows_control_characters_as_signs_of_their_own(user):
    def look(user):
        labels = [label for label in user.window().findChildren(QLabel) if label.objectName() == 'Msg']
        assert [label.text() for label in labels] == list(CONTROLS.values())
        assert max(label.sizeHint().width() for label in labels) <= labels[0].width()

    look_at(user, lambda: ui.showMessageBox('Output', list(CONTROLS)), look)


@pytest.mark.parametrize('tail', [b'', b'\0<what stands here is not read'])
def test_a_description_is_read_from_a_file_up_to_its_first_nul(user, tmp_path, tail):
    path = tmp_path / 'façade.xml'
    path.write_bytes(ui.makeXmlFromWidgetList([('TextField', 'a')]).encode() + tail)
    user.plan(close)
    assert ui.showDialog('t', str(path), 300, 100, {'a': 'x'}) == {'a': 'x', 'CloseButtonClicked': 'CloseButton_OK'}


@pytest.mark.parametrize('make_path, failure, words', [
    (lambda folder: folder / 'missing', ui.UiError, '^Error opening file: {}$'),
    (lambda folder: folder / 'empty', RuntimeError, 'Null pointer'),
    (lambda folder: folder, RuntimeError, 'Null pointer|directory'),
    (lambda folder: folder / 'broken', RuntimeError, 'line 2'),
    (lambda folder: '', ui.UiError, '^Error opening file: $'),
], ids=['missing', 'empty', 'directory', 'broken', 'no name'])
def test_a_bad_file_is_an_error_and_the_next_one_works(user, tmp_path, make_path, failure, words):
    (tmp_path / 'empty').write_text('')
    (tmp_path / 'broken').write_text('<Container>\n<')
    (tmp_path / 'good').write_text(ui.makeXmlFromWidgetList([]))
    path = str(make_path(tmp_path))
    with pytest.raises(failure, match=words.format(path)) as caught:
        ui.showDialog('t', path)
    assert caught.type is failure and not stage.dialogs()
    user.plan(close)
    assert ui.showDialog('t', str(tmp_path / 'good')) == {'CloseButtonClicked': 'CloseButton_OK'}


def test_a_file_that_must_not_be_read_is_an_error_with_its_name():
    with tempfile.TemporaryDirectory() as folder:
        path = os.path.join(folder, 'closed.xml')
        with open(path, 'w') as file:
            file.write(ui.makeXmlFromWidgetList([]))
        os.chmod(folder, 0o755)
        os.chmod(path, 0)
        assert run_script('''
import os, sys
from quorvane_velmora import ui
if os.getuid() == 0:
    os.seteuid(65534)
assert os.path.exists(sys.argv[1])
try:
    ui.showDialog('t', sys.argv[1])
except ui.UiError as error:
    print(error)
os.seteuid(os.getuid())
''', path) == 'Error opening file: %s\n' % path


def escape(user):
    user.press(Qt.Key.Key_Escape)


def ask_to_close(user):
    user.ask_to_close()


@pytest.mark.parametrize('buttons, widgets, pressed', [
    (['OK', 'Cancel'], FORM, 'Cancel'), (['Cancel', 'A', 'B'], FORM, 'Cancel'), (['Yes', 'Cancel'], FORM[4:], 'Cancel'),
    (['Done'], FORM[4:], 'Done'), (['Done'], [], 'Done'),
])
def test_escape_and_the_window_manager_press_cancel_or_the_only_button_of_a_box(user, buttons, widgets, pressed):
    dialog = make(*buttons, widgets=widgets)
    for how in [escape] if stage.APPLICATION else [escape, ask_to_close]:
        user.plan(how)
        assert dialog.launch() == 'CloseButton_' + pressed


@pytest.mark.parametrize('widgets', [[widget] for widget in FORM[:3]], ids=lambda widgets: widgets[0][0])
@pytest.mark.parametrize('buttons', [['OK'], ['Yes', 'No']])
def test_escape_never_confirms_a_form_and_a_close_request_ends_it_without_a_button(user, buttons, widgets):
    dialog = make(*buttons, widgets=widgets)
    for hide in lambda: None, lambda: dialog.hideWidget(widgets[0][1]):
        hide()
        if not stage.APPLICATION:
            user.plan(escape, ask_to_close)
            assert dialog.launch() == '' and 'CloseButtonClicked' not in dialog.getValues()
    user.plan(escape, lambda user: user.close(buttons[0]))
    assert dialog.launch() == 'CloseButton_' + buttons[0]


def test_a_box_with_a_choice_waits_for_it(user):
    user.plan(escape, ask_to_close, escape, lambda user: user.close('No'))
    assert ui.showMessageBox('t', ['?'], ['Yes', 'No']) == 'No'


@pytest.mark.standalone
def test_a_box_with_a_choice_ends_with_the_application_and_one_without_a_button_by_a_close_request(user):
    user.plan(lambda user: QApplication.exit())
    with pytest.raises(IndexError):
        ui.showMessageBox('t', ['?'], ['Yes', 'No'])
    dialog = make('Yes', 'No', widgets=[])
    dialog.hideWidget('CloseButtonsContainer')
    user.plan(escape, ask_to_close)
    assert dialog.launch() == '' and not stage.dialogs()


def test_enter_in_a_text_field_closes_nothing_and_keeps_the_keyboard_there(user):
    user.plan(lambda user: (user.type('text'), user.press(Qt.Key.Key_Return), user.press(Qt.Key.Key_Enter)),
              lambda user: user.type('!'), lambda user: user.close('Cancel'))
    values = ui.showSimpleDialog('t', FORM, 400, True)
    assert values['Show'] == 'text!' and values['CloseButtonClicked'] == 'CloseButton_Cancel'


@pytest.mark.parametrize('key', [Qt.Key.Key_Space, Qt.Key.Key_Return])
def test_a_message_box_opens_with_its_first_button_under_the_keyboard(user, key):
    user.plan(lambda user: user.press(key))
    assert ui.showMessageBox('t', ['?'], ['Yes', 'No', 'Cancel']) == 'Yes'


def test_tab_goes_as_the_eye_does_and_past_what_takes_no_input(user):
    def walk(key):
        def step(user):
            for _ in range(6):
                stops.append(user.focus())
                user.press(key)
        return step

    stops = []
    dialog = make('OK', 'Cancel')
    user.plan(walk(Qt.Key.Key_Tab), walk(Qt.Key.Key_Backtab), close)
    dialog.launch()
    order = ['Show', 'Win', 'Prize', 'Vote', 'CloseButton_OK', 'CloseButton_Cancel']
    assert stops == order + order[:1] + order[:0:-1]
    dialog.enableWidget('Show', False)
    dialog.hideWidget('Prize')
    stops.clear()
    user.plan(walk(Qt.Key.Key_Tab), close)
    dialog.launch()
    assert stops == ['Win', 'Vote', 'CloseButton_OK', 'CloseButton_Cancel', 'Win', 'Vote']


def test_a_dialog_can_be_launched_again_with_what_was_left_in_it(user):
    dialog = make('OK', 'Cancel')
    user.plan(lambda user: user.type('kept'), close)
    assert dialog.launch() == 'CloseButton_OK' and not stage.dialogs()
    assert launch(user, dialog, lambda user: user.find('Show').text()) == 'kept'
    assert dialog.getValues()['Show'] == 'kept'


def test_only_push_buttons_named_for_it_close_a_dialog(user):
    toggle = widget('ToggleButton', 'CloseButton_X', '0 u l', '8 u b', '4 u w', '4 u h')
    named = widget('PushButton', 'CloseButton_', content=text('any label'))
    other = widget('PushButton', 'closeButton_Y', '0 u l', '4 u b', '9 u w', '4 u h')
    dialog = ui.createDialog('t', container('c', toggle, container('inner', named, other)))
    user.plan(click('CloseButton_X'), click('closeButton_Y'), lambda user: user.close(''))
    assert dialog.launch() == 'CloseButton_' and dialog.getValue('CloseButton_X') is True


def test_a_dialog_without_close_button_is_built_but_not_shown():
    dialog = ui.createDialog('t', container('c', widget('ToggleButton', 'CloseButton_X'), widget('PushButton', 'b')))
    for _ in range(2):
        with pytest.raises(ui.UiError) as caught:
            dialog.launch()
        assert str(caught.value) == 'Cannot close dialog: there must be at least one close button'
        assert stage.active() is None and dialog.getValues() == {'CloseButton_X': False}


@pytest.mark.standalone
def test_a_dialog_opened_from_a_timer_has_its_own_window_and_those_beneath_take_no_input(user):
    outer = make('OK', 'Cancel')
    answers = []

    def open_box(user):
        beneath = user.window()

        def try_beneath(user):
            assert user.window() is not beneath and user.window().windowTitle() == 'Nested' and beneath.isVisible()
            field, button = (beneath.findChild(QWidget, name) for name in ('Show', 'CloseButton_Cancel'))
            QTest.keyClicks(field, 'unheard')
            QTest.mouseClick(button, Qt.MouseButton.LeftButton)
            beneath.close()
            assert beneath.isVisible()

        with user.meanwhile(try_beneath, lambda user: user.close('No')):
            answers.append(ui.showMessageBox('Nested', ['?'], ['Yes', 'No']))

    user.plan(open_box, lambda user: user.find('Show').setFocus(), lambda user: user.type('heard'), close)
    assert outer.launch() == 'CloseButton_OK' and answers == ['No']
    assert outer.getValues()['Show'] == 'heard' and not stage.dialogs()


def enter(text):
    """Types into the field that has the keyboard, and ends the edit."""
    def typed(user):
        assert user.focus() == 'Text'
        user.type(text)
        user.press(Qt.Key.Key_Return)
    return typed


def press(key, focus):
    def pressed(user):
        assert user.focus() == focus
        user.press(key)
    return pressed


def ask(*_):
    assert ui.showMessageBox('Box', ['?'], ['Yes', 'No']) == 'No'


def run_inner(callback):
    inner = make_dialog('inner')
    inner.addCallback('Text', ui.EventType.VALUE_CHANGED, callback)
    return inner.launch()


def ask_from_another(*_):
    assert run_inner(ask) == 'CloseButton_Cancel'


def fail_in_another(*_):
    with pytest.raises(ZeroDivisionError):
        run_inner(lambda *_: 1 / 0)


ANSWER = [press(Qt.Key.Key_Tab, 'CloseButton_Yes'), press(Qt.Key.Key_Return, 'CloseButton_No')]


@pytest.mark.parametrize('interrupt, answer', [
    (ask, ANSWER), (ask_from_another, [enter('x'), *ANSWER, press(Qt.Key.Key_Escape, 'Text')]),
    (fail_in_another, [enter('x')]),
], ids=['box', 'nested', 'exception'])
def test_the_keyboard_is_after_a_box_where_it_was_before(patient, interrupt, answer):
    dialog = make_dialog()
    for name in 'Text', 'Menu':
        dialog.addCallback(name, ui.EventType.VALUE_CHANGED, interrupt)
    patient.plan(enter('a'), *answer, enter('b'), *answer, press(Qt.Key.Key_Tab, 'Text'),
                 press(Qt.Key.Key_Tab, 'Toggle'), press(Qt.Key.Key_Down, 'Menu'), *answer,
                 press(Qt.Key.Key_Up, 'Menu'), *answer, press(Qt.Key.Key_Down, 'Menu'), *answer,
                 press(Qt.Key.Key_Escape, 'Menu'))
    assert dialog.launch() == 'CloseButton_Cancel'
    assert (dialog.getValue('Text'), dialog.getValue('Menu')) == ('ab', 'b')


@pytest.mark.standalone
def test_a_form_taller_than_the_screen_can_be_scrolled_to_its_buttons(user):
    def reach(user):
        button = user.find('CloseButton_OK')
        assert user.window().height() <= 800 and button.visibleRegion().isEmpty()
        bar = next(bar for bar in user.window().findChildren(QScrollBar) if bar.isVisible())
        QTest.keyClick(bar, Qt.Key.Key_End)
        spot = button.mapTo(user.window(), button.rect().center())
        assert user.window().childAt(spot) is button

    def reach_by_key(user):
        user.find('row 0').setFocus()
        user.press(Qt.Key.Key_Backtab)
        assert user.focus() == 'CloseButton_OK' and not user.find('CloseButton_OK').visibleRegion().isEmpty()
        user.press(Qt.Key.Key_Space)

    def resize(user):
        window, size = user.window(), user.window().size()
        margin = 15
        for height, scrolls in (3000, False), (size.height(), True):
            window.resize(size.width(), height)
            bars = [bar for bar in window.findChildren(QScrollBar) if bar.isVisible()]
            assert [bar.orientation() for bar in bars] == [Qt.Orientation.Vertical] * scrolls
            field = user.find('row 0')
            end = field.mapTo(window, field.rect().topRight()).x()
            assert size.width() - sum(bar.width() for bar in bars) - end == margin

    user.plan(reach, resize, reach_by_key)
    values = ui.showSimpleDialog('t', [('TextField', 'row %d' % row, 'row') for row in range(100)], 300)
    assert values['CloseButtonClicked'] == 'CloseButton_OK' and len(values) == 101


@pytest.mark.parametrize('end', [
    pytest.param(lambda user: sip.delete(user.window()), id='delete'),
    pytest.param(lambda user: QApplication.quit(), id='quit', marks=pytest.mark.standalone),
    pytest.param(lambda user: QApplication.exit(3), id='exit', marks=pytest.mark.standalone)])
def test_a_run_ends_when_others_delete_what_runs_or_quit_and_the_next_one_works(user, end):
    dialog = make('OK')
    user.plan(end)
    assert dialog.launch() == '' and dialog.getValue('Show') == ''
    user.plan(close)
    assert ui.showMessageBox('after', ['it']) == 'OK'


def test_a_thread_gets_no_user_interface_of_its_own():
    printed = run_script('''
from concurrent.futures import ThreadPoolExecutor
from quorvane_velmora import ui
print(repr(ThreadPoolExecutor().submit(ui.showMessageBox, 't', ['x']).exception()))
''', QT_QPA_PLATFORM='offscreen')
    assert printed.startswith('RuntimeError')
    assert 'this is not the main thread' in printed or 'belongs to the thread that used it first' in printed


def failure_in_another_thread(action, *arguments):
    """What it fails with there, or None."""
    with ThreadPoolExecutor() as threads:
        return threads.submit(action, *arguments).exception()


@pytest.mark.parametrize('call', [
    lambda dialog: dialog.launch(), lambda dialog: dialog.getValues(), lambda dialog: dialog.setValue('Show', 'x'),
    lambda dialog: dialog.hideWidget('Show'), lambda dialog: make('OK').launch(),
    lambda dialog: ui.showMessageBox('t', ['x']),
])
def test_a_call_from_another_thread_is_an_error_and_does_no_harm(user, call):
    dialog = make('OK')
    failure = failure_in_another_thread(call, dialog)
    assert type(failure) is RuntimeError and 'thread' in str(failure)
    assert dialog.getValue('Show') == '' and stage.active() is None
    user.plan(close)
    assert dialog.launch() == 'CloseButton_OK'


def test_dialogs_can_be_dropped_on_another_thread(user):
    held = [make('OK'), make('OK')]
    user.plan(close)
    held[1].launch()
    assert failure_in_another_thread(held.clear) is None
    user.plan(close)
    assert make('OK').launch() == 'CloseButton_OK'
    gc.collect()  # what failures of other tests still hold
    assert [window.objectName() for window in QApplication.topLevelWidgets()].count('Launched') == 0


def test_a_long_dialog_that_is_launched_again_is_painted_again_and_follows_what_changes(user):
    rows = [('TextField', 'Row %d' % i, 'Row %d' % i, 'text') for i in range(120)]
    dialog = make('OK', widgets=rows, height=400)

    def look(user):
        # Without the first rows: a cursor blinks there.
        return user.window().grab(QRect(0, 100, 400, 300)).toImage()

    first = launch(user, dialog, look)
    assert launch(user, dialog, look) == first
    dialog.setValue('Row 8', 'other')
    assert launch(user, dialog, look) != first
