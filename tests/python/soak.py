"""Many dialogs in one process leave nothing behind, and the last take no longer than the first.

    soak.py unseen COUNT    described, built, written, read, their callbacks fired, dropped; without a window
    soak.py shown COUNT     launched, filled in and closed by real keys and clicks; in the application they float

Prints what was measured, and fails with words."""

import gc
import os
import re
import subprocess
import sys
import tempfile
import time
from collections import Counter

import pytest
from PyQt6.QtCore import QEvent
from PyQt6.QtGui import QPixmapCache
from PyQt6.QtWidgets import QApplication

from descriptions import container, widget
from forms import EVENTS, listen, make_dialog
from quorvane_velmora import testing, ui

# Bytes that the process may grow by after the warm-up, and times that the last thousand may take of the first.
MOST_GROWTH = 1 << 20
SLOWEST = 1.5

TIPS = tempfile.NamedTemporaryFile('w', suffix='.xml')
TIPS.write('<Tooltips><Tooltip Widget="Text">What &lt;b&gt; is &amp; is not.</Tooltip></Tooltips>')
TIPS.flush()
FOLDER = tempfile.TemporaryDirectory()
os.mkdir(os.path.join(FOLDER.name, 'inner'))

ROWS = [('TextField', 'text', 'Text', 'a'), ('ToggleButton', 'toggle', 'Toggle', True), ('Menu', 'menu', 'Menu', (['x', 'y'], 1)),
        ('PushButton', 'button', 'Button'), ('Label', 'label', '', 'words\nin two lines')]


def build_and_use(turn):
    dialog = make_dialog('Unseen %d' % turn)
    heard = listen(dialog, 'Text', 'Toggle')
    dialog.setWidgetResourceName('Text', TIPS.name)
    dialog.setValues({'Text': str(turn), 'Toggle': True, 'Menu': (['c'], 2)})
    dialog.enableWidget('Toggle', False)
    dialog.hideWidget('Button')
    assert len(heard) == 3
    assert dialog.getValues() == {'Text': str(turn), 'Toggle': True, 'Menu': 'c'}


def keep_in_a_cycle(turn):
    dialog = make_dialog()
    dialog.addCallback('Text', EVENTS[-1], lambda *_: dialog.hideWidget('Text'))
    dialog.setValue('Text', 'x' * (turn % 100))
    assert not dialog.isDisplayed('Text')


def refuse(turn):
    with pytest.raises(RuntimeError, match='line 1'):
        ui.createDialog('Refused', '<Container><Widget Name="%d"></Container>' % turn)
    with pytest.raises(RuntimeError, match='Nobody'):
        ui.createDialog('Refused', container('c', widget('Label', 'a', '0 u s Nobody', '0 u b', '1 u w', '1 u h')))
    with pytest.raises(ui.UiError):
        ui.makeXmlFromWidgetList([*ROWS, ('TextField',)])
    dialog = make_dialog()
    with pytest.raises(TypeError):
        dialog.setValues({'Text': 'good', 'Menu': (['a', turn], 0)})


def raise_in_a_callback(turn):
    dialog = make_dialog()

    def give_up(given, name, event):
        given.removeCallback(name, event, give_up)
        raise LookupError(turn)

    dialog.addCallback('Toggle', ui.EventType.STATE, give_up)
    with pytest.raises(LookupError):
        dialog.setValue('Toggle', True)


def answer_form(person, turn):
    person.answer('Form', {'Text': 'b', 'toggle': False, 'menu': 'x'}, 'OK')
    values = ui.showSimpleDialog('Form', ROWS, 300, True)
    assert values == {'text': 'b', 'toggle': False, 'menu': 'x', 'CloseButtonClicked': 'CloseButton_OK'}


def answer_message(person, turn):
    person.answer('Message', says='of %d' % turn, press='Escape')
    assert ui.showMessageBox('Message', ['Out of %d' % turn, 'Again?'], ['Yes', 'Cancel']) == 'Cancel'


def act_on_the_form(person, turn):
    dialog = make_dialog()
    dialog.setWidgetResourceName('Text', TIPS.name)

    def change(given, name, event):
        given.disableNextClose()
        given.setValue('Menu', ([str(turn)], 0))
        given.hideWidget('Toggle')
        given.enableWidget('Text', False)

    dialog.addCallback('Button', ui.EventType.ACTIVATE, change)
    person.answer('Form', press='Button')
    person.answer('Form', press='OK')
    person.answer('Form', press='Cancel')
    assert dialog.launch() == 'CloseButton_Cancel' and dialog.getValue('Menu') == str(turn)
    person.answer('Form', press='OK')
    assert dialog.launch() == 'CloseButton_OK'


def open_another(person, turn):
    dialog = make_dialog('Outer')
    dialog.addCallback('Button', ui.EventType.ACTIVATE, lambda *_: (answer_message(person, turn),
                                                                    person.answer('Outer', press='OK')))
    person.answer('Outer', press='Button')
    assert dialog.launch() == 'CloseButton_OK'


def raise_while_it_runs(person, turn):
    dialog = make_dialog()

    def give_up(*_):
        raise LookupError(turn)

    dialog.addCallback('Text', ui.EventType.VALUE_CHANGED, give_up)
    person.answer('Form', {'Text': 'b\n'})
    with pytest.raises(LookupError):
        dialog.launch()


def drop_from_a_callback(person, turn):
    kept = [make_dialog()]
    kept[0].addCallback('Button', ui.EventType.ACTIVATE, lambda *_: kept.clear())
    person.answer('Form', press='Button')
    person.answer('Form', press='OK')
    assert kept[0].launch() == 'CloseButton_OK' and not kept


def pick_a_path(person, turn):
    person.answer('Pick', {'Files': 'inner'}, 'OK')
    assert ui.showBrowser('Pick', FOLDER.name) == os.path.join(FOLDER.name, 'inner')


UNSEEN = [build_and_use, keep_in_a_cycle, refuse, raise_in_a_callback]
SHOWN = [answer_form, answer_message, act_on_the_form, open_another, raise_while_it_runs, drop_from_a_callback]


def let_go():
    gc.collect()
    # What goes when the loop comes around that the application itself runs in.
    QApplication.processEvents()
    QApplication.sendPostedEvents(None, QEvent.Type.DeferredDelete.value)


def count_lasting(folder):
    """The entries of a folder, without those that come and go: the application looks at its directory each second."""
    fewest = len(os.listdir(folder))
    for _ in range(50):
        time.sleep(0.005)
        fewest = min(fewest, len(os.listdir(folder)))
    return fewest


def count_things():
    """What must be as many at the end as after the warm-up."""
    let_go()
    things = Counter({'files': count_lasting('/proc/self/fd'), 'threads': count_lasting('/proc/self/task'),
                      'widgets': len(QApplication.allWidgets())})
    if QApplication.platformName() == 'xcb':
        told = subprocess.run(['xrestop', '-b', '-m', '1'], capture_output=True, text=True, check=True).stdout
        for kind, number in re.findall(r'^\t([\w ]*?) *: (\d+)$', told, re.MULTILINE):
            if kind not in ('res_base', 'pixmap bytes'):
                things['X ' + kind] += int(number)
    return things


def get_resident():
    let_go()
    with open('/proc/self/statm') as statm:
        return int(statm.read().split()[1]) * os.sysconf('SC_PAGE_SIZE')


def fit_growth(samples):
    """What a line through the samples, which are equally far from each other, grows by from end to end."""
    middle = (len(samples) - 1) / 2
    squares = sum((place - middle) ** 2 for place in range(len(samples)))
    return sum((place - middle) * amount for place, amount in enumerate(samples)) / squares * (len(samples) - 1)


def soak(work, count):
    """Does it so often; gives the bytes that the process has grown by after the first fifth, the things that are more
    then, and the processor's time of the last thousand in those of the first one."""
    resident, seconds = [], []
    for turn in range(count):
        if turn == count // 5:
            before = count_things()
        if turn % (count // 100) == 0:
            resident.append(get_resident())
            seconds.append(time.process_time())
        work(turn)
    seconds.append(time.process_time())
    after = count_things()
    thousand = 100000 // count
    slower = ((seconds[-1] - seconds[-1 - thousand]) / (seconds[20 + thousand] - seconds[20])) if thousand <= 40 else None
    return fit_growth(resident[20:]), {kind: '%d, not %d' % (after[kind], before[kind]) for kind in before | after
                                       if after[kind] != before[kind]}, slower


def keeps_what_was_freed():
    with open('/proc/self/maps') as maps:
        return 'libasan' in maps.read()


def main(setting, count):
    ui.makeXmlFromWidgetList([('PushButton', 'the application is there from here on')])
    QPixmapCache.setCacheLimit(0)  # it grows up to a bound of its own
    inside = os.path.basename(os.readlink('/proc/self/exe')) == 'velmora'
    start = time.monotonic()
    if setting == 'unseen':
        growth, left, slower = soak(lambda turn: UNSEEN[turn % len(UNSEEN)](turn), count)
    else:
        works = SHOWN + [pick_a_path] * inside
        with testing.person() as person:
            growth, left, slower = soak(lambda turn: works[turn % len(works)](person, turn), count)
    print('%-8s %-12s %7d dialogs %6.0f s   grown by %6.0f KB   left: %s   last thousand: %s'
          % (setting, 'application' if inside else QApplication.platformName(), count, time.monotonic() - start,
             growth / 1024, left or 'nothing', slower and '%.2f of the first' % slower), flush=True)
    assert not left, 'What is left when the dialogs have gone: %s' % left
    assert growth < MOST_GROWTH or keeps_what_was_freed(), 'The process has grown by %.0f bytes' % growth
    assert slower is None or slower < SLOWEST, 'The last thousand took %.2f times as long as the first' % slower


if __name__ == '__main__':
    main(sys.argv[1], int(sys.argv[2]))
