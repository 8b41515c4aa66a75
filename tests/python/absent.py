"""What stands in for PyQt6 where the interpreter has none: names can be imported and passed on. A test that does more with
one is skipped, and says so."""

import sys
import types

import pytest


def skip(reason='needs PyQt6'):
    """Ends the test. What was planned for its user does not count."""
    skip.isDone = True
    pytest.skip(reason)


class Absent(types.ModuleType):
    def __getattr__(self, name):
        if name.startswith('__'):
            raise AttributeError(name)
        thing = Absent('%s.%s' % (self.__name__, name))
        setattr(self, name, thing)
        return thing

    def _skip(self, *_, **__):
        skip()

    __call__ = __instancecheck__ = __iter__ = __len__ = __getitem__ = __add__ = __radd__ = __sub__ = __rsub__ = _skip

    def __bool__(self):
        return True

    def __or__(self, other):
        return self

    def __mro_entries__(self, bases):
        return (object,)


def install():
    package = sys.modules['PyQt6'] = Absent('PyQt6')
    for name in 'sip', 'QtCore', 'QtGui', 'QtTest', 'QtWidgets':
        sys.modules['PyQt6.' + name] = getattr(package, name)
