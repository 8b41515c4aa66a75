"""The values of widgets, as scripts read and write them."""

from unittest.mock import Mock

import pytest

from descriptions import close_button, container, text, widget
from quorvane_velmora import ui
from PyQt6.QtCore import Qt

FORM = [('TextField', 'Show', 'Show'), ('ToggleButton', 'Win', 'Win'), ('Menu', 'Prize', 'Prize', (['a', 'b'], 0)),
        ('PushButton', 'Vote'), ('Label', 'Hint', '', 'hint')]
START = {'Show': '', 'Win': False, 'Prize': 'a'}


def make(initial_values=None, widgets=FORM):
    return ui.createDialog('Values', ui.makeXmlFromWidgetList(widgets), 400, 300, initial_values or {})


def entries(dialog, name='Prize'):
    """The entries of a menu, in the only way a script can learn them: selecting one after the other."""
    found = []
    while True:
        dialog.setValues({name: ([], len(found))})
        if dialog.getValue(name) is None:
            return found
        found.append(dialog.getValue(name))


WRITERS = {
    'setValue': lambda dialog, name, value: dialog.setValue(name, value),
    'setValues': lambda dialog, name, value: dialog.setValues({name: value}),
    'setValue without callbacks': lambda dialog, name, value: dialog.setValue(name, value, False),
    'setValues without callbacks': lambda dialog, name, value: dialog.setValues({name: value}, False),
}


@pytest.fixture(params=WRITERS.values(), ids=WRITERS)
def write(request):
    return request.param


def test_a_new_form_has_the_values_of_its_description_and_no_close_button():
    assert make().getValues() == START
    bare = make(widgets=[('TextField', 'a'), ('Label', 'b', '', 'x'), ('Menu', 'c'), ('ToggleButton', 'd', '', True)])
    assert bare.getValues() == {'a': '', 'c': None, 'd': True}


@pytest.mark.parametrize('name, value, read', [
    ('Show', 'Oscars', 'Oscars'), ('Show', '', ''), ('Show', None, None), ('Show', 'é 𝄞', 'é 𝄞'),
    ('Win', True, True), ('Win', 1, True), ('Win', 0, False), ('Win', None, False),
])
def test_a_value_is_read_as_it_was_written(write, name, value, read):
    dialog = make()
    write(dialog, name, value)
    for seen in dialog.getValue(name), dialog.getValues()[name], make({name: value}).getValue(name):
        assert seen == read and type(seen) is type(read)
    assert dialog.getValues() == {**START, name: read}


def test_one_value_replaces_the_entries_of_a_menu_and_many_add_to_them():
    dialog = make()
    dialog.setValue('Prize', (['c', 'd'], 1))
    assert dialog.getValue('Prize') == 'd'
    dialog.setValue('Prize', (['c', 'd'], 0))
    dialog.setValues({'Prize': (['c', 'd'], 3)})
    assert dialog.getValue('Prize') == 'd'
    assert entries(dialog) == ['c', 'd', 'c', 'd']
    assert entries(make({'Prize': (['c'], 2)})) == ['a', 'b', 'c']


def test_an_index_outside_the_menu_selects_nothing_and_an_empty_list_empties_it_or_adds_nothing():
    dialog = make()
    for index in -1, 2, 2 ** 31 - 1:
        dialog.setValues({'Prize': ([], index)})
        assert dialog.getValues()['Prize'] is None
    assert entries(dialog) == ['a', 'b']
    dialog.setValue('Prize', ([], 0))
    assert dialog.getValue('Prize') is None and entries(dialog) == []


# A value that is refused, and the entries of the menu after setValue and after setValues.
BAD_MENUS = [
    (['c'], TypeError, 'ab', 'ab'), (0, TypeError, 'ab', 'ab'), ('c', TypeError, 'ab', 'ab'),
    (None, TypeError, 'ab', 'ab'), (('c', 0), TypeError, 'ab', 'ab'), ((('c',), 0), TypeError, 'ab', 'ab'),
    ((), IndexError, 'ab', 'ab'), ((['c'],), IndexError, 'c', 'abc'), ((['c'], '0'), TypeError, 'c', 'abc'),
    ((['c', 5, 'd'], 0), TypeError, 'c', 'abc'), (([5], 0), TypeError, '', 'ab'),
]


@pytest.mark.parametrize('value, failure, after_one, after_many', BAD_MENUS)
def test_a_refused_menu_value_leaves_what_was_done_before_the_refusal(value, failure, after_one, after_many):
    for name, after in ('setValue', after_one), ('setValues', after_many):
        dialog = make()
        with pytest.raises(failure) as caught:
            WRITERS[name](dialog, 'Prize', value)
        assert caught.type is failure and entries(dialog) == list(after)
        assert caught.value.__notes__ == ["The menu 'Prize' takes a tuple of a list of str and an index, as "
                                          "(['a', 'b'], 0); it was given %r" % (value,)]
    with pytest.raises(failure):
        make({'Prize': value})


@pytest.mark.parametrize('name, value, failure', [
    ('Show', 5, TypeError), ('Show', b'x', TypeError), ('Show', ['x'], TypeError), ('Show', True, TypeError),
    ('Show', 'a\ud800', UnicodeEncodeError), ('Win', 'yes', TypeError), ('Win', [], TypeError), ('Win', 1.5, TypeError)])
def test_a_refused_text_or_state_changes_nothing(write, name, value, failure):
    dialog = make()
    takes = {'Show': 'text field', 'Win': 'toggle button'}[name], name, {'Show': 'str or None', 'Win': 'bool, an int or None'}[name]
    for refused in lambda: write(dialog, name, value), lambda: make({name: value}):
        with pytest.raises(failure) as caught:
            refused()
        assert caught.value.__notes__ == ['The %s %r takes a %s; it was given %r' % (*takes, value)]
    assert dialog.getValues() == START


def test_what_a_callback_raises_in_a_setter_says_nothing_of_the_value(write):
    dialog, fail = make(), Mock(side_effect=KeyError('mine'))
    for name, value in ('Show', 'x'), ('Win', True), ('Prize', (['c'], 0)):
        for event in ui.EventType.STATE, ui.EventType.VALUE_CHANGED:
            dialog.addCallback(name, event, fail)
        try:
            write(dialog, name, value)
        except KeyError as failure:
            assert not hasattr(failure, '__notes__')


def test_a_text_ends_at_its_first_zero_byte_and_a_number_at_32_bits(write):
    dialog = make()
    write(dialog, 'Show', 'a\x1b\0b')
    write(dialog, 'Win', 2 ** 70)
    assert dialog.getValues() == {**START, 'Show': 'a\x1b', 'Win': True}
    with pytest.raises(OverflowError):
        write(dialog, 'Prize', ([], 2 ** 31))


class Unsure(int):
    def __bool__(self):
        raise KeyError('of the script')


@pytest.mark.parametrize('take', [
    lambda dialog: dialog.setValue('Win', Unsure()), lambda dialog: dialog.setValue('Win', True, Unsure()),
    lambda dialog: dialog.setValues({'Win': Unsure()}), lambda dialog: dialog.displayWidget('Win', Unsure()),
    lambda dialog: dialog.enableWidget('Win', Unsure()), lambda _: make({'Win': Unsure()}),
    lambda _: ui.makeXmlFromWidgetList([('ToggleButton', 'Win', '', Unsure())])])
def test_a_truth_that_raises_is_refused_with_its_own_error_and_changes_nothing(take):
    dialog = make()
    dialog.hideWidget('Win')
    dialog.enableWidget('Win', False)
    with pytest.raises(KeyError, match='of the script'):
        take(dialog)
    assert dialog.getValues() == START
    assert not dialog.isDisplayed('Win') and not dialog.isEnabled('Win')


def test_many_values_are_written_from_top_to_bottom_up_to_the_first_refused():
    dialog = make(widgets=[('TextField', name) for name in 'abc'])
    with pytest.raises(TypeError):
        dialog.setValues({'c': 'new', 'b': 5, 'a': 'new'})
    assert dialog.getValues() == {'a': 'new', 'b': '', 'c': ''}
    dialog.setValues({})
    dialog.setValues({'unknown': 5, 'CloseButtonClicked': 5, 'CloseButton_OK': 5, 'A': 5, 'c': 'last'})
    assert dialog.getValues() == {'a': 'new', 'b': '', 'c': 'last'}


def test_widgets_of_one_name_are_read_and_written_by_their_order():
    dialog = make(widgets=[('PushButton', 'a'), ('TextField', 'a', '', 'first'), ('TextField', 'a', '', 'second')])
    assert dialog.getValue('a') == 'first' and dialog.getValues() == {'a': 'second'}
    dialog.setValue('a', 'new')
    assert dialog.getValue('a') == 'new' and dialog.getValues() == {'a': 'second'}
    dialog.setValues({'a': 'all'})
    assert dialog.getValue('a') == 'all' and dialog.getValues() == {'a': 'all'}


def test_a_field_without_text_is_passed_over_only_where_it_stands_in_a_container():
    behind = widget('TextField', 'a', content=text('behind'))
    inner = container('inner', widget('TextField', 'a'))
    for tree, found in (container('outer', inner, behind), 'behind'), (container('outer', behind, inner), None):
        dialog = ui.createDialog('t', tree)
        dialog.setValue('a', None)
        assert dialog.getValue('a') == found


def test_what_the_user_did_is_the_value_without_enter(user):
    dialog = make({'Show': 'old'})
    values = []
    user.run(dialog, lambda user: user.type('New'),
             lambda user: user.click('Win'),
             lambda user: (user.find('Prize').setFocus(), user.press(Qt.Key.Key_Down)),
             lambda user: values.append(dialog.getValues()))
    assert values == [{'Show': 'New', 'Win': True, 'Prize': 'b'}]
    assert dialog.getValues() == {**values[0], 'CloseButtonClicked': 'CloseButton_OK'}


def test_what_a_script_writes_while_the_dialog_is_open_stands_on_the_screen(user):
    dialog = make()

    def write_and_look(user):
        dialog.setValues({'Show': 'seen', 'Win': True, 'Prize': (['c'], 2)})
        assert user.find('Show').text() == 'seen' and user.find('Win').isChecked()
        assert user.find('Prize').currentText() == 'c' and user.find('Prize').count() == 3
        dialog.setValue('Prize', (['only'], 5))
        assert user.find('Prize').currentIndex() == -1 and user.find('Prize').count() == 1
        dialog.setValue('Show', None)
        assert user.find('Show').text() == ''

    def type_into_nothing(user):
        assert dialog.getValue('Show') is None
        user.type('x')
        assert dialog.getValue('Show') == 'x'

    user.run(dialog, write_and_look, type_into_nothing)


def test_the_close_button_stands_among_the_values_from_its_press_on(user):
    beside = '14 u l', '0 u b', '12 u w', '4 u h'
    dialog = ui.createDialog('t', container('c', close_button('A'), close_button('B', *beside)))
    assert dialog.getValues() == {}
    for label in 'AB':
        user.plan(lambda user: user.close(label))
        dialog.launch()
        assert dialog.getValues() == {'CloseButtonClicked': 'CloseButton_' + label}
    assert dialog.getValue('CloseButtonClicked') is None


class Classless:
    __class__ = property(lambda self: 1 / 0)


class Pretended:
    __slots__ = ()
    __class__ = list


def test_an_object_that_lies_about_its_class_is_refused_with_the_error_that_it_raises():
    dialog = make()
    as_list = [ui.makeXmlFromWidgetList, lambda thing: ui.showMessageBox('t', thing),
               lambda thing: dialog.setValue('Prize', (thing, 0)),
               lambda thing: ui.makeXmlFromWidgetList([('Menu', 'm', 'M', (thing, 0))])]
    as_other = [dialog.setValues, lambda thing: dialog.setValue('Prize', thing),
                lambda thing: ui.createDialog('t', '', 1, 1, thing), lambda thing: ui.makeXmlFromWidgetList([thing])]
    for take in as_list:
        with pytest.raises(AttributeError, match='__len__'):
            take(Pretended())
    for take in as_list + as_other:
        with pytest.raises(ZeroDivisionError):
            take(Classless())
