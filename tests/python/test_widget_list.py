"""Descriptions that are made from a list of widgets."""

import math
import reprlib
from collections import namedtuple
from xml.etree import ElementTree

import pytest

from descriptions import container, text, widget
from quorvane_velmora import ui
from PyQt6.QtGui import QFontMetrics
from PyQt6.QtWidgets import QApplication, QLabel, QPushButton

EDGES = ('X1', 'Y1', 'X2', 'Y2')


def shape(element):
    """An element as its name, its attributes in order, its text and its children."""
    children = [shape(child) for child in element]
    return element.tag, list(element.attrib.items()), (element.text or '') if not children else '', children


def align(horizontal):
    return '<LabelAlign><Align H="%s" V="Center"/></LabelAlign>' % horizontal


def make(widgets, *close_buttons):
    return ElementTree.fromstring(ui.makeXmlFromWidgetList(widgets, list(close_buttons)))


def find(root, name):
    return next(element for element in root.iter('Widget') if element.get('Name') == name)


def places(root, name):
    """The four edges of the widget of that name, each as in '1 u l'."""
    return [' '.join(find(root, name).find('Layout/Constraint/' + edge).attrib.values()) for edge in EDGES]


def texts(root, name):
    return [element.text or '' for element in find(root, name).iter('Text')]


def test_two_entries_give_the_whole_document():
    document = ui.makeXmlFromWidgetList([('TextField', 'Show', 'Show', 'Academy Awards'),
                                         ('ToggleButton', 'Win', 'Do you win ?', True)], ['OK', 'Cancel'])
    buttons = container(
        'CloseButtonsContainer',
        widget('PushButton', 'CloseButton_OK', '0 u l', '0 u b', '12 u w', '4 u h', ahead=text('OK'),
               content=align('Center')),
        widget('PushButton', 'CloseButton_Cancel', '12 u w', '0 u b', '0 uu r', '4 u h', ahead=text('Cancel'),
               content=align('Center')), places=('0 u l', '0 u b', '0 uu r', '5 u h'))
    rows = container(
        'UserDefinedWidgetsContainer',
        widget('Label', 'Label_Show', '0 u l', '4 u h', '15 u w', '0 uu t', content=text('Show') + align('Left')),
        widget('TextField', 'Show', '15 u l', '4 u h', '-1 uu r', '0 uu t',
               content=align('Left') + text('Academy Awards')),
        widget('Label', 'Label_Do you win ?', '0 u l', '4 u h', '15 u w', '-4 uu t',
               content=text('Do you win ?') + align('Left')),
        widget('ToggleButton', 'Win', '15 u l', '4 u h', '4 uu w', '-4 uu t',
               content=align('Left') + '<State><Int>1</Int></State>'),
        places=('0 u l', '1 u s CloseButtonsContainer', '0 uu r', '0 uu t'))
    main = container('MainContainer', buttons, rows, places=('1 u l', '1 u b', '-1 uu r', '-4 uu t'))
    assert shape(ElementTree.fromstring(document)) == shape(ElementTree.fromstring(main))


@pytest.mark.parametrize('kind, value, right, properties', [
    ('Label', 'text', '0 uu r', text('text')),
    ('Menu', (['a', '', 'b'], 5), '20 uu w',
     '<MenuString><Text>a</Text><Text/><Text>b</Text></MenuString><Selection><Int>5</Int></Selection>'),
    ('Menu', ([], -1), '20 uu w', '<MenuString/><Selection><Int>-1</Int></Selection>'),
    ('Gauge', 'ignored', '-1 uu r', ''), ('textfield', 'ignored', '-1 uu r', ''), ('TextField', None, '-1 uu r', ''),
    ('TextField', '', '-1 uu r', ''), ('Label', 0, '0 uu r', ''), ('ToggleButton', False, '4 uu w', ''),
    ('Menu', (), '20 uu w', ''),
])
def test_a_kind_decides_the_width_and_how_its_value_is_written(kind, value, right, properties):
    row = make([(kind, 'name', '', value, 'ignored', 5)]).findall('.//Group')[-1][0]
    meant = widget(kind, 'name', '0 u l', '4 u h', right, '0 uu t', content=align('Left') + properties)
    assert shape(row) == shape(ElementTree.fromstring(meant))


def test_the_longest_label_in_bytes_makes_the_column_and_each_entry_a_row():
    Entry = namedtuple('Entry', 'kind name label')
    entries = [('TextField', 'a'), Entry('TextField', 'b', 'é' * 20), ('Menu', 'c', ''), ('Label', 'd', 'short')]
    assert ui.makeXmlFromWidgetList(entries) == ui.makeXmlFromWidgetList(entries[:])
    root = make(entries)
    assert [places(root, name)[0] for name in 'abcd'] == ['43 u l'] * 4
    assert [places(root, name)[3] for name in 'abcd'] == ['0 uu t', '-4 uu t', '-8 uu t', '-12 uu t']
    assert places(root, 'Label_short') == ['0 u l', '4 u h', '43 u w', '-12 uu t']
    assert not [name for name in root.iter('Widget') if name.get('Name') == 'Label_']


def test_numbers_that_stand_for_the_column_while_it_is_unknown_become_it_everywhere():
    root = make([('TextField', '-999', 'x-888', '1-9990'), ('Menu', 'm', '', (['-888'], 0))], '-999')
    assert texts(root, '8') == ['180'] and texts(root, 'Label_x8') == ['x8']
    assert texts(root, 'm') == ['8'] and texts(root, 'CloseButton_8') == ['8']


def test_three_close_buttons_stand_side_by_side():
    root = make([], 'A', 'B', 'C')
    assert [places(root, 'CloseButton_' + label)[:3] for label in 'ABC'] == [
        [x + ' u l', '0 u b', '12 u w'] for x in ('0', '14', '28')]


def test_nothing_is_checked_for_being_there_only_once():
    root = make([('TextField', 'a', 'x'), ('TextField', 'a', 'x')], 'A', 'A', '')
    assert [element.get('Name') for element in root.iter('Widget')] == [
        'MainContainer', 'CloseButtonsContainer', 'CloseButton_A', 'CloseButton_A', 'CloseButton_',
        'UserDefinedWidgetsContainer', 'Label_x', 'a', 'Label_x', 'a']


def test_an_empty_list_of_close_buttons_gets_ok_and_keeps_it():
    mine = []
    ui.makeXmlFromWidgetList([], mine)
    assert mine == ['OK']
    with pytest.raises(TypeError):
        ui.makeXmlFromWidgetList([5], own := [])
    assert own == ['OK']
    root = ElementTree.fromstring(ui.makeXmlFromWidgetList([]))
    assert texts(root, 'CloseButton_OK') == ['OK'] and len(list(root.iter('PushButton'))) == 1


def test_a_push_button_shows_its_name_in_a_width_measured_from_it():
    root = make([('PushButton', 'A rather long name', 'label', 'ignored')])
    width, measure, target = places(root, 'A rather long name')[2].split()
    needed = QFontMetrics(QApplication.font()).horizontalAdvance('A rather long name')
    assert (measure, target) == ('uu', 'w') and 0 <= int(width) - 4 - math.ceil(needed / 7) <= 1
    tags = [child.tag for child in find(root, 'A rather long name')]
    assert tags == ['LabelString', 'Layout', 'LabelAlign'] and texts(root, 'A rather long name') == [
        'A rather long name']


@pytest.mark.parametrize('part', ['Wide ', 'iii ', '\u6f22', 'a\u0301'])
def test_a_line_far_wider_than_any_screen_has_at_least_the_room_that_it_needs(part):
    name = part * (20004 // len(part))
    width = places(make([('PushButton', name)]), name)[2].split()[0]
    assert 7 * int(width) >= QFontMetrics(QApplication.font()).horizontalAdvance(name)


class Undecided:
    def __init__(self, failure):
        self._failure = failure

    def __bool__(self):
        raise self._failure


INCOMPLETE = '^Incomplete widget description$'


@pytest.mark.parametrize('entry, failure, words', [
    (['TextField', 'a'], TypeError, ''), ('TextField', TypeError, ''), (None, TypeError, ''),
    ((), ui.UiError, INCOMPLETE), (('TextField',), ui.UiError, INCOMPLETE),
    ((1, 'a'), TypeError, ''), (('TextField', None), TypeError, ''),
    (('TextField', 'a', 5), TypeError, ''), (('TextField', 'a', None), TypeError, ''),
    (('TextField', 'a', 'l', 5), TypeError, ''), (('Label', 'a', 'l', ['x']), TypeError, ''),
    (('ToggleButton', 'a', 'l', 'yes'), TypeError, ''),
    (('Menu', 'a', 'l', ['x']), TypeError, ''), (('Menu', 'a', 'l', 'x'), TypeError, ''),
    (('Menu', 'a', 'l', (5, 0)), TypeError, ''), (('Menu', 'a', 'l', (('x',), 0)), TypeError, ''),
    (('Menu', 'a', 'l', (['x'], '0')), TypeError, ''), (('Menu', 'a', 'l', (['x', 5], 0)), TypeError, ''),
    (('Menu', 'a', 'l', (['x'],)), IndexError, ''),
    (('TextField', 'a', 'l', Undecided(ArithmeticError())), ArithmeticError, ''),
    (('Text Field', 'a'), RuntimeError, 'Text Field'), (('', 'a'), RuntimeError, 'name'),
])
def test_a_bad_entry_is_refused_and_the_next_list_works(entry, failure, words):
    widgets = [('TextField', 'first'), entry]
    for show in (ui.makeXmlFromWidgetList, lambda widgets: ui.showSimpleDialog('t', widgets, 400)):
        with pytest.raises(failure, match=words) as caught:
            show(widgets)
        assert caught.type is failure
        assert caught.value.__notes__[-1] == 'Entry [1] of the widget list is ' + reprlib.repr(entry)
    assert widgets == [('TextField', 'first'), entry]
    assert find(make(widgets[:1]), 'first') is not None


@pytest.mark.parametrize('kind, meant', [('Gauge', ''), ('textfield', 'TextField'), ('Text', 'TextField'),
                                         ('toggle_button', 'ToggleButton'), ('MenuButton', 'Menu'), ('xy', '')])
def test_a_kind_that_no_widget_has_is_refused_when_the_dialog_is_built(kind, meant):
    entries = [('TextField', 'a'), (kind, 'odd')]
    words = (r'line \d+: unknown widget element "%s" of the widget "odd"\. Known are Container, Label, Menu, PushButton, '
             r'TextField, ToggleButton\.%s$' % (kind, ' Is it "%s"\\?' % meant if meant else ''))
    with pytest.raises(RuntimeError, match=words) as caught:
        ui.createDialog('t', ui.makeXmlFromWidgetList(entries))
    assert not hasattr(caught.value, '__notes__')
    with pytest.raises(RuntimeError, match=words) as caught:
        ui.showSimpleDialog('t', entries, 400)
    assert caught.value.__notes__ == ['Entry [1] of the widget list is %r; the kinds are TextField, ToggleButton, Menu, '
                                      'Label and PushButton' % (entries[1],)]


def test_a_note_says_which_value_a_row_was_given_and_is_left_out_where_it_cannot_be_made():
    def notes_of(*entries, buttons=()):
        with pytest.raises(Exception) as caught:
            make(list(entries), *buttons)
        return getattr(caught.value, '__notes__', [])

    assert notes_of(('Label', 'a', '', ['x'] * 9)) == [
        "The label 'a' takes a str or None; it was given ['x', 'x', 'x', 'x', 'x', 'x', ...]",
        "Entry [0] of the widget list is ('Label', 'a', '', ['x', 'x', 'x', 'x', 'x', 'x', ...])"]
    assert notes_of(('Menu', 'a', '', 'x'))[0].startswith("The menu 'a' takes a tuple of a list of str and an index")
    assert notes_of(buttons=['Yes', 5]) == ['Entry [1] of the list of close buttons is 5']
    with pytest.raises(TypeError) as caught:
        ui.showMessageBox('t', ['a', None])
    assert caught.value.__notes__ == ['Entry [1] of the list of messages is None']

    class Stubborn(Exception):
        def __setattr__(self, name, value):
            raise OSError(name)

    with pytest.raises(Stubborn, match='^odd$'):
        make([('TextField', 'a', '', Undecided(Stubborn('odd')))])


NASTY = ['<&>"\'', '\ttab\t', 'two\nlines', 'dos\r\nend', '\r', ' leading', 'trailing ', '   ', '\n', 'clef 𝄞 😀',
         'e\u0301 and é', ']]>', '&amp;&#10;', '<!--', '\ufeffmark', '\u2028\x85\x7f', 'a' * 3000]


@pytest.mark.parametrize('text', NASTY, ids=ascii)
def test_every_text_comes_through_a_dialog_as_it_was(user, text):
    xml = ui.makeXmlFromWidgetList([
        ('TextField', text, text, text), ('Menu', 'm' + text, 'm' + text, (['', text], 1)),
        ('Label', 'l' + text, '', text), ('PushButton', 'p' + text)], [text])
    values = {text: text, 'm' + text: text}
    dialog = ui.createDialog(text, xml, 400, 300)
    assert dialog.getValues() == values

    def look(user):
        seen = {label.objectName(): label.text().replace('&&', '&') for label in user.window().findChildren(QLabel)
                if label.objectName() != 'titleBar'}
        assert seen == {'Label_' + text: text, 'Label_m' + text: 'm' + text, 'l' + text: text}
        assert user.title() == text
        assert user.find('p' + text).text().replace('&&', '&') == 'p' + text
        assert user.find(text).text() == text
        assert user.find('m' + text).currentText() == text
        user.find('CloseButton_' + text, QPushButton).click()

    user.plan(look)
    assert dialog.launch() == 'CloseButton_' + text
    assert dialog.getValues() == {**values, 'CloseButtonClicked': 'CloseButton_' + text}


@pytest.mark.parametrize('text', ['a\0b', '\x01', 'a\x1f', '\x0b', '\ufffe', '\ud800', b'\xff', b'a\xc3'], ids=ascii)
def test_what_a_description_cannot_hold_is_refused_when_it_is_written(text):
    for widgets, buttons in [([('TextField', text)], []), ([('TextField', 'a', text)], []),
                             ([('TextField', 'a', '', text)], []), ([('Label', 'a', '', text)], []),
                             ([('Menu', 'a', '', ([text], 0))], []), ([('PushButton', text)], []), ([], [text])]:
        with pytest.raises((RuntimeError, UnicodeEncodeError), match='XML cannot hold|not valid UTF-8|surrogates'):
            ui.makeXmlFromWidgetList(widgets, buttons)
    assert find(make([('TextField', 'next')]), 'next') is not None


def test_names_of_any_character_come_back_or_are_refused():
    refused = 0
    for character in map(chr, [*range(0x300), *range(0x300, 0x110000, 997)]):
        rows = [('TextField', character, character, character), ('Menu', 'm' + character, '', ([character], 0))]
        try:
            description = ui.makeXmlFromWidgetList(rows, ['OK' + character])
        except (RuntimeError, UnicodeEncodeError):
            refused += 1
            continue
        dialog = ui.createDialog(character, description)
        assert dialog.getValues() == {character: character, 'm' + character: character}, ascii(character)
        assert dialog.isDisplayed('CloseButton_OK' + character)
    assert refused < 50
