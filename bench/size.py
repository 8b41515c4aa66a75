"""Measures how the cost of a dialog grows with the size of what a script hands over: texts of all kinds in all places, the
entries of a menu, the widgets, and what is done to all of these while a person looks at them."""

import sys
import tempfile
import time
from pathlib import Path

sys.path.insert(0, str(Path(__file__).parent.parent / 'tests' / 'python'))

import sides
from descriptions import close_button, container, text, widget
from quorvane_velmora import testing, ui

# Of which texts are made: what Qt shapes, breaks, replaces and orders in different ways.
LETTERS = {'word': 'x', 'words': 'word ', 'lines': 'ab\n', 'tabs': '\t', 'ampersands': '&amp;', 'marks': '\u0301',
           'Hebrew': '\u05d0\u05d1 ', 'Arabic': '\u0633\u0644\u0627\u0645', 'Chinese': '\u4e2d', 'emoji': '\U0001f600',
           'embeddings': 'a\u202b', 'separators': 'a\u2028'}
FEW, MANY = 100000, 1000000
TOP = '0 u l', '-4 u t', '12 u w', '4 u h'


def make(*widgets, title='Size'):
    return ui.createDialog(title, container('c', *widgets, close_button('OK', *TOP)), 300, 200)


def make_field(words):
    dialog = make(widget('TextField', 'w'))
    dialog.setValue('w', words)
    return dialog


def make_menu(entries):
    dialog = make(widget('Menu', 'w'))
    dialog.setValue('w', (entries, 0))
    return dialog


def make_with_tooltip(words):
    dialog = make(widget('TextField', 'w'))
    with tempfile.NamedTemporaryFile('w', suffix='.xml') as file:
        file.write('<Tooltips><Tooltip Widget="w">%s</Tooltip></Tooltips>' % words)
        file.flush()
        dialog.setWidgetResourceName('w', file.name)
    return dialog


PLACES = {'label': lambda words: make(widget('Label', 'w', content=text(words))),
          'wide label': lambda words: make(widget('Label', 'w', '0 u l', '0 u b', '99999 u w', '999 u h', content=text(words))),
          'button': lambda words: make(widget('PushButton', 'w', content=text(words))),
          'field': make_field,
          'entry of a menu': lambda words: make_menu([words]),
          'title': lambda words: make(title=words),
          'tooltip': make_with_tooltip}


def make_rows(count):
    return ui.createDialog('Size', ui.makeXmlFromWidgetList(sides.rows(count), ['OK']), 400, 28 * count)


COUNTS = {'entries of a menu': (lambda count: make_menu(['entry %d' % i for i in range(count)]), 10000, 100000),
          'rows': (make_rows, 1000, 10000)}


def change_back_and_forth(change, change_back):
    """From top to bottom, where the keyboard is passed on from row to row, and from bottom to top."""
    def change_all(dialog, names):
        for order in names, names[::-1]:
            for call in change, change_back:
                for name in order:
                    call(dialog, name)
                sides.flush()
    return change_all


CHANGES = {'hidden, shown': change_back_and_forth(ui.Dialog.hideWidget, ui.Dialog.showWidget),
           'disabled, enabled': change_back_and_forth(lambda dialog, name: dialog.enableWidget(name, False),
                                                      lambda dialog, name: dialog.enableWidget(name, True)),
           'set': lambda dialog, names: dialog.setValues({name: ('other', False, ([], 3))[i % 3]
                                                          for i, name in enumerate(names)}, False)}


def shown_title(words):
    """As much of a long title as a window has, which counts as Qt does."""
    return words.encode('utf-16-le')[:8190].decode('utf-16-le', 'ignore') + '…'


def run(make_dialog, size):
    """Seconds of the processor from nothing to the end of a dialog that a person presses a button of."""
    start = time.process_time()
    dialog = make_dialog(size)
    with testing.person(60) as person:
        person.answer(shown_title(size) if make_dialog is PLACES['title'] else 'Size', press='OK')
        dialog.launch()
    return time.process_time() - start


def run_change(change, count):
    """Seconds of the processor that a change of all rows takes in the shown dialog, with the picture of it."""
    dialog, seconds = make_rows(count), []

    def change_all(_):
        start = time.process_time()
        change(dialog, ['w%d' % i for i in range(count)])
        sides.flush()
        seconds.append(time.process_time() - start)

    with testing.person(60) as person:
        person.answer('Size', press='OK', do=change_all)
        dialog.launch()
    return seconds[0]


def run_box(words):
    start = time.process_time()
    with testing.person(60) as person:
        person.answer('Size', press='OK')
        ui.showMessageBox('Size', [words])
    return time.process_time() - start


def print_sizes():
    run(PLACES['label'], 'x')  # loads Qt and its fonts
    print('%-18s %-14s %9s %9s %7s' % ('', '', 'few', 'many', 'growth'))
    for place, make_dialog in PLACES.items():
        for name, letter in LETTERS.items():
            print_growth(place, name, lambda size: run(make_dialog, letter * (size // len(letter))), FEW, MANY)
    for name in 'word', 'marks':
        print_growth('label', name + ', more', lambda size: run(PLACES['label'], LETTERS[name] * size), MANY, 10 * MANY)
    for name, letter in LETTERS.items():
        print_growth('message', name, lambda size: run_box(letter * (size // len(letter))), FEW, MANY)
    for what, (make_dialog, few, many) in COUNTS.items():
        print_growth(what, '%d, %d' % (few, many), lambda size: run(make_dialog, size), few, many)
    for what, change in CHANGES.items():
        print_growth(what, '1000, 10000', lambda count: run_change(change, count), 1000, 10000)


def print_growth(what, of_what, once, few, many):
    least, most = (min(once(size) for _ in range(3)) for size in (few, many))
    print('%-18s %-14s %7.0fms %7.0fms %7.1f' % (what, of_what, least * 1e3, most * 1e3, most / least), flush=True)
