"""The extension modules."""
