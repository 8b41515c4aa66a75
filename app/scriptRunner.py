"""Runs scripts in the application, each as the interpreter on its own would."""

# A script can put anything in the place of what is taken here.
import builtins
import functools
import gc
import os
import pkgutil
import runpy
import signal
import sys
import types
from builtins import (BaseException, KeyboardInterrupt, OSError, SystemExit, compile, exec, getattr, int, isinstance, open,
                      print, str, type)
from importlib.machinery import SourceFileLoader

modules = sys.modules
show_error = sys.__excepthook__
first_path = None


def start(module_folder, stop_signal, stop):
    """Makes the modules importable, and `stop_signal` call `stop`."""
    sys.path.append(os.fsdecode(module_folder))
    signal.signal(stop_signal, stop)
    # Not the interpreter's own hook: with that, PyQt6 ends the process for an exception in a slot.
    sys.excepthook = functools.partial(show_error)


def make_main():
    """A new `__main__` in place of the one before and of all that it had."""
    main = types.ModuleType('__main__')
    main.__dict__.update(__builtins__=builtins, __annotations__={})
    modules['__main__'] = main
    # A dialog of the one before, and the functions that hear of its events, hold each other.
    gc.collect()
    return main.__dict__


def set_first_path(folder):
    """Only the script that runs now has its folder at the head of the path."""
    global first_path
    if first_path is not None and sys.path and sys.path[0] is first_path:
        del sys.path[0]
    sys.path.insert(0, folder)
    first_path = folder


def prepare(is_module, name, target, arguments):
    """The function that runs a script, and its arguments. To be called from no Python function: the script is at the
    bottom of its stack."""
    target = os.fsdecode(target)
    sys.argv = [os.fsdecode(argument) for argument in [b'-m' if is_module else name, *arguments]]
    if is_module:
        try:
            set_first_path(os.getcwd())
        except OSError:
            set_first_path('')
        make_main()
        return runpy._run_module_as_main, (target, True)
    if pkgutil.get_importer(target) is not None:
        # A folder or an archive with a module `__main__` in it.
        set_first_path(target)
        make_main()
        return runpy._run_module_as_main, ('__main__', False)
    set_first_path(os.path.dirname(os.path.realpath(target)))
    with open(target, 'rb') as file:
        source = file.read()
    names = make_main()
    names.update(__file__=target, __cached__=None, __loader__=SourceFileLoader('__main__', target))
    return exec, (compile(source, target, 'exec', dont_inherit=True), names)


def report(error):
    """Prints what ended a script; gives the exit status, and the last line of the traceback."""
    if isinstance(error, SystemExit):
        return get_exit_status(error), ''
    while error.__traceback__ and error.__traceback__.tb_frame.f_code.co_filename == __file__:
        error.__traceback__ = error.__traceback__.tb_next
    try:
        words = str(error)
    except BaseException:
        words = ''
    failure = f'{type(error).__name__}: {words}' if words else type(error).__name__
    hook = getattr(sys, 'excepthook', None)
    try:
        (show_error if hook is None else hook)(type(error), error, error.__traceback__)
    except BaseException as other:
        write_error('Error in sys.excepthook:')
        show_error(type(other), other, other.__traceback__.tb_next)
        write_error('\nOriginal exception was:')
        show_error(type(error), error, error.__traceback__)
    return (130 if isinstance(error, KeyboardInterrupt) else 1), failure


def get_exit_status(error):
    code = error.code
    if code is None:
        return 0
    if isinstance(code, int):
        # What the system has of it; a number that is too large counts as -1.
        return code & 0xff if -2 ** 63 <= code < 2 ** 63 else 0xff
    write_error(code)
    return 1


def write_error(words):
    try:
        if sys.stderr is not None:
            print(words, file=sys.stderr)
    except BaseException:
        pass


def flush():
    for name in 'stdout', 'stderr':
        try:
            getattr(sys, name).flush()
        except BaseException:
            pass
