#pragma once

#include <boost/python/list.hpp>
#include <boost/python/object.hpp>

#include <memory>
#include <string>

namespace Kv
{

class XmlWriter;

namespace PyextUi
{

/// The label of the close button that a dialog always has.
inline std::string const okLabel = "OK";

/// The width of a text in the default font, in whole layout units.
int measureInUnits(std::string const& text);

/// Turns a list of widget entries into the description of a form: a row for each entry, with a caption on the left and
/// the widget on the right, and a bar of close buttons along the bottom. Each entry is a tuple ( type, name, label,
/// initial state ), of which the last two can be left out. Made for one call of `generate`.
class WidgetListGenerator
{
public:
    /// Both lists are shared with the caller: an empty `closeButtons` gets "OK" as its one label.
    WidgetListGenerator(boost::python::list const& widgetEntries, boost::python::list const& closeButtonLabels);
    ~WidgetListGenerator();

    /// The description. Throws `UiError` for an entry that is too short, and sets Python's `TypeError` or `IndexError`
    /// for one of the wrong form.
    std::string generate();

    /// Names the first entry of a kind that no row is of; None where there is none.
    static boost::python::object describeUnknownKind(boost::python::list const& widgetEntries);

private:
    struct WidgetEntry
    {
        std::string type;
        std::string name;
        std::string label;
        boost::python::object value;
    };

    /// The right edge and the value of the rows of one kind. Null stands for no value.
    struct RowKind
    {
        std::string name;
        int x2Value;
        char const* x2Target;
        void (WidgetListGenerator::*writeValue)(boost::python::object const&);
    };

    /// The place of an edge, as the description says it.
    struct Edge
    {
        int value;
        char const* type;
        char const* target;
        char const* sibling = "";
    };

    /// The kind without a name for a type that is none of the others.
    static RowKind const& findRowKind(std::string const& type);

    /// Writes the rows and gives the width of the caption column, in layout units.
    int writeRows();

    /// Leaves the `Container` and its `Group` open.
    void writeContainerHead(std::string const& name, Edge const& x1, Edge const& y1, Edge const& x2, Edge const& y2);
    void writeCloseButtons();
    void writeCloseButton(std::string const& label, int x, int width, bool alignRight);
    WidgetEntry readWidgetEntry(int index) const;
    void writeRow(WidgetEntry const& entry, int rowOffset);
    void writeValue(RowKind const& kind, WidgetEntry const& entry);
    /// Leaves the `Label` and its `Widget` open.
    void writeRowLabel(std::string const& label, int rowOffset);
    /// Leaves the widget element and its `Widget` open.
    void openRowWidget(std::string const& type, std::string const& name, int rowOffset, int x2Value,
                       char const* x2Target);
    /// Leaves the element and its `Widget` open.
    void openWidget(std::string const& element, std::string const& name);
    void closeTags(int count);
    void writeConstraint(Edge const& x1, Edge const& y1, Edge const& x2, Edge const& y2);
    void writeEdge(char const* edge, Edge const& place);
    void writeLabelString(std::string const& text);
    void writeLabelAlign(char const* h, char const* v);
    void writeTextValue(boost::python::object const& value);
    void writeStateValue(boost::python::object const& value);
    void writeMenuValue(boost::python::object const& value);
    static void substitutePlaceholders(std::string& text, int width);

    boost::python::list _widgets;
    boost::python::list _closeButtons;
    std::unique_ptr<XmlWriter> _writer;
};

} // namespace PyextUi

} // namespace Kv
