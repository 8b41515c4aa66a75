"""Dialogs inside the application: where they float, how they are moved, and what becomes of the rest meanwhile."""

import pytest

import stage
from callback_tools import listen, make_dialog
from descriptions import close_button, container
from quorvane_velmora import ui
from PyQt6.QtCore import QEvent, QPoint, QPointF, QRect, Qt
from PyQt6.QtGui import QGuiApplication, QMouseEvent
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QFrame, QLabel, QScrollBar, QTreeView, QWidget

pytestmark = [pytest.mark.inside, pytest.mark.usefixtures('no_wait_is_endless')]

PLAIN = container('c', close_button('OK'))


def panel():
    return stage.APPLICATION.findChild(QWidget, 'mainPanel')


def drag(widget, *moves):
    """Presses in the middle of a widget, moves by so many pixels, and lets go."""
    place = QPointF(widget.mapToGlobal(widget.rect().center()))

    def send(kind, button, buttons):
        local = QPointF(widget.mapFromGlobal(place.toPoint()))
        QApplication.sendEvent(widget, QMouseEvent(kind, local, place, button, buttons, Qt.KeyboardModifier.NoModifier))

    left, none = Qt.MouseButton.LeftButton, Qt.MouseButton.NoButton
    send(QEvent.Type.MouseButtonPress, left, left)
    for x, y in moves:
        place += QPointF(x, y)
        send(QEvent.Type.MouseMove, none, left)
    send(QEvent.Type.MouseButtonRelease, left, none)
    send(QEvent.Type.MouseMove, none, none)


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
    assert the_dialog().geometry() == expected and the_dialog().parent() is panel()
    assert the_dialog().hasFocus() and panel().children()[-1] is the_dialog()
    del dialog
    assert stage.dialogs() == []


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
    user.plan(lambda user: user.close())
    assert dialog.launch() == 'CloseButton_OK'


def test_each_edge_of_a_dialog_larger_than_the_panel_can_be_seen():
    dialog = ui.createDialog('Large', PLAIN, panel().width() + 300, panel().height() + 200)
    window, room = the_dialog(), panel().rect()
    edges = {'left': lambda: window.geometry().left() >= 0, 'right': lambda: window.geometry().right() <= room.right(),
             'top': lambda: window.geometry().top() >= 0, 'bottom': lambda: window.geometry().bottom() <= room.bottom()}
    for edge, far in ('left', (9000, 0)), ('right', (-9000, 0)), ('top', (0, 9000)), ('bottom', (0, -9000)):
        drag(window, far, (-far[0] + (1 if far[0] > 0 else -1) * 700 if far[0] else 0, 0))
        drag(window, far)
        assert edges[edge](), edge
    assert dialog.getValues() == {}


def test_dialogs_keep_their_place_and_stay_within_reach_when_the_panel_changes():
    dialog = ui.createDialog('Followed', PLAIN, 200, 100)
    window = the_dialog()
    place, size = window.pos(), stage.APPLICATION.size()
    try:
        stage.APPLICATION.resize(size.width() + 90, size.height() + 70)
        QApplication.processEvents()
        assert window.pos() == place
        drag(title_bar(window), (9000, 9000))
        stage.APPLICATION.resize(size.width() - 60, size.height() - 80)
        QApplication.processEvents()
        assert panel().rect().intersected(window.geometry()).height() >= 24
        assert panel().rect().intersected(window.geometry()).width() >= 48
    finally:
        stage.APPLICATION.resize(size)
        QApplication.processEvents()
    assert dialog.isDisplayed('titleBar')


@pytest.mark.parametrize('description', ['<Container>', '', PLAIN.replace('Name="OK"', 'Name="CloseButton_OK" Id="1"'),
                                         PLAIN + 'x'])
def test_a_description_that_fails_leaves_nothing_behind(description):
    kept = make_dialog('kept')
    with pytest.raises(RuntimeError):
        ui.createDialog('failed', description.replace('</PushButton>', '<Nonsense/></PushButton>'), 300, 200)
    failed = [title_bar(window) for window in stage.floating() if stage.title_of(window) == 'failed']
    for bar in failed:  # before the loop comes around: who it would tell is gone
        drag(bar, (5, 5))
    assert stage.titles() == ['kept']
    assert kept.getValue('Text') == 'old'


def test_what_has_no_room_scrolls_under_the_title():
    dialog = make_dialog('Small')
    del dialog
    dialog = ui.createDialog('Small', ui.makeXmlFromWidgetList([('TextField', 'row %d' % row, 'row') for row in range(40)]),
                             300, 200)
    QApplication.processEvents()
    bars = [bar for bar in the_dialog().findChildren(QScrollBar) if bar.isVisible()]
    assert [bar.orientation() for bar in bars] == [Qt.Orientation.Vertical]
    button = the_dialog().findChild(QWidget, 'CloseButton_OK')
    assert button.visibleRegion().isEmpty()
    bars[0].setValue(bars[0].maximum())
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
        beneath = {stage.title_of(one): one for one in stage.dialogs()}['bystander']
        QTest.mouseClick(beneath.findChild(QWidget, 'Button'), Qt.MouseButton.LeftButton)
        QTest.keyClick(files, Qt.Key.Key_Down)

    for _ in range(2):
        before = states()
        assert before == ([True] * 3, dict.fromkeys(stage.titles(), True))
        patient.plan(disturb, lambda user: user.click('Button'), disturb, lambda user: user.close(),
                     lambda user: user.close('Cancel'))
        assert outer.launch() == 'CloseButton_Cancel'
        nothing, (before_inner, during, after_inner) = [False] * 3, seen
        assert [state[0] for state in seen] == [nothing] * 3
        assert {title for title, enabled in before_inner[1].items() if enabled} == {'outer'}
        assert {title for title, enabled in during[1].items() if enabled} == {'inner'}
        assert after_inner[1]['outer'] and not after_inner[1]['bystander']
        assert states()[0] == [True] * 3 and set(states()[1].values()) <= {True}
        assert QApplication.focusWidget() is files and heard == []
        seen.clear()


def test_a_dialog_made_in_a_callback_is_usable_while_the_outer_one_runs(patient):
    outer, made, clicks = make_dialog('outer'), [], []

    def make(*_):
        made.append(make_dialog('palette'))
        made[0].addCallback('Button', ui.EventType.ACTIVATE, lambda *_: clicks.append(stage.titles()))

    outer.addCallback('Button', ui.EventType.ACTIVATE, make)
    patient.plan(lambda user: user.click('Button'), lambda user: user.click('Button'),
                 lambda user: made.clear(), lambda user: user.close())
    assert outer.launch() == 'CloseButton_OK' and clicks == [['outer', 'palette']]


def test_the_keyboard_goes_around_in_the_dialog_and_brings_it_into_view(user):
    height = panel().height()
    rows = [('TextField', 'row %d' % row, 'row') for row in range(height // 28 + 4)]

    def walk(user):
        assert user.focus() == 'row 0'
        user.press(Qt.Key.Key_Backtab)
        assert user.focus() == 'CloseButton_OK' and not user.find('CloseButton_OK').visibleRegion().isEmpty()
        user.press(Qt.Key.Key_Tab)
        assert user.focus() == 'row 0' and not user.find('row 0').visibleRegion().isEmpty()
        user.close()

    user.plan(walk)
    assert ui.showSimpleDialog('Tall', rows, 300)['CloseButtonClicked'] == 'CloseButton_OK'
