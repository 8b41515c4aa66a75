"""Measures what only a fresh process shows, and prints it: run as C{fresh.py import|memory SIDE}."""

import gc
import os
import sys
import time

ROWS = 5000


def measure_import(side):
    start = time.perf_counter()
    if side == 'ours':
        from quorvane_velmora import ui  # noqa: F401
    elif side == 'PyQt6':
        import PyQt6.QtWidgets  # noqa: F401
    else:
        import tkinter.ttk  # noqa: F401
    return time.perf_counter() - start


def get_resident():
    gc.collect()
    with open('/proc/self/statm') as statm:
        return int(statm.read().split()[1]) * os.sysconf('SC_PAGE_SIZE')


def measure_memory(name):
    import sides
    side = {'ours': sides.Ours, 'PyQt6': sides.PyQt}[name]()
    # Both have Qt, its fonts and its style then.
    for other in sides.Ours(), sides.PyQt():
        other.prepare(30)
        other.launch(other.build(30))
    side.prepare(ROWS)
    before = get_resident()
    form = side.build(ROWS)
    after = get_resident()
    assert side.read(form)['w0'] == 'text'
    return (after - before) / ROWS


print({'import': measure_import, 'memory': measure_memory}[sys.argv[1]](sys.argv[2]))
