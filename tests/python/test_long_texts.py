"""Texts that have no room: what is seen of them, and how the rest is read."""

import pytest

import stage
from descriptions import close_button, container, text, widget
from quorvane_velmora import ui
from user import close, look_at
from PyQt6.QtCore import QEvent, QPoint, QPointF, QRect, Qt
from PyQt6.QtGui import QContextMenuEvent, QFontMetrics, QHelpEvent, QMouseEvent
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import (QApplication, QLabel, QLineEdit, QMenu, QPushButton, QScrollBar, QStyle, QStyleOptionButton,
                             QToolTip, QWidget)

pytestmark = pytest.mark.usefixtures('no_wait_is_endless')

LINES = ['Traceback', '  in <b>render</b>, frame 7'] + ['    line %d of many' % line for line in range(40)]


def label(user):
    return user.window().findChild(QLabel, 'Msg')


def ask_for_tip(widget):
    """What the widget answers when the pointer rests on it."""
    place = QPoint(20, widget.height() // 2)
    QToolTip.hideText()
    while QToolTip.isVisible():
        QTest.qWait(10)
    QApplication.sendEvent(widget, QHelpEvent(QEvent.Type.ToolTip, place, widget.mapToGlobal(place)))
    return QToolTip.text()


def copy_from_menu(shown):
    QApplication.sendEvent(shown, QContextMenuEvent(QContextMenuEvent.Reason.Mouse, QPoint(5, 14),
                                                    shown.mapToGlobal(QPoint(5, 14))))
    menu = QApplication.activePopupWidget()
    assert isinstance(menu, QMenu)
    menu.actions()[0].trigger()
    menu.close()
    return QApplication.clipboard().text()


def seen_in_box(user, look, messages, buttons=()):
    """What `look` gives while a message box is open; it is then closed by its last button."""
    return look_at(user, lambda: ui.showMessageBox('Box', messages, list(buttons)), look,
                   lambda user: user.close((list(buttons) or ['OK'])[-1]))


def test_a_text_is_shown_from_the_top_and_whole_in_a_tooltip(user):
    def look(user):
        shown = label(user)
        room = shown.height() // QFontMetrics(shown.font()).lineSpacing()
        return room, shown.grab(QRect(0, 0, 90, shown.height())).toImage(), ask_for_tip(shown)

    count, picture, tip = seen_in_box(user, look, ['\n'.join(LINES)])
    assert tip.split('\n')[:12] == LINES[:12]
    _, expected, no_tip = seen_in_box(user, look, ['\n'.join(LINES[:count]) + '…'])
    assert picture == expected and no_tip == ''


@pytest.mark.parametrize('words', ['word ' * 1000, 'x' * 5000], ids=['words', 'one word'])
def test_a_tooltip_has_no_endless_line(user, words):
    dialog = ui.createDialog('t', container('c', widget('Label', 'Msg', content=text(words)), close_button('OK', *TOP)))
    tip = look_at(user, dialog.launch, lambda user: ask_for_tip(label(user)))
    screen = QApplication.primaryScreen().availableSize()
    size = QFontMetrics(QToolTip.font()).size(0, tip)
    assert size.width() < screen.width() and size.height() < screen.height() // 2
    assert tip.count('\n') > 3 and words.startswith(tip.split('\n')[0])


TOP = '0 u l', '-4 u t', '12 u w', '4 u h'


@pytest.mark.standalone
@pytest.mark.parametrize('messages, buttons, bars', [
    (['word ' * 1000, 'short'], [], []), (['x' * 5000], ['Yes', 'No'], []),
    (['Message %d of forty' % line for line in range(40)], [], [Qt.Orientation.Vertical]),
    (['Which?'], ['B%d' % button for button in range(20)], [Qt.Orientation.Horizontal]),
], ids=['words', 'one word', 'forty lines', 'twenty buttons'])
def test_what_the_screen_cuts_leaves_the_buttons_whole(user, messages, buttons, bars):
    def look(user):
        first = user.window().findChild(QPushButton)
        assert first.visibleRegion().boundingRect() == first.rect()
        return [bar.orientation() for bar in user.window().findChildren(QScrollBar) if bar.isVisible()]

    assert seen_in_box(user, look, messages, buttons) == bars


def test_a_label_of_a_button_begins_at_its_beginning_and_ends_in_an_ellipsis(user):
    words = 'Replace & render what has changed since the day before yesterday'

    def look(user):
        button = user.window().findChild(QPushButton)
        option = QStyleOptionButton()
        option.initFrom(button)
        room = button.style().subElementRect(QStyle.SubElement.SE_PushButtonContents, option, button)
        elided = QFontMetrics(button.font()).elidedText(words, Qt.TextElideMode.ElideRight, room.width())
        return elided, button.grab().toImage(), ask_for_tip(button)

    elided, picture, tip = seen_in_box(user, look, ['?'], [words, 'Cancel'])
    assert tip == words and elided.startswith('Replace')
    _, expected, no_tip = seen_in_box(user, look, ['?'], [elided, 'Cancel'])
    assert picture == expected and no_tip == ''


def test_a_text_is_selected_by_the_mouse_and_copied_and_a_click_takes_no_keyboard(user):
    left, none = Qt.MouseButton.LeftButton, Qt.MouseButton.NoButton

    def click_and_type(user):
        QTest.mouseMove(label(user), QPoint(5, 14))
        QTest.mouseClick(label(user), left, pos=QPoint(5, 14))
        assert user.focus() == 'Field'
        user.type('typed')
        user.press(Qt.Key.Key_Tab)
        assert user.focus() == 'CloseButton_OK'

    def select(user):
        shown = label(user)
        QTest.mouseMove(user.find('Field'))
        QTest.mouseMove(shown, QPoint(5, 14))

        def drag(kind, x, button, buttons):
            at = QPointF(x, 8)
            QApplication.sendEvent(shown, QMouseEvent(kind, at, QPointF(shown.mapToGlobal(at.toPoint())), button, buttons,
                                                      Qt.KeyboardModifier.NoModifier))

        drag(QEvent.Type.MouseButtonPress, 0, left, left)
        end = QFontMetrics(shown.font()).horizontalAdvance('A note') + 1
        drag(QEvent.Type.MouseMove, end, none, left)
        drag(QEvent.Type.MouseButtonRelease, end, left, none)
        user.press(Qt.Key.Key_C, Qt.KeyboardModifier.ControlModifier)
        copied.append(QApplication.clipboard().text())
        user.press(Qt.Key.Key_Tab)
        assert user.focus() != 'Msg'

    def copy_whole(user):
        copied.append(copy_from_menu(label(user)))

    copied = []
    user.plan(click_and_type, select, copy_whole, close)
    words = 'A note <i>that</i> & is not whole\non its row\nor the next\nor any'
    values = ui.showSimpleDialog('t', [('TextField', 'Field'), ('Label', 'Msg', '', words)], 300)
    assert values['Field'] == 'typed' and copied == ['A note', words]


def test_a_push_button_draws_its_text_where_it_is_told_to(user):
    def align(where):
        return '<LabelAlign><Align H="%s" V="Center"/></LabelAlign>' % where

    def row(name, bottom, more=''):
        return widget('PushButton', name, '0 u l', '%d u b' % bottom, '30 u w', '4 u h', content=text('Hi') + more)

    def ink(name):
        """The columns in which the text stands, in the middle of the button's height."""
        button = user.find(name, QPushButton)
        picture = button.grab().toImage()
        ground = picture.pixelColor(button.width() - 20, button.height() // 2).lightness()
        inked = [x for x in range(5, button.width() - 5) for y in range(7, button.height() - 7)
                 if abs(picture.pixelColor(x, y).lightness() - ground) > 60]
        return min(inked), max(inked)

    dialog = ui.createDialog('t', container('c', row('left', 0, align('Left')), row('center', 5, align('Center')),
                                            row('plain', 10), close_button('OK', *TOP)), 300, 200)
    user.plan(lambda user: user.find('CloseButton_OK').setFocus())
    left, center, plain = look_at(user, dialog.launch, lambda user: [ink(name) for name in ('left', 'center', 'plain')])
    assert left[1] < 30 and center == plain and abs(sum(center) - 210) <= 4


@pytest.mark.standalone
def test_nothing_in_a_title_is_a_sign_for_qt(user):
    title = look_at(user, lambda: ui.showMessageBox('take [*] & <b>', ['?']),
                    lambda user: user.window().windowHandle().title())
    assert title == 'take [*] & <b>' and not stage.dialogs()


# The characters that Qt gets of a text to draw, and of one in a row that never scrolls.
MOST, MOST_IN_ROW = 100000, 4096


def look_at_huge_texts(user):
    """The sizes of all texts that the native widgets have, by what they are; the title and the menu's apart."""
    window = user.window()
    inner = window.findChildren(QWidget)
    whole = [getattr(one, what)() for one in inner for what in ('toolTip', 'accessibleName', 'accessibleDescription')]
    whole += [one.text() for one in inner if hasattr(one, 'text') and one.objectName() != 'titleBar']
    return {MOST: whole, MOST_IN_ROW: [window.windowTitle(), user.find('Menu').itemText(0)]}


@pytest.mark.parametrize('letter', ['x', 'word ', '\u0301', '\U0001f600', '\u05d0', 'ab\n', '\t'])
def test_of_a_huge_text_qt_gets_a_part_and_the_script_has_the_whole(user, tmp_path, letter):
    huge = letter * (3 * MOST // len(letter))
    tips = tmp_path / 'tips.xml'
    tips.write_text('<Tooltips><Tooltip Widget="Field">%s</Tooltip></Tooltips>' % huge)
    dialog = ui.createDialog(huge, container('c', widget('Label', 'Msg', content=text(huge)), widget('TextField', 'Field'),
                                             widget('PushButton', 'Button', content=text(huge)), widget('Menu', 'Menu'),
                                             close_button('OK', *TOP)))
    dialog.setValues({'Field': huge, 'Menu': ([huge, 'other'], 0)})
    dialog.setWidgetResourceName('Field', str(tips))
    found, copied = look_at(user, dialog.launch, lambda user: (look_at_huge_texts(user), copy_from_menu(label(user))))
    for most, texts in found.items():
        # Emoji are two units for Qt; here they are one.
        sizes = [len(shown.encode('utf-16-le')) // 2 for shown in texts]
        assert max(sizes) in (most, most - 1)
        assert all(shown[:50] == huge[:50] and shown[-1] == '…' for shown, size in zip(texts, sizes) if size > 1000)
    assert copied == huge
    assert dialog.getValues() == {'Field': huge, 'Menu': huge, 'CloseButtonClicked': 'CloseButton_OK'}


def test_a_field_whose_text_is_too_long_is_looked_at_and_takes_no_edit(user):
    huge = 'x' * (MOST + 1)
    dialog = ui.createDialog('t', ui.makeXmlFromWidgetList([('TextField', 'Field'), ('TextField', 'Full')], ['OK']), 400, 150)
    dialog.setValues({'Field': huge, 'Full': huge[:MOST]})
    tips = []

    def edit(name):
        def step(user):
            field = user.find(name, QLineEdit)
            field.setFocus()
            field.selectAll()
            tips.append(ask_for_tip(field))
            user.press(Qt.Key.Key_Delete)
            user.type('typed')
            user.press(Qt.Key.Key_Z, Qt.KeyboardModifier.ControlModifier)
            user.press(Qt.Key.Key_Return)
        return step

    def paste(user):
        QApplication.clipboard().setText(huge + huge)
        user.find('Full').setFocus()
        user.press(Qt.Key.Key_V, Qt.KeyboardModifier.ControlModifier)

    user.plan(edit('Field'), lambda user: tips.append(dialog.getValue('Field') == huge),
              lambda user: dialog.setValue('Field', 'short'), edit('Field'), paste, close)
    dialog.launch()
    assert tips == ['A text of 100001 characters is too long to be edited here.', True, '']
    # What is pasted ends where nothing more would be shown.
    assert dialog.getValue('Field') == 'short' and dialog.getValue('Full') == huge[:MOST]
