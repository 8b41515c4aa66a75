"""What stands where in a dialog that is on the screen, at any scale and in light and dark colours."""

import itertools
import json

import pytest

from scripts import run_script

pytestmark = pytest.mark.standalone


@pytest.fixture(scope='module', params=itertools.product('12', ['#efefef', '#303030']), ids=str)
def pictures(request):
    """The form as it opens and enlarged, the message box as it opens and enlarged."""
    scale, colour = request.param
    seen = json.loads(run_script('import sys, layout_probe; layout_probe.main(sys.argv[1])', colour,
                                 QT_QPA_PLATFORM='offscreen', QT_SCALE_FACTOR=scale))
    assert [picture['ratio'] for picture in seen] == [float(scale)] * 4
    return seen


def test_all_widgets_stand_inside_the_window_and_none_over_another(pictures):
    for picture, count in zip(pictures, (13, 13, 7, 7)):
        width, height = picture['size']
        assert len(picture['widgets']) == count
        for widget in picture['widgets']:
            x, y, w, h = widget['rect']
            assert x >= 0 and y >= 0 and x + w <= width and y + h <= height, widget
        for one, other in itertools.combinations(picture['widgets'], 2):
            (x1, y1, w1, h1), (x2, y2, w2, h2) = one['rect'], other['rect']
            assert x1 + w1 <= x2 or x2 + w2 <= x1 or y1 + h1 <= y2 or y2 + h2 <= y1, (one, other)


def test_a_caption_and_its_widget_have_their_middle_at_one_height(pictures):
    captions = {'Label_Name of the show': 'Show', 'Label_Do you win against all ?': 'Win',
                'Label_Category': 'Prize', 'Label_Jury': 'Ask the jury again', 'Label_Hint': 'Hint'}
    for picture in pictures[:2]:
        middles = {widget['name']: (2 * widget['rect'][1] + widget['rect'][3]) / 2 * picture['ratio']
                   for widget in picture['widgets']}
        for caption, name in captions.items():
            assert abs(middles[caption] - middles[name]) <= 1


def test_every_text_has_the_room_that_it_needs(pictures):
    for picture in pictures:
        for widget in picture['widgets']:
            if widget['width']:
                needed, room = widget['width']
                assert needed <= room, widget


def test_rows_stand_under_each_other_and_a_larger_window_widens_what_hangs_on_both_sides(pictures):
    small, large = ({widget['name']: widget['rect'] for widget in picture['widgets']} for picture in pictures[:2])
    tops = [small[name][1] for name in ('Show', 'Win', 'Prize', 'Ask the jury again', 'Hint', 'Last')]
    assert tops == sorted(set(tops))
    assert {small[name][0] for name in ('Show', 'Win', 'Prize', 'Ask the jury again', 'Hint', 'Last')} == {7 + 27 * 7}
    grown = {name: (large[name][0] - x, large[name][1] - y, large[name][2] - w, large[name][3] - h)
             for name, (x, y, w, h) in small.items()}
    assert grown['Show'] == grown['Hint'] == (0, 0, 90, 0)
    assert grown['Win'] == grown['Prize'] == grown['Label_Jury'] == (0, 0, 0, 0)
    assert grown['CloseButton_OK'] == (0, 50, 0, 0) and grown['CloseButton_Cancel'] == (90, 50, 0, 0)


def test_every_text_stands_out_from_its_ground(pictures):
    for picture in pictures:
        for widget in picture['widgets']:
            assert widget['contrast'] is None or widget['contrast'] >= 4.5, widget
