#include <boost/python.hpp>

#include "pyWidgetListGenerator.h"

#include "cbHandler.h"
#include "pyDialog.h"
#include "pyUiError.h"
#include "pyUtils.h"
#include "pyWidgetValue.h"
#include "text/liString.h"
#include "text/liStringSubstituter.h"
#include "uiConstraint.h"
#include "wsFont.h"
#include "xml/xmlWriter.h"

#include <algorithm>
#include <array>
#include <ostream>
#include <streambuf>
#include <utility>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

std::string const textFieldType = "TextField";
std::string const toggleButtonType = "ToggleButton";
std::string const pushButtonType = "PushButton";
std::string const menuType = "Menu";
std::string const labelType = "Label";
constexpr char const* closeButtonsContainer = "CloseButtonsContainer";

// All in layout units.
constexpr int rowPitch = 4;
constexpr int rowHeight = 4;
constexpr int captionMargin = 3;
constexpr int toggleButtonWidth = 4;
constexpr int menuWidth = 20;
constexpr int rightMargin = -1;
constexpr int pushButtonMargin = 4;
constexpr int closeButtonWidth = 12;
constexpr int closeButtonStep = 14;
constexpr int closeButtonHeight = 4;
constexpr int closeBarHeight = 5;

// The width of the caption column is known only when all rows are written. Until then these stand in for it.
constexpr int labelColumnPlaceholder = -999;
constexpr int widgetColumnPlaceholder = -888;

/// A string stream, whose text can be taken without a copy of it.
class TextBuffer final : public std::streambuf
{
public:
    /// As much memory as a form of so many rows needs, as a rule.
    explicit TextBuffer(Py_ssize_t rowCount)
    {
        constexpr std::size_t rowSize = 1500;
        constexpr Py_ssize_t maxRows = 1 << 16;
        _text.reserve(rowSize * static_cast<std::size_t>(std::min(rowCount, maxRows) + 1));
    }

    std::string take() { return std::move(_text); }

protected:
    std::streamsize xsputn(char const* text, std::streamsize size) override
    {
        _text.append(text, static_cast<std::size_t>(size));
        return size;
    }

    int_type overflow(int_type character) override
    {
        _text += traits_type::to_char_type(character);
        return character;
    }

private:
    std::string _text;
};

struct Substituter
{
    void writeNumber(std::string& text, int number) { text = LiStringUtil::convertNb(number); }
};

} // namespace

int measureInUnits(std::string const& text)
{
    int const pixels = static_cast<int>(WsFontRegistry::getInstance().getDefaultFont()->getStringWidth(text.c_str()));
    return static_cast<int>(UiConstraint::pixelsToUIUnits({static_cast<float>(pixels), 0}).x);
}

WidgetListGenerator::WidgetListGenerator(bp::list const& widgetEntries, bp::list const& closeButtonLabels)
    : _widgets(widgetEntries), _closeButtons(closeButtonLabels)
{
    if (lengthOf(_closeButtons) == 0)
        _closeButtons.append(okLabel);
}

WidgetListGenerator::~WidgetListGenerator() = default;

std::string WidgetListGenerator::generate()
{
    // What says of itself that it is a list need not be one.
    TextBuffer buffer(PyList_Check(_widgets.ptr()) ? PyList_GET_SIZE(_widgets.ptr()) : 0);
    std::ostream stream(&buffer);
    // A lack of memory is told as one.
    stream.exceptions(std::ios::badbit);
    _writer = std::make_unique<XmlWriter>(stream, 2);
    writeContainerHead("MainContainer", {1, "u", "l"}, {1, "u", "b"}, {-1, "uu", "r"}, {-4, "uu", "t"});
    writeContainerHead(closeButtonsContainer, {0, "u", "l"}, {0, "u", "b"}, {0, "uu", "r"}, {closeBarHeight, "u", "h"});
    writeCloseButtons();
    closeTags(2);
    writeContainerHead("UserDefinedWidgetsContainer", {0, "u", "l"}, {1, "u", "s", closeButtonsContainer},
                       {0, "uu", "r"}, {0, "uu", "t"});
    int const labelColumnWidth = writeRows();
    closeTags(4);
    std::string text = buffer.take();
    _writer.reset();
    substitutePlaceholders(text, labelColumnWidth);
    return text;
}

bp::object WidgetListGenerator::describeUnknownKind(bp::list const& widgetEntries)
{
    int const count = lengthOf(widgetEntries);
    for (int index = 0; index < count; ++index)
    {
        bp::object const entry = widgetEntries[index];
        if (findRowKind(bp::extract<std::string>(entry[0])).name.empty())
            return describeEntry("widget list", index, entry) +
                   "; the kinds are TextField, ToggleButton, Menu, Label and PushButton";
    }
    return bp::object();
}

WidgetListGenerator::RowKind const& WidgetListGenerator::findRowKind(std::string const& type)
{
    using Generator = WidgetListGenerator;
    static std::array<RowKind, 6> const kinds{{
        {textFieldType, rightMargin, "r", &Generator::writeTextValue},
        {toggleButtonType, toggleButtonWidth, "w", &Generator::writeStateValue},
        {menuType, menuWidth, "w", &Generator::writeMenuValue},
        {labelType, 0, "r", &Generator::writeTextValue},
        {pushButtonType, 0, "w", nullptr},
        {"", rightMargin, "r", nullptr},
    }};
    return *std::find_if(kinds.begin(), kinds.end() - 1, [&type](RowKind const& kind) { return kind.name == type; });
}

int WidgetListGenerator::writeRows()
{
    std::size_t longest = 0;
    forEachEntry(_widgets, lengthOf(_widgets), "widget list",
                 [&](int index)
                 {
                     WidgetEntry const entry = readWidgetEntry(index);
                     longest = std::max(longest, entry.label.size());
                     writeRow(entry, rowPitch * index);
                 });
    return longest == 0 ? 0 : static_cast<int>(longest) + captionMargin;
}

void WidgetListGenerator::writeContainerHead(std::string const& name, Edge const& x1, Edge const& y1, Edge const& x2,
                                             Edge const& y2)
{
    openWidget("Container", name);
    writeConstraint(x1, y1, x2, y2);
    _writer->closeTag();
    _writer->openTag("Group");
    _writer->writeAttrib("Type", "Children");
}

void WidgetListGenerator::writeCloseButtons()
{
    int const count = lengthOf(_closeButtons);
    forEachEntry(_closeButtons, count, "list of close buttons",
                 [&](int i)
                 {
                     bool const alignRight = i == 1 && count == 2;
                     writeCloseButton(bp::extract<std::string>(_closeButtons[i]), closeButtonStep * i, closeButtonWidth,
                                      alignRight);
                 });
}

void WidgetListGenerator::writeCloseButton(std::string const& label, int x, int width, bool alignRight)
{
    openWidget(pushButtonType, closeButtonPrefix + label);
    writeLabelString(label);
    if (alignRight)
        writeConstraint({width, "u", "w"}, {0, "u", "b"}, {0, "uu", "r"}, {closeButtonHeight, "u", "h"});
    else
        writeConstraint({x, "u", "l"}, {0, "u", "b"}, {width, "u", "w"}, {closeButtonHeight, "u", "h"});
    writeLabelAlign("Center", "Center");
    closeTags(2);
}

WidgetListGenerator::WidgetEntry WidgetListGenerator::readWidgetEntry(int index) const
{
    auto const entry = castTo<bp::tuple>(_widgets[index]);
    int const length = lengthOf(entry);
    if (length < 2)
        throw UiError(__FILE__, __LINE__, "Incomplete widget description");
    WidgetEntry read;
    read.type = bp::extract<std::string>(entry[0]);
    read.name = bp::extract<std::string>(entry[1]);
    if (length >= 3)
        read.label = bp::extract<std::string>(entry[2]);
    if (length >= 4)
        read.value = entry[3];
    return read;
}

void WidgetListGenerator::writeRow(WidgetEntry const& entry, int rowOffset)
{
    if (!entry.label.empty())
    {
        writeRowLabel(entry.label, rowOffset);
        closeTags(2);
    }
    RowKind const& kind = findRowKind(entry.type);
    int const x2Value = entry.type == pushButtonType ? measureInUnits(entry.name) + pushButtonMargin : kind.x2Value;
    openRowWidget(entry.type, entry.name, rowOffset, x2Value, kind.x2Target);
    if (kind.writeValue)
        withNote([&] { writeValue(kind, entry); }, [&] { return describeValue(kind.name, entry.name, entry.value); });
    closeTags(2);
}

void WidgetListGenerator::writeValue(RowKind const& kind, WidgetEntry const& entry)
{
    if (entry.value)
        (this->*kind.writeValue)(entry.value);
}

void WidgetListGenerator::writeRowLabel(std::string const& label, int rowOffset)
{
    openWidget(labelType, labelType + "_" + label);
    writeConstraint({0, "u", "l"}, {rowHeight, "u", "h"}, {labelColumnPlaceholder, "u", "w"}, {-rowOffset, "uu", "t"});
    writeLabelString(label);
    writeLabelAlign("Left", "Center");
}

void WidgetListGenerator::openRowWidget(std::string const& type, std::string const& name, int rowOffset, int x2Value,
                                        char const* x2Target)
{
    bool const isPushButton = type == pushButtonType;
    openWidget(type, name);
    if (isPushButton)
        writeLabelString(name);
    writeConstraint({widgetColumnPlaceholder, "u", "l"}, {rowHeight, "u", "h"}, {x2Value, "uu", x2Target},
                    {-rowOffset, "uu", "t"});
    writeLabelAlign(isPushButton ? "Center" : "Left", "Center");
}

void WidgetListGenerator::openWidget(std::string const& element, std::string const& name)
{
    _writer->openTag(element);
    _writer->openTag("Widget");
    _writer->writeAttrib("Name", name);
}

void WidgetListGenerator::closeTags(int count)
{
    for (int i = 0; i < count; ++i)
        _writer->closeTag();
}

void WidgetListGenerator::writeConstraint(Edge const& x1, Edge const& y1, Edge const& x2, Edge const& y2)
{
    _writer->openTag("Layout");
    _writer->openTag("Constraint");
    writeEdge("X1", x1);
    writeEdge("Y1", y1);
    writeEdge("X2", x2);
    writeEdge("Y2", y2);
    closeTags(2);
}

void WidgetListGenerator::writeEdge(char const* edge, Edge const& place)
{
    _writer->openTag(edge);
    _writer->writeAttrib("Value", place.value);
    _writer->writeAttrib("Type", place.type);
    _writer->writeAttrib("Target", place.target);
    if (*place.sibling)
        _writer->writeAttrib("Sibling", place.sibling);
    _writer->closeTag();
}

void WidgetListGenerator::writeLabelString(std::string const& text)
{
    _writer->openTag("LabelString");
    _writer->writeTag("Text", text);
    _writer->closeTag();
}

void WidgetListGenerator::writeLabelAlign(char const* h, char const* v)
{
    _writer->openTag("LabelAlign");
    _writer->openTag("Align");
    _writer->writeAttrib("H", h);
    _writer->writeAttrib("V", v);
    closeTags(2);
}

void WidgetListGenerator::writeTextValue(bp::object const& value)
{
    std::string const text = bp::extract<std::string>(value);
    if (!text.empty())
        writeLabelString(text);
}

void WidgetListGenerator::writeStateValue(bp::object const& value)
{
    _writer->openTag("State");
    bool const state = bp::extract<bool>(value);
    _writer->writeTag("Int", state ? 1 : 0);
    _writer->closeTag();
}

void WidgetListGenerator::writeMenuValue(bp::object const& value)
{
    auto const form = castTo<bp::tuple>(value);
    auto const items = castTo<bp::list>(form[0]);
    int const selection = bp::extract<int>(form[1]);
    _writer->openTag("MenuString");
    int const count = lengthOf(items);
    for (int i = 0; i < count; ++i)
        _writer->writeTag("Text", bp::extract<std::string>(items[i])());
    _writer->closeTag();
    _writer->openTag("Selection");
    _writer->writeTag("Int", selection);
    _writer->closeTag();
}

void WidgetListGenerator::substitutePlaceholders(std::string& text, int width)
{
    using NumberHandler = CbDataMethod<Substituter, std::string, int>;
    Substituter writer;
    NumberHandler labelColumn(&writer, &Substituter::writeNumber, width);
    NumberHandler widgetColumn(&writer, &Substituter::writeNumber, width);
    LiStringSubstituter substituter;
    substituter.add(LiStringUtil::convertNb(labelColumnPlaceholder), &labelColumn);
    substituter.add(LiStringUtil::convertNb(widgetColumnPlaceholder), &widgetColumn);
    text = substituter.substitute(text);
}

} // namespace Kv::PyextUi
