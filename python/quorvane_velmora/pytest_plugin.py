"""The person of C{quorvane_velmora.testing} as a fixture of pytest."""

import functools

import pytest


@pytest.fixture
def person(request, tmp_path):
    """Answers the dialogs of the test. Pictures of failures go to C{tmp_path}."""
    from quorvane_velmora import testing

    someone = testing.person(pictures=tmp_path)
    test = request.node.obj

    # What is wrong in the end is a failure of the test, not an error after it.
    @functools.wraps(test)
    def answered(*arguments, **keywords):
        __tracebackhide__ = True
        try:
            with someone:
                return test(*arguments, **keywords)
        except testing.NeverCame as failure:
            pytest.fail(str(failure), pytrace=False)

    request.node.obj = answered
    yield someone
    request.node.obj = test
