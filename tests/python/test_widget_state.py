"""Showing, hiding, enabling and naming the tooltips of widgets by name, before, in and after a run."""

import pathlib
import runpy

import pytest

from forms import UNKNOWN, listen, make_dialog
from quorvane_velmora import ui
from PyQt6 import sip
from PyQt6.QtCore import QEvent, QObject, QPoint, QRect, Qt
from PyQt6.QtGui import QTextDocument
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QProxyStyle, QScrollArea, QStyle, QToolTip

pytestmark = [pytest.mark.screen, pytest.mark.usefixtures('no_wait_is_endless')]

ENABLE, DISABLE = ui.EventType.ENABLE, ui.EventType.DISABLE

NAMES = ['Text', 'Toggle', 'Menu', 'Button', 'Note', 'Label_Caption', 'CloseButton_Cancel', 'UserDefinedWidgetsContainer']


def go_through_every_operation(dialog, someone=None):
    """Changes and reads each state of each kind of widget; on the screen too, where a user sees it."""
    for name in NAMES:
        for change, displayed in ((dialog.hideWidget, False), (dialog.showWidget, True),
                                  (lambda widget: dialog.displayWidget(widget, False), False),
                                  (lambda widget: dialog.displayWidget(widget, True), True)):
            assert change(name) is None
            assert dialog.isDisplayed(name) is displayed
            assert someone is None or someone.find(name).isVisible() is displayed
        for enabled in (False, True):
            assert dialog.enableWidget(name, enabled) is None
            assert dialog.isEnabled(name) is enabled
            assert someone is None or someone.find(name).isEnabled() is enabled


def test_every_operation_acts_at_once_before_in_and_after_a_run(user):
    dialog = make_dialog()
    go_through_every_operation(dialog)
    for _ in range(2):
        user.run(dialog, lambda someone: go_through_every_operation(dialog, someone))
        go_through_every_operation(dialog)


OPERATIONS = [('isEnabled',), ('enableWidget', True), ('isDisplayed',), ('showWidget',), ('hideWidget',),
              ('displayWidget', True), ('setWidgetResourceName', 'resource')]


@pytest.mark.parametrize('name', ['Nobody', '', 'text', 'MainContainer\0', 'root', 'Whatever'])
@pytest.mark.parametrize('operation', OPERATIONS, ids=lambda operation: operation[0])
def test_an_unknown_name_is_refused_by_every_operation(operation, name):
    with pytest.raises(ui.UiError) as refused:
        getattr(make_dialog(), operation[0])(name, *operation[1:])
    assert str(refused.value) == UNKNOWN


TAKE_AWAY = {
    'hidden': lambda dialog, name: dialog.hideWidget(name),
    'disabled': lambda dialog, name: dialog.enableWidget(name, False),
    'in a hidden container': lambda dialog, name: dialog.hideWidget('UserDefinedWidgetsContainer'),
    'in a disabled container': lambda dialog, name: dialog.enableWidget('UserDefinedWidgetsContainer', False),
}


@pytest.mark.parametrize('in_run', [False, True], ids=['before', 'in the run'])
@pytest.mark.parametrize('take_away', TAKE_AWAY.values(), ids=TAKE_AWAY.keys())
@pytest.mark.parametrize('name', ['Text', 'Toggle', 'Menu', 'Button'])
def test_a_widget_out_of_reach_keeps_its_value_and_takes_no_input(user, name, take_away, in_run):
    dialog = make_dialog()
    values = dialog.getValues()
    heard = listen(dialog, name)

    def take(_=None):
        take_away(dialog, name)
        del heard[:]

    def disturb(someone):
        """What the window system delivers goes to the window, which finds the widget under it."""
        window, widget = someone.window().window(), someone.find(name)
        place = widget.mapTo(window, widget.rect().center())
        assert window.rect().contains(place)
        QTest.keyClick(window.windowHandle(), Qt.Key.Key_X)
        QTest.mouseClick(window.windowHandle(), Qt.MouseButton.LeftButton, pos=place)
        for _ in range(8):
            QTest.keyClick(window.windowHandle(), Qt.Key.Key_Tab)
            assert QApplication.focusWidget() is not widget
        assert QApplication.activePopupWidget() is None

    if in_run:
        user.run(dialog, take, disturb)
    else:
        take()
        user.run(dialog, disturb)
    assert heard == []
    assert dialog.getValue(name) == values.get(name)


def test_the_keyboard_goes_on_to_the_widget_that_comes_next_when_a_script_takes_away_one_after_the_other(user):
    rows = [('TextField', 'Row%d' % i) for i in range(9)]
    dialog = ui.createDialog('Rows', ui.makeXmlFromWidgetList(rows, ['OK']), 300, 320)

    def take_away_some(_):
        dialog.hideWidget('Row3')
        dialog.enableWidget('Row4', False)

    def take_away_all(someone):
        def holder():
            return someone.window().focusWidget().objectName()

        def disable(name):
            dialog.enableWidget(name, False)
            return holder()

        def hide(name):
            dialog.hideWidget(name)
            return holder()

        someone.find('Row0').setFocus()
        assert [disable('Row0'), hide('Row1')] == ['Row1', 'Row2']
        dialog.showWidget('Row3')
        assert disable('Row2') == 'Row3'
        dialog.enableWidget('Row4', True)
        assert hide('Row3') == 'Row4'
        fifth, sixth = someone.find('Row5'), someone.find('Row6')
        places = fifth.pos(), sixth.pos()
        sixth.move(places[0])
        fifth.move(places[1])
        assert [disable('Row4'), hide('Row6')] == ['Row6', 'Row5']
        sip.delete(someone.find('Row7'))
        assert [hide('Row5'), disable('Row8')] == ['Row8', 'CloseButton_OK']
        dialog.enableWidget('Row2', True)
        someone.press(Qt.Key.Key_Tab)
        assert holder() == 'Row2'
        assert hide('Row2') == 'CloseButton_OK'

    user.run(dialog, take_away_some, take_away_all)


class Painting(QObject):
    """The names of the widgets that have been painted."""

    def __init__(self, widgets):
        super().__init__()
        self.names = set()
        for widget in widgets:
            widget.installEventFilter(self)

    def eventFilter(self, widget, event):
        if event.type() == QEvent.Type.Paint:
            self.names.add(widget.objectName())
        return False

    def await_all(self, names):
        while self.names != set(names):
            QTest.qWait(5)
        self.names.clear()


@pytest.mark.parametrize('change', [
    lambda dialog, names: [dialog.hideWidget(name) or dialog.showWidget(name) for name in names],
    lambda dialog, names: [dialog.enableWidget(name, not dialog.isEnabled(name)) for name in names],
    lambda dialog, _: dialog.enableWidget('UserDefinedWidgetsContainer', not dialog.isEnabled('UserDefinedWidgetsContainer')),
    lambda dialog, names: dialog.setValues({'Text': dialog.getValue('Text') + '!', 'Toggle': not dialog.getValue('Toggle'),
                                            'Menu': (['a', 'b'], int(dialog.getValue('Menu') == 'a'))}),
], ids=['shown', 'enabled', 'enabled in a container', 'set'])
def test_what_changes_out_of_sight_is_painted_in_sight_and_at_each_change_from_then_on(user, change):
    names = ['Text', 'Toggle', 'Menu']
    rows = [('TextField', 'Row%d' % i) for i in range(30)]
    rows += [('TextField', 'Text', '', 'old'), ('ToggleButton', 'Toggle', '', False), ('Menu', 'Menu', '', (['a', 'b'], 0))]
    dialog = ui.createDialog('Rows', ui.makeXmlFromWidgetList(rows, ['OK']), 300, 28 * len(rows))

    def look(someone):
        painting = Painting([someone.find(name) for name in names])
        change(dialog, names)
        QTest.qWait(20)  # the next picture is without it
        bar = someone.window().findChild(QScrollArea).verticalScrollBar()
        bar.setValue(bar.maximum())
        painting.await_all(names)
        change(dialog, names)
        painting.await_all(names)

    user.plan(lambda someone: someone.window().resize(300, 200))
    user.run(dialog, look)


def press_escape(user):
    user.press(Qt.Key.Key_Escape)


def test_escape_does_not_press_a_disabled_button(user):
    dialog = make_dialog()
    dialog.enableWidget('CloseButton_Cancel', False)
    assert user.run(dialog, press_escape, lambda someone: someone.ask_to_close()) == 'CloseButton_OK'


def test_escape_presses_the_only_button_that_is_left_when_the_others_are_hidden(user):
    dialog = ui.createDialog('Box', ui.makeXmlFromWidgetList([('PushButton', 'Button')], ['OK', 'Cancel']), 300, 100)
    dialog.hideWidget('CloseButton_Cancel')
    assert user.run(dialog, press_escape) == 'CloseButton_OK'
    dialog.hideWidget('Button')
    user.plan(press_escape)
    assert dialog.launch() == 'CloseButton_OK'


@pytest.mark.standalone
def test_a_hidden_widget_is_shown_where_its_constraint_says(user):
    dialog, other = make_dialog(), make_dialog()
    names = ['Text', 'Button', 'CloseButton_Cancel', 'UserDefinedWidgetsContainer']
    for name in names:
        dialog.hideWidget(name)
    places = []

    def resize(someone):
        someone.window().resize(520, 300)

    def look(someone):
        window = someone.window()
        places.append([QRect(someone.find(name).mapTo(window, QPoint(0, 0)), someone.find(name).size())
                       for name in names])

    user.run(other, look, resize, look)
    user.run(dialog, lambda _: [dialog.showWidget(name) for name in names], look,
             lambda _: [dialog.hideWidget(name) for name in names], resize,
             lambda _: [dialog.showWidget(name) for name in names], look)
    assert places[:2] == places[2:]
    assert places[0] != places[1]


def test_only_a_real_change_of_the_enabled_state_raises_an_event(user):
    dialog = make_dialog()
    heard = listen(dialog, 'Toggle', 'Button')

    def change(_=None):
        for enabled in (True, False, False, True, True):
            dialog.enableWidget('Toggle', enabled)
        for enabled in (False, True):
            dialog.enableWidget('UserDefinedWidgetsContainer', enabled)
        dialog.hideWidget('Toggle')
        dialog.showWidget('Toggle')

    change()
    user.run(dialog, change)
    assert heard == [('Toggle', DISABLE), ('Toggle', ENABLE)] * 2


TOOLTIPS = '<Tooltips><Tooltip Widget="Toggle">Tick &lt;b&gt; &amp; go</Tooltip>' \
           '<Tooltip Widget="Text">The text</Tooltip></Tooltips>'


@pytest.fixture
def resource(tmp_path, monkeypatch):
    monkeypatch.chdir(tmp_path)
    (tmp_path / 'ballot.xml').write_text(TOOLTIPS)
    return tmp_path / 'ballot'


def name_in_script(script, dialog, widget, resource):
    """Names the resource in a script, by whose place it is looked for."""
    runpy.run_path(str(script), {'dialog': dialog, 'widget': widget, 'resource': resource}, '__main__')


def as_read(tip):
    """A tooltip as it stands on the screen."""
    page = QTextDocument()
    (page.setHtml if Qt.mightBeRichText(tip) else page.setPlainText)(tip)
    return page.toPlainText().replace('\xa0', ' ')


class EagerTooltips(QProxyStyle):
    """Shows a tooltip after 20 ms in place of 700."""

    def styleHint(self, hint, *rest):
        return 20 if hint == QStyle.StyleHint.SH_ToolTip_WakeUpDelay else super().styleHint(hint, *rest)


def hover(name):
    """Lets the pointer rest on a widget until its tooltip stands on the screen, or long enough for one to come."""
    def step(user):
        user.tips = getattr(user, 'tips', [])
        widget = user.find(name)
        style = EagerTooltips()
        widget.setStyle(style)
        window = user.window().window()
        while not window.isActiveWindow():  # others show none
            QTest.qWait(20)
        QTest.mouseMove(window.windowHandle(), user.window().mapTo(window, QPoint(1, 1)))
        for _ in range(100):
            QTest.qWait(20)
            if not QToolTip.isVisible():
                break
        QTest.mouseMove(window.windowHandle(), widget.mapTo(window, widget.rect().center()))
        for _ in range(250 if widget.toolTip() else 15):
            QTest.qWait(20)
            if QToolTip.isVisible():
                break
        user.tips.append(as_read(QToolTip.text()) if QToolTip.isVisible() else None)
        widget.setStyle(None)
    return step


@pytest.mark.parametrize('form', [str, lambda path: str(path) + '.xml', lambda path: './' + path.name],
                         ids=['path', 'path with extension', 'relative path'])
def test_a_tooltip_resource_is_found_by_its_path(user, resource, form):
    dialog = make_dialog()
    for name in ('Text', 'Button', 'Note'):
        dialog.setWidgetResourceName(name, form(resource))
    user.run(dialog, hover('Text'))
    assert user.tips == ['The text']


def tips(user, dialog, *names):
    seen = []
    user.run(dialog, lambda user: seen.extend(user.find(name).toolTip() for name in names))
    return seen


def test_a_bare_name_is_looked_for_in_the_application_and_then_beside_the_script(user, resource):
    folder = resource.parent / 'scripts'
    folder.mkdir()
    script, link = folder / 'script.py', resource.parent / 'link.py'
    script.write_text('dialog.setWidgetResourceName(widget, resource)')
    link.symlink_to(script)
    (folder / 'votes.xml').write_text(TOOLTIPS.replace('Text', 'Name').replace('The', 'My'))
    for name, word in ('both', 'Bare'), ('both.xml', 'Whole'), ('bare', 'Bare'):
        (folder / name).write_text(TOOLTIPS.replace('The', word))
    form = [('TextField', name) for name in ('Name', 'Text')] + [('ToggleButton', 'Toggle')]
    dialog = ui.createDialog('t', ui.makeXmlFromWidgetList(form), 300, 140)
    seen = []
    for name in 'both', 'both.xml', 'bare', 'ballot', 'nowhere':
        name_in_script(script, dialog, 'Text', name)
        seen += tips(user, dialog, 'Text')
        dialog.setWidgetResourceName('Text', str(resource))
    assert seen == ['Whole text', 'Whole text', 'Bare text', 'The text', 'The text']
    name_in_script(script, dialog, 'Name', 'votes')
    assert 'counted' in tips(user, dialog, 'Name')[0]
    name_in_script(link, dialog, 'Text', 'bare')
    assert tips(user, dialog, 'Text') == ['Bare text']


def test_the_tooltip_of_a_widget_is_seen_on_hover_in_its_own_words(user, resource):
    dialog = make_dialog()
    user.run(dialog, lambda _: dialog.setWidgetResourceName('Toggle', str(resource)),
             lambda _: dialog.setWidgetResourceName('Button', str(resource)),
             lambda _: dialog.setWidgetResourceName('Toggle', 'unknown'),
             lambda _: dialog.setWidgetResourceName('Toggle', ''), hover('Toggle'), hover('Button'))
    assert user.tips == ['Tick <b> & go', None]


@pytest.mark.parametrize('text, words', [
    ('<Tooltips><Tooltip Widget="Text">', ''), ('<Other/>', '"Tooltips"'), ('', '"Tooltips"'),
    ('<Tooltips>\n<Tip/></Tooltips>', 'line 2'), ('<Tooltips>\n<Tooltip/></Tooltips>', 'line 2'),
], ids=['broken off', 'another root', 'empty', 'unknown element', 'no widget'])
def test_a_damaged_tooltip_resource_is_refused_with_words_and_changes_nothing(user, resource, text, words):
    dialog = make_dialog()
    dialog.setWidgetResourceName('Text', str(resource))
    pathlib.Path('damaged.xml').write_text(text)
    with pytest.raises(RuntimeError) as refused:
        dialog.setWidgetResourceName('Text', './damaged')
    assert 'damaged.xml' in str(refused.value) and words in str(refused.value).replace('Line', 'line')
    assert tips(user, dialog, 'Text') == ['The text']


def test_a_dialog_looks_the_same_to_those_who_read_from_right_to_left(person, tmp_path):
    def take_picture(path):
        while not QApplication.focusWidget():  # a window system says so later
            QApplication.processEvents()
        person.picture(path)

    time = QApplication.cursorFlashTime()
    QApplication.setCursorFlashTime(0)
    for direction in Qt.LayoutDirection.RightToLeft, Qt.LayoutDirection.LeftToRight:
        QApplication.setLayoutDirection(direction)
        person.answer('Form', do=lambda _: take_picture(tmp_path / (direction.name + '.png')), press='OK')
        make_dialog().launch()
    QApplication.setCursorFlashTime(time)
    one, other = (path.read_bytes() for path in tmp_path.iterdir())
    assert one == other
