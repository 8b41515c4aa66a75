"""Reads what the sanitizers wrote during a test run, and fails for every error, for each leak that was allocated by one
of the project's own libraries, and for each race in which one of the two accesses is made there. The interpreter and Qt
keep much until the end of the process, and Qt's locks are not seen; that is theirs."""

import pathlib
import re
import sys

RUNTIMES = re.compile(r'lib(asan|tsan|ubsan|stdc\+\+)\.so')
OURS = re.compile(r'[/(]libKV\w+\.so|\((velmora|\w+Test)\+')
ACCESS = re.compile(r'^  (?:previous )?(?:atomic )?(?:read|write) of .*\n((?:    #.*\n)*)', re.M | re.I)
FRAME = re.compile(r'^\s+#\d+ .*$', re.MULTILINE)


def called_by_us(stack):
    """True if it is our code that calls the runtime."""
    for frame in FRAME.findall(stack):
        if not RUNTIMES.search(frame):
            return bool(OURS.search(frame))
    return False


def is_our_race(race):
    accesses = ACCESS.findall(race)
    return any(map(called_by_us, accesses)) if accesses else bool(OURS.search(race))


def findings(report):
    if 'WARNING: ThreadSanitizer' in report:
        return [race for race in re.split(r'={18}\n', report)
                if 'WARNING: ThreadSanitizer' in race and is_our_race(race)]
    if 'runtime error:' in report or re.search(r'ERROR: AddressSanitizer', report):
        return [report]
    return [leak for leak in re.split(r'\n\n', report) if 'leak of' in leak and called_by_us(leak)]


found = [text for path in sorted(pathlib.Path(sys.argv[1]).glob('report.*'))
         for text in findings(path.read_text(errors='replace'))]
print('\n\n'.join(text[:4000] for text in found[:20]))
print('sanitizer reports of ours: %d' % len(found))
sys.exit(1 if found else 0)
