"""Dialogs inside the application: where they float, how they are moved, and what becomes of the rest meanwhile."""

import pytest

import stage
from forms import listen, make_dialog
from descriptions import close_button, container, widget
from quorvane_velmora import ui
from user import click, close, look_at
from PyQt6.QtCore import QEvent, QPoint, QPointF, QRect, Qt
from PyQt6.QtGui import QGuiApplication, QMouseEvent, QWheelEvent
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QFrame, QLabel, QScrollBar, QStyle, QTreeView, QWidget

pytestmark = [pytest.mark.inside, pytest.mark.usefixtures('no_wait_is_endless')]

PLAIN = container('c', close_button('OK'))


def panel():
    return stage.APPLICATION.findChild(QWidget, 'mainPanel')


class Pointer:
    """In the middle of a widget at first, which hears of it wherever it goes."""

    LEFT, NONE = Qt.MouseButton.LeftButton, Qt.MouseButton.NoButton

    def __init__(self, widget):
        self.widget = widget
        self.place = QPointF(widget.mapToGlobal(widget.rect().center()))

    def send(self, kind, button, buttons):
        local = QPointF(self.widget.mapFromGlobal(self.place.toPoint()))
        QApplication.sendEvent(self.widget, QMouseEvent(kind, local, self.place, button, buttons,
                                                        Qt.KeyboardModifier.NoModifier))

    def press(self):
        self.send(QEvent.Type.MouseButtonPress, self.LEFT, self.LEFT)

    def move(self, x, y, buttons=LEFT):
        self.place += QPointF(x, y)
        self.send(QEvent.Type.MouseMove, self.NONE, buttons)

    def release(self):
        self.send(QEvent.Type.MouseButtonRelease, self.LEFT, self.NONE)


def drag(widget, *moves):
    """Presses in the middle of a widget, moves by so many pixels, and lets go."""
    pointer = Pointer(widget)
    pointer.press()
    for move in moves:
        pointer.move(*move)
    pointer.release()
    pointer.move(0, 0, Pointer.NONE)


def bars(dialog):
    return {bar.orientation(): bar for bar in dialog.findChildren(QScrollBar) if bar.isVisible()}


def turn_wheel(widget, x=0, y=0):
    """Whoever does not want it leaves it to what holds it: Qt does that for real events alone."""
    place = QPointF(widget.rect().center())
    event = QWheelEvent(place, widget.mapToGlobal(place), QPoint(), QPoint(120 * x, 120 * y), Pointer.NONE,
                        Qt.KeyboardModifier.NoModifier, Qt.ScrollPhase.NoScrollPhase, False)
    event.ignore()
    while widget and not event.isAccepted():
        QApplication.sendEvent(widget, event)
        widget = widget.parent()


def resize(width, height):
    stage.APPLICATION.resize(width, height)
    QApplication.processEvents()


@pytest.fixture
def small_panel():
    size = stage.APPLICATION.size()
    resize(900, 640)
    yield panel()
    resize(size.width(), size.height())


def the_dialog():
    found, = stage.dialogs()
    return found


def title_bar(dialog):
    return dialog.findChild(QLabel, 'titleBar')


@pytest.mark.parametrize('width, height', [(400, 300), (401, 301), (1, 1), (5000, 77), (300, 4001), (-1, 0), (200, -1)])
def test_a_dialog_floats_in_the_middle_of_the_panel_from_its_construction_on(width, height):
    dialog = ui.createDialog('Here', PLAIN, width, height)
    screen = QGuiApplication.primaryScreen().size()
    width, height = width if width > 0 else screen.width() * 4 // 5, height if height > 0 else screen.height() * 4 // 5
    room = panel().size()
    bottom = room.height() // 2 - height // 2
    expected = QRect(room.width() // 2 - width // 2, room.height() - bottom - height - 25, width, height + 25)
    bar = QApplication.style().pixelMetric(QStyle.PixelMetric.PM_ScrollBarExtent)
    if width > room.width():
        expected = QRect(0, expected.y(), room.width(), expected.height() + bar)
    if height + 25 > room.height():
        expected = QRect(expected.x(), 0, width + bar, room.height())
    for find in stage.floating, stage.dialogs:  # at once, and when the loop has turned
        found, = find()
        assert found.geometry() == expected and found.parent() is panel()
        assert found.hasFocus() and panel().children()[-1] is found
    del dialog
    assert stage.dialogs() == []


def test_a_dialog_gets_its_widgets_with_the_first_turn_and_none_if_it_goes_before(user):
    first, second = (make_dialog(title) for title in ('first', 'second'))
    assert [window.findChildren(QWidget) for window in stage.floating()] == [[], []]
    del first
    user.plan(close)
    ui.showMessageBox('A run needs all of them', ['?'])
    window, = stage.floating()
    assert stage.title_of(window) == 'second' and window.findChild(QWidget, 'Text').isVisible()
    assert second.getValue('Text') == 'old'


def test_the_title_bar_is_a_grey_strip_with_a_line_and_a_title_that_can_be_read():
    dialog = ui.createDialog('A title that is longer than the dialog is wide', PLAIN, 120, 60)
    QApplication.processEvents()
    bar = title_bar(the_dialog())
    assert bar.geometry() == QRect(0, 0, 120, 24) and bar.findChild(QFrame).geometry() == QRect(0, 23, 120, 1)
    picture = bar.grab().toImage()
    colours = [picture.pixelColor(x, 12).lightness() for x in range(120)]
    assert colours[4] == round(255 * 0.65) and min(colours) < 60
    assert not [child for child in the_dialog().findChildren(QScrollBar) if child.isVisible()]
    assert dialog.isDisplayed('titleBar')
    dialog.hideWidget('titleBar')
    assert not bar.isVisible()


@pytest.mark.parametrize('grip', [title_bar, lambda dialog: dialog], ids=['title bar', 'ground'])
def test_a_dialog_is_dragged_and_never_out_of_reach(user, grip):
    dialog = ui.createDialog('Dragged', PLAIN, 200, 100)
    window = the_dialog()
    start, room = window.pos(), panel().rect()
    drag(grip(window), (30, -40), (5, 6))
    assert window.pos() == start + QPoint(35, -34)
    for far in (9000, 0), (-9000, 0), (0, 9000), (0, -9000):
        drag(grip(window), far)
        seen = room.intersected(window.geometry())
        assert seen.width() >= 48 and seen.height() >= 24 and room.top() <= window.y() <= room.bottom() - 23
    drag(grip(window), (0, 200))
    user.plan(close)
    assert dialog.launch() == 'CloseButton_OK'


def press_escape(pointer):
    QTest.keyClick(pointer.widget.parent(), Qt.Key.Key_Escape)


def release_elsewhere(pointer):
    Pointer(stage.APPLICATION).release()
    pointer.move(0, 0, Pointer.NONE)


def lose_the_grip(pointer):
    pointer.widget.hide()
    pointer.widget = pointer.widget.parent()
    pointer.move(0, 0, Pointer.NONE)


def show_a_box(_):
    ui.showMessageBox('Box', ['?'])


@pytest.mark.parametrize('end', [press_escape, release_elsewhere, lose_the_grip, show_a_box],
                         ids=['hidden', 'released elsewhere', 'grip hidden', 'blocked'])
def test_a_drag_ends_with_the_release_and_when_its_dialog_is_hidden_or_blocked(patient, end):
    dialog = make_dialog('Dragged')
    pointer = Pointer(title_bar(the_dialog()))
    window, places = the_dialog(), []

    def pull(user):
        pointer.press()
        pointer.move(20, 10)
        end(pointer)
        places.append(window.pos())

    def go_on(user):
        for buttons in Pointer.LEFT, Pointer.NONE:
            pointer.move(30, 40, buttons)
            places.append(window.pos())
        user.close()

    start = window.pos()
    patient.plan(pull)
    if end is show_a_box:
        patient.plan(lambda user: user.press(Qt.Key.Key_Return))
    if end is press_escape:
        dialog.launch()
    patient.plan(go_on)
    dialog.launch()
    assert places == [start + QPoint(20, 10)] * 3


def test_a_dialog_larger_than_the_panel_fills_it_and_scrolls_as_far_as_it_was_made(small_panel):
    dialog = ui.createDialog('Large', container('c', widget('Label', 'low', '0 u l', '0 u b', '4 u w', '4 u h'),
                                                widget('Label', 'high', '-4 u r', '-8 u t', '4 u w', '4 u h')),
                             1000, 800)
    window = the_dialog()
    assert window.geometry() == small_panel.rect()
    drag(title_bar(window), (50, 50))
    assert window.geometry() == small_panel.rect()
    QApplication.processEvents()
    low, high = (window.findChild(QWidget, name) for name in ('low', 'high'))
    assert [one.mapTo(window, QPoint(0, 0)) for one in (low, high)] == [QPoint(0, 825 - 28), QPoint(1000 - 28, 28)]
    assert high.visibleRegion().isEmpty() and low.visibleRegion().isEmpty()
    turn_wheel(low, y=-50)
    assert not low.visibleRegion().isEmpty()
    turn_wheel(low, x=-50)
    turn_wheel(low, y=50)
    assert not high.visibleRegion().isEmpty() and title_bar(window).pos() == QPoint(0, 0)
    resize(1700, 1200)
    assert window.geometry() == QRect(0, 0, 1000, 825) and not bars(window)
    drag(title_bar(window), (50, 50))
    assert window.pos() == QPoint(50, 50) and dialog.getValues() == {}


def test_a_bar_stands_beside_what_a_dialog_was_given(small_panel):
    for width, height, only in (700, 200, Qt.Orientation.Horizontal), (200, 700, Qt.Orientation.Vertical):
        dialog = ui.createDialog('Large', PLAIN, width, height)
        QApplication.processEvents()
        assert list(bars(the_dialog())) == [only]
        del dialog


def test_a_long_form_shows_each_row_to_pages_scrolls_by_the_wheel_and_follows_the_keyboard_around(user, small_panel):
    names = ['row %d' % row for row in range(40)]
    form = [('Menu' if row % 2 else 'TextField', name, 'row', (['a', 'b'], 0) if row % 2 else 'text')
            for row, name in enumerate(names)]
    seen = set()

    def look(user):
        bottom = title_bar(user.window()).height()
        for name in [*names, 'CloseButton_OK']:
            found = user.find(name)
            top = found.mapTo(user.window(), QPoint(0, 0)).y()
            if bottom <= top and top + found.height() <= user.window().height():
                seen.add(name)

    def page(key):
        def turned(user):
            look(user)
            user.press(key)
            look(user)
        return turned

    def wheel(user):
        bar = bars(user.window())[Qt.Orientation.Vertical]
        assert bar.value() == bar.maximum() and seen == {*names, 'CloseButton_OK'}
        for name in names[::-2]:  # the menus
            turn_wheel(user.find(name), y=3)
        assert bar.value() == 0 and user.focus() == 'row 0'

    def go_around(user):
        for key, name in (Qt.Key.Key_Backtab, 'CloseButton_OK'), (Qt.Key.Key_Tab, 'row 0'):
            user.press(key)
            assert user.focus() == name and not user.find(name).visibleRegion().isEmpty()

    user.plan(*[page(Qt.Key.Key_PageDown)] * 4, wheel, go_around, close)
    values = ui.showSimpleDialog('Long', form, 300)
    assert values['row 1'] == 'a' and values['row 39'] == 'a'


def test_a_field_wider_than_the_panel_opens_with_its_beginning(user, small_panel):
    place = look_at(user, lambda: ui.showSimpleDialog('Wide', [('TextField', 'Text', 'A caption')], 1200),
                    lambda user: user.find('Text').mapTo(user.window(), QPoint(0, 0)))
    assert place.x() > 70, 'the caption is seen'


def test_dialogs_keep_their_place_and_stay_within_reach_when_the_panel_changes(small_panel):
    dialog = ui.createDialog('Followed', PLAIN, 200, 100)
    window = the_dialog()
    place = window.pos()
    resize(990, 710)
    assert window.pos() == place
    drag(title_bar(window), (9000, 9000))
    resize(840, 560)
    seen = small_panel.rect().intersected(window.geometry())
    assert seen.height() >= 24 and seen.width() >= 48 and dialog.isDisplayed('titleBar')


@pytest.mark.parametrize('description', ['<Container>', '', PLAIN.replace('Name="OK"', 'Name="CloseButton_OK" Id="1"'),
                                         PLAIN + 'x'])
def test_a_description_that_fails_leaves_nothing_behind(description):
    kept = make_dialog('kept')
    with pytest.raises(RuntimeError):
        ui.createDialog('failed', description.replace('</PushButton>', '<Nonsense/></PushButton>'), 300, 200)
    _, failed = stage.floating()
    drag(failed, (5, 5))  # before the loop comes around: who it would tell is gone
    assert stage.titles() == ['kept']
    assert kept.getValue('Text') == 'old'


def test_what_has_no_room_scrolls_under_the_title():
    form = [('TextField', 'row %d' % row, 'row') for row in range(40)]
    dialog = ui.createDialog('Small', ui.makeXmlFromWidgetList(form), 300, 200)
    QApplication.processEvents()
    assert dialog.isDisplayed('titleBar')
    (orientation, bar), = bars(the_dialog()).items()
    assert orientation == Qt.Orientation.Vertical
    button = the_dialog().findChild(QWidget, 'CloseButton_OK')
    assert button.visibleRegion().isEmpty()
    bar.setValue(bar.maximum())
    assert not button.visibleRegion().isEmpty() and title_bar(the_dialog()).y() == 0


def states():
    """What of the application takes input, and what does so of the dialogs."""
    main = stage.APPLICATION
    own = [main.menuBar().actions()[0], main.findChild(QTreeView, 'Browser.list'),
           main.findChild(QWidget, 'compositions')]
    return [widget.isEnabled() for widget in own], {stage.title_of(one): one.isEnabled() for one in stage.dialogs()}


def test_the_application_takes_no_input_during_a_run_and_is_afterwards_as_before(patient):
    files = stage.APPLICATION.findChild(QTreeView, 'Browser.list')
    files.setFocus()
    bystander, outer, inner = (make_dialog(title) for title in ('bystander', 'outer', 'inner'))
    seen = []
    files.setFocus()

    def run_inner(*_):
        inner.launch()
        seen.append(states())

    outer.addCallback('Button', ui.EventType.ACTIVATE, run_inner)
    heard = listen(bystander, 'Button')

    def disturb(user):
        seen.append(states())
        beneath = {stage.title_of(one): one for one in stage.floating()}['bystander']
        QTest.mouseClick(beneath.findChild(QWidget, 'Button'), Qt.MouseButton.LeftButton)
        QTest.keyClick(files, Qt.Key.Key_Down)

    for _ in range(2):
        before = states()
        assert before == ([True] * 3, dict.fromkeys(stage.titles(), True))
        patient.plan(disturb, click('Button'), disturb, close, click('CloseButton_Cancel'))
        assert outer.launch() == 'CloseButton_Cancel'
        nothing, (before_inner, during, after_inner) = [False] * 3, seen
        assert [state[0] for state in seen] == [nothing] * 3
        assert {title for title, enabled in before_inner[1].items() if enabled} == {'outer'}
        assert {title for title, enabled in during[1].items() if enabled} == {'inner'}
        assert after_inner[1]['outer'] and not after_inner[1]['bystander']
        assert states()[0] == [True] * 3 and set(states()[1].values()) <= {True}
        assert QApplication.focusWidget() is files and heard == []
        seen.clear()


def test_when_a_dialog_goes_the_front_most_has_the_keyboard_where_it_was(user):
    files = stage.APPLICATION.findChild(QTreeView, 'Browser.list')
    dialogs = {title: make_dialog(title) for title in ('Text', 'Toggle', 'Menu')}
    windows = {stage.title_of(one): one for one in stage.dialogs()}
    holders = {title: window.findChild(QWidget, title) for title, window in windows.items()}
    for holder in files, *holders.values():
        holder.setFocus()
    user.plan(close)
    ui.showMessageBox('Box', ['?'])
    assert QApplication.focusWidget() is holders['Menu']
    drag(title_bar(windows['Text']), (1, 1))
    assert QApplication.focusWidget() is holders['Text']
    for gone, holder in ('Text', holders['Menu']), ('Menu', holders['Toggle']), ('Toggle', files):
        del dialogs[gone]
        assert QApplication.focusWidget() is holder


def test_the_keyboard_stays_in_a_dialog_whose_callback_disables_what_had_it_and_all_around_it(user):
    dialog = make_dialog()
    dialog.addCallback('Text', ui.EventType.VALUE_CHANGED,
                       lambda given, *_: given.enableWidget('UserDefinedWidgetsContainer', False))
    user.plan(lambda user: (user.type('a'), user.press(Qt.Key.Key_Return)),
              lambda user: QTest.keyClick(QApplication.focusWidget() or stage.APPLICATION, Qt.Key.Key_Escape))
    assert dialog.launch() == 'CloseButton_Cancel'


def test_a_dialog_made_in_a_callback_is_usable_while_the_outer_one_runs(patient):
    outer, made, clicks = make_dialog('outer'), [], []

    def make(*_):
        made.append(make_dialog('palette'))
        made[0].addCallback('Button', ui.EventType.ACTIVATE, lambda *_: clicks.append(stage.titles()))

    outer.addCallback('Button', ui.EventType.ACTIVATE, make)
    patient.plan(click('Button'), click('Button'), lambda user: made.clear(), close)
    assert outer.launch() == 'CloseButton_OK' and clicks == [['outer', 'palette']]
