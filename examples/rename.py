"""Renames the files of a folder, and shows beforehand what they will be called.

    python3 rename.py FOLDER

Enter in a field brings the preview up to date.
"""

import os
import sys

from quorvane_velmora import ui

PREVIEWS = ['First', 'Second', 'Third']
CASES = ['As it is', 'Lower', 'Upper']


class Renamer:
    def __init__(self, folder):
        self.folder = folder
        self.files = sorted(entry.name for entry in os.scandir(folder) if entry.is_file())
        self.dialog = ui.createDialog('Rename', ui.makeXmlFromWidgetList([
            ('TextField', 'Find', 'Find'),
            ('TextField', 'Replace', 'Replace by'),
            ('Menu', 'Case', 'Letters', (CASES, 0)),
            *(('TextField', name, label) for name, label in zip(PREVIEWS, ['Preview', '', ''])),
        ], ['Rename', 'Cancel']), 400, 224)
        for name in PREVIEWS:
            self.dialog.enableWidget(name, False)
        for name in 'Find', 'Replace', 'Case':
            self.dialog.addCallback(name, ui.EventType.VALUE_CHANGED, self.preview)
        self.dialog.addCallback('CloseButton_Rename', ui.EventType.ACTIVATE, self.rename)
        self.preview()

    def plan(self):
        """The new name of each file that gets one."""
        values = self.dialog.getValues()
        change = {'Lower': str.lower, 'Upper': str.upper}.get(values['Case'], str)
        names = {file: change(file.replace(values['Find'], values['Replace']) if values['Find'] else file)
                 for file in self.files}
        return {old: new for old, new in names.items() if old != new}

    def preview(self, *_):
        plan = self.plan()
        lines = ['%s  \N{RIGHTWARDS ARROW}  %s' % change for change in plan.items()]
        if len(lines) > len(PREVIEWS):
            lines[len(PREVIEWS) - 1:] = ['and %d more' % (len(lines) - len(PREVIEWS) + 1)]
        lines += [''] * (len(PREVIEWS) - len(lines))
        self.dialog.setValues(dict(zip(PREVIEWS, lines)), False)
        self.dialog.enableWidget('CloseButton_Rename', bool(plan))

    def rename(self, *_):
        plan = self.plan()
        left = set(self.files) - set(plan)
        bad = sorted({new for new in plan.values() if not new or '/' in new})
        taken = sorted({new for new in plan.values() if list(plan.values()).count(new) > 1 or new in left})
        if bad or taken:
            self.dialog.disableNextClose()
            ui.showMessageBox('Rename', ['No file can be called "%s".' % name for name in bad] +
                              ['More than one file would be called %s.' % name for name in taken])
            return
        # In two steps: a new name can be another file's old one.
        for old in plan:
            os.rename(self.path(old), self.path(old) + '.renaming')
        for old, new in plan.items():
            os.rename(self.path(old) + '.renaming', self.path(new))
            print('%s -> %s' % (old, new))

    def path(self, name):
        return os.path.join(self.folder, name)

    def run(self):
        self.dialog.launch()


Renamer(sys.argv[1] if len(sys.argv) > 1 else os.getcwd()).run()
