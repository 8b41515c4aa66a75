"""Asks for a folder and lists the image sequences in it: in the application's browser, or outside by its path."""

import collections
import os
import re

from quorvane_velmora import ui


def accept(focusPath, currentPath):
    """What is selected, or the folder that is shown where nothing is."""
    folder = focusPath or currentPath
    if os.path.isdir(folder):
        return folder
    ui.showMessageBox('Sequences', ['Please select a folder, not a file.'])
    return ''


def askForPath():
    path = os.getcwd()
    while True:
        values = ui.showSimpleDialog('Sequences', [('TextField', 'Folder', 'Folder', path)], 480, True)
        if values.get('CloseButtonClicked') != 'CloseButton_OK':
            return ''
        path = os.path.expanduser(values['Folder'])
        if os.path.isdir(path):
            return path
        ui.showMessageBox('Sequences', ['There is no such folder.'])


def findFolder():
    try:
        return ui.showBrowser('Sequences', os.getcwd(), accept)
    except ui.UiError:  # outside the application there is no browser
        return askForPath()


def findSequences(folder):
    """The first and the last frame of each sequence, by its name."""
    frames = collections.defaultdict(list)
    for name in os.listdir(folder):
        match = re.fullmatch(r'(.+\.)(\d+)(\.\w+)', name)
        if match:
            start, number, suffix = match.groups()
            frames[start + '#' * len(number) + suffix].append(int(number))
    return {name: (min(numbers), max(numbers)) for name, numbers in sorted(frames.items())}


folder = findFolder()
if folder:
    found = ['%s  %d-%d' % (name, *span) for name, span in findSequences(folder).items()]
    ui.showMessageBox('Sequences', found[:20] or ['There are no sequences here.'])
