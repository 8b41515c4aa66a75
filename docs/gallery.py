"""Makes a contact sheet of the examples' dialogs: at several scales, light and dark, with a large font, from right to left,
with characters of other scripts, in windows of their own and floating in the application.

    ./run gallery            build/gallery/sheet.png
    ./run gallery --docs     and the pictures of the documentation
"""

import os
import pathlib
import shutil
import subprocess
import sys

ROOT = pathlib.Path(__file__).parents[1]
EXAMPLES = ROOT / 'examples'
TARGET = ROOT / 'build' / 'gallery'
# Its path is seen in some pictures.
SHOTS = pathlib.Path('/tmp/velmora-shots')

# The looks, with what chooses them: environment variables, and what is done to the QApplication before a dialog comes.
LOOKS = {
    'plain': ({}, None),
    'scale 1.5': ({'QT_SCALE_FACTOR': '1.5'}, None),
    'scale 2': ({'QT_SCALE_FACTOR': '2'}, None),
    'dark': ({}, 'make_dark'),
    'large font': ({}, 'enlarge_font'),
    'right to left': ({}, 'turn_around'),
}
# The application has a dark look of its own.
FLOATING = ['plain', 'scale 2', 'large font', 'right to left']

# What the examples do not show: characters of other scripts.
SCRIPTS = '''
from quorvane_velmora import ui
def test_scripts(person, look):
    person.answer('镜头发布', {'镜头': 'sh_010 🎬 渲染', 'コメント': 'もっと明るく 😀'}, 'OK', do=look)
    ui.showSimpleDialog('镜头发布', [
        ('TextField', 'shot', '镜头'), ('TextField', 'note', 'コメント'), ('ToggleButton', 'farm', '렌더 팜', True),
        ('Menu', 'step', 'مرحلة', (['تركيب 🎞', 'اضاءة'], 0)), ('PushButton', 'שלח 🚀', 'עברית')], 400, True)
'''

APPLICATION = '''
import os, runpy, sys
from PyQt6.QtWidgets import QApplication
from quorvane_velmora import testing, ui
tour, images = sys.argv[1:]
window = next(one for one in QApplication.topLevelWidgets() if one.objectName() == 'Velmora')
window.resize(1180, 760)
def take(name, thing):
    assert thing.grab().save(os.path.join(images, name))
with testing.person() as person:
    person.answer('Tour', {'Value': 'Grade: gain'}, 'Cancel', do=lambda person: take('application.png', window))
    runpy.run_path(tour, run_name='__main__')
    person.answer('Pick an image', {'Files': 'preview.####.jpg  1-48'}, 'Cancel',
                  do=lambda person: person.picture(os.path.join(images, 'browser.png')))
    ui.showBrowser('Pick an image', os.getcwd())
'''


def make_dark(application):
    from PyQt6.QtGui import QColor, QPalette
    palette = QPalette(QColor(53, 53, 53), QColor(45, 45, 45))
    palette.setColor(QPalette.ColorRole.Base, QColor(35, 35, 35))
    application.setPalette(palette)


def enlarge_font(application):
    font = application.font()
    font.setPointSizeF(2 * font.pointSizeF())
    application.setFont(font)


def turn_around(application):
    from PyQt6.QtCore import Qt
    application.setLayoutDirection(Qt.LayoutDirection.RightToLeft)


def pytest_configure(config):
    """As a plugin of pytest: puts the look on."""
    from PyQt6.QtWidgets import QApplication
    config.application = QApplication.instance() or QApplication(['velmora'])
    config.application.setQuitOnLastWindowClosed(False)
    change = LOOKS[os.environ['GALLERY_LOOK']][1]
    if change:
        globals()[change](config.application)
    for window in config.application.topLevelWidgets():
        if window.objectName() == 'Velmora':
            window.resize(1180, 860)


def take(look, isFloating):
    """Pictures of all examples with a look; gives the folder with them."""
    folder = TARGET / ('%s%s' % (look, ', floating' if isFloating else ''))
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    extra = TARGET / 'test_scripts.py'
    tests = (EXAMPLES / 'test_examples.py').read_text()
    common = tests[:tests.index('def isInside')].replace('Path(__file__).parent', 'Path(%r)' % str(EXAMPLES))
    extra.write_text(common + SCRIPTS)
    program = [os.environ['VELMORA_PROGRAM'], '--exit'] if isFloating else [sys.executable]
    environment = {**os.environ, **LOOKS[look][0], 'VELMORA_PICTURES': str(folder), 'GALLERY_LOOK': look,
                   'QT_QPA_PLATFORM': 'offscreen', 'XDG_CONFIG_HOME': str(folder),
                   'PYTHONPATH': os.pathsep.join([str(ROOT / 'docs'), os.environ.get('PYTHONPATH', '')])}
    done = subprocess.run([*program, '-m', 'pytest', '-q', '-p', 'gallery', '-p', 'no:cacheprovider', '--basetemp=%s' % SHOTS,
                           str(EXAMPLES / 'test_examples.py'), str(extra)], env=environment, capture_output=True, text=True)
    if done.returncode:
        sys.exit('%s:\n%s' % (folder.name, done.stdout))
    return folder


def take_application(images):
    """Pictures of the application with the tour in it, and of the browser, in a folder as a shot has it."""
    shutil.rmtree(SHOTS, ignore_errors=True)
    shutil.copytree(EXAMPLES / 'compositions', SHOTS)
    for folder in 'mattes', 'plates', 'renders':
        (SHOTS / folder).mkdir()
    for frame in range(1, 49):
        (SHOTS / ('preview.%04d.jpg' % frame)).write_bytes(bytes(350000))
    (SHOTS / 'notes.txt').write_text('Notes\n')
    # The application shows the name of the script that runs.
    script = TARGET / 'tour.py'
    script.write_text(APPLICATION)
    compositions = [option for name in ('shot_020', 'shot_010') for option in ('--open', name + '.vmcomposition')]
    subprocess.run([os.environ['VELMORA_PROGRAM'], *compositions, '--exit', script, EXAMPLES / 'tour.py', images], cwd=SHOTS,
                   env={**os.environ, 'QT_QPA_PLATFORM': 'offscreen', 'XDG_CONFIG_HOME': str(TARGET)}, check=True)
    shutil.rmtree(SHOTS)


def paint(folders):
    """One picture of all: a row for each look."""
    from PyQt6.QtCore import QRect, Qt
    from PyQt6.QtGui import QGuiApplication, QImage, QPainter
    application = QGuiApplication(['gallery', '-platform', 'offscreen'])
    rows = [(folder.name, [QImage(str(path)) for path in sorted(folder.glob('*.png'))]) for folder in folders]
    width, height, gap, words = 360, 230, 12, 24
    columns = max(len(images) for _, images in rows)
    sheet = QImage(columns * (width + gap) + gap, len(rows) * (height + gap + words) + gap, QImage.Format.Format_RGB32)
    sheet.fill(Qt.GlobalColor.gray)
    painter = QPainter(sheet)
    for row, (name, images) in enumerate(rows):
        top = gap + row * (height + gap + words)
        painter.drawText(QRect(gap, top, 900, words), Qt.AlignmentFlag.AlignVCenter, name)
        for column, image in enumerate(images):
            if image.width() > width or image.height() > height:
                image = image.scaled(width, height, Qt.AspectRatioMode.KeepAspectRatio,
                                     Qt.TransformationMode.SmoothTransformation)
            painter.drawImage(gap + column * (width + gap), top + words, image)
    painter.end()
    path = TARGET / 'sheet.png'
    sheet.save(str(path))
    del application
    return path


def main(arguments):
    folders = [take(look, False) for look in LOOKS] + [take(look, True) for look in FLOATING]
    print(paint(folders))
    if '--docs' in arguments:
        images = ROOT / 'docs' / 'images'
        for path in folders[0].glob('*.png'):
            if path.stem != 'scripts':
                shutil.copy(path, images)
        take_application(images)


if __name__ == '__main__':
    main(sys.argv[1:])
