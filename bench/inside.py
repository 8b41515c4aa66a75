"""Measures what is special inside the application, which runs this, and prints it as JSON."""

import gc
import json
import time

from quorvane_velmora import ui
from sides import application, rows

TURNS = 5


def best(work):
    """The least time of some turns; C{work} gives what is to live for so long."""
    seconds = []
    for _ in range(TURNS):
        gc.collect()
        start = time.perf_counter()
        kept = work()
        seconds.append(time.perf_counter() - start)
        del kept
        application.processEvents()
    return min(seconds)


def build(count):
    list_of_rows = rows(count)
    return best(lambda: ui.createDialog('', ui.makeXmlFromWidgetList(list_of_rows), 400, 300))


def drop(count):
    """A dialog goes before the loop has turned."""
    xml = ui.makeXmlFromWidgetList(rows(count))
    dialogs = []
    seconds = []
    for _ in range(TURNS):
        dialogs.append(ui.createDialog('', xml, 400, 300))
        start = time.perf_counter()
        dialogs.clear()
        seconds.append(time.perf_counter() - start)
        application.processEvents()
    return min(seconds)


def take_back(count):
    """Callables of as many widgets, the last one first."""
    dialog = ui.createDialog('', ui.makeXmlFromWidgetList(rows(count)), 400, 300)
    heard = [('w%d' % i, ui.EventType.VALUE_CHANGED, lambda *given: None) for i in range(count)]
    seconds = []
    for _ in range(TURNS):
        for name, event, call in heard:
            dialog.addCallback(name, event, call)
        start = time.perf_counter()
        for name, event, call in reversed(heard):
            dialog.removeCallback(name, event, call)
        seconds.append(time.perf_counter() - start)
    return min(seconds)


def make_many(count):
    xml = ui.makeXmlFromWidgetList(rows(3))
    return best(lambda: [ui.createDialog('', xml, 400, 300) for _ in range(count)])


print(json.dumps({'build': {count: build(count) for count in (1000, 10000)},
                  'drop before a turn': {count: drop(count) for count in (1000, 10000)},
                  'callbacks taken back': {count: take_back(count) for count in (1000, 10000)},
                  'dialogs made in one turn': {count: make_many(count) for count in (100, 1000)}}))
