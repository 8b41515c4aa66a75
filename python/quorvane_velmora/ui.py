"""The user interface for scripts, C{libKVpyextUi} under the name that scripts know it by."""

import sys

from quorvane_velmora.libs import libKVpyextUi

sys.modules[__name__] = libKVpyextUi
