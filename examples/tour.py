"""A tour through the application: changes a value of an open composition, and writes a report to a folder.

    ./run app examples/tour.py

The composition's own file changes only where "Save" is ticked.
"""

import glob
import os

from quorvane_velmora import graph, ui


class Tour:
    def __init__(self, shots, selection):
        self.shots = {'%d  %s' % (place, shot.getName()): shot for place, shot in enumerate(shots, 1)}
        self.selection = selection
        self.values = {}
        self.done = []
        xml = ui.makeXmlFromWidgetList([
            ('Menu', 'Composition', 'Composition'), ('Menu', 'Value', 'Value'), ('TextField', 'Text', 'Change to'),
            ('ToggleButton', 'Save', 'Save'),
            ('Label', 'Selection', 'Files', '%d selected in the browser' % len(selection)),
        ], ['Apply', 'Cancel'])
        self.dialog = ui.createDialog('Tour', xml, 400, 196)
        self.dialog.addCallback('Composition', ui.EventType.VALUE_CHANGED, self.showValues)
        self.dialog.addCallback('Value', ui.EventType.VALUE_CHANGED, self.showText)
        self.dialog.addCallback('CloseButton_Apply', ui.EventType.ACTIVATE, self.apply)
        current = shots.index(ui.Workspace.getCurrentComposition())
        self.dialog.setValue('Composition', (list(self.shots), current))

    def shot(self):
        return self.shots[self.dialog.getValue('Composition')]

    def showValues(self, dialog, widgetName, eventType):
        shot = self.shot()
        self.values = {'%s: %s' % (node, key): (node, key)
                       for node in shot.getNodes() for key in shot.getNodeValues(node)}
        gains = [place for place, (node, key) in enumerate(self.values.values()) if key == 'gain']
        dialog.setValue('Value', (list(self.values), gains[0] if gains else 0))
        dialog.enableWidget('CloseButton_Apply', bool(self.values))

    def showText(self, dialog, widgetName, eventType):
        node, key = self.values.get(dialog.getValue('Value'), (None, None))
        dialog.setValue('Text', self.shot().getNodeValues(node)[key] if node else '')

    def apply(self, dialog, widgetName, eventType):
        try:
            self.change(self.shot(), *self.values[dialog.getValue('Value')], dialog.getValue('Text'))
        except graph.GraphError as refusal:
            dialog.disableNextClose()
            ui.showMessageBox('Tour', [str(refusal)])

    def change(self, shot, node, key, text):
        cg = ui.CursorGuard('busy')
        shot.setNodeValue(node, key, text)
        self.done = ['%s of %s is now %s.' % (key, node, text or 'empty')]
        if self.dialog.getValue('Save'):
            shot.save()
            self.done.append('The composition has been saved.')

    def accept(self, focusPath, currentPath):
        folder = focusPath or currentPath
        if not os.path.isdir(folder) or not os.access(folder, os.W_OK):
            ui.showMessageBox('Tour', ['A report needs a folder that can be written to.',
                                       'Select one, or nothing for the folder that is shown.'])
            return ''
        question = ['The report is there already. Replace it?']
        isThere = os.path.exists(self.reportPath(folder))
        return '' if isThere and ui.showMessageBox('Tour', question, ['Replace', 'Cancel']) != 'Replace' else folder

    def reportPath(self, folder):
        return os.path.join(folder, self.shot().getName() + '.report.txt')

    def report(self, path):
        cg = ui.CursorGuard('busy')
        with open(path, 'w', encoding='utf-8', errors='surrogateescape') as file:
            print(self.shot().getPath(), *self.done, sep='\n', file=file)
            print('Selected files:', *self.selection or ['none'], sep='\n  ', file=file)
        self.done.append('The report is ' + os.path.basename(path))

    def run(self):
        if self.dialog.launch() != 'CloseButton_Apply':
            return
        folder = ui.showBrowser('Folder for the report', os.path.dirname(self.shot().getPath()), self.accept)
        if folder:
            self.report(self.reportPath(folder))
        ui.showMessageBox('Tour', self.done)


# What is selected counts only while the browser has the keyboard: no dialog may come first.
selected = ui.Workspace.getBrowserSelection()
if not ui.Workspace.getNbCompositions() and ui.showMessageBox(
        'Tour', ['No composition is open.', 'Open the examples?'], ['Open', 'Cancel']) == 'Open':
    for path in sorted(glob.glob(os.path.join(os.path.dirname(__file__), 'compositions', '*.vmcomposition'))):
        ui.Workspace.openComposition(graph.readComposition(path))
compositions = ui.Workspace.getCompositions()
if compositions:
    Tour(compositions, selected).run()
