"""Adds up the JUnit files of a test run and says how many tests passed, as the last line of it."""

import pathlib
import sys
import xml.etree.ElementTree as ElementTree


def count(folder):
    total = failed = skipped = 0
    for path in sorted(pathlib.Path(folder).glob('*.xml')):
        for suite in ElementTree.parse(path).getroot().iter('testsuite'):
            total += int(suite.get('tests', 0))
            failed += int(suite.get('failures', 0)) + int(suite.get('errors', 0))
            skipped += int(suite.get('skipped', 0) or 0)
    return total - failed - skipped, failed, skipped


passed, failed, skipped = count(sys.argv[1])
print('%d passed, %d failed%s' % (passed, failed, ', %d skipped' % skipped if skipped else ''))
sys.exit(1 if failed or not passed else 0)
