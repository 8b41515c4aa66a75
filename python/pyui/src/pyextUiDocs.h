#pragma once

namespace Kv::PyextUi::Docs
{

// The docstrings of the module, in epydoc markup.

constexpr char const* module = "Quorvane Velmora internal UI extension module.";

constexpr char const* showDialog =
    R"(Shows a dialog that a file describes, and blocks until one of its close buttons is pressed.

@param title: The title of the dialog.
@type title: C{str}
@param xmlFile: The path of the file with the dialog's description, in XML.
@type xmlFile: C{str}
@param width: The width of the dialog's content in pixels. A value below 1 stands for 80 % of the screen.
Defaults to -1.
@type width: C{int}
@param height: The height of the dialog's content in pixels. A value below 1 stands for 80 % of the screen.
Defaults to -1.
@type height: C{int}
@param initialValues: The values that the widgets start with, by widget name, in the forms of L{Dialog.setValues}.
No callback runs for them. Defaults to {}.
@type initialValues: C{dict}
@return: The widgets' values by widget name as they stood when the dialog closed, whichever button closed it, and the
name of that button under C{CloseButtonClicked}, which is not there if the dialog was ended without a button.
@rtype: C{dict}
@raise UiError: If the file cannot be opened, or the dialog has no close button.
@raise TypeError: If an initial value is of the wrong form.
@raise IndexError: If the tuple of an initial value for a menu is too short.
@raise RuntimeError: If the file is a directory, if the description is faulty (the words name the line), or if there is
no display to show it on.)";

constexpr char const* showSimpleDialog =
    R"(Shows a form made from a list of widgets, and blocks until it is closed. Example::

    values = ui.showSimpleDialog( 'Awards', [
        ( 'TextField', 'Show', 'Show', 'Academy Awards' ),
        ( 'ToggleButton', 'Win', 'Do you win ?', True ) ], 400, True )
    if values.get( 'CloseButtonClicked' ) == 'CloseButton_OK':
        print( values[ 'Show' ], values[ 'Win' ] )

@param title: The title of the dialog.
@type title: C{str}
@param list: The widgets from top to bottom, in the form of L{makeXmlFromWidgetList}.
@type list: C{list}
@param width: The width of the dialog's content in pixels. The height follows from the number of widgets.
@type width: C{int}
@param cancelButton: Whether there is a button "Cancel" beside "OK". Default is C{False}.
@type cancelButton: C{bool}
@param initialValues: The values that the widgets start with, by widget name, in the forms of L{Dialog.setValues}.
No callback runs for them. Defaults to {}.
@type initialValues: C{dict}
@return: The widgets' values by widget name as they stood when the dialog closed, whichever button closed it, and the
name of that button, C{CloseButton_OK} or C{CloseButton_Cancel}, under C{CloseButtonClicked}, which is not there if the
dialog was ended without a button.
@rtype: C{dict}
@raise UiError: If an entry of the list has fewer than two elements.
@raise TypeError: If an entry or a value is of the wrong form.
@raise IndexError: If the tuple for a menu is too short.
@raise RuntimeError: If a widget type is unknown, if a text holds a character that a description cannot hold, or if there
is no display to show the dialog on.)";

constexpr char const* showMessageBox =
    R"(Shows lines of text, and blocks until one of the close buttons is pressed. The box is as wide as its longest line.
There is no C{showMessage} beside it: a message without a choice is a box without C{closeButtons}.

@param title: The title of the box.
@type title: C{str}
@param messages: The lines from top to bottom. Control characters in them are shown as signs.
@type messages: C{list} of C{str}
@param closeButtons: The labels of the close buttons. An empty list gets the label "OK". Defaults to [].
@type closeButtons: C{list} of C{str}
@return: The label of the button that closed the box.
@rtype: C{str}
@raise TypeError: If a line or a label is no C{str}.
@raise IndexError: If the box was ended without one of its buttons.
@raise RuntimeError: If there is no display to show the box on.)";

constexpr char const* makeXmlFromWidgetList =
    R"(Makes the description of a form from a list of widgets: a row for each, with its label on the left, and the close
buttons along the bottom. Nothing is shown.

@param widgets: The widgets from top to bottom, each a tuple ( type, name, label, initial state ) of which the last two
can be left out. The type is one of C{TextField}, C{ToggleButton}, C{Menu}, C{Label} and C{PushButton}. The initial state
of a C{TextField} or C{Label} is a C{str}, that of a C{ToggleButton} a C{bool}, that of a C{Menu} a tuple of the list of
its entries and the index of the selected one. A C{PushButton} shows its name.
@type widgets: C{list} of C{tuple}
@param closeButtons: The labels of the close buttons. The button's name is C{CloseButton_} and the label. An empty list
gets the label "OK". Defaults to [].
@type closeButtons: C{list} of C{str}
@return: The description, for L{createDialog}.
@rtype: C{str}
@raise UiError: If an entry has fewer than two elements.
@raise TypeError: If an entry or a value is of the wrong form.
@raise IndexError: If the tuple for a menu is too short.
@raise RuntimeError: If a text holds a character that a description cannot hold, or a type cannot be the name of an
element.)";

constexpr char const* createDialog =
    R"(Makes a dialog from a description. It is launched by L{Dialog.launch}.

@param title: The title of the dialog.
@type title: C{str}
@param xmlString: The dialog's description, in XML.
@type xmlString: C{str}
@param width: The width of the dialog's content in pixels. A value below 1 stands for 80 % of the screen.
Defaults to -1.
@type width: C{int}
@param height: The height of the dialog's content in pixels. A value below 1 stands for 80 % of the screen.
Defaults to -1.
@type height: C{int}
@param initialValues: The values that the widgets start with, by widget name, in the forms of L{Dialog.setValues}.
No callback runs for them. Defaults to {}.
@type initialValues: C{dict}
@return: The dialog.
@rtype: L{Dialog}
@raise TypeError: If an initial value is of the wrong form.
@raise IndexError: If the tuple of an initial value for a menu is too short.
@raise RuntimeError: If the description is faulty; the words name the line.)";

constexpr char const* showBrowser =
    R"(Shows the file browser of Velmora for picking a path, and blocks until it is closed. It only works within Velmora.
Example::

    def isImage( focusPath, currentPath ):
        return focusPath if focusPath.endswith( '.exr' ) else ''

    path = ui.showBrowser( 'Pick an image', '/shots', isImage )

@param title: The title of the browser.
@type title: C{str}
@param initialPath: The path that the browser goes to first: a directory, or a file, which then is in focus. One that
does not exist leaves the browser at the root of the file system. Defaults to "".
@type initialPath: C{str}
@param pathValidationCb: A callable that is called each time that the user presses OK, with the path in focus, which is
empty if nothing is selected, and the path of the current directory. It returns the path to give back, whatever that is,
or an empty C{str}, which keeps the browser open. Without it, and where it cannot be called, the path in focus is given
back, or the current directory if nothing is in focus. Defaults to C{None}.
@type pathValidationCb: callable
@return: The path, or an empty C{str} if the user has pressed Cancel. Of a sequence of files shown as one entry, it is
that of the first file.
@rtype: C{str}
@raise UiError: If it is not used within Velmora.
@raise ValueError: If a path holds a zero byte.)";

constexpr char const* eventType =
    R"(What a widget tells the callables that L{Dialog.addCallback} has registered:
  - C{ENABLE}: a widget has been enabled
  - C{DISABLE}: a widget has been disabled
  - C{STATE}: a toggle button's state has changed
  - C{ACTIVATE}: a widget has been activated (clicked)
  - C{VALUE_CHANGED}: a text field's value has been changed, when the user changes it and presses the Enter key)";

constexpr char const* dialog =
    R"(A dialog, whose widgets can be filled, read, and heard of. There is no public constructor: L{createDialog} is the only
way to get hold of a C{Dialog}.

A dialog can use four kinds of widgets: push button, toggle button, text field and menu. A push button whose name begins
with C{CloseButton_} closes the dialog.

A widget raises these events, for which L{addCallback} registers a callable:
  - C{EventType.ENABLE}: a widget has been enabled
  - C{EventType.DISABLE}: a widget has been disabled
  - C{EventType.STATE}: a toggle button's state has changed
  - C{EventType.ACTIVATE}: a widget has been activated (clicked)
  - C{EventType.VALUE_CHANGED}: a text field's value has been changed, when the user changes it and presses the Enter key

Example::

    def myCallbackFunction1( dialog, widgetName, eventType ):
        print( widgetName, dialog.getValue( widgetName ) )

    xml = ui.makeXmlFromWidgetList( [ ( 'ToggleButton', 'Vote', 'Do you vote ?' ) ], [ 'OK', 'Cancel' ] )
    dialog = ui.createDialog( 'MyDialog', xml, 400, 84 )
    dialog.addCallback( 'Vote', ui.EventType.ACTIVATE, myCallbackFunction1 )
    if dialog.launch() == 'CloseButton_OK':
        print( dialog.getValues() ))";

constexpr char const* launch =
    R"(Shows the dialog and blocks until one of its close buttons is pressed. It can be launched any number of times; its
widgets keep their values. What a callback raises in the meantime comes out of it.

@return: The name of the close button. If the dialog was ended without one, the name of the button pressed last before,
or an empty text.
@rtype: C{str}
@raise UiError: If the dialog has no close button.
@raise RuntimeError: If there is no display to show the dialog on.)";

constexpr char const* getValue =
    R"(Gets the value of a widget: the text of a text field as a C{str}, the state of a toggle button as a C{bool}, the text
of the selected entry of a menu as a C{str}.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@return: The value, or C{None} if no widget of that name has one.
@rtype: C{str}, C{bool} or C{None})";

constexpr char const* getValues =
    R"(Gets the values of all widgets, each in the form of L{getValue}.

@return: The values by widget name. Once a close button has been pressed, its name is there under
C{CloseButtonClicked}.
@rtype: C{dict})";

constexpr char const* setValue =
    R"(Sets the value of a widget. Nothing happens if no widget of that name takes one.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param value: The value: a C{str} or C{None} for a text field, a C{bool} for a toggle button, a tuple of the list of the
entries and the index of the selected one for a menu, whose entries are replaced.
@param invokeCallback: Whether the callbacks of the widget run for the change. Defaults to C{True}.
@type invokeCallback: C{bool}
@raise TypeError: If the value is of the wrong form.
@raise IndexError: If the tuple for a menu is too short.)";

constexpr char const* setValues =
    R"(Sets the values of the widgets that C{values} names, in the order of the description. A name that no widget has is
ignored.

@param values: The values by widget name, each in the form of L{setValue}; but the entries of a menu are added to
those that it has, and the index counts in all of them.
@type values: C{dict}
@param invokeCallback: Whether the callbacks of the widgets run for the changes. Defaults to C{True}.
@type invokeCallback: C{bool}
@raise TypeError: If a value is of the wrong form. The widgets before it keep what they were given.
@raise IndexError: If the tuple for a menu is too short.)";

constexpr char const* addCallback =
    R"(Registers a callable for an event of a widget. It is kept until it is removed, or the dialog goes.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param eventType: The event.
@type eventType: L{EventType}
@param cb: The callable, called as C{def func( Dialog, widgetName, eventType )}. Its result is ignored.
@type cb: callable
@raise UiError: If the widget does not exist.)";

constexpr char const* removeCallback =
    R"(Takes back one registration by L{addCallback}. If there is none for the same widget, event and object, nothing
happens.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param eventType: The event.
@type eventType: L{EventType}
@param cb: The very object that was registered.
@type cb: callable
@raise UiError: If the widget does not exist.)";

constexpr char const* setWidgetResourceName =
    R"(Names the UI resource that a widget has been built from, in which its tooltip is found.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param resName: The resource: a full path or a bare file name, with or without the extension.
@type resName: C{str}
@raise UiError: If the widget does not exist.
@raise RuntimeError: If the resource is there and is none.)";

constexpr char const* displayWidget =
    R"(Shows or hides a widget. A hidden one keeps its value.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param display: C{True} to show the widget, C{False} to hide it.
@type display: C{bool}
@raise UiError: If the widget does not exist.)";

constexpr char const* showWidget =
    R"(Shows a widget.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@raise UiError: If the widget does not exist.)";

constexpr char const* hideWidget =
    R"(Hides a widget. It keeps its value.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@raise UiError: If the widget does not exist.)";

constexpr char const* isDisplayed =
    R"(Tells whether a widget itself is displayed, also where what holds it is not.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@return: C{True} if it is.
@rtype: C{bool}
@raise UiError: If the widget does not exist.)";

constexpr char const* enableWidget =
    R"(Enables or disables a widget. A disabled one keeps its value and takes no input.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@param enable: C{True} to enable the widget, C{False} to disable it.
@type enable: C{bool}
@raise UiError: If the widget does not exist.)";

constexpr char const* isEnabled =
    R"(Tells whether a widget itself is enabled, also where what holds it is not.

@param widgetName: The name of the widget.
@type widgetName: C{str}
@return: C{True} if it is.
@rtype: C{bool})";

constexpr char const* disableNextClose =
    R"(Keeps the dialog open at the next press of a close button, and only at that. Called in an C{ACTIVATE} callback of a
close button that was added before the launch, it holds for the press that the callback runs for.)";

constexpr char const* cursorGuard =
    R"(Changes the current cursor to an alternate cursor, automatically reverting to previous cursor when going out of scope.
A cursor is named by a C{str}: C{'normal'}, known as C{Cursor.NORMAL}, or C{'busy'}, known as C{Cursor.BUSY}. Example::

    def render():
        cg = ui.CursorGuard( 'busy' )
        for frame in frames:
            renderFrame( frame )

    def ask():
        cg = ui.CursorGuard( 'normal' )
        return ui.showMessageBox( 'Render', [ 'Go on ?' ], [ 'Yes', 'No' ] ))";

constexpr char const* cursorGuardInit =
    R"(Makes a cursor the current one.

@param cursor: The name of the cursor.
@type cursor: C{str}
@raise RuntimeError: If there is no cursor of that name; the words list the names.)";

constexpr char const* browserScheme =
    R"(The constants of this class define the various browser schemes, that is the types of entity that can be browsed. There
are no instances of it. No function of this module takes a scheme or, as C{getBrowserScheme} would, gives one.)";

constexpr char const* workspace =
    R"(The compositions that the running application has open, and what is selected in its browsers. This class
only makes sense when scripts are executed in the embedded interpreter. All of its methods are static. Example::

    if ui.Workspace.getNbCompositions() > 0:
        print( ui.Workspace.getCurrentComposition().getPath() ))";

constexpr char const* getCurrentComposition =
    R"(Gets the current composition. Each call gives an object of its own for it.

@return: Composition that is currently opened in the Velmora UI workspace.
@rtype: L{Graph}
@raise UiError: If this method is not used within the embedded interpreter,
or if there is no current composition in the workspace.)";

constexpr char const* getCompositions =
    R"(Gets all compositions, in the order in which they were opened.

@return: The list of compositions that are opened in the Velmora UI workspace.
@rtype: C{list} of L{Graph}
@raise UiError: If this method is not used within the embedded interpreter.)";

constexpr char const* getNbCompositions =
    R"(Counts the compositions.

@return: The number of compositions that are opened in the Velmora UI workspace.
@rtype: C{int}
@raise UiError: If this method is not used within the embedded interpreter.)";

constexpr char const* openComposition =
    R"(Opens the given composition in the Velmora UI workspace. It becomes the current one. One that
C{graph.readComposition} has read belongs to the workspace from then on, changes included, and stays open without the
C{Graph}. If its file is open already, the composition that is open becomes the current one instead, and the C{Graph}
keeps its own.

@param path: Composition to open.
@type path: L{Graph}
@raise UiError: If this method is not used within the embedded interpreter.
@raise RuntimeError: If the composition has been closed, or if its file is open already and the C{Graph} has changes that
are not saved. Nothing has changed then.)";

constexpr char const* isCompositionOpened =
    R"(Indicates whether the composition at the specified path is currently opened in the Velmora UI workspace.

@param path: The path of the composition's file, with the extension C{vmcomposition}. It is the file that counts, by
whatever path it was opened.
@type path: C{str}
@return: C{True} if it is.
@rtype: C{bool}
@raise UiError: If this method is not used within the embedded interpreter.)";

constexpr char const* getBrowserSelection =
    R"(Gets the paths of elements selected in the Velmora browser in focus. The browser need not be a file system browser:
the paths are what its elements are called in the scheme that it shows (see L{BrowserScheme}).

@return: The paths. The list is empty if there's no selection or if there's no browser in focus.
@rtype: C{list} of C{str}
@raise UiError: If this method is not used within the embedded interpreter.)";

} // namespace Kv::PyextUi::Docs
