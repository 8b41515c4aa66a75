#pragma once

namespace Kv::PyextGraph::Docs
{

// The docstrings of the module, in epydoc markup.

constexpr char const* module = "Quorvane Velmora internal graph extension module.";

constexpr char const* graph =
    R"(The graph of a composition: nodes, each with a name of its own, a type, values, and inputs that refer to other
nodes. There is no public constructor: the workspace of the C{ui} module hands out the graphs of the compositions that
are open in Velmora, and L{readComposition} reads one from its file.

A C{Graph} does not keep a composition of the workspace open. Once that is closed, every method raises L{GraphError};
the object can still be compared, and printed. Two of them are equal if they stand for the same composition. Example::

    shot = ui.Workspace.getCurrentComposition()
    for node in shot.getNodes():
        if shot.getNodeType( node ) == 'ImageReader':
            shot.setNodeValue( node, 'proxy', 'half' )
    shot.save())";

constexpr char const* readComposition =
    R"(Reads the file of a composition, in Velmora and in an interpreter on its own. The composition is the script's own:
nobody sees it, and it is there for as long as the C{Graph}, until C{ui.Workspace.openComposition} gives it to the
workspace. Each call reads the file anew. Example::

    shot = graph.readComposition( '/shots/shot_010.vmcomposition' )
    shot.setNodeValue( 'Grade', 'gain', '1.3' )
    shot.save()

@param path: The path of the file. One that is relative begins in the current directory.
@type path: C{str}
@return: The graph of the composition. It only reads if the file cannot be written.
@rtype: L{Graph}
@raise GraphError: If there is no such file, if it cannot be read, if it is that of no composition, or if a later version
of the application has written it.)";

constexpr char const* getName =
    R"(Gets the name of the composition.

@return: The name of the composition's file, without its extension.
@rtype: C{str}
@raise GraphError: If the composition has been closed.)";

constexpr char const* getPath =
    R"(Gets the path of the composition's file.

@return: The path, absolute and with symbolic links followed.
@rtype: C{str}
@raise GraphError: If the composition has been closed.)";

constexpr char const* isWritable =
    R"(Tells whether the composition can be changed by this object. Its file is looked at for each call: one that cannot
be written cannot be changed.

@return: C{True} if it can.
@rtype: C{bool}
@raise GraphError: If the composition has been closed.)";

constexpr char const* getNodes =
    R"(Gets the names of all nodes.

@return: The names, in the order of the composition's file.
@rtype: C{list} of C{str}
@raise GraphError: If the composition has been closed.)";

constexpr char const* getNodeType =
    R"(Gets the type of a node.

@param nodeName: The name of the node.
@type nodeName: C{str}
@return: The type.
@rtype: C{str}
@raise GraphError: If there is no such node, or the composition has been closed.)";

constexpr char const* getNodeInputs =
    R"(Gets the inputs of a node.

@param nodeName: The name of the node.
@type nodeName: C{str}
@return: The names of the nodes that the inputs refer to, by the names of the inputs.
@rtype: C{dict}
@raise GraphError: If there is no such node, or the composition has been closed.)";

constexpr char const* getNodeValues =
    R"(Gets the values of a node.

@param nodeName: The name of the node.
@type nodeName: C{str}
@return: The values, all of them texts, by their names. To change one, use L{setNodeValue}.
@rtype: C{dict}
@raise GraphError: If there is no such node, or the composition has been closed.)";

constexpr char const* setNodeValue =
    R"(Sets a value of a node. One that is not there yet is added. The file changes when the composition is saved.

@param nodeName: The name of the node.
@type nodeName: C{str}
@param key: The name of the value, which is not empty.
@type key: C{str}
@param value: The value.
@type value: C{str}
@raise GraphError: If there is no such node, if a text holds a character that a file cannot hold, if the composition is
read-only, or if it has been closed. Nothing has changed then.)";

constexpr char const* save =
    R"(Writes the composition's file, as a whole or not at all.

@raise GraphError: If the file cannot be written, which leaves it as it was, if the composition is read-only, or if it
has been closed.)";

} // namespace Kv::PyextGraph::Docs
