"""A script on a real display, X without a window manager or Wayland, in front of a user who has nothing but keys and a
mouse."""

import sys
import time

import pytest

pytestmark = pytest.mark.standalone

OK_BUTTON = 49, 21  # from the left and from the bottom edge of a window


def start(desk, script):
    return desk.start(sys.executable, '-u', '-c', 'from quorvane_velmora import ui' + script)


def end(script):
    """What it prints until it ends, which must be well."""
    printed = script.communicate()[0]
    assert script.returncode == 0
    return printed


def test_a_form_is_filled_in_by_keys_and_by_the_mouse_which_picks_from_a_menu_where_it_stands(desk):
    script = start(desk, '''
form = [('TextField', 'Show', 'Show'), ('ToggleButton', 'Win', 'Win'), ('TextField', 'Speech', 'Speech'),
        ('Menu', 'Prize', 'Prize', (['one', 'two', 'three'], 0))]
print(sorted(ui.showSimpleDialog('Awards 1', form, 400, True).items()))
''')
    window = desk.wait_for_window('Awards 1')
    desk.run('type', 'Oscars')
    desk.run('key', 'Tab', 'space', 'Tab')
    desk.run('type', 'Thank you')
    desk.run('key', 'Return', 'Tab', 'Down')
    menu, row = (120, 57), 22
    desk.click_in(window, *menu)
    time.sleep(0.6)  # a click that comes sooner is taken for the second half of the one that opens it
    desk.click_in(window, menu[0], menu[1] - row)
    desk.click_in(window, *OK_BUTTON)
    assert end(script) == ("[('CloseButtonClicked', 'CloseButton_OK'), ('Prize', 'three'), ('Show', 'Oscars'), "
                           "('Speech', 'Thank you'), ('Win', True)]\n")
    desk.wait_until_gone('Awards 1')


# Without a window manager, X has no title to close a window by.
@pytest.mark.parametrize('desk', ['wayland'], indirect=True)
def test_a_window_that_is_closed_by_its_title_presses_cancel_or_stays_where_it_needs_an_answer(desk):
    script = start(desk, '''
print(ui.showSimpleDialog('Form', [('TextField', 'a')], 300, True))
print(ui.showMessageBox('Delete the whole shot?', ['Really?'], ['Yes', 'No']))
''')
    desk.close_by_title(desk.wait_for_window('Form'))
    assert script.stdout.readline() == "{'CloseButtonClicked': 'CloseButton_Cancel', 'a': ''}\n"
    box = desk.wait_for_window('Delete the whole shot?')
    assert box.width > 280  # of which the buttons of the title leave room for that
    desk.close_by_title(box)
    desk.run('key', 'Tab', 'Return')
    assert end(script) == 'No\n'


# A Wayland compositor asks a window to go, and destroys none.
@pytest.mark.parametrize('desk', ['xcb'], indirect=True)
def test_a_run_ends_when_others_destroy_its_window_and_the_next_dialog_opens(desk):
    script = start(desk, '''
dialog = ui.createDialog('Lost', ui.makeXmlFromWidgetList([('TextField', 'a', '', 'kept')]), 300, 84)
print(repr(dialog.launch()), dialog.getValue('a'))
print(ui.showMessageBox('Next', ['It opens.']))
''')
    desk.run('windowclose', desk.wait_for_window('Lost').identity)
    assert script.stdout.readline() == "'' kept\n"
    desk.wait_for_window('Next')
    desk.run('key', 'Return')
    assert end(script) == 'OK\n'


def test_a_dialog_gets_the_keys_each_time_it_opens_and_again_after_a_box_above_it(desk):
    script = start(desk, '''
dialog = ui.createDialog('Again', ui.makeXmlFromWidgetList([('TextField', 'a'), ('PushButton', 'Ask')],
                                                           ['OK', 'Cancel']), 300, 120)
def ask(dialog, name, event):
    print(ui.showMessageBox('Box', ['Really?'], ['Yes', 'No']))
dialog.addCallback('Ask', ui.EventType.ACTIVATE, ask)
for _ in range(2):
    print(dialog.launch(), dialog.getValue('a'))
print(ui.showSimpleDialog('Other', [('TextField', 'b')], 300, True))
''')
    desk.wait_for_window('Again')
    desk.run('type', 'first')
    desk.run('key', 'Escape')
    assert script.stdout.readline() == 'CloseButton_Cancel first\n'
    desk.wait_for_window('Again')
    desk.run('type', 'second')
    desk.run('key', 'Tab', 'space')
    desk.wait_for_window('Box')
    desk.run('key', 'Tab', 'Return')
    assert script.stdout.readline() == 'No\n'
    desk.wait_for_window('Again')
    desk.run('key', 'shift+Tab', 'End')
    desk.run('type', '!')
    desk.run('key', 'Escape')
    assert script.stdout.readline() == 'CloseButton_Cancel second!\n'
    desk.wait_for_window('Other')
    desk.run('type', 'x')
    desk.run('key', 'Escape')
    assert end(script) == "{'CloseButtonClicked': 'CloseButton_Cancel', 'b': 'x'}\n"


def test_a_dialog_that_failed_and_stays_leaves_the_keys_and_the_place_in_front_to_the_one_that_runs(desk):
    script = start(desk, '''
xml = ui.makeXmlFromWidgetList([('TextField', 'a'), ('PushButton', 'Ask')])
outer, failing = ui.createDialog('Outer', xml, 300, 120), ui.createDialog('Failing', xml, 300, 120)
def fail(*_):
    raise ValueError('failed')
def ask(*_):
    try:
        failing.launch()
    except ValueError as error:
        print(error)
failing.addCallback('Ask', ui.EventType.ACTIVATE, fail)
outer.addCallback('Ask', ui.EventType.ACTIVATE, ask)
print(outer.launch(), outer.getValue('a'))
''')
    for title in 'Outer', 'Failing':
        desk.wait_for_window(title)
        desk.run('key', 'Tab', 'space')
    assert script.stdout.readline() == 'failed\n'
    window = desk.wait_for_window('Outer')
    desk.run('key', 'shift+Tab')
    desk.run('type', 'heard')
    desk.click_in(window, *OK_BUTTON)
    assert end(script) == 'CloseButton_OK heard\n'
