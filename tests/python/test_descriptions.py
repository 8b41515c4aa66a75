"""Descriptions written by hand: what a good one builds, and how a bad one is refused."""

import pytest

import stage
from descriptions import close_button, container, widget
from quorvane_velmora import ui
from PyQt6.QtCore import QPoint

GOOD = '''<?xml version="1.0" encoding="UTF-8"?>
<!-- two boxes side by side, and a note above the first -->
<Container>
  <Widget Name="main"><Layout><Constraint>
    <X1 Value="1" Type="u" Target="l"/> <Y1 Value="1" Type="u" Target="b"/>
    <X2 Value="-1" Type="uu" Target="r"/> <Y2 Value="-1" Type="uu" Target="t"/>
  </Constraint></Layout></Widget>
  <Group Type="Children">
    <Container>
      <Widget Name="left"><Layout><Constraint>
        <X1 Value="0" Type="u" Target="l"/> <Y1 Value="0" Type="u" Target="b"/>
        <X2 Value="30" Type="u" Target="w"/> <Y2 Value="10" Type="u" Target="h"/>
      </Constraint></Layout></Widget>
      <Group Type="Children">
        <PushButton>
          <Widget Name="CloseButton_Go"><LabelString><Text>Go &amp; <![CDATA[<win>]]></Text></LabelString>
          <Layout><Constraint>
            <X1 Value="12" Type="u" Target="w"/> <Y1 Value="0" Type="u" Target="b"/>
            <X2 Value="0" Type="u" Target="r"/> <Y2 Value="4" Type="u" Target="h"/>
          </Constraint></Layout></Widget>
        </PushButton>
      </Group>
    </Container>
    <Menu>
      <Widget Name="right"><Layout><Constraint>
        <X1 Value="2" Type="u" Target="s" Sibling="left"/> <Y1 Value="4" Type="u" Target="h"/>
        <X2 Value="0" Type="u" Target="r"/> <Y2 Value="0" Type="u" Target="t"/>
      </Constraint></Layout>
      <MenuString><Text>one</Text><Text>two</Text></MenuString>
      <Selection><Int> 1 </Int></Selection></Widget>
    </Menu>
    <TextField>
      <Widget Name="note"><Layout><Constraint>
        <X1 Value="0" Type="u" Target="l"/> <Y1 Value="1" Type="u" Target="s" Sibling="left"/>
        <X2 Value="-2" Type="u" Target="s" Sibling="right"/> <Y2 Value="4" Type="uu" Target="h"/>
      </Constraint></Layout>
      <LabelAlign><Align H="Center" V="Center"/></LabelAlign></Widget>
    </TextField>
  </Group>
</Container>
'''


def test_a_complete_description_builds_widgets_where_their_siblings_put_them(user):
    dialog = ui.createDialog('Hand-written', GOOD, 500, 324 - stage.TITLE_HEIGHT, {'note': 'hello'})
    assert dialog.getValues() == {'right': 'two', 'note': 'hello'}
    seen = {}

    def look(user):
        for name in 'left', 'CloseButton_Go', 'right', 'note':
            found = user.find(name)
            corner = found.mapTo(user.window(), QPoint(0, 0))
            seen[name] = [corner.x(), corner.x() + found.width(), corner.y(), corner.y() + found.height()]
        assert user.find('CloseButton_Go').text() == 'Go && <win>'
        user.close('Go')

    user.plan(look)
    assert dialog.launch() == 'CloseButton_Go'
    assert seen['left'] == [7, 217, 247, 317]
    assert seen['CloseButton_Go'][:2] == [133, 217] and seen['right'][:2] == [231, 493]
    assert seen['note'][:2] == [7, 217]
    for name, bottom, top in ('CloseButton_Go', 317, 289), ('right', 35, 7), ('note', 240, 212):
        assert 0 <= seen[name][2] - top <= 2 and 0 <= bottom - seen[name][3] <= 2


def replaced(old, new):
    """The good description with one place changed, and the line of that place."""
    assert old in GOOD
    return GOOD.replace(old, new, 1), GOOD[:GOOD.index(old)].count('\n') + 1


LEFT_X1 = '<X1 Value="0" Type="u" Target="l"/>'
LEFT_X2 = '<X2 Value="30" Type="u" Target="w"/>'
RIGHT_X1 = '<X1 Value="2" Type="u" Target="s" Sibling="left"/>'
RIGHT_WIDGET = '<Widget Name="right">'
BAD = {
    'no XML': ('words', 1, 'outside of the root'),
    'an unknown widget': (GOOD.replace('Menu>', 'Dial>'), replaced('<Menu>', '')[1], '"Dial"'),
    'an unknown property': (*replaced('<LabelAlign>', '<Colour/><LabelAlign>'), '"Colour"'),
    'an unknown attribute': (*replaced(RIGHT_WIDGET, '<Widget Name="right" Id="1">'), '"Id"'),
    'bytes that are no UTF-8': (GOOD.encode().replace(b'Go &amp;', b'Go \xff'), replaced('Go &amp;', '')[1], 'UTF-8'),
    'a number with a point': (*replaced('Value="30"', 'Value="3.5"'), '"3.5"'),
    'a number as a word': (*replaced('Value="30"', 'Value="wide"'), '"wide"'),
    'a number beyond all': (*replaced('Value="30"', 'Value="99999999999"'), '"99999999999"'),
    'an unknown measure': (*replaced('Value="30" Type="u"', 'Value="30" Type="px"'), '"px"'),
    'an unknown edge code': (*replaced(LEFT_X2, '<X2 Value="30" Type="u" Target="q"/>'), '"q"'),
    'a code of the other direction': (*replaced(LEFT_X2, '<X2 Value="30" Type="u" Target="h"/>'), '"h"'),
    'a sibling where none is asked for': (
        *replaced(LEFT_X2, '<X2 Value="30" Type="u" Target="w" Sibling="right"/>'), 'Sibling'),
    'no sibling where one is asked for': (*replaced(RIGHT_X1, '<X1 Value="2" Type="u" Target="s"/>'), 'Sibling'),
    'a sibling that is not there': (GOOD.replace('Sibling="left"', 'Sibling="lost"', 1), replaced('<Menu>', '')[1],
                                    '"lost"'),
    'a sibling from another container': (GOOD.replace('Sibling="left"', 'Sibling="CloseButton_Go"', 1),
                                         replaced('<Menu>', '')[1], '"CloseButton_Go"'),
    'siblings in a ring': (GOOD.replace(LEFT_X2, '<X2 Value="0" Type="u" Target="s" Sibling="right"/>'), None,
                           'hangs on itself'),
    'two edges that measure from each other': (
        GOOD.replace(LEFT_X1, LEFT_X1.replace('"l"', '"w"'), 1), replaced('<Container>\n      <W', '')[1],
        'hangs on itself'),
    'a missing edge': (GOOD.replace(LEFT_X2, '', 1), replaced('<Widget Name="left">', '')[1], '"X2"'),
    'an edge twice': (*replaced(LEFT_X2, LEFT_X2 * 2), '"X2"'),
    'no name': (*replaced(RIGHT_WIDGET, '<Widget>'), 'Name'),
    'no layout': (container('main', '<Menu><Widget Name="bare"/></Menu>'), None, 'Layout'),
    'an alignment of its own': (*replaced('H="Center"', 'H="Right"'), '"Right"'),
    'a group of another type': (*replaced('Type="Children"', 'Type="Friends"'), '"Friends"'),
}


@pytest.mark.parametrize('case', BAD.values(), ids=BAD)
def test_a_bad_description_is_refused_with_its_line_and_the_next_one_builds(case):
    description, line, words = (*case, '')[:3]
    with pytest.raises(RuntimeError, match=r'^line %s: .*%s' % (line or r'\d+', words)) as caught:
        ui.createDialog('bad', description)
    assert caught.type is RuntimeError and len(str(caught.value)) > len('line 99: ')
    assert ui.createDialog('good', GOOD).getValue('right') == 'two'


@pytest.mark.parametrize('description', ['', ' \n', '<!-- nothing -->', '<?xml version="1.0"?>\n'])
def test_a_description_without_any_element_is_refused(description):
    with pytest.raises(RuntimeError, match='Null pointer'):
        ui.createDialog('empty', description)


def nested(depth):
    tree = close_button('OK')
    for level in range(depth, 0, -1):
        tree = container('level %d' % level, tree)
    return tree


def test_256_nested_containers_are_shown(user):
    dialog = ui.createDialog('deep', nested(256), 300, 100)
    assert user.run(dialog) == 'CloseButton_OK'


@pytest.mark.parametrize('depth', [257, 300, 5000])
def test_deeper_nesting_is_refused_with_its_line(depth):
    description = nested(depth)
    with pytest.raises(RuntimeError, match='nested deeper than') as caught:
        ui.createDialog('deep', description)
    line = int(str(caught.value).partition(':')[0][len('line '):])
    assert depth == 5000 or '<Container><Widget Name="level 257">' in description.split('\n')[line - 1]


def test_errors_that_quote_a_huge_text_lose_its_middle():
    huge = 'x' * 10000000
    dialog = ui.createDialog('t', container('c', widget('TextField', huge)))
    for refused in (lambda: ui.createDialog('t', '<%s/>' % huge), lambda: ui.showDialog('t', huge),
                    lambda: ui.createDialog('t', 'x', **{huge: 1}), lambda: dialog.setValue(huge, 5)):
        with pytest.raises(Exception) as error:
            refused()
        words = [str(error.value), *error.value.__dict__.get('__notes__', [])]
        assert max(map(len, words)) < 11000 and any('xxx … xxx' in one for one in words)
