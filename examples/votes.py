"""A ballot that reacts: the name is asked for only from those who vote, and nobody votes without one."""

from quorvane_velmora import ui


class Ballot:
    def __init__(self):
        xml = ui.makeXmlFromWidgetList([
            ('ToggleButton', 'Vote', 'Do you vote ?'),
            ('TextField', 'Name', 'Your name'),
            ('Menu', 'Film', 'Best film', (['The Long Take', 'Second Unit', 'Magic Hour'], 0)),
            ('Label', 'Hint', '', 'Tick the box to vote.'),
        ], ['Send', 'Cancel'])
        self.dialog = ui.createDialog('Votes', xml, 400, 168)
        self.dialog.addCallback('Vote', ui.EventType.STATE, self.onVote)
        self.dialog.addCallback('CloseButton_Send', ui.EventType.ACTIVATE, self.onSend)
        for name in ('Vote', 'Name', 'Film', 'CloseButton_Send'):
            self.dialog.setWidgetResourceName(name, 'votes')
        self.enableFields(False)

    def enableFields(self, enable):
        for name in ('Name', 'Film', 'CloseButton_Send'):
            self.dialog.enableWidget(name, enable)
        self.dialog.displayWidget('Hint', not enable)

    def onVote(self, dialog, widgetName, eventType):
        self.enableFields(dialog.getValue(widgetName))

    def onSend(self, dialog, widgetName, eventType):
        if not dialog.getValue('Name').strip():
            dialog.disableNextClose()
            ui.showMessageBox('Votes', ['Please give your name: votes are not secret here.'])

    def run(self):
        if self.dialog.launch() == 'CloseButton_Send':
            print('%(Name)s votes for %(Film)s.' % self.dialog.getValues())
        else:
            print('No vote.')


Ballot().run()
