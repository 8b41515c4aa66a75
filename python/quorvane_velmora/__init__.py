"""Quorvane Velmora for scripts: C{from quorvane_velmora import ui}."""
