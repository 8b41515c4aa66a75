"""The form of L{sides} made and used with tkinter, which needs a display."""

import tkinter as tk
from tkinter import ttk

from sides import ENTRIES, TITLE, other_values


class Tk:
    name = 'tkinter'

    def __init__(self):
        self.root = tk.Tk()
        self.root.withdraw()

    def prepare(self, count):
        self.values = other_values(count)

    def build(self, count):
        window = tk.Toplevel(self.root)
        window.withdraw()
        window.title(TITLE)
        window.variables = {}
        for i in range(count):
            name = 'w%d' % i
            variable = tk.BooleanVar(window, True) if i % 3 == 1 else tk.StringVar(window, 'two' if i % 3 else 'text')
            if i % 3 == 0:
                widget = ttk.Entry(window, textvariable=variable)
            elif i % 3 == 1:
                widget = ttk.Checkbutton(window, variable=variable)
            else:
                widget = ttk.Combobox(window, values=ENTRIES, textvariable=variable)
            window.variables[name] = variable
            ttk.Label(window, text='Row %d' % i).grid(row=i, column=0, sticky='w')
            widget.grid(row=i, column=1, sticky='we')
        ttk.Button(window, text='OK', command=window.quit).grid(row=count, column=0)
        return window

    def launch(self, window):
        window.deiconify()
        window.update()
        window.after_idle(window.quit)
        window.mainloop()
        window.withdraw()

    def read(self, window):
        return {name: variable.get() for name, variable in window.variables.items()}

    def write(self, window):
        for name, value in self.values.items():
            window.variables[name].set(value)

    def listen(self, window, name, call):
        window.variables[name].trace_add('write', call)

    def set(self, window, name, text):
        window.variables[name].set(text)
