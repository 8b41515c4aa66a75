"""The graphs of compositions for scripts, C{libKVpyextGraph} under the name that scripts know it by."""

import sys

from quorvane_velmora.libs import libKVpyextGraph

sys.modules[__name__] = libKVpyextGraph
